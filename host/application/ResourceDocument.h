// ResourceDocument: the items of one resource file, with undo steps, read and saved.
#pragma once

#include <map>
#include <memory>
#include <string>
#include <vector>

#include <String.h>

#include "host/library/ResourceCollection.h"

class BResources;


// The collection's locks guard the items and the undo steps. Loading and saving take them; any
// thread may do either.
class ResourceDocument : public BResEditor::BResourceCollection {
public:
	ResourceDocument();
	~ResourceDocument() override;

	// Reads the file; what it held before is forgotten. On an error nothing changes.
	status_t Load(const char* path);

	// Writes the differences into the file, which is replaced as a whole; all of it, when the file
	// is gone. B_NO_INIT when there is no path yet.
	status_t Save();

	// Writes everything into that file, new or not, and belongs to it from then on.
	status_t SaveAs(const char* path);

	const char* Path() const; // "" for a document that was never saved
	const char* Name() const; // the last part of the path, or "Untitled"

	// Whether the items differ from what was last read or saved.
	bool IsModified() const;

	// Whether somebody else has changed the file since it was last read or saved. Not so when it
	// is gone.
	bool IsChangedOnDisk() const;

	// The text of the step, NULL when there is none.
	const char* UndoName() const;
	const char* RedoName() const;
	bool Undo();
	bool Redo();

protected:
	void StepBegins(const char* operation) override;
	void ItemChanges(const BResEditor::BResourceItem* item, uint32 change) override;
	void StepEnds() override;

	// A message keeps the flattened form that the item has, so that a small edit stays a small
	// change of the file.
	void PrepareData(
		const BResEditor::BResourceItem* item, std::vector<uint8>& data) const override;

private:
	struct Change {
		std::shared_ptr<const BResEditor::BResourceItem> before; // NULL for a new item
		std::shared_ptr<const BResEditor::BResourceItem> after; // NULL for a removed one
		BResEditor::BResourceHandle handle;
		int32 index; // of the item, before and after
	};
	struct Step {
		BString name;
		std::vector<Change> changes;
	};
	struct SavedItem {
		BString name;
		std::vector<uint8> data;
	};
	struct FileStamp {
		int64 seconds = 0;
		int64 nanoseconds = 0;
		int64 size = -1; // -1: no file
		bool operator==(const FileStamp&) const = default;
	};
	typedef std::pair<type_code, int32> ItemKey;
	typedef std::map<ItemKey, SavedItem> SavedItems;

	class ReadAccess;
	class WriteAccess;

	static FileStamp _StampOf(const char* path);
	SavedItems _PresentItems() const;
	status_t _WriteAll(const char* path) const;
	status_t _WriteDifferences(const char* path, const SavedItems& present);
	status_t _WriteChanged(BResources& resources, const SavedItems& present) const;
	std::vector<ItemKey> _OrderInFile(
		const std::vector<ItemKey>& former, const SavedItems& present) const;
	bool _HasChanged(const ItemKey& key, const SavedItems& present) const;
	bool _Replay(std::vector<Step>& from, std::vector<Step>& to, bool undo);
	void _ReplayChange(const Change& change, bool undo);

	std::string fPath;
	SavedItems fSaved; // as in the file
	FileStamp fStamp;
	std::vector<Step> fUndoSteps; // the newest last
	std::vector<Step> fRedoSteps;
	Step fOpenStep;
	bool fReplaying;
};
