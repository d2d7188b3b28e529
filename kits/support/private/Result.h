// Result: a value, or the reason why there is none.
#pragma once

#include <optional>
#include <utility>

#include <SupportDefs.h>

namespace BPrivate {


// T must not be status_t itself.
template<typename T> class Result {
public:
	Result(T value) : fValue(std::move(value)), fError(B_OK) {}

	// B_OK is no error: it would promise a value that is not there.
	Result(status_t error) : fError(error == B_OK ? B_ERROR : error) {}

	explicit operator bool() const { return fValue.has_value(); }
	status_t Error() const { return fError; }

	T& operator*() { return *fValue; }
	const T& operator*() const { return *fValue; }
	T* operator->() { return &*fValue; }
	const T* operator->() const { return &*fValue; }

private:
	std::optional<T> fValue;
	status_t fError;
};


} // namespace BPrivate
