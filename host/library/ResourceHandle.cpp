#include "host/library/ResourceHandle.h"

namespace BResEditor {


BResourceHandle::BResourceHandle() : fNumber(0)
{
}


bool
BResourceHandle::IsValid() const
{
	return fNumber != 0;
}


bool
BResourceHandle::operator==(const BResourceHandle& other) const
{
	return fNumber == other.fNumber;
}


bool
BResourceHandle::operator!=(const BResourceHandle& other) const
{
	return fNumber != other.fNumber;
}


BResourceHandle::BResourceHandle(int32 number) : fNumber(number)
{
}


} // namespace BResEditor
