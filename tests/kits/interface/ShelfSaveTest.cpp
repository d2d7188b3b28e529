// What shelves save, and how they are filled again.
#include <filesystem>
#include <fstream>
#include <random>
#include <string>

#include <unistd.h>

#include <DataIO.h>
#include <Entry.h>
#include <File.h>

#include "ShelfWindows.h"
#include "support/Dump.h"

namespace {

// As a file of the test's own, which goes with it.
struct TemporaryFile {
	TemporaryFile() : path(testing::TempDir() + "shelf-" + std::to_string(getpid()))
	{
		EXPECT_EQ(B_OK, get_ref_for_path(path.c_str(), &ref));
	}

	~TemporaryFile() { std::filesystem::remove(path); }

	const std::string path;
	entry_ref ref;
};


BMessage
MessageOf(const BMallocIO& stream)
{
	BMessage message;
	EXPECT_EQ(B_OK, message.Unflatten(static_cast<const char*>(stream.Buffer())));
	return message;
}

} // namespace


// Two replicants are dragged into a shelf, and a shelf in a later window has them back.
TEST(Shelf, IsFilledAgainFromWhatItSaved)
{
	BMallocIO stream;
	BRect frames[2];
	uint32 ids[2];
	BMessage archives[2];
	{
		ShelfWindows windows;
		windows.LockedOther([&] {
			EXPECT_EQ(B_OK, windows.shelf->SetSaveLocation(&stream));
			EXPECT_EQ(&stream, windows.shelf->SaveLocation(NULL));
		});
		BDragger* dragger = windows.AddText("Dragged");
		windows.DropOnOther(dragger, BPoint(200, 100));
		windows.DropOnOther(dragger, BPoint(220, 200));
		windows.driver.Drag(windows.DraggerAt(0), BPoint(4, 4), windows.drops, BPoint(130, 50));
		windows.LockedOther([&] {
			for (int32 i = 0; i < 2; i++) {
				BView* view;
				windows.shelf->ReplicantAt(i, &view, &ids[i]);
				frames[i] = view->Frame();
				archives[i] = ArchiveOf(*view);
			}
			EXPECT_EQ(B_OK, windows.shelf->Save());
			EXPECT_FALSE(windows.shelf->IsDirty());
		});
	}

	ShelfWindows windows;
	windows.LockedOther([&] {
		stream.Seek(0, SEEK_SET);
		BShelf shelf(&stream, windows.drops);
		ASSERT_EQ(2, shelf.CountReplicants());
		EXPECT_FALSE(shelf.IsDirty());
		for (int32 i = 0; i < 2; i++) {
			BView* view;
			uint32 id;
			shelf.ReplicantAt(i, &view, &id);
			EXPECT_EQ(frames[i], view->Frame());
			EXPECT_EQ(ids[i], id);
			EXPECT_EQ("", test::first_difference(archives[i], ArchiveOf(*view)));
			EXPECT_STREQ("Dragged", dynamic_cast<BStringView*>(view)->Text());
			EXPECT_TRUE(dynamic_cast<BDragger*>(view->ChildAt(0))->InShelf());
		}
		// Numbers are not used again.
		BMessage archive = TextArchive();
		EXPECT_EQ(B_OK, shelf.AddReplicant(&archive, BPoint(0, 0)));
		uint32 id;
		shelf.ReplicantAt(2, NULL, &id);
		EXPECT_LT(ids[1], id);
	});
}


TEST(Shelf, SavesTheSameAgain)
{
	ShelfWindows windows;
	windows.LockedOther([&] {
		BMallocIO first, second;
		{
			BShelf shelf(&first, windows.drops);
			for (const bool hasDragger : { true, false }) {
				BMessage archive = TextArchive("text", hasDragger);
				EXPECT_EQ(B_OK, shelf.AddReplicant(&archive, BPoint(20, 30)));
			}
			EXPECT_EQ(B_OK, shelf.Save());
		}
		BMessage saved = MessageOf(first);
		saved.AddString("stranger", "of a later version");
		saved.Flatten(&second);
		second.Seek(0, SEEK_SET);
		BShelf again(&second, windows.drops);
		EXPECT_EQ(B_OK, again.Save());
		EXPECT_TRUE(saved.HasSameData(MessageOf(second), true, true))
			<< test::first_difference(saved, MessageOf(second));
	});
}


TEST(Shelf, SavesInAFile)
{
	TemporaryFile file;
	ShelfWindows windows;
	windows.LockedOther([&] {
		{
			BShelf shelf(&file.ref, windows.drops);
			entry_ref ref;
			EXPECT_EQ(nullptr, shelf.SaveLocation(&ref));
			EXPECT_EQ(file.ref, ref);
			BMessage archive = TextArchive();
			EXPECT_EQ(B_OK, shelf.AddReplicant(&archive, BPoint(20, 30)));
			EXPECT_FALSE(std::filesystem::exists(file.path));
		} // saves what has changed
		EXPECT_TRUE(std::filesystem::exists(file.path));
		BShelf again(&file.ref, windows.drops);
		ASSERT_EQ(1, again.CountReplicants());
		EXPECT_EQ(B_OK, again.DeleteReplicant(int32(0)));
		EXPECT_EQ(B_OK, again.Save());
		BShelf empty(&file.ref, windows.drops);
		EXPECT_EQ(0, empty.CountReplicants());
	});
}


