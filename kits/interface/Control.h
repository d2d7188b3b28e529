// BControl: a view with a label, a value and a message that it sends when it is operated.
#pragma once

#include <InterfaceDefs.h>
#include <Invoker.h>
#include <View.h>

#include <memory>
#include <string>

class BMessage;

enum { B_CONTROL_OFF = 0, B_CONTROL_ON = 1, B_CONTROL_PARTIALLY_ON = 2 };


// The base of everything that a user operates. Setters redraw what they change; like all of a
// view they need the window's lock when attached. The message given to the constructor is
// owned. When attached without a target, the window becomes the target.
class _EXPORT BControl : public BView, public BInvoker {
public:
	BControl(BRect frame, const char* name, const char* label, BMessage* message,
		uint32 resizingMode, uint32 flags);
	BControl(BMessage* archive);
	virtual ~BControl();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	virtual void AttachedToWindow();
	virtual void AllAttached();
	virtual void DetachedFromWindow();
	virtual void AllDetached();
	virtual void WindowActivated(bool active);

	virtual void MessageReceived(BMessage* message);
	virtual void MakeFocus(bool focused = true);
	virtual void KeyDown(const char* bytes, int32 numBytes);
	virtual void MouseDown(BPoint where);
	virtual void MouseUp(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage);

	// An empty label is no label: Label() then answers NULL.
	virtual void SetLabel(const char* label);
	const char* Label() const;

	virtual void SetValue(int32 value);
	int32 Value() const;

	// A disabled control is not reached by keyboard navigation; enabling gives that back to a
	// control that had it.
	virtual void SetEnabled(bool enabled);
	bool IsEnabled() const;

	virtual void GetPreferredSize(float* _width, float* _height);
	virtual void ResizeToPreferred();

	// Sends a copy of the given message, or of the control's own, with "when", "source" and
	// "be:value" added. B_BAD_VALUE without a message.
	virtual status_t Invoke(BMessage* message = NULL);

	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 what, const char* property);
	virtual status_t GetSupportedSuites(BMessage* message);
	virtual status_t Perform(perform_code code, void* data);

protected:
	// True inside MakeFocus() while the focus comes or goes.
	bool IsFocusChanging() const;
	bool IsTracking() const;
	void SetTracking(bool tracking);
	void SetValueNoUpdate(int32 value);

private:
	BControl(const BControl&) = delete;
	BControl& operator=(const BControl&) = delete;

	bool _HandleProperty(BMessage* message);

	std::string fLabel; // empty: no label
	int32 fValue;
	bool fEnabled;
	bool fFocusChanging;
	bool fTracking;
	bool fWantsNavigation; // gets B_NAVIGABLE back when enabled
};
