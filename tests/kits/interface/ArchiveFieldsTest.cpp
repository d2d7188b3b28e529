// What each class calls its archived fields, and that a revived object answers by them.
#include <gtest/gtest.h>

#include <Bitmap.h>
#include <ListView.h>
#include <MenuBar.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <OutlineListView.h>
#include <PopUpMenu.h>
#include <StringItem.h>
#include <TextControl.h>
#include <TextView.h>

#include "ControlFixture.h"

namespace {

const BRect kFrame(10, 10, 209, 109);

} // namespace


TEST(ArchiveFields, OfATextControl)
{
	ControlFixture fixture;
	BTextControl control(kFrame, "control", "Label:", "text", new BMessage('msg '));
	control.SetAlignment(B_ALIGN_RIGHT, B_ALIGN_CENTER);
	control.SetDivider(70);
	control.SetModificationMessage(new BMessage('modi'));
	control.SetEnabled(false);
	const BMessage archive = ArchiveOf(control);
	EXPECT_EQ(B_ALIGN_RIGHT, archive.GetInt32("_a_label", -1));
	EXPECT_EQ(B_ALIGN_CENTER, archive.GetInt32("_a_text", -1));
	EXPECT_EQ(70, archive.GetFloat("_divide", -1));
	EXPECT_TRUE(archive.GetBool("_disable", false));
	BMessage message;
	EXPECT_EQ(B_OK, archive.FindMessage("_mod_msg", &message));
	EXPECT_EQ(uint32('modi'), message.what);

	const auto revived = Revive<BTextControl>(archive);
	alignment label, text;
	revived->GetAlignment(&label, &text);
	EXPECT_EQ(B_ALIGN_RIGHT, label);
	EXPECT_EQ(B_ALIGN_CENTER, text);
	EXPECT_EQ(70, revived->Divider());
	EXPECT_EQ(uint32('modi'), revived->ModificationMessage()->what);
	EXPECT_FALSE(revived->IsEnabled());
	EXPECT_STREQ("text", revived->Text());
	ExpectRoundTrip(fixture, control);
}


TEST(ArchiveFields, OfATextView)
{
	ControlFixture fixture;
	BTextView view(kFrame, "view", BRect(3, 4, 150, 90), B_FOLLOW_NONE, B_WILL_DRAW);
	view.SetText("Some text");
	view.SetAlignment(B_ALIGN_RIGHT);
	view.SetTabWidth(40);
	view.SetColorSpace(B_RGB32);
	view.SetMaxBytes(200);
	view.Select(2, 5);
	view.SetStylable(true);
	view.SetAutoindent(true);
	view.SetWordWrap(false);
	view.MakeSelectable(false);
	view.MakeEditable(false);
	view.DisallowChar('x');
	const BMessage archive = ArchiveOf(view);
	EXPECT_STREQ("Some text", archive.GetString("_text", ""));
	EXPECT_EQ(B_ALIGN_RIGHT, archive.GetInt32("_align", -1));
	EXPECT_EQ(40, archive.GetFloat("_tab", -1));
	EXPECT_EQ(B_RGB32, archive.GetInt32("_col_sp", -1));
	EXPECT_EQ(3, archive.GetRect("_trect", BRect()).left);
	EXPECT_EQ(200, archive.GetInt32("_max", -1));
	EXPECT_EQ(2, archive.GetInt32("_sel", 0, -1));
	EXPECT_EQ(5, archive.GetInt32("_sel", 1, -1));
	EXPECT_TRUE(archive.GetBool("_stylable", false));
	EXPECT_TRUE(archive.GetBool("_auto_in", false));
	EXPECT_FALSE(archive.GetBool("_wrap", true));
	EXPECT_TRUE(archive.GetBool("_nsel", false));
	EXPECT_TRUE(archive.GetBool("_nedit", false));
	EXPECT_FALSE(archive.GetBool("_password", false));
	EXPECT_TRUE(archive.HasData("_dis_ch", B_RAW_TYPE));
	EXPECT_TRUE(archive.HasData("_runs", B_RAW_TYPE));

	const auto revived = Revive<BTextView>(archive);
	EXPECT_STREQ("Some text", revived->Text());
	EXPECT_EQ(B_ALIGN_RIGHT, revived->Alignment());
	EXPECT_EQ(40, revived->TabWidth());
	EXPECT_EQ(B_RGB32, revived->ColorSpace());
	EXPECT_EQ(200, revived->MaxBytes());
	int32 from, to;
	revived->GetSelection(&from, &to);
	EXPECT_EQ(2, from);
	EXPECT_EQ(5, to);
	EXPECT_TRUE(revived->IsStylable());
	EXPECT_TRUE(revived->DoesAutoindent());
	EXPECT_FALSE(revived->DoesWordWrap());
	EXPECT_FALSE(revived->IsSelectable());
	EXPECT_FALSE(revived->IsEditable());
	ExpectRoundTrip(fixture, view);
}