TEST(Shelf, SavesNothingWhereItCannot)
{
	BApplication app("application/x-vnd.Archway-test");
	BView view(BRect(0, 0, 99, 99), "container", B_FOLLOW_NONE, 0);
	BShelf shelf(&view);
	char bytes[16];
	BMemoryIO small(bytes, sizeof(bytes));
	EXPECT_EQ(B_OK, shelf.SetSaveLocation(&small));
	BMessage archive = TextArchive();
	EXPECT_EQ(B_OK, shelf.AddReplicant(&archive, BPoint(0, 0)));
	EXPECT_NE(B_OK, shelf.Save());
	EXPECT_TRUE(shelf.IsDirty());
	entry_ref nowhere(1, 1, "in no folder");
	EXPECT_EQ(B_OK, shelf.SetSaveLocation(&nowhere));
	EXPECT_NE(B_OK, shelf.Save());
	EXPECT_EQ(B_OK, shelf.SetSaveLocation(static_cast<const entry_ref*>(NULL)));
	EXPECT_EQ(B_ERROR, shelf.Save());
}


// #pragma mark - zombies


TEST(Shelf, KeepsTheArchiveOfAZombie)
{
	ShelfWindows windows;
	const BMessage strange = StrangeArchive();
	windows.LockedOther([&] {
		BMallocIO stream;
		{
			BShelf shelf(&stream, windows.drops);
			BMessage archive = strange;
			EXPECT_EQ(B_OK, shelf.AddReplicant(&archive, BPoint(20, 30)));
			shelf.SetDisplaysZombies(true);
			EXPECT_TRUE(shelf.DisplaysZombies());
			EXPECT_EQ(B_OK, shelf.AddReplicant(&archive, BPoint(40, 50)));
			BView* view;
			status_t error;
			shelf.ReplicantAt(0, &view, NULL, &error);
			EXPECT_EQ(nullptr, view);
			EXPECT_EQ(B_NAME_NOT_FOUND, error);
			shelf.ReplicantAt(1, &view, NULL, &error);
			ASSERT_NE(nullptr, view);
			EXPECT_EQ(BPoint(40, 50), view->Frame().LeftTop());
			EXPECT_EQ(B_NAME_NOT_FOUND, error);
			EXPECT_EQ(B_OK, shelf.Save());
		}
		const BMessage saved = MessageOf(stream);
		for (int32 i = 0; i < 2; i++) {
			BMessage entry, archive;
			EXPECT_EQ(B_OK, saved.FindMessage("replicant", i, &entry));
			EXPECT_EQ(B_OK, entry.FindMessage("message", &archive));
			EXPECT_TRUE(strange.HasSameData(archive, false, true));
			EXPECT_EQ(BPoint(20 + 20 * i, 30 + 20 * i), entry.FindPoint("position"));
		}
		stream.Seek(0, SEEK_SET);
		BShelf again(&stream, windows.drops);
		EXPECT_TRUE(again.DisplaysZombies());
		EXPECT_EQ(2, again.CountReplicants());
	});
}


TEST(Shelf, DragsAZombieAsItCame)
{
	ShelfWindows windows;
	const BMessage strange = StrangeArchive();
	windows.LockedOther([&] {
		BMessage archive = strange;
		windows.shelf->SetDisplaysZombies(true);
		EXPECT_EQ(B_OK, windows.shelf->AddReplicant(&archive, BPoint(40, 50)));
	});
	DropGround* drops = windows.Add(new DropGround(BRect(0, 0, 299, 299)));
	windows.driver.Drag(windows.DraggerAt(0), BPoint(4, 4), drops, BPoint(90, 90));
	ASSERT_EQ(1u, drops->dropped.size());
	BMessage dropped = drops->dropped[0];
	for (const char* name : { "be:actions", "buttons", "_drop_point_", "_drop_offset_" })
		EXPECT_EQ(B_OK, dropped.RemoveName(name)) << name;
	EXPECT_EQ("", test::first_difference(strange, dropped));
	// It can be moved like any other.
	windows.driver.Drag(windows.DraggerAt(0), BPoint(4, 4), windows.drops, BPoint(146, 86));
	EXPECT_EQ(BRect(50, 60, 149, 89), windows.FrameAt(0));
}


TEST(Shelf, TakesNoZombiesUnlessAllowed)
{
	ShelfWindows windows;
	windows.LockedOther([&] {
		BMessage archive = StrangeArchive();
		windows.shelf->SetAllowsZombies(false);
		EXPECT_FALSE(windows.shelf->AllowsZombies());
		EXPECT_EQ(B_NAME_NOT_FOUND, windows.shelf->AddReplicant(&archive, BPoint(0, 0)));
		EXPECT_EQ(0, windows.shelf->CountReplicants());
	});
}


