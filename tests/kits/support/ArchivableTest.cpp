#include <cerrno>
#include <memory>
#include <string>

#include <gtest/gtest.h>

#include <Archivable.h>
#include <Message.h>

#include "app/private/ArchiveSource.h"

class _EXPORT ArchivedThing : public BArchivable {
public:
	ArchivedThing() {}
	explicit ArchivedThing(BMessage* archive) : BArchivable(archive), fSource(archive)
	{
		fNumber = archive->FindInt32("number");
		archive->HasInt32("other");
	}

	static BArchivable* Instantiate(BMessage* archive);
	status_t Archive(BMessage* into, bool deep = true) const override
	{
		const status_t status = BArchivable::Archive(into, deep);
		return status == B_OK ? into->AddInt32("number", fNumber) : status;
	}

	int32 fNumber = 7;
	BPrivate::ArchiveSource fSource;
};


BArchivable*
ArchivedThing::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "ArchivedThing") ? new ArchivedThing(archive) : nullptr;
}


namespace Outer::Inner {

class _EXPORT Thing : public BArchivable {
public:
	static BArchivable* Instantiate(BMessage* archive);
};


BArchivable*
Thing::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "Outer::Inner::Thing") ? new Thing : nullptr;
}

} // namespace Outer::Inner


namespace BPrivate {

class _EXPORT _HiddenThing_ : public BArchivable {
public:
	static BArchivable* Instantiate(BMessage* archive);
};


BArchivable*
_HiddenThing_::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "_HiddenThing_") ? new _HiddenThing_ : nullptr;
}

} // namespace BPrivate


namespace {

BMessage
archive_of(const char* className)
{
	BMessage archive;
	archive.AddString("class", className);
	return archive;
}

} // namespace


TEST(Archivable, WritesTheNameOfItsDynamicClass)
{
	BMessage archive;
	const ArchivedThing thing;
	const BArchivable& base = thing;
	EXPECT_EQ(B_OK, base.Archive(&archive));
	EXPECT_STREQ("ArchivedThing", archive.FindString("class"));
	EXPECT_EQ(B_BAD_VALUE, base.Archive(nullptr));

	archive.MakeEmpty();
	EXPECT_EQ(B_OK, Outer::Inner::Thing().Archive(&archive));
	EXPECT_STREQ("Outer::Inner::Thing", archive.FindString("class"));
	archive.MakeEmpty();
	EXPECT_EQ(B_OK, BPrivate::_HiddenThing_().Archive(&archive));
	EXPECT_STREQ("_HiddenThing_", archive.FindString("class"));
}


TEST(Archivable, AnObjectIsMadeFromItsArchive)
{
	BMessage archive = archive_of("ArchivedThing");
	archive.AddInt32("number", 9);
	image_id id = 0;
	std::unique_ptr<BArchivable> object(instantiate_object(&archive, &id));
	auto* thing = dynamic_cast<ArchivedThing*>(object.get());
	ASSERT_NE(nullptr, thing);
	EXPECT_EQ(9, thing->fNumber);
	EXPECT_LT(0, id);
}


TEST(Archivable, ClassesInNameSpacesAreFound)
{
	for (const char* name : { "Outer::Inner::Thing", "_HiddenThing_", "BPrivate::_HiddenThing_" }) {
		BMessage archive = archive_of(name);
		std::unique_ptr<BArchivable> object(instantiate_object(&archive));
		EXPECT_NE(nullptr, object) << name;
	}
}


TEST(Archivable, OnlyTheFirstClassIsTried)
{
	BMessage archive = archive_of("NoSuchThing");
	archive.AddString("class", "ArchivedThing");
	image_id id;
	EXPECT_EQ(nullptr, instantiate_object(&archive, &id));
	EXPECT_EQ(B_NAME_NOT_FOUND, id);
}


TEST(Archivable, WhyThereIsNoObjectIsTold)
{
	image_id id;
	EXPECT_EQ(nullptr, instantiate_object(nullptr, &id));
	EXPECT_EQ(B_BAD_VALUE, id);
	BMessage empty;
	EXPECT_EQ(nullptr, instantiate_object(&empty, &id));
	EXPECT_EQ(B_BAD_VALUE, id);
	for (const char* name :
		{ "", "A B", "9A", "A::", "::A", "A:B", "A<int>", "strlen\n", "A:::B" }) {
		BMessage archive = archive_of(name);
		EXPECT_EQ(nullptr, instantiate_object(&archive, &id)) << name;
		EXPECT_EQ(B_BAD_VALUE, id) << name;
	}
	BMessage elsewhere = archive_of("NoSuchThing");
	elsewhere.AddString("add_on", "application/x-vnd.No-such");
	EXPECT_EQ(nullptr, instantiate_object(&elsewhere, &id));
	EXPECT_EQ(B_LAUNCH_FAILED_APP_NOT_FOUND, id);
	// The class is there, but not in the image that the archive means.
	BMessage foreign = archive_of("ArchivedThing");
	foreign.AddString("add_on", "application/x-vnd.No-such");
	EXPECT_EQ(nullptr, instantiate_object(&foreign, &id));
	EXPECT_EQ(B_LAUNCH_FAILED_APP_NOT_FOUND, id);
}


