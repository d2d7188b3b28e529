// TypedText: what is being typed in a text control and has not been sent yet.
#pragma once

class BTextControl;
class BWindow;

// The text control that has the window's keyboard, or NULL.
BTextControl* FieldInUse(const BWindow* window);

// Has the control send what was typed in it, as when the focus moves on. Its message, if something
// was typed, is posted behind those that wait already. The control keeps the focus and its
// selection. With the window locked.
void SendTypedText(BTextControl* field);
