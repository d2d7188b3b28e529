#include "host/library/ResourceItem.h"

#include "host/library/ResourceCollection.h"

namespace BResEditor {


BResourceItem::BResourceItem(BResourceCollection* collection, const BResourceHandle& handle) :
	fCollection(collection), fHandle(handle), fType(0), fID(0),
	fData(std::make_shared<const std::vector<uint8>>())
{
}


BResourceItem::BResourceItem(const BResourceItem& other) = default;


BResourceHandle
BResourceItem::Handle() const
{
	return fHandle;
}


type_code
BResourceItem::Type() const
{
	return fType;
}


int32
BResourceItem::ID() const
{
	return fID;
}


const char*
BResourceItem::Name() const
{
	return fName.String();
}


const void*
BResourceItem::Data() const
{
	return fData->empty() ? nullptr : fData->data();
}


size_t
BResourceItem::Size() const
{
	return fData->size();
}


status_t
BResourceItem::SetType(type_code type)
{
	return SetKey(type, fID);
}


status_t
BResourceItem::SetID(int32 id)
{
	return SetKey(fType, id);
}


status_t
BResourceItem::SetName(const char* name)
{
	if (name == nullptr)
		name = "";
	if (fName == name)
		return B_OK;

	fCollection->_WillChange(this, B_ITEM_ATTRIBUTES_CHANGED);
	fName = name;
	return B_OK;
}


status_t
BResourceItem::SetData(const void* data, size_t size)
{
	if (data == nullptr && size > 0)
		return B_BAD_VALUE;

	const uint8* bytes = static_cast<const uint8*>(data);
	std::vector<uint8> copy(bytes, bytes + size);
	fCollection->PrepareData(this, copy);
	if (copy == *fData)
		return B_OK;

	fCollection->_WillChange(this, B_ITEM_DATA_CHANGED);
	fData = std::make_shared<const std::vector<uint8>>(std::move(copy));
	return B_OK;
}


status_t
BResourceItem::SetKey(type_code type, int32 id)
{
	if (type == fType && id == fID)
		return B_OK;
	if (fCollection->FindItem(type, id).IsValid())
		return B_NAME_IN_USE;

	fCollection->_WillChange(this, B_ITEM_ATTRIBUTES_CHANGED);
	fCollection->_Rekey(this, type, id);
	return B_OK;
}


} // namespace BResEditor