TEST(Archivable, AnyEntryOfTheClassListIsValid)
{
	BMessage archive = archive_of("Derived");
	archive.AddString("class", "Base");
	archive.AddString("class", "BPrivate::_Part_");
	EXPECT_TRUE(validate_instantiation(&archive, "Base"));
	EXPECT_EQ(B_OK, errno);
	EXPECT_TRUE(validate_instantiation(&archive, "_Part_"));
	EXPECT_FALSE(validate_instantiation(&archive, "Other"));
	EXPECT_EQ(B_MISMATCHED_VALUES, errno);
	EXPECT_FALSE(validate_instantiation(nullptr, "Base"));
	EXPECT_EQ(B_BAD_VALUE, errno);
}


TEST(Archivable, TheFunctionAloneIsFound)
{
	EXPECT_EQ(&ArchivedThing::Instantiate, find_instantiation_func("ArchivedThing"));
	EXPECT_EQ(nullptr, find_instantiation_func("ArchivedThing", "application/x-vnd.No-such"));
	EXPECT_EQ(nullptr, find_instantiation_func("NoSuchThing"));
	errno = B_OK;
	EXPECT_EQ(nullptr, find_instantiation_func(static_cast<const char*>(nullptr)));
	EXPECT_EQ(B_BAD_VALUE, errno);
	BMessage archive = archive_of("ArchivedThing");
	errno = B_OK;
	EXPECT_EQ(nullptr, find_instantiation_func(&archive));
	EXPECT_EQ(B_BAD_VALUE, errno);
}


TEST(ArchiveSource, KnowsWhatTheConstructorsLookedUp)
{
	BMessage archive = archive_of("ArchivedThing");
	archive.AddInt32("number", 9);
	archive.AddInt32("other", 9);
	archive.AddInt32("unknown", 9);
	std::unique_ptr<BArchivable> object(instantiate_object(&archive));
	auto* thing = dynamic_cast<ArchivedThing*>(object.get());
	ASSERT_NE(nullptr, thing);
	// Who looks later leaves no mark.
	EXPECT_EQ(9, archive.FindInt32("unknown"));
	EXPECT_EQ(9, thing->fSource.Archive().FindInt32("unknown"));
	EXPECT_TRUE(thing->fSource.IsKnown("class"));
	EXPECT_TRUE(thing->fSource.IsKnown("number"));
	EXPECT_TRUE(thing->fSource.IsKnown("other"));
	EXPECT_FALSE(thing->fSource.IsKnown("unknown"));
	archive.ReplaceInt32("number", 1);
	EXPECT_EQ(9, thing->fSource.Archive().FindInt32("number"));
}


TEST(ArchiveSource, KnowsMoreFieldsThanOneWordHasBits)
{
	BMessage archive = archive_of("ArchivedThing");
	for (int32 i = 0; i < 300; i++)
		archive.AddInt32(("field " + std::to_string(i)).c_str(), i);
	BPrivate::ArchiveSource source(&archive);
	for (int32 i = 0; i < 300; i += 7)
		archive.FindInt32(("field " + std::to_string(i)).c_str());
	for (int32 i = 0; i < 300; i++)
		EXPECT_EQ(i % 7 == 0, source.IsKnown(("field " + std::to_string(i)).c_str())) << i;
}


TEST(Archivable, AManagedArchiveIsGivenBackAsItWas)
{
	BMessage archive = archive_of("ArchivedThing");
	archive.AddInt32("number", 3);
	archive.AddInt32("_views", 1);
	const BMessage child = archive_of("ArchivedThing");
	archive.AddMessage("_managed_archivable", &child);
	archive.AddBool("_managed_archive", true);
	const BMessage original(archive);
	std::unique_ptr<BArchivable> object(instantiate_object(&archive));
	auto* thing = dynamic_cast<ArchivedThing*>(object.get());
	ASSERT_NE(nullptr, thing);
	EXPECT_TRUE(thing->fSource.WasManaged());
	EXPECT_TRUE(thing->fSource.Archive().HasMessage("_views"));
	EXPECT_TRUE(archive.HasSameData(original, false, true));
}
