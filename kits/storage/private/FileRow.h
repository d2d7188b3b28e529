// FileRow: one file or folder in a file panel's list; FileHeader: the titles above its columns.
#pragma once

#include <StringItem.h>
#include <View.h>

#include "storage/private/FolderContents.h"

namespace BPrivate {

class FileRow : public BStringItem {
public:
	explicit FileRow(const FolderItem& item);

	const FolderItem& Item() const { return fItem; }

	void DrawItem(BView* owner, BRect frame, bool complete = false) override;
	void Update(BView* owner, const BFont* font) override;

private:
	void _DrawIcon(BView* owner, BPoint leftTop) const;

	FolderItem fItem;
	std::string fSize;
	std::string fDate;
};


class FileHeader : public BView {
public:
	explicit FileHeader(BRect frame);

	void Draw(BRect updateRect) override;
};

} // namespace BPrivate
