// BOptionPopUp: a menu field whose choice is the value of a control.
#pragma once

#include <OptionControl.h>

class BMenu;
class BMenuField;


// The options are the items of the pop-up menu of a BMenuField, the child "_menu", which the user
// operates and the keyboard reaches: the control itself is never navigable. The first option that
// is added becomes the value. A choice by the user sets the value and invokes the control.
class _EXPORT BOptionPopUp : public BOptionControl {
public:
	BOptionPopUp(BRect frame, const char* name, const char* label, BMessage* message,
		uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP, uint32 flags = B_WILL_DRAW);
	// A menu field of fixed size takes all the room right of its divider.
	BOptionPopUp(BRect frame, const char* name, const char* label, BMessage* message,
		bool fixedSize, uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP,
		uint32 flags = B_WILL_DRAW);
	BOptionPopUp(BMessage* archive);
	virtual ~BOptionPopUp();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	// The child. A control whose archive had none gets an empty one when it is first asked for.
	BMenuField* MenuField();

	virtual bool GetOptionAt(int32 index, const char** _name, int32* _value);
	// The value stays, also when it was this option's.
	virtual void RemoveOptionAt(int32 index);
	virtual int32 CountOptions() const;
	virtual status_t AddOptionAt(const char* name, int32 value, int32 index);
	virtual int32 SelectedOption(const char** _name = NULL, int32* _value = NULL) const;

	virtual void AttachedToWindow();
	virtual void AllAttached();
	virtual void MessageReceived(BMessage* message);
	virtual void MakeFocus(bool focused = true);
	virtual void Draw(BRect updateRect);

	// The label is the menu field's.
	virtual void SetLabel(const char* label);
	// Marks the first option of that value. Without one nothing is marked anew.
	virtual void SetValue(int32 value);
	virtual void SetEnabled(bool enabled);

	// Room for the label and for every option.
	virtual void GetPreferredSize(float* _width, float* _height);
	// Moves the menu field's divider behind the label as well.
	virtual void ResizeToPreferred();

private:
	BOptionPopUp(const BOptionPopUp&) = delete;
	BOptionPopUp& operator=(const BOptionPopUp&) = delete;

	BMenuField* _Field() const;
	BMenu* _Menu() const;
	void _CreateField(bool fixedSize);
	float _PreferredDivider() const;
};
