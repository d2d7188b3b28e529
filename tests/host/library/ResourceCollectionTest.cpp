#include "host/library/ResourceCollection.h"

#include <atomic>
#include <string>
#include <thread>

#include <gtest/gtest.h>

#include <Application.h>
#include <Looper.h>
#include <Message.h>

#include "host/library/ResourceAddonBase.h"
#include "support/Driver.h"

using namespace BResEditor;

namespace {


struct Fixture {
	BResourceCollection collection;
	BResourceAddonArgs args { &collection };
	BResourceAddonBase user { args };

	BResourceHandle Add(type_code type, int32 id, const std::string& data, const char* name = "")
	{
		BResourceHandle handle;
		BResourceCollection* writable = user.WriteLock("add");
		EXPECT_EQ(B_OK, writable->AddItem(&handle, type, id, name, data.data(), data.size()));
		user.WriteUnlock(writable);
		return handle;
	}

	std::string DataOf(const BResourceHandle& handle)
	{
		const BResourceItem* item = collection.Item(handle);
		return item != nullptr ? std::string(static_cast<const char*>(item->Data()), item->Size())
							   : "gone";
	}
};


// A looper whose use of the collection is told of changes.
class Listener : public BLooper {
public:
	explicit Listener(const BResourceAddonArgs& args) : user(args, this)
	{
		if (const BResourceCollection* collection = user.ReadLock())
			user.ReadUnlock(collection);
		Run();
	}

	void MessageReceived(BMessage* message) override
	{
		if (message->what == B_RESOURCE_DATA_CHANGED)
			notices++;
	}

	BResourceAddonBase user;
	std::atomic<int> notices = 0;
};


} // namespace


TEST(ResourceHandle, IsAValueThatSurvivesChanges)
{
	Fixture fixture;
	EXPECT_FALSE(BResourceHandle().IsValid());
	const BResourceHandle handle = fixture.Add('ARCV', 1, "bytes", "name");
	EXPECT_TRUE(handle.IsValid());
	EXPECT_EQ(handle, fixture.collection.FindItem('ARCV', 1));

	BResourceItem* item = fixture.collection.WriteItem(handle);
	EXPECT_EQ(B_OK, item->SetID(7));
	EXPECT_EQ(handle, fixture.collection.FindItem('ARCV', 7));
	EXPECT_FALSE(fixture.collection.FindItem('ARCV', 1).IsValid());
	EXPECT_STREQ("name", fixture.collection.Item(handle)->Name());
	EXPECT_NE(handle, fixture.Add('ARCV', 1, "other"));
}


TEST(ResourceCollection, KeepsItemsInTheirOrder)
{
	Fixture fixture;
	const BResourceHandle first = fixture.Add('BBBB', 2, "b");
	const BResourceHandle second = fixture.Add('AAAA', 1, "a");
	EXPECT_EQ(2, fixture.collection.CountItems());
	EXPECT_EQ(first, fixture.collection.HandleAt(0));
	EXPECT_EQ(second, fixture.collection.HandleAt(1));
	EXPECT_FALSE(fixture.collection.HandleAt(2).IsValid());
	EXPECT_FALSE(fixture.collection.HandleAt(-1).IsValid());
}


TEST(ResourceCollection, ResolvesConflictsAsItIsTold)
{
	Fixture fixture;
	const BResourceHandle first = fixture.Add('ARCV', 1, "one");
	BResourceHandle handle;
	EXPECT_EQ(B_NAME_IN_USE, fixture.collection.AddItem(&handle, 'ARCV', 1, "", "x", 1));
	EXPECT_EQ("one", fixture.DataOf(first));

	EXPECT_EQ(B_OK, fixture.collection.AddItem(&handle, 'ARCV', 1, "", "two", 3, true));
	EXPECT_EQ(2, fixture.collection.Item(handle)->ID());

	EXPECT_EQ(B_OK,
		fixture.collection.AddItem(&handle, 'ARCV', 1, "", "three", 5, false,
			BResourceCollection::B_RENUMBER_ON_CONFLICT));
	EXPECT_EQ(3, fixture.collection.Item(handle)->ID());

	EXPECT_EQ(B_OK,
		fixture.collection.AddItem(&handle, 'ARCV', 1, "new", "four", 4, false,
			BResourceCollection::B_REPLACE_ON_CONFLICT));
	EXPECT_EQ(first, handle);
	EXPECT_EQ("four", fixture.DataOf(first));
	EXPECT_EQ(3, fixture.collection.CountItems());
}


