// What a BResources knows of its file and its items.
#pragma once

#include <sys/stat.h>

#include <memory>
#include <string>

#include <Resources.h>

#include "storage/private/ResourceFormat.h"
#include "storage/private/ResourceReader.h"
#include "storage/private/ResourceTable.h"
#include "storage/private/ResourceWriter.h"

namespace BPrivate {


// The file's size and the time of its last writing: while they stay, the places that were read
// from its table are good.
struct Stamp {
	off_t size = 0;
	timespec time = {};

	bool operator==(const Stamp& other) const
	{
		return size == other.size && time.tv_sec == other.time.tv_sec
			&& time.tv_nsec == other.time.tv_nsec;
	}
};


inline Stamp
StampOf(int fd)
{
	struct stat stat;
	if (fstat(fd, &stat) < 0)
		return Stamp();
	return { stat.st_size, stat.st_mtim };
}


} // namespace BPrivate


struct BResources::State {
	BPrivate::ResourceTable table;
	BPrivate::ResourceFrame frame;
	BPrivate::Stamp stamp;
	std::string path; // as far as it is known, to find a file that was replaced
	bool readOnly = false;
	bool changed = false;
	bool failed = false; // at the last Sync(), and somebody was told

	BPrivate::ResourceItem* Load(BPrivate::ResourceItem* item, int fd)
	{
		if (item == NULL || item->data != NULL)
			return item;
		if (!(BPrivate::StampOf(fd) == stamp))
			return NULL; // somebody wrote over the file: the places mean nothing now
		item->data = BPrivate::ReadResourceData(*item, Source(fd));
		table.DataChanged(item, NULL);
		return item->data != NULL ? item : NULL;
	}

	BPrivate::ResourceSource Source(int fd) const { return { fd, frame.info.big_endian }; }

	status_t LoadAll(int fd)
	{
		int32 failures = 0;
		for (int32 i = 0; i < table.Count(); i++) {
			if (Load(table.At(i), fd) == NULL)
				failures++;
		}
		return -failures;
	}

	// Whether all that a save needs can be had.
	bool IsIntact(int fd)
	{
		if (BPrivate::StampOf(fd) == stamp)
			return true;
		for (int32 i = 0; i < table.Count(); i++) {
			if (table.At(i)->data == NULL)
				return false;
		}
		return frame.info.base <= static_cast<off_t>(BPrivate::kX86HeaderSize);
	}

	// What the file has besides its resources. What a damaged or foreign file holds is given up; an
	// executable's own part never is.
	void AdoptFrame(const BPrivate::ResourceReader& reader, status_t status)
	{
		frame = BPrivate::ResourceFrame();
		if (reader.Info().kind == B_NO_RESOURCE_FILE)
			return;
		frame.info = reader.Info();
		frame.size = reader.FileSize();
		if (status == B_OK)
			frame.extras = reader.Extras();
	}

	status_t Adopt(BPrivate::ResourceReader& reader)
	{
		frame.info = reader.Info();
		frame.extras = reader.Extras();
		frame.size = reader.FileSize();
		for (auto& item : reader.Items())
			table.Add(std::move(item));
		return B_OK;
	}
};
