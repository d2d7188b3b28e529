// Groups: boxes of controls, each with one kind of control in all its states.
#pragma once

#include <Rect.h>

class BView;


// The frames are those of the boxes; the caller owns the result, a view without a parent.
BView* NewButtonGroup(BRect frame);
BView* NewChoiceGroup(BRect frame);
BView* NewStringGroup(BRect frame);
BView* NewFieldGroup(BRect frame);
BView* NewSliderGroup(BRect frame);
BView* NewStatusGroup(BRect frame);
BView* NewListGroup(BRect frame);
BView* NewTextGroup(BRect frame);
BView* NewPageGroup(BRect frame);

// A page of the last group.
BView* NewValuePage(BRect frame);