TEST(ArchiveFields, OfAListViewAndItsItems)
{
	ControlFixture fixture;
	BListView list(kFrame, "list", B_MULTIPLE_SELECTION_LIST);
	BStringItem first("first", 1, false), second("second");
	second.SetEnabled(false);
	list.AddItem(&first);
	list.AddItem(&second);
	list.Select(0);
	list.SetInvocationMessage(new BMessage('invo'));
	list.SetSelectionMessage(new BMessage('sele'));
	const BMessage archive = ArchiveOf(list);
	EXPECT_EQ(B_MULTIPLE_SELECTION_LIST, archive.GetInt32("_lv_type", -1));
	BMessage message;
	EXPECT_EQ(B_OK, archive.FindMessage("_msg", &message));
	EXPECT_EQ(uint32('invo'), message.what);
	EXPECT_EQ(B_OK, archive.FindMessage("_2nd_msg", &message));
	EXPECT_EQ(uint32('sele'), message.what);
	EXPECT_EQ(B_OK, archive.FindMessage("_l_items", 0, &message));
	EXPECT_STREQ("first", message.GetString("_label", ""));
	EXPECT_TRUE(message.GetBool("_sel", false));
	EXPECT_FALSE(message.GetBool("_li_expanded", false));
	EXPECT_EQ(1, message.GetInt32("_li_outline_level", 0));
	EXPECT_EQ(B_OK, archive.FindMessage("_l_items", 1, &message));
	EXPECT_TRUE(message.GetBool("_disable", false));
	EXPECT_TRUE(message.GetBool("_li_expanded", false));

	const auto revived = Revive<BListView>(archive);
	EXPECT_EQ(B_MULTIPLE_SELECTION_LIST, revived->ListType());
	EXPECT_EQ(uint32('invo'), revived->InvocationCommand());
	EXPECT_EQ(uint32('sele'), revived->SelectionCommand());
	EXPECT_EQ(2, revived->CountItems());
	EXPECT_TRUE(revived->IsItemSelected(0));
	EXPECT_FALSE(revived->ItemAt(1)->IsEnabled());
	EXPECT_EQ(1u, revived->ItemAt(0)->OutlineLevel());
	EXPECT_FALSE(revived->ItemAt(0)->IsExpanded());
	ExpectRoundTrip(fixture, list);
}


TEST(ArchiveFields, OfAnOutlineListView)
{
	ControlFixture fixture;
	BOutlineListView list(kFrame, "outline");
	BStringItem top("top"), below("below");
	list.AddItem(&top);
	list.AddUnder(&below, &top);
	list.Collapse(&top);
	const BMessage archive = ArchiveOf(list);
	BMessage message;
	EXPECT_EQ(B_OK, archive.FindMessage("_l_full_items", 1, &message));
	EXPECT_STREQ("below", message.GetString("_label", ""));
	EXPECT_EQ(1, message.GetInt32("_li_outline_level", 0));
	EXPECT_FALSE(archive.HasMessage("_l_items"));

	const auto revived = Revive<BOutlineListView>(archive);
	EXPECT_EQ(1, revived->CountItems());
	EXPECT_EQ(2, revived->FullListCountItems());
	revived->Expand(revived->ItemAt(0));
	EXPECT_EQ(2, revived->CountItems());
	ExpectRoundTrip(fixture, list);
}


