#include "interface/private/ViewInspector.h"

#include <cstdio>
#include <cxxabi.h>
#include <mutex>
#include <typeinfo>

#include <Alert.h>
#include <Box.h>
#include <Button.h>
#include <ListView.h>
#include <Menu.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <OutlineListView.h>
#include <ScrollBar.h>
#include <Slider.h>
#include <StatusBar.h>
#include <StringItem.h>
#include <StringView.h>
#include <TabView.h>
#include <TextControl.h>
#include <TextView.h>
#include <Window.h>

#include "interface/private/StandInView.h"
#include "interface/private/ViewPrivate.h"
#include "interface/private/WindowInternals.h"
#include "server/Desktop.h"

namespace BPrivate {

namespace {

struct WindowEntry {
	BWindow* window;
	WindowNode node;
};


// Windows are looked at from threads that may not wait for their locks.
struct Windows {
	std::mutex lock;
	std::vector<WindowEntry> entries;

	WindowNode* Find(const BWindow* window)
	{
		for (WindowEntry& entry : entries) {
			if (entry.window == window)
				return &entry.node;
		}
		return nullptr;
	}
};


// Never destroyed: windows' threads outlive main() in a program that just returns from it.
Windows&
windows()
{
	static Windows* const sWindows = new Windows;
	return *sWindows;
}


// #pragma mark - classes


std::string
readable_name(const std::type_info& type)
{
	int status = 0;
	char* name = abi::__cxa_demangle(type.name(), nullptr, nullptr, &status);
	std::string result = status == 0 && name != nullptr ? name : type.name();
	std::free(name);
	return result;
}


const std::type_info*
base_of(const std::type_info& type)
{
	if (const auto* single = dynamic_cast<const abi::__si_class_type_info*>(&type))
		return single->__base_type;
	if (const auto* multiple = dynamic_cast<const abi::__vmi_class_type_info*>(&type)) {
		if (multiple->__base_count > 0)
			return multiple->__base_info[0].__base_type;
	}
	return nullptr;
}


void
describe_class(const std::type_info& type, ViewNode* _node)
{
	_node->className = readable_name(type);
	for (const std::type_info* base = &type; base != nullptr && *base != typeid(BView);) {
		base = base_of(*base);
		if (base != nullptr)
			_node->baseClasses.push_back(readable_name(*base));
	}
}


std::string
text_of(const char* text)
{
	return text != nullptr ? text : "";
}


std::string
number_text(double number)
{
	char buffer[32];
	std::snprintf(buffer, sizeof(buffer), "%g", number);
	return buffer;
}


// #pragma mark - items


ViewNode
item_node(const void* address, const std::type_info& type, BRect frame, const ViewNode& owner)
{
	ViewNode node;
	node.address = address;
	node.className = readable_name(type);
	node.isItem = true;
	node.frame = frame;
	node.bounds = frame.OffsetToCopy(0, 0);
	node.screen = frame.OffsetByCopy(owner.screen.LeftTop() - owner.bounds.LeftTop());
	node.visible = node.screen & owner.visible;
	node.hidden = owner.hidden;
	return node;
}


void
describe_list(BListView* list, ViewNode* _node)
{
	_node->count = list->CountItems();
	for (int32 i = 0, index; (index = list->CurrentSelection(i)) >= 0; i++)
		_node->selection.push_back(index);
	for (int32 i = 0; i < list->CountItems(); i++) {
		BListItem* item = list->ItemAt(i);
		ViewNode node = item_node(item, typeid(*item), list->ItemFrame(i), *_node);
		if (const BStringItem* string = dynamic_cast<const BStringItem*>(item))
			node.text = text_of(string->Text());
		node.level = static_cast<int32>(item->OutlineLevel());
		node.enabled = item->IsEnabled();
		node.isSelected = item->IsSelected();
		_node->children.push_back(std::move(node));
	}
}


void
describe_menu(BMenu* menu, ViewNode* _node)
{
	_node->count = menu->CountItems();
	for (int32 i = 0; i < menu->CountItems(); i++) {
		BMenuItem* item = menu->ItemAt(i);
		ViewNode node = item_node(item, typeid(*item), item->Frame(), *_node);
		node.label = text_of(item->Label());
		node.enabled = item->IsEnabled();
		node.isMarked = item->IsMarked();
		_node->children.push_back(std::move(node));
	}
}


void
describe_tabs(BTabView* tabs, ViewNode* _node)
{
	_node->count = tabs->CountTabs();
	for (int32 i = 0; i < tabs->CountTabs(); i++) {
		BTab* tab = tabs->TabAt(i);
		ViewNode node = item_node(tab, typeid(*tab), tabs->TabFrame(i), *_node);
		node.label = text_of(tab->Label());
		node.enabled = tab->IsEnabled();
		node.isSelected = i == tabs->Selection();
		_node->children.push_back(std::move(node));
	}
}


// #pragma mark - views


void
describe_contents(BView* view, ViewNode* _node)
{
	if (BControl* control = dynamic_cast<BControl*>(view)) {
		_node->label = text_of(control->Label());
		_node->value = number_text(control->Value());
		_node->enabled = control->IsEnabled();
	}
	if (BTextControl* control = dynamic_cast<BTextControl*>(view))
		_node->text = text_of(control->Text());
	else if (BTextView* text = dynamic_cast<BTextView*>(view)) {
		_node->text = text_of(text->Text());
	} else if (BStringView* string = dynamic_cast<BStringView*>(view))
		_node->text = text_of(string->Text());
	else if (BStatusBar* bar = dynamic_cast<BStatusBar*>(view)) {
		_node->label = text_of(bar->Label());
		_node->text = text_of(bar->Text());
		_node->value = number_text(bar->CurrentValue());
	} else if (BScrollBar* bar = dynamic_cast<BScrollBar*>(view))
		_node->value = number_text(bar->Value());
	else if (BBox* box = dynamic_cast<BBox*>(view))
		_node->label = text_of(box->Label());
	else if (BListView* list = dynamic_cast<BListView*>(view))
		describe_list(list, _node);
	else if (BMenu* menu = dynamic_cast<BMenu*>(view))
		describe_menu(menu, _node);
	else if (BTabView* tabs = dynamic_cast<BTabView*>(view))
		describe_tabs(tabs, _node);
	else if (BMenuField* field = dynamic_cast<BMenuField*>(view)) {
		_node->label = text_of(field->Label());
		_node->enabled = field->IsEnabled();
		BMenuItem* marked = field->Menu() != nullptr ? field->Menu()->FindMarked() : nullptr;
		if (marked == nullptr)
			marked = field->MenuItem();
		_node->marked = marked != nullptr ? text_of(marked->Label()) : "";
	} else if (StandInView* standIn = dynamic_cast<StandInView*>(view))
		_node->label = standIn->ArchivedClass();
}


std::string
font_text(const BView* view)
{
	BFont font;
	view->GetFont(&font);
	font_family family;
	font_style style;
	font.GetFamilyAndStyle(&family, &style);
	return std::string(family) + "/" + style + "/" + number_text(font.Size());
}


ViewNode
describe_view(BView* view, const ViewNode& parent, const ViewTree& tree, BPoint windowPlace)
{
	ViewNode node;
	node.address = view;
	describe_class(typeid(*view), &node);
	node.name = text_of(view->Name());
	node.count = view->CountChildren();
	node.frame = view->Frame();
	node.bounds = view->Bounds();
	node.screen = view->Frame().OffsetByCopy(parent.screen.LeftTop() - parent.bounds.LeftTop());
	const BRect visible = tree.VisibleFrame(*ViewPrivate(view).Node());
	node.visible = visible.IsValid() ? visible.OffsetByCopy(windowPlace) : BRect();
	node.hidden = parent.hidden || ViewPrivate(view).Node()->HideCount() > 0;
	node.focus = view->IsFocus();
	node.font = font_text(view);
	node.viewColor = view->ViewColor();
	node.lowColor = view->LowColor();
	node.highColor = view->HighColor();
	describe_contents(view, &node);
	for (BView* child = view->ChildAt(0); child != nullptr; child = child->NextSibling())
		node.children.push_back(describe_view(child, node, tree, windowPlace));
	return node;
}


// By the window's own thread, or under its lock: until it is made, and from when it is deleted, its
// class changes.
void
note_class(BWindow* window, WindowNode* _node)
{
	_node->className = readable_name(typeid(*window));
	_node->isAlert = dynamic_cast<BAlert*>(window) != nullptr;
}


// The window of that number, locked; NULL with the reason.
BWindow*
lock_window(uint32 id, bigtime_t timeout, status_t* _status)
{
	BWindow* window = nullptr;
	{
		std::lock_guard guard(windows().lock);
		for (const WindowEntry& entry : windows().entries) {
			if (entry.node.id == id)
				window = entry.window;
		}
	}
	*_status = B_BAD_VALUE;
	if (window == nullptr)
		return nullptr;
	// The address alone is used for locking: the window may end meanwhile.
	const status_t status = window->LockWithTimeout(timeout);
	if (status != B_OK) {
		if (status == B_TIMED_OUT)
			*_status = status;
		return nullptr;
	}
	const WindowInternals& internals = WindowInternals::Of(window);
	if (internals.server == nullptr || internals.server->Id() != id) {
		window->Unlock();
		return nullptr;
	}
	*_status = B_OK;
	return window;
}

} // namespace


void
ViewInspector::Install()
{
	static ViewInspector sInspector;
	if (Desktop* desktop = Desktop::Get())
		desktop->SetInspector(&sInspector);
}


std::vector<WindowNode>
ViewInspector::Windows()
{
	constexpr bigtime_t kPatience = 20000;
	std::vector<WindowNode> nodes;
	{
		std::lock_guard guard(windows().lock);
		for (const WindowEntry& entry : windows().entries)
			nodes.push_back(entry.node);
	}
	for (WindowNode& node : nodes) {
		status_t status;
		BWindow* window = node.shown ? lock_window(node.id, kPatience, &status) : nullptr;
		if (window == nullptr)
			continue;
		note_class(window, &node);
		node.frame = window->Frame();
		window->Unlock();
	}
	return nodes;
}


status_t
ViewInspector::Describe(uint32 id, bigtime_t timeout, ViewNode* _root)
{
	status_t status;
	BWindow* window = lock_window(id, timeout, &status);
	if (window == nullptr)
		return status;
	const ViewTree& tree = WindowInternals::Of(window).tree;
	ViewNode root;
	root.address = window;
	root.frame = root.bounds = window->Bounds();
	root.screen = root.visible = window->Frame();
	root.hidden = window->IsHidden();
	root.count = window->CountChildren();
	for (BView* view = window->ChildAt(0); view != nullptr; view = view->NextSibling())
		root.children.push_back(describe_view(view, root, tree, root.screen.LeftTop()));
	window->Unlock();
	*_root = std::move(root);
	return B_OK;
}


status_t
ViewInspector::RevealItem(uint32 id, const void* view, const void* item)
{
	status_t status;
	BWindow* window = lock_window(id, 1000000, &status);
	if (window == nullptr)
		return status;
	status = B_ENTRY_NOT_FOUND;
	const ServerView& root = WindowInternals::Of(window).tree.Root();
	for (ServerView* node = root.FirstChild(); node != nullptr; node = node->NextInTree(&root)) {
		if (node->Owner() != view)
			continue;
		BListView* list = dynamic_cast<BListView*>(node->Owner());
		for (int32 i = 0; list != nullptr && i < list->CountItems(); i++) {
			if (list->ItemAt(i) != item)
				continue;
			const BRect frame = list->ItemFrame(i);
			const BRect bounds = list->Bounds();
			if (frame.top < bounds.top)
				list->ScrollTo(BPoint(bounds.left, frame.top));
			else if (frame.bottom > bounds.bottom)
				list->ScrollTo(BPoint(bounds.left, frame.bottom - bounds.Height()));
			status = B_OK;
		}
		break;
	}
	window->Unlock();
	return status;
}


// #pragma mark - WindowList


void
WindowList::Add(BWindow* window, uint32 id)
{
	std::lock_guard guard(windows().lock);
	WindowNode node;
	node.id = id;
	windows().entries.push_back({ window, node });
}


void
WindowList::Remove(BWindow* window)
{
	std::lock_guard guard(windows().lock);
	std::erase_if(
		windows().entries, [window](const WindowEntry& entry) { return entry.window == window; });
}


void
WindowList::SetTitle(BWindow* window, const char* title)
{
	std::lock_guard guard(windows().lock);
	if (WindowNode* node = windows().Find(window))
		node->title = title;
}


void
WindowList::SetShown(BWindow* window, bool shown)
{
	std::lock_guard guard(windows().lock);
	if (WindowNode* node = windows().Find(window)) {
		// For as long as the window is too busy to be asked. A constructor that shows its window
		// gives its own class here.
		note_class(window, node);
		node->shown = shown;
		node->isMenu = static_cast<uint32>(window->Feel()) == kMenuWindowFeel;
	}
}


void
WindowList::SetActive(BWindow* window, bool active)
{
	std::lock_guard guard(windows().lock);
	if (WindowNode* node = windows().Find(window))
		node->active = active;
}


void
WindowList::SetFrame(BWindow* window, BRect frame)
{
	std::lock_guard guard(windows().lock);
	if (WindowNode* node = windows().Find(window))
		node->frame = frame;
}


} // namespace BPrivate
