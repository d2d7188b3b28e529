// What the WindowInspector tells of each class of view.

#include "interface/private/WindowInspector.h"

#include <cstdio>
#include <cstdlib>
#include <cxxabi.h>
#include <typeinfo>

#include <Box.h>
#include <Control.h>
#include <Font.h>
#include <ListItem.h>
#include <ListView.h>
#include <Menu.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <ScrollBar.h>
#include <StatusBar.h>
#include <StringItem.h>
#include <StringView.h>
#include <TabView.h>
#include <TextControl.h>
#include <TextView.h>
#include <View.h>
#include <Window.h>

namespace BPrivate {

namespace {

std::string
Text(const char* text)
{
	return text != nullptr ? text : "";
}


std::string
Number(float number)
{
	char text[32];
	std::snprintf(text, sizeof(text), "%g", number);
	return text;
}


// The first base of a class; NULL for one without.
const std::type_info*
BaseOf(const std::type_info& type)
{
	if (const auto* single = dynamic_cast<const abi::__si_class_type_info*>(&type))
		return single->__base_type;
	const auto* several = dynamic_cast<const abi::__vmi_class_type_info*>(&type);
	if (several == nullptr || several->__base_count == 0)
		return nullptr;
	return several->__base_info[0].__base_type;
}


void
AddClasses(const BView& view, ViewNode& node)
{
	const std::type_info* type = &typeid(view);
	node.className = class_name_of(*type);
	while (*type != typeid(BView)) {
		type = BaseOf(*type);
		if (type == nullptr)
			return;
		node.baseClasses.push_back(class_name_of(*type));
	}
}


// #pragma mark - items


ViewNode
MakeItem(const void* address, BRect frame, const BView& view, const ViewNode& parent)
{
	ViewNode item;
	item.address = address;
	item.isItem = true;
	item.frame = frame;
	item.bounds = frame.OffsetToCopy(0, 0);
	item.screen = view.ConvertToScreen(frame);
	item.visible = item.screen & parent.visible;
	item.hidden = parent.hidden;
	item.viewColor = parent.viewColor;
	item.lowColor = parent.lowColor;
	item.highColor = parent.highColor;
	return item;
}


void
AddListItems(BListView& list, ViewNode& node)
{
	node.count = list.CountItems();
	for (int32 i = 0; i < node.count; i++) {
		BListItem* entry = list.ItemAt(i);
		ViewNode item = MakeItem(entry, list.ItemFrame(i), list, node);
		if (const auto* text = dynamic_cast<const BStringItem*>(entry))
			item.text = Text(text->Text());
		item.className = class_name_of(typeid(*entry));
		item.enabled = entry->IsEnabled();
		item.isSelected = list.IsItemSelected(i);
		item.level = static_cast<int32>(entry->OutlineLevel());
		if (item.isSelected)
			node.selection.push_back(i);
		node.children.push_back(std::move(item));
	}
}


void
AddMenuItems(BMenu& menu, ViewNode& node)
{
	node.count = menu.CountItems();
	node.enabled = menu.IsEnabled();
	for (int32 i = 0; i < node.count; i++) {
		BMenuItem* entry = menu.ItemAt(i);
		ViewNode item = MakeItem(entry, entry->Frame(), menu, node);
		item.className = class_name_of(typeid(*entry));
		item.label = Text(entry->Label());
		item.enabled = entry->IsEnabled();
		item.isMarked = entry->IsMarked();
		if (item.isMarked)
			node.marked = item.label;
		node.children.push_back(std::move(item));
	}
}


void
AddTabs(BTabView& tabs, ViewNode& node)
{
	node.count = tabs.CountTabs();
	for (int32 i = 0; i < node.count; i++) {
		BTab* tab = tabs.TabAt(i);
		ViewNode item = MakeItem(tab, tabs.TabFrame(i), tabs, node);
		item.className = class_name_of(typeid(*tab));
		item.label = Text(tab->Label());
		item.enabled = tab->IsEnabled();
		item.isSelected = tabs.Selection() == i;
		if (item.isSelected)
			node.selection.push_back(i);
		node.children.push_back(std::move(item));
	}
}


// #pragma mark - views


void
AddMenuField(BMenuField& field, ViewNode& node)
{
	node.label = Text(field.Label());
	node.enabled = field.IsEnabled();
	const BMenuItem* marked = field.Menu() != nullptr ? field.Menu()->FindMarked() : nullptr;
	const BMenuItem* shown = field.MenuItem();
	if (marked == nullptr)
		marked = shown;
	if (marked != nullptr)
		node.marked = Text(marked->Label());
	if (shown != nullptr)
		node.text = Text(shown->Label());
}


// Whatever a class alone knows of itself.
void
AddContents(BView& view, ViewNode& node)
{
	if (auto* control = dynamic_cast<BControl*>(&view)) {
		node.label = Text(control->Label());
		node.value = std::to_string(control->Value());
		node.enabled = control->IsEnabled();
	}
	if (auto* control = dynamic_cast<BTextControl*>(&view))
		node.text = Text(control->Text());
	else if (auto* text = dynamic_cast<BTextView*>(&view))
		node.text = Text(text->Text());
	else if (auto* string = dynamic_cast<BStringView*>(&view))
		node.text = Text(string->Text());
	else if (auto* box = dynamic_cast<BBox*>(&view))
		node.label = Text(box->Label());
	else if (auto* bar = dynamic_cast<BScrollBar*>(&view))
		node.value = Number(bar->Value());
	else if (auto* field = dynamic_cast<BMenuField*>(&view))
		AddMenuField(*field, node);
	else if (auto* list = dynamic_cast<BListView*>(&view))
		AddListItems(*list, node);
	else if (auto* menu = dynamic_cast<BMenu*>(&view))
		AddMenuItems(*menu, node);
	else if (auto* tabs = dynamic_cast<BTabView*>(&view))
		AddTabs(*tabs, node);
	else if (auto* bar = dynamic_cast<BStatusBar*>(&view)) {
		node.label = Text(bar->Label());
		node.text = Text(bar->Text());
		node.value = Number(bar->CurrentValue());
	}
}


ViewNode
DescribeView(BView& view, const ViewNode& parent)
{
	ViewNode node;
	node.address = &view;
	AddClasses(view, node);
	node.name = Text(view.Name());
	node.frame = view.Frame();
	node.bounds = view.Bounds();
	node.screen = view.ConvertToScreen(node.bounds);
	node.visible = node.screen & parent.visible;
	node.hidden = parent.hidden || view.IsHidden(&view);
	node.focus = view.IsFocus();
	node.viewColor = view.ViewColor();
	node.lowColor = view.LowColor();
	node.highColor = view.HighColor();

	BFont font;
	view.GetFont(&font);
	font_family family;
	font_style style;
	font.GetFamilyAndStyle(&family, &style);
	node.font = std::string(family) + '/' + style + '/' + Number(font.Size());

	AddContents(view, node);
	const size_t items = node.children.size();
	for (BView* child = view.ChildAt(0); child != nullptr; child = child->NextSibling())
		node.children.push_back(DescribeView(*child, node));
	if (items == 0 && node.count == 0)
		node.count = static_cast<int32>(node.children.size());
	return node;
}


BView*
FindIn(BView* view, const void* address)
{
	for (; view != nullptr; view = view->NextSibling()) {
		if (view == address)
			return view;
		if (BView* found = FindIn(view->ChildAt(0), address))
			return found;
	}
	return nullptr;
}

} // namespace


std::string
class_name_of(const std::type_info& type)
{
	int status = 0;
	char* name = abi::__cxa_demangle(type.name(), nullptr, nullptr, &status);
	const std::string result = status == 0 ? name : type.name();
	std::free(name);
	return result;
}


ViewNode
describe_window(BWindow& window)
{
	ViewNode root;
	root.className = class_name_of(typeid(window));
	root.name = Text(window.Title());
	root.frame = window.Frame();
	root.bounds = window.Bounds();
	root.screen = window.Frame();
	root.visible = root.screen;
	root.hidden = window.IsHidden();
	for (BView* child = window.ChildAt(0); child != nullptr; child = child->NextSibling())
		root.children.push_back(DescribeView(*child, root));
	root.count = static_cast<int32>(root.children.size());
	return root;
}


BView*
find_view(BWindow& window, const void* address)
{
	return FindIn(window.ChildAt(0), address);
}


} // namespace BPrivate