TEST(ArchiveFields, OfAMenuField)
{
	ControlFixture fixture;
	BPopUpMenu* menu = new BPopUpMenu("menu");
	menu->AddItem(new BMenuItem("Chosen", NULL));
	menu->ItemAt(0)->SetMarked(true);
	BMenuField field(kFrame, "field", "Label:", menu, true);
	field.SetAlignment(B_ALIGN_CENTER);
	field.SetDivider(61);
	field.HidePopUpMarker();
	field.SetEnabled(false);
	const BMessage archive = ArchiveOf(field);
	EXPECT_STREQ("Label:", archive.GetString("_label", ""));
	EXPECT_TRUE(archive.GetBool("_disable", false));
	EXPECT_EQ(B_ALIGN_CENTER, archive.GetInt32("_align", -1));
	EXPECT_EQ(61, archive.GetFloat("_divide", -1));
	EXPECT_TRUE(archive.GetBool("be:fixeds", false));
	EXPECT_FALSE(archive.GetBool("be:dmark", true));

	const auto revived = Revive<BMenuField>(archive);
	EXPECT_STREQ("Label:", revived->Label());
	EXPECT_FALSE(revived->IsEnabled());
	EXPECT_EQ(B_ALIGN_CENTER, revived->Alignment());
	EXPECT_EQ(61, revived->Divider());
	EXPECT_STREQ("Chosen", revived->MenuItem()->Label());
	EXPECT_TRUE(revived->Menu()->ItemAt(0)->IsMarked());
	ExpectRoundTrip(fixture, field);
}


TEST(ArchiveFields, OfAMenuAndItsItems)
{
	ControlFixture fixture;
	BMenu menu("menu", 120, 60);
	menu.SetRadioMode(true);
	menu.SetTriggersEnabled(false);
	menu.SetMaxContentWidth(90);
	menu.SetLabelFromMarked(true);
	BMenuItem* item = new BMenuItem("Item", new BMessage('item'), 'K', B_SHIFT_KEY);
	item->SetTrigger('t');
	item->SetMarked(true);
	menu.AddItem(item, BRect(1, 2, 50, 20));
	BMenuItem* deeper = new BMenuItem(new BMenu("Deeper"), new BMessage('deep'));
	deeper->SetEnabled(false);
	menu.AddItem(deeper, BRect(1, 22, 50, 40));
	menu.SetEnabled(false);
	const BMessage archive = ArchiveOf(menu);
	EXPECT_EQ(B_ITEMS_IN_MATRIX, archive.GetInt32("_layout", -1));
	EXPECT_TRUE(archive.GetBool("_disable", false));
	EXPECT_TRUE(archive.GetBool("_radio", false));
	EXPECT_TRUE(archive.GetBool("_trig_disabled", false));
	EXPECT_TRUE(archive.GetBool("_dyn_label", false));
	EXPECT_TRUE(archive.HasBool("_rsize_to_fit"));
	EXPECT_EQ(90, archive.GetFloat("_maxwidth", -1));
	EXPECT_EQ(BRect(1, 2, 50, 20), archive.GetRect("_i_frames", BRect()));

	BMessage first, second, message;
	ASSERT_EQ(B_OK, archive.FindMessage("_items", 0, &first));
	EXPECT_STREQ("Item", first.GetString("_label", ""));
	EXPECT_TRUE(first.GetBool("_marked", false));
	EXPECT_EQ('t', first.GetInt32("_user_trig", 0));
	EXPECT_EQ('K', first.GetInt32("_shortcut", 0));
	EXPECT_EQ(B_SHIFT_KEY | B_COMMAND_KEY, uint32(first.GetInt32("_mods", 0)));
	EXPECT_EQ(B_OK, first.FindMessage("_msg", &message));
	ASSERT_EQ(B_OK, archive.FindMessage("_items", 1, &second));
	EXPECT_TRUE(second.GetBool("_disable", false));
	EXPECT_EQ(B_OK, second.FindMessage("_submenu", &message));

	const auto revived = Revive<BMenu>(archive);
	EXPECT_FALSE(revived->IsEnabled());
	EXPECT_TRUE(revived->IsRadioMode());
	EXPECT_FALSE(revived->AreTriggersEnabled());
	EXPECT_TRUE(revived->IsLabelFromMarked());
	EXPECT_EQ(90, revived->MaxContentWidth());
	uint32 modifiers;
	EXPECT_EQ('K', revived->ItemAt(0)->Shortcut(&modifiers));
	EXPECT_EQ(B_SHIFT_KEY | B_COMMAND_KEY, modifiers);
	EXPECT_EQ('t', revived->ItemAt(0)->Trigger());
	EXPECT_TRUE(revived->ItemAt(0)->IsMarked());
	EXPECT_STREQ("Deeper", revived->SubmenuAt(1)->Name());
	EXPECT_EQ(BRect(1, 22, 50, 40), revived->ItemAt(1)->Frame());
}


