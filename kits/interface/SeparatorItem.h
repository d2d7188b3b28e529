// BSeparatorItem: a line between the items of a menu.
#pragma once

#include <MenuItem.h>


// Always disabled, with an empty label.
class BSeparatorItem : public BMenuItem {
public:
	BSeparatorItem();
	BSeparatorItem(BMessage* archive);
	virtual ~BSeparatorItem();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;
	virtual void SetEnabled(bool enabled);

protected:
	virtual void GetContentSize(float* _width, float* _height);
	virtual void Draw();
};