TEST(ResourceCollection, RemovedItemsAreGone)
{
	Fixture fixture;
	const BResourceHandle handle = fixture.Add('ARCV', 1, "one");
	EXPECT_EQ(B_OK, fixture.collection.RemoveItem(handle));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, fixture.collection.RemoveItem(handle));
	EXPECT_EQ(NULL, fixture.collection.Item(handle));
	EXPECT_EQ(0, fixture.collection.CountItems());
}


TEST(ResourceItem, RefusesAKeyThatIsTaken)
{
	Fixture fixture;
	fixture.Add('ARCV', 1, "one");
	const BResourceHandle second = fixture.Add('ARCV', 2, "two");
	EXPECT_EQ(B_NAME_IN_USE, fixture.collection.WriteItem(second)->SetID(1));
	EXPECT_EQ(2, fixture.collection.Item(second)->ID());
	EXPECT_EQ(B_OK, fixture.collection.WriteItem(second)->SetType('TEXT'));
	EXPECT_EQ(second, fixture.collection.FindItem('TEXT', 2));
}


TEST(ResourceCollection, TellsEachUserItsChangesOnce)
{
	Fixture fixture;
	const BResourceHandle before = fixture.Add('ARCV', 1, "one");
	BResourceAddonBase late(fixture.args);
	uint32 changes;
	EXPECT_EQ(before, fixture.collection.GetNextChange(&fixture.user, &changes));
	EXPECT_EQ(uint32(B_ITEM_CREATED), changes);
	EXPECT_FALSE(fixture.collection.GetNextChange(&fixture.user, &changes).IsValid());
	EXPECT_FALSE(fixture.collection.GetNextChange(&late, &changes).IsValid());

	fixture.collection.WriteItem(before)->SetData("x", 1);
	fixture.collection.WriteItem(before)->SetName("n");
	fixture.collection.WriteItem(before)->SetData("x", 1); // no change
	EXPECT_EQ(before, fixture.collection.GetNextChange(&late, &changes));
	EXPECT_EQ(uint32(B_ITEM_DATA_CHANGED | B_ITEM_ATTRIBUTES_CHANGED), changes);
	EXPECT_FALSE(fixture.collection.GetNextChange(&late, &changes).IsValid());
}


TEST(ResourceCollection, PostsOneNoticeAfterTheWriteLock)
{
	BApplication application("application/x-vnd.Archway-test");
	Fixture fixture;
	Listener* listener = new Listener(fixture.args);
	Driver::WaitUntilIdle();

	fixture.Add('ARCV', 1, "one");
	fixture.Add('ARCV', 2, "two");
	Driver::WaitUntilIdle();
	EXPECT_EQ(1, listener->notices); // the first has not been answered by reading

	uint32 changes;
	while (fixture.collection.GetNextChange(&listener->user, &changes).IsValid())
		;
	fixture.Add('ARCV', 3, "three");
	Driver::WaitUntilIdle();
	EXPECT_EQ(2, listener->notices);

	listener->Lock();
	listener->Quit();
}


TEST(ResourceAddonBase, ReadersShareAndAWriterWaits)
{
	Fixture fixture;
	const BResourceCollection* first = fixture.user.ReadLock();
	const BResourceCollection* again = fixture.user.ReadLock();
	EXPECT_EQ(first, again);

	std::atomic<bool> read = false, written = false;
	std::thread reader([&] {
		BResourceAddonBase other(fixture.args);
		other.ReadUnlock(other.ReadLock());
		read = true;
	});
	reader.join();
	EXPECT_TRUE(read);

	std::thread writer([&] {
		BResourceAddonBase other(fixture.args);
		BResourceCollection* collection = other.WriteLock("write");
		written = true;
		other.WriteUnlock(collection);
	});
	fixture.user.ReadUnlock(again);
	EXPECT_FALSE(written);
	fixture.user.ReadUnlock(first);
	writer.join();
	EXPECT_TRUE(written);
}


TEST(ResourceAddonBase, ADisconnectedUserGetsNoCollection)
{
	Fixture fixture;
	fixture.user.Disconnect();
	EXPECT_EQ(NULL, fixture.user.ReadLock());
	EXPECT_EQ(NULL, fixture.user.WriteLock("write"));
	BResourceAddonBase nobody(BResourceAddonArgs { NULL });
	EXPECT_EQ(NULL, nobody.ReadLock());
}
