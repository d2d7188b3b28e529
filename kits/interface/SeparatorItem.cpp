#include "SeparatorItem.h"

#include <cmath>

#include <Message.h>

#include "interface/private/Look.h"

namespace {

constexpr float kHeight = 7; // bottom - top of the content
constexpr float kInset = 2; // of the line, from both sides

} // namespace


BSeparatorItem::BSeparatorItem() : BMenuItem("", NULL)
{
	BMenuItem::SetEnabled(false);
}


BSeparatorItem::BSeparatorItem(BMessage* archive) : BMenuItem(archive)
{
	BMenuItem::SetEnabled(false);
}


BSeparatorItem::~BSeparatorItem() = default;


BArchivable*
BSeparatorItem::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BSeparatorItem") ? new BSeparatorItem(archive) : NULL;
}


status_t
BSeparatorItem::Archive(BMessage* archive, bool deep) const
{
	return BMenuItem::Archive(archive, deep);
}


void
BSeparatorItem::SetEnabled(bool)
{
}


void
BSeparatorItem::GetContentSize(float* _width, float* _height)
{
	if (_width != NULL)
		*_width = kInset;
	if (_height != NULL)
		*_height = kHeight;
}


void
BSeparatorItem::Draw()
{
	BMenu* menu = Menu();
	BRect line = Frame();
	if (menu->Layout() == B_ITEMS_IN_ROW) {
		line.left = std::floor((line.left + line.right) / 2);
		line.right = line.left + 1;
		line.InsetBy(0, kInset);
	} else {
		line.top = std::floor((line.top + line.bottom) / 2);
		line.bottom = line.top + 1;
		line.InsetBy(kInset, 0);
	}
	BPrivate::Look::DrawSeparator(menu, line, menu->LowColor());
}
