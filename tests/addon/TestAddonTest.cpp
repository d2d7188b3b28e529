#include "addon/TestAddon.h"

#include <memory>

#include <gtest/gtest.h>

#include <Application.h>
#include <Message.h>
#include <View.h>

#include "archive/ViewArchive.h"
#include "host/library/ResourceCollection.h"

using namespace BResEditor;

namespace {


struct Fixture {
	BResourceCollection collection;
	BResourceAddonArgs args { &collection };
	std::unique_ptr<BResourceAddon> addon { make_nth_resourcer(0, 0, args, 0) };

	const BResourceItem* Add(type_code type)
	{
		BResourceHandle handle;
		BResourceAddonBase user(args);
		BResourceCollection* writable = user.WriteLock(NULL);
		writable->AddItem(&handle, type, 1, "", "x", 1);
		user.WriteUnlock(writable);
		return collection.Item(handle);
	}
};


} // namespace


TEST(MakeNthResourcer, HasOneHandler)
{
	BResourceCollection collection;
	const BResourceAddonArgs args { &collection };
	std::unique_ptr<BResourceAddon> first(make_nth_resourcer(0, 0, args, 0));
	std::unique_ptr<BResourceAddon> again(make_nth_resourcer(0, 0, args, 0));
	EXPECT_NE(nullptr, dynamic_cast<TestAddon*>(first.get()));
	EXPECT_NE(first, again);
	EXPECT_EQ(NULL, make_nth_resourcer(1, 0, args, 0));
	EXPECT_EQ(NULL, make_nth_resourcer(-1, 0, args, 0));
}


TEST(TestAddon, RatesArchivedObjectsOnly)
{
	Fixture fixture;
	const BResourceItem* archive = fixture.Add('ARCV');
	const BResourceItem* text = fixture.Add('CSTR');
	EXPECT_EQ(1.0f, fixture.addon->PreciseQuality(archive));
	EXPECT_EQ(-1.0f, fixture.addon->QuickQuality(archive));
	EXPECT_EQ(-1.0f, fixture.addon->PreciseQuality(text));
	EXPECT_EQ(-1.0f, fixture.addon->QuickQuality(text));
}


TEST(TestAddon, OffersOneKindOfItem)
{
	Fixture fixture;
	BMessage info;
	EXPECT_EQ(B_OK, fixture.addon->GetNthGenerateInfo(0, &info));
	EXPECT_STREQ("Archived Object", info.GetString(B_GENERATE_NAME, ""));
	EXPECT_EQ(int32('ARCV'), info.GetInt32(B_GENERATE_TYPE, 0));

	BMessage none;
	EXPECT_EQ(-1, fixture.addon->GetNthGenerateInfo(1, &none));
	EXPECT_TRUE(none.IsEmpty());
}


TEST(TestAddon, GeneratesAnEmptyView)
{
	BApplication application("application/x-vnd.Archway-test");
	Fixture fixture;
	BMessage request;
	request.AddInt32(B_GENERATE_TYPE, 'ARCV');
	BResourceHandle handle;
	ASSERT_EQ(B_OK,
		fixture.addon->GenerateResource(
			&handle, &request, 5, "mine", false, BResourceCollection::B_FAIL_ON_CONFLICT));

	const BResourceItem* item = fixture.collection.Item(handle);
	ASSERT_NE(nullptr, item);
	EXPECT_EQ(type_code('ARCV'), item->Type());
	EXPECT_EQ(5, item->ID());
	EXPECT_STREQ("mine", item->Name());

	BMessage archive;
	ASSERT_EQ(B_OK, archive.Unflatten(static_cast<const char*>(item->Data())));
	std::unique_ptr<BView> view(dynamic_cast<BView*>(instantiate_object(&archive)));
	ASSERT_NE(nullptr, view);
	EXPECT_STREQ("The View", view->Name());
	EXPECT_EQ(BRect(0, 0, 200, 100), view->Frame());
	EXPECT_EQ(0, view->CountChildren());
	EXPECT_EQ(0x1212u, view->ResizingMode());
	EXPECT_EQ(0x2c000000u, view->Flags());
}


TEST(TestAddon, GeneratesNothingElseAndReleasesTheLock)
{
	Fixture fixture;
	BResourceHandle handle;
	BMessage request;
	EXPECT_EQ(B_NAME_NOT_FOUND,
		fixture.addon->GenerateResource(
			&handle, &request, 1, "", false, BResourceCollection::B_FAIL_ON_CONFLICT));

	request.AddInt32(B_GENERATE_TYPE, 'TEXT');
	EXPECT_EQ(-1,
		fixture.addon->GenerateResource(
			&handle, &request, 1, "", false, BResourceCollection::B_FAIL_ON_CONFLICT));
	EXPECT_EQ(0, fixture.collection.CountItems());

	// A lock that was kept would stop this read in the debugger when it asks for writing.
	const BResourceCollection* collection = fixture.addon->ReadLock();
	fixture.addon->ReadUnlock(collection);
	BResourceCollection* writable = fixture.addon->WriteLock(NULL);
	EXPECT_NE(nullptr, writable);
	fixture.addon->WriteUnlock(writable);
}


TEST(TestAddon, PassesTheCollectionsRefusalOn)
{
	BApplication application("application/x-vnd.Archway-test");
	Fixture fixture;
	fixture.Add('ARCV');
	BMessage request;
	request.AddInt32(B_GENERATE_TYPE, 'ARCV');
	BResourceHandle handle;
	EXPECT_EQ(B_NAME_IN_USE,
		fixture.addon->GenerateResource(
			&handle, &request, 1, "", false, BResourceCollection::B_FAIL_ON_CONFLICT));
}


TEST(TestAddon, DeclinesTheRest)
{
	Fixture fixture;
	BMessage drop('DATA');
	EXPECT_EQ(-1, fixture.addon->HandleDrop(&drop));
	EXPECT_EQ(NULL, fixture.addon->MakeMiniEditor(fixture.args, BResourceHandle(), NULL));
}
