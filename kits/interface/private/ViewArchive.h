// Archives that lose nothing: what a class does to read and write its fields exactly.
//
// A view that was read from an archive keeps (shares) that message. When it is archived again,
// - a field whose value is still what was read comes out as it was read: present or absent, with
//   its type, its entries and its place among the others;
// - a field whose value has changed is written in the platform's type, at its old place;
// - a field that no constructor of the class chain looked up comes out untouched;
// - a field that was looked up and is no longer written is gone.
//
// What the author of a class does, for all of this to hold:
//
// 1. In the archive constructor, read with the typed Find functions of the given message, after
//    calling the base class's constructor, which has taken care of the rest:
//
//	BSlider::BSlider(BMessage* archive) : BControl(archive)
//	{
//		if (archive->FindInt32("_minv", &fMinValue) != B_OK)
//			fMinValue = 0;
//	}
//
// 2. In Archive(), call the base class first and write every field that the constructor reads with
//    an ArchiveWriter, whether it is wanted or not:
//
//	status_t BSlider::Archive(BMessage* archive, bool deep) const
//	{
//		const status_t status = BControl::Archive(archive, deep);
//		if (status != B_OK)
//			return status;
//		ArchiveWriter writer(archive);
//		writer.Int32("_minv", fMinValue, 0);
//		writer.String("_minlbl", fMinLabel, NULL, fMinLabel != NULL);
//		return writer.Status();
//	}
//
//    The third argument is the value that the constructor takes when it cannot read the field; the
//    fourth says whether a view that was never archived, or whose value has changed, has the field
//    at all. Where the constructor's rule is another one (it clamps, or combines fields), ask
//    Keep() and add the field by hand. A field that is only added by hand (AddInt32() and so on)
//    keeps its place and is not doubled either, but is always present in the platform's type.
//
// 3. Never adjust an archived view because it is attached: frame, colours, divider, selection and
//    marks stay until a user or a setter changes them. is_revived() tells.
//
// Objects that are no views (list and menu items, tabs) hold an ArchiveSource of their own, made of
// the message in their base class's archive constructor, and call begin_archive() first in that
// class's Archive().
#pragma once

#include <cmath>
#include <span>

#include <GraphicsDefs.h>
#include <Message.h>
#include <Point.h>
#include <Rect.h>

#include "app/private/ArchiveSource.h"

class BView;

namespace BPrivate {


// Whether the view was made from an archive.
_EXPORT bool is_revived(const BView* view);


// What a constructor from an archive does to flags or mode that its class needs: it does not count
// as a change of what was read. SetFlags() would.
_EXPORT void force_flags(BView* view, uint32 add, uint32 remove = 0);
_EXPORT void force_resizing_mode(BView* view, uint32 mode);


// Lets every field that is written into the archive from now on take the place that it had in the
// source, and puts the fields in that no constructor looked up. Call it before anything is written;
// BView::Archive() does. Nothing happens without a source.
_EXPORT void begin_archive(const ArchiveSource* source, BMessage* archive);


// For a view's Archive() that writes views into fields of its own: made before the base class's
// Archive() is called, it keeps that from taking the last step, which is Finish().
class _EXPORT ArchiveScope {
public:
	ArchiveScope(const BView* view, BMessage* archive);
	ArchiveScope(const ArchiveScope&) = delete;
	ArchiveScope& operator=(const ArchiveScope&) = delete;

	// Gives a tree that was read from the managed form that form again.
	status_t Finish();

private:
	BMessage* fArchive; // borrowed
	bool fIsRoot;
};

// Archives a view as a part of the view that is being archived, always deep.
_EXPORT status_t archive_as_child(const BView* view, BMessage* archive);


// Whether the archive that begin_archive() was called for has become, byte by byte, what the object
// was read from. Fields that were kept are not looked at, whatever they hold.
bool is_as_read(const BMessage& archive);


// Whether a value is still what was read. Numbers that are none are the same as each other.
template<typename Value>
bool
same_value(const Value& a, const Value& b)
{
	return a == b;
}


inline bool
same_value(float a, float b)
{
	return a == b || (std::isnan(a) && std::isnan(b));
}


inline bool
same_value(BPoint a, BPoint b)
{
	return same_value(a.x, b.x) && same_value(a.y, b.y);
}


inline bool
same_value(BRect a, BRect b)
{
	return same_value(a.LeftTop(), b.LeftTop()) && same_value(a.RightBottom(), b.RightBottom());
}


// Writes fields into an archive that begin_archive() was called for, or into one of a new object.
class _EXPORT ArchiveWriter {
public:
	explicit ArchiveWriter(BMessage* archive);

	void Bool(const char* name, bool value, bool absent, bool wanted = true);
	void Int8(const char* name, int8 value, int8 absent, bool wanted = true);
	void Int16(const char* name, int16 value, int16 absent, bool wanted = true);
	void Int32(const char* name, int32 value, int32 absent, bool wanted = true);
	void Int64(const char* name, int64 value, int64 absent, bool wanted = true);
	void Float(const char* name, float value, float absent, bool wanted = true);
	void Point(const char* name, BPoint value, BPoint absent, bool wanted = true);
	void Rect(const char* name, BRect value, BRect absent, bool wanted = true);
	// NULL stands for no string and is never written.
	void String(const char* name, const char* value, const char* absent, bool wanted = true);
	// NULL stands for no message and is never written. Compares the contents.
	void Message(const char* name, const BMessage* value, bool wanted = true);

	// Several entries under one name, each of which is read alone.
	void Int16s(const char* name, std::span<const int16> values, std::span<const int16> absent,
		bool wanted = true);
	void Int32s(const char* name, std::span<const int32> values, std::span<const int32> absent,
		bool wanted = true);
	void Floats(const char* name, std::span<const float> values, std::span<const float> absent,
		bool wanted = true);
	void Data(
		const char* name, type_code type, const void* bytes, ssize_t size, bool wanted = true);

	// Writes the field as it was read, or leaves it out as it was, if the object has a source and
	// says that its value is unchanged. Otherwise false: the caller adds the field, or not.
	bool Keep(const char* name, bool unchanged);
	// For the field that BArchivable wrote: further names of the source stay, until somebody adds
	// names of his own. `always`: whatever the object's class is.
	void KeepClass(bool always);
	// For the name, which BHandler wrote.
	void KeepName(const char* name);
	// What the object was read from; empty for a new object. A look leaves no marks.
	const BMessage& Source() const { return fSource; }

	// The first error; nothing is written after it.
	status_t Status() const { return fStatus; }

private:
	template<typename Value, typename Find, typename Add>
	void _Write(const char* name, std::span<const Value> values, std::span<const Value> absent,
		bool wanted, Find find, Add add);
	void _Note(status_t status);

	BMessage* fArchive; // borrowed
	BMessage fSource;
	bool fHasSource;
	status_t fStatus = B_OK;
};


} // namespace BPrivate
