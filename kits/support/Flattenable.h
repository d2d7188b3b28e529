// BFlattenable: an object that can be turned into bytes and back.
#pragma once

#include <SupportDefs.h>
#include <TypeConstants.h>

class BFlattenable {
public:
	virtual ~BFlattenable();

	virtual bool IsFixedSize() const = 0;
	virtual type_code TypeCode() const = 0;
	virtual ssize_t FlattenedSize() const = 0;
	virtual status_t Flatten(void* buffer, ssize_t size) const = 0;
	virtual bool AllowsTypeCode(type_code code) const; // by default only TypeCode()
	virtual status_t Unflatten(type_code code, const void* buffer, ssize_t size) = 0;
};
