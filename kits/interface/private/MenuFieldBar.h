// The menu bar inside of a menu field. The names of the classes are those that archives have.
#pragma once

#include <MenuBar.h>
#include <MenuItem.h>

class BMenuField;


// One item, whose submenu is the field's menu, fills the whole bar.
class _BMCMenuBar_ : public BMenuBar {
public:
	_BMCMenuBar_(BRect frame, bool fixedSize);
	_BMCMenuBar_(BMessage* archive);
	virtual ~_BMCMenuBar_();

	static BArchivable* Instantiate(BMessage* archive);

	virtual void AttachedToWindow();
	virtual void Draw(BRect updateRect);
	virtual void MouseDown(BPoint where);
	virtual void FrameResized(float width, float height);
	virtual void GetPreferredSize(float* _width, float* _height);
	virtual void MakeFocus(bool focus = true);

	BMenuField* Field() const;

private:
	virtual void _LayoutChanged();
	void _TakeMargins();
	void _StretchItem();
};


// What older systems put into that bar.
class _BMCItem_ : public BMenuItem {
public:
	_BMCItem_(BMessage* archive);

	static BArchivable* Instantiate(BMessage* archive);
};
