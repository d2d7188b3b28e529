#include <NodeInfo.h>

#include <string.h>

#include <string>

#include <Path.h>
#include <TypeConstants.h>

#include "storage/private/Descriptor.h"
#include "storage/private/IconData.h"
#include "storage/private/NodeAttributes.h"

using namespace BPrivate;

namespace {

constexpr char kTypeAttribute[] = "BEOS:TYPE";
constexpr char kPreferredAppAttribute[] = "BEOS:PREF_APP";
constexpr char kAppHintAttribute[] = "BEOS:PPATH";


// A text of the length that types and signatures may have; NULL removes it.
status_t
SetTextAttribute(BNode& node, const char* name, type_code type, const char* text)
{
	if (text == NULL)
		return node.RemoveAttr(name);
	const ssize_t size = strlen(text) + 1;
	if (size > B_MIME_TYPE_LENGTH + 1)
		return B_BAD_VALUE;
	const ssize_t written = node.WriteAttr(name, type, 0, text, size);
	return written < 0 ? static_cast<status_t>(written) : B_OK;
}


status_t
GetTextAttribute(const BNode& node, const char* name, char* buffer)
{
	const ssize_t read = node.ReadAttr(name, B_MIME_STRING_TYPE, 0, buffer, B_MIME_TYPE_LENGTH + 1);
	if (read < 0)
		return static_cast<status_t>(read);
	buffer[read < B_MIME_TYPE_LENGTH ? read : B_MIME_TYPE_LENGTH] = '\0';
	return B_OK;
}

} // namespace


BNodeInfo::BNodeInfo() : fNode(NULL), fCStatus(B_NO_INIT)
{
}


BNodeInfo::BNodeInfo(BNode* node) : fNode(NULL), fCStatus(B_NO_INIT)
{
	SetTo(node);
}


BNodeInfo::~BNodeInfo()
{
}


status_t
BNodeInfo::SetTo(BNode* node)
{
	fNode = NULL;
	if (node == NULL)
		return fCStatus = B_BAD_VALUE;
	fCStatus = node->InitCheck();
	if (fCStatus == B_OK)
		fNode = node;
	return fCStatus;
}


status_t
BNodeInfo::InitCheck() const
{
	return fCStatus;
}


status_t
BNodeInfo::GetType(char* type) const
{
	if (type == NULL)
		return B_BAD_VALUE;
	if (fCStatus != B_OK)
		return fCStatus;
	if (GetTextAttribute(*fNode, kTypeAttribute, type) == B_OK && BMimeType::IsValid(type))
		return B_OK;

	const std::string path = PathOf(fNode->_Fd());
	entry_ref ref;
	BMimeType guess;
	status_t status = path.empty() ? static_cast<status_t>(B_ENTRY_NOT_FOUND)
								   : get_ref_for_path(path.c_str(), &ref);
	if (status == B_OK)
		status = BMimeType::GuessMimeType(&ref, &guess);
	if (status == B_OK)
		strcpy(type, guess.Type());
	return status;
}


status_t
BNodeInfo::SetType(const char* type)
{
	if (fCStatus != B_OK)
		return fCStatus;
	return SetTextAttribute(*fNode, kTypeAttribute, B_MIME_STRING_TYPE, type);
}


status_t
BNodeInfo::GetIcon(BBitmap* icon, icon_size size) const
{
	if (icon == NULL)
		return B_BAD_VALUE;
	if (fCStatus != B_OK)
		return fCStatus;
	AttributeValue value;
	const status_t status = ReadAttribute(fNode->_Fd(), IconName(size), &value);
	if (status != B_OK)
		return status;
	return DataToIcon(value.data.data(), value.data.size(), size, icon);
}


status_t
BNodeInfo::SetIcon(const BBitmap* icon, icon_size size)
{
	if (fCStatus != B_OK)
		return fCStatus;
	if (icon == NULL)
		return fNode->RemoveAttr(IconName(size));
	AttributeValue value = { IconType(size), {} };
	const status_t status = IconToData(icon, size, &value.data);
	return status == B_OK ? WriteAttribute(fNode->_Fd(), IconName(size), value) : status;
}


status_t
BNodeInfo::GetPreferredApp(char* signature, app_verb) const
{
	if (signature == NULL)
		return B_BAD_VALUE;
	if (fCStatus != B_OK)
		return fCStatus;
	return GetTextAttribute(*fNode, kPreferredAppAttribute, signature);
}


status_t
BNodeInfo::SetPreferredApp(const char* signature, app_verb)
{
	if (fCStatus != B_OK)
		return fCStatus;
	return SetTextAttribute(*fNode, kPreferredAppAttribute, B_MIME_STRING_TYPE, signature);
}


// The hint is kept as a path, which says more to another program than a folder's number.
status_t
BNodeInfo::GetAppHint(entry_ref* _ref) const
{
	if (_ref == NULL)
		return B_BAD_VALUE;
	if (fCStatus != B_OK)
		return fCStatus;
	AttributeValue value;
	const status_t status = ReadAttribute(fNode->_Fd(), kAppHintAttribute, &value);
	return status == B_OK ? get_ref_for_path(value.data.c_str(), _ref) : status;
}


status_t
BNodeInfo::SetAppHint(const entry_ref* ref)
{
	if (fCStatus != B_OK)
		return fCStatus;
	if (ref == NULL)
		return fNode->RemoveAttr(kAppHintAttribute);
	const BPath path(ref);
	if (path.InitCheck() != B_OK)
		return path.InitCheck();
	const AttributeValue value = { B_MIME_STRING_TYPE,
		std::string(path.Path(), strlen(path.Path()) + 1) };
	return WriteAttribute(fNode->_Fd(), kAppHintAttribute, value);
}


status_t
BNodeInfo::GetTrackerIcon(BBitmap* icon, icon_size size) const
{
	if (icon == NULL)
		return B_BAD_VALUE;
	if (fCStatus != B_OK)
		return fCStatus;
	if (GetIcon(icon, size) == B_OK)
		return B_OK;
	char type[B_MIME_TYPE_LENGTH + 1];
	const status_t status = GetType(type);
	return status == B_OK ? BMimeType(type).GetIcon(icon, size) : status;
}


status_t
BNodeInfo::GetTrackerIcon(const entry_ref* ref, BBitmap* icon, icon_size size)
{
	BNode node(ref);
	const BNodeInfo info(&node);
	return info.GetTrackerIcon(icon, size);
}
