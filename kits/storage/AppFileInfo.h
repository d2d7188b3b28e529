// BAppFileInfo: what a program file says about itself.
#pragma once

#include <memory>
#include <string>

#include <NodeInfo.h>

class BFile;
class BMessage;
class BResources;

struct version_info {
	uint32 major;
	uint32 middle;
	uint32 minor;
	uint32 variety;
	uint32 internal;
	char short_info[64];
	char long_info[256];
};

enum info_location { B_USE_ATTRIBUTES = 0x1, B_USE_RESOURCES = 0x2, B_USE_BOTH_LOCATIONS = 0x3 };

enum version_kind { B_APP_VERSION_KIND, B_SYSTEM_VERSION_KIND };


// Written to the file's attributes and resources, read from the attributes first. The file stays
// the caller's.
class BAppFileInfo : public BNodeInfo {
public:
	BAppFileInfo();
	BAppFileInfo(BFile* file);
	virtual ~BAppFileInfo();

	status_t SetTo(BFile* file);

	virtual status_t GetType(char* type) const;
	virtual status_t SetType(const char* type);
	// `signature` has room for B_MIME_TYPE_LENGTH + 1 bytes.
	status_t GetSignature(char* signature) const;
	status_t SetSignature(const char* signature);
	status_t GetAppFlags(uint32* _flags) const;
	status_t SetAppFlags(uint32 flags);
	// Strings in the field "types". When the file has a signature, the signature's BMimeType is told
	// too; types that are no longer supported forget the program only if `syncAll` is set.
	status_t GetSupportedTypes(BMessage* _types) const;
	status_t SetSupportedTypes(const BMessage* types);
	status_t SetSupportedTypes(const BMessage* types, bool syncAll);
	bool IsSupportedType(const char* type) const;
	bool Supports(BMimeType* type) const;
	virtual status_t GetIcon(BBitmap* icon, icon_size size = B_LARGE_ICON) const;
	virtual status_t SetIcon(const BBitmap* icon, icon_size size = B_LARGE_ICON);
	// Of a file type that the program supports; NULL is the program itself.
	status_t GetIconForType(const char* type, BBitmap* icon, icon_size size = B_LARGE_ICON) const;
	status_t SetIconForType(const char* type, const BBitmap* icon, icon_size size = B_LARGE_ICON);
	status_t GetVersionInfo(version_info* _info, version_kind kind) const;
	status_t SetVersionInfo(const version_info* info, version_kind kind);

	void SetInfoLocation(info_location location);
	bool IsUsingAttributes() const;
	bool IsUsingResources() const;

private:
	BAppFileInfo(const BAppFileInfo&);
	BAppFileInfo& operator=(const BAppFileInfo&);

	struct Item;

	status_t _Read(const Item& item, std::string* _data) const;
	status_t _Write(const Item& item, const void* data, size_t size);
	status_t _ReadText(const Item& item, char* buffer) const;

	std::unique_ptr<BResources> fResources; // NULL when the file cannot hold resources
	info_location fWhere;
};