TEST(ArchiveFields, OfAMenuBar)
{
	ControlFixture fixture;
	BMenuBar bar(kFrame, "bar");
	bar.SetBorder(B_BORDER_EACH_ITEM);
	bar.AddItem(new BMenuItem("Item", new BMessage('item')));
	const BMessage archive = ArchiveOf(bar);
	EXPECT_EQ(B_BORDER_EACH_ITEM, archive.GetInt32("_border", -1));
	EXPECT_EQ(B_BORDER_EACH_ITEM, Revive<BMenuBar>(archive)->Border());
	ExpectRoundTrip(fixture, bar);
}


TEST(ArchiveFields, OfABitmap)
{
	BApplication app("application/x-vnd.Archway-test");
	BBitmap bitmap(BRect(0, 0, 9, 4), B_RGBA32, true);
	bitmap.Lock();
	bitmap.AddChild(new BView(BRect(1, 1, 3, 3), "inside", B_FOLLOW_NONE, B_WILL_DRAW));
	bitmap.Unlock();
	const BMessage archive = ArchiveOf(bitmap);
	EXPECT_EQ(BRect(0, 0, 9, 4), archive.GetRect("_frame", BRect()));
	EXPECT_EQ(B_RGBA32, archive.GetInt32("_cspace", -1));
	EXPECT_EQ(40, archive.GetInt32("_rowbytes", -1));
	EXPECT_TRUE(archive.HasInt32("_bmflags"));
	BMessage view;
	EXPECT_EQ(B_OK, archive.FindMessage("_views", &view));

	const auto revived = Revive<BBitmap>(archive);
	EXPECT_EQ(bitmap.Bounds(), revived->Bounds());
	revived->Lock();
	EXPECT_NE(nullptr, revived->FindView("inside"));
	revived->Unlock();
}


// The older form says in words of its own that the bitmap takes views and lies in one piece.
TEST(ArchiveFields, OfABitmapOfTheOlderForm)
{
	BApplication app("application/x-vnd.Archway-test");
	BMessage archive;
	archive.AddString("class", "BBitmap");
	archive.AddRect("_frame", BRect(0, 0, 9, 4));
	archive.AddInt32("_cspace", B_RGB32);
	archive.AddBool("_view_ok", true);
	archive.AddBool("_contiguous", true);
	const auto revived = Revive<BBitmap>(archive);
	BView* view = new BView(BRect(0, 0, 3, 3), "view", B_FOLLOW_NONE, 0);
	ASSERT_TRUE(revived->Lock());
	revived->AddChild(view);
	EXPECT_NE(nullptr, view->Window());
	revived->Unlock();
}
