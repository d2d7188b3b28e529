// What programs find with few headers, as they were written for the original ones.
#include <Alert.h>
#include <Application.h>
#include <Button.h>
#include <FilePanel.h>
#include <ListView.h>
#include <MenuField.h>
#include <MessageFilter.h>
#include <PopUpMenu.h>
#include <TextControl.h>
#include <gtest/gtest.h>


// Neither <Message.h> nor <AppDefs.h>, <List.h>, <TextView.h> or <Invoker.h> is named above.
TEST(Headers, BringWhatTheirClassesAreUsedWith)
{
	BApplication app("application/x-vnd.Archway-test");

	BButton button(BRect(0, 0, 9, 9), "button", "Press", new BMessage(B_QUIT_REQUESTED));
	EXPECT_EQ(static_cast<uint32>(B_QUIT_REQUESTED), button.Message()->what);

	BTextControl control(BRect(0, 0, 99, 9), "control", "Name:", "text", new BMessage(B_REPLY));
	EXPECT_EQ(4, control.TextView()->TextLength());

	BStringItem item("item");
	BList items;
	items.AddItem(&item);
	BListView list(BRect(0, 0, 9, 9), "list");
	EXPECT_TRUE(list.AddList(&items));
	EXPECT_TRUE(list.RemoveItem(&item));

	BInvoker invoker(new BMessage(B_COPY), be_app);
	EXPECT_EQ(static_cast<uint32>(B_COPY), invoker.Command());

	BDirectory directory;
	EXPECT_EQ(B_NO_INIT, directory.InitCheck());
}
