// BNodeInfo: a file's type, icon and preferred application.
#pragma once

#include <SupportDefs.h>

#include <Entry.h>
#include <Mime.h>
#include <Node.h>
#include <Rect.h>

class BBitmap;


// The node stays the caller's and must outlive this object.
class BNodeInfo {
public:
	BNodeInfo();
	BNodeInfo(BNode* node);
	virtual ~BNodeInfo();

	status_t SetTo(BNode* node);
	status_t InitCheck() const;

	// `type` has room for B_MIME_TYPE_LENGTH + 1 bytes. Without an attribute the shared MIME
	// database answers, by the file's name and its first bytes.
	virtual status_t GetType(char* type) const;
	// NULL removes the type.
	virtual status_t SetType(const char* type);
	virtual status_t GetIcon(BBitmap* icon, icon_size size = B_LARGE_ICON) const;
	virtual status_t SetIcon(const BBitmap* icon, icon_size size = B_LARGE_ICON);

	status_t GetPreferredApp(char* signature, app_verb verb = B_OPEN) const;
	status_t SetPreferredApp(const char* signature, app_verb verb = B_OPEN);
	status_t GetAppHint(entry_ref* _ref) const;
	status_t SetAppHint(const entry_ref* ref);

	// The file's own icon, or that of its type.
	status_t GetTrackerIcon(BBitmap* icon, icon_size size = B_LARGE_ICON) const;
	static status_t GetTrackerIcon(
		const entry_ref* ref, BBitmap* icon, icon_size size = B_LARGE_ICON);

private:
	friend class BAppFileInfo;

	BNodeInfo(const BNodeInfo&);
	BNodeInfo& operator=(const BNodeInfo&);

	BNode* fNode; // borrowed
	status_t fCStatus;
};
