// BQuery: a question about the attributes of all files of a volume.
#pragma once

#include <string>
#include <vector>

#include <EntryList.h>
#include <Messenger.h>
#include <SupportDefs.h>

class BString;
class BVolume;

// B_AND and above join comparisons.
typedef enum {
	B_INVALID_OP = 0,
	B_EQ,
	B_GT,
	B_GE,
	B_LT,
	B_LE,
	B_NE,
	B_CONTAINS,
	B_BEGINS_WITH,
	B_ENDS_WITH,
	B_AND = 0x101,
	B_OR,
	B_NOT,
} query_op;

// The predicate is a text, or is pushed piece by piece with each operator behind its operands. The
// file systems of this host keep no index (BVolume::KnowsQuery() is false), so a complete query is
// answered B_UNSUPPORTED and there are no entries.
class BQuery : public BEntryList {
public:
	BQuery();
	virtual ~BQuery();
	BQuery(const BQuery&) = delete;
	BQuery& operator=(const BQuery&) = delete;

	// Forgets all but the errors of the past.
	status_t Clear();

	void PushAttr(const char* attribute);
	void PushOp(query_op operation);
	void PushUInt32(uint32 value);
	void PushInt32(int32 value);
	void PushUInt64(uint64 value);
	void PushInt64(int64 value);
	void PushFloat(float value);
	void PushDouble(double value);
	void PushString(const char* value, bool caseInsensitive = false);

	// B_NOT_ALLOWED once it was fetched.
	status_t SetVolume(const BVolume* volume);
	// Replaces what was pushed.
	status_t SetPredicate(const char* expression);
	status_t SetTarget(BMessenger target);

	bool IsLive() const;
	// B_NO_INIT when there is none or what was pushed makes none; B_BAD_VALUE for too little room.
	status_t GetPredicate(char* buffer, size_t length);
	status_t GetPredicate(BString* predicate);
	size_t PredicateLength(); // with its NUL; 0 when there is none
	dev_t TargetDevice() const; // B_ERROR when there is none

	// B_NO_INIT without a volume or predicate.
	status_t Fetch();

	virtual status_t GetNextEntry(BEntry* entry, bool traverse = false);
	virtual status_t GetNextRef(entry_ref* ref);
	virtual int32 GetNextDirents(struct dirent* buffer, size_t length, int32 count = INT32_MAX);
	virtual status_t Rewind();
	virtual int32 CountEntries();

private:
	// A piece of the predicate: an attribute, a value, or a term with its operands inside.
	struct Piece {
		enum Kind { kAttribute, kNumber, kString, kTerm } kind;
		std::string text;
	};

	void _PushNumber(const std::string& text);
	void _PushComparison(query_op operation);
	const std::string* _Predicate() const; // NULL when there is none

	std::vector<Piece> fStack;
	bool fBroken = false; // an operator did not find its operands
	bool fFetched = false;
	dev_t fDevice;
	BMessenger fTarget;
};