// #pragma mark - bytes from outside


TEST(Shelf, BearsEveryTruncation)
{
	ShelfWindows windows;
	windows.LockedOther([&] {
		BMallocIO stream;
		{
			BShelf shelf(&stream, windows.drops);
			BMessage archive = TextArchive();
			EXPECT_EQ(B_OK, shelf.AddReplicant(&archive, BPoint(20, 30)));
			EXPECT_EQ(B_OK, shelf.Save());
		}
		for (size_t size = 0; size < stream.BufferLength(); size++) {
			BMemoryIO cut(stream.Buffer(), size);
			BShelf shelf(&cut, windows.drops);
			EXPECT_EQ(0, shelf.CountReplicants()) << size;
		}
	});
}


TEST(Shelf, BearsAnyValues)
{
	ShelfWindows windows;
	std::mt19937 random(5);
	const char* const names[] = { "replicant", "message", "position", "uniqueid", "_sg_cnt",
		"_zom_alw", "_zom_dsp", "__widget", "class", "_views", "_frame" };
	const char* const classes[] = { "BDragger", "BStringView", "BStringItem", "Nobody", "BShelf" };
	const std::function<BMessage(int)> make = [&](int depth) {
		BMessage message;
		message.AddString("class", classes[random() % std::size(classes)]);
		for (uint32 i = random() % 6; i > 0; i--) {
			const char* name = names[random() % std::size(names)];
			switch (random() % (depth < 5 ? 5 : 3)) {
				case 0:
					message.AddInt32(name, static_cast<int32>(random()));
					break;
				case 1:
					message.AddBool(name, random() % 2 != 0);
					break;
				case 2:
					message.AddPoint(name, BPoint(float(random()), -1e30f));
					break;
				default: {
					const BMessage inner = make(depth + 1);
					message.AddMessage(name, &inner);
				}
			}
		}
		return message;
	};
	windows.LockedOther([&] {
		for (int i = 0; i < 300; i++) {
			BMessage saved;
			for (int k = 0; k < 3; k++) {
				BMessage entry = make(0);
				const BMessage archive = make(0);
				entry.AddMessage("message", &archive);
				saved.AddMessage("replicant", &entry);
			}
			BMallocIO stream;
			saved.Flatten(&stream);
			stream.Seek(0, SEEK_SET);
			BShelf shelf(&stream, windows.drops);
			EXPECT_EQ(B_OK, shelf.Save());
			while (shelf.CountReplicants() > 0)
				EXPECT_EQ(B_OK, shelf.DeleteReplicant(int32(0)));
			while (BView* view = windows.drops->ChildAt(0)) {
				view->RemoveSelf();
				delete view;
			}
		}
	});
}


// #pragma mark - scripts


TEST(Shelf, AnswersScripts)
{
	ShelfWindows windows;
	const BMessenger window(windows.other);
	const auto ask = [&](uint32 what, int32 index, const BMessage* data = NULL) {
		BMessage message(what), reply;
		if (index >= 0)
			message.AddSpecifier("Replicant", index);
		else
			message.AddSpecifier("Replicant");
		message.AddSpecifier("Shelf");
		message.AddSpecifier("View", "drops");
		if (data != NULL)
			message.AddMessage("data", data);
		EXPECT_EQ(B_OK, window.SendMessage(&message, &reply));
		return reply;
	};
	const BMessage archive = TextArchive("scripted");
	EXPECT_EQ(B_OK, ask(B_CREATE_PROPERTY, -1, &archive).GetInt32("error", -1));
	EXPECT_EQ(B_OK, ask(B_CREATE_PROPERTY, -1, &archive).GetInt32("error", -1));
	EXPECT_EQ(2, ask(B_COUNT_PROPERTIES, -1).GetInt32("result", -1));
	BMessage found;
	EXPECT_EQ(B_OK, ask(B_GET_PROPERTY, 1).FindMessage("result", &found));
	EXPECT_STREQ("scripted", found.GetString("_text", ""));
	EXPECT_EQ(B_OK, ask(B_DELETE_PROPERTY, 0).GetInt32("error", -1));
	EXPECT_EQ(1, windows.Count());
	EXPECT_EQ(B_BAD_VALUE, ask(B_DELETE_PROPERTY, 1).GetInt32("error", 0));
	EXPECT_EQ(1, windows.Count());
	windows.LockedOther([&] {
		BMessage message(B_GET_PROPERTY), specifier(B_INDEX_SPECIFIER);
		specifier.AddInt32("index", 0);
		message.AddSpecifier("Replicant", int32(0));
		EXPECT_EQ(windows.shelf.get(),
			windows.shelf->ResolveSpecifier(
				&message, 0, &specifier, B_INDEX_SPECIFIER, "Replicant"));
	});
	BMessage suites;
	EXPECT_EQ(B_OK, windows.shelf->GetSupportedSuites(&suites));
	EXPECT_STREQ("suite/vnd.Be-shelf", suites.GetString("suites", ""));
}
