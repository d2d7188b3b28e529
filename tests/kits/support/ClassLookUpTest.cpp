// A class is looked for once, not once for each object.

#include <dlfcn.h>
#include <string.h>

#include <atomic>
#include <memory>

#include <gtest/gtest.h>

#include <Archivable.h>
#include <Message.h>

namespace {

std::atomic<int> sLookUps { 0 };

} // namespace


#if !defined(__SANITIZE_ADDRESS__) && !defined(__SANITIZE_THREAD__)
#define COUNTS_LOOK_UPS 1

// In front of the C library's for all of the program.
extern "C" void*
dlsym(void* handle, const char* name)
{
	typedef void* (*look_up)(void*, const char*);
	static const look_up sNext = [] {
		void* next = dlvsym(RTLD_NEXT, "dlsym", "GLIBC_2.34");
		return reinterpret_cast<look_up>(
			next != nullptr ? next : dlvsym(RTLD_NEXT, "dlsym", "GLIBC_2.2.5"));
	}();
	sLookUps++;
	return sNext(handle, name);
}
#endif


TEST(ClassLookUp, IsDoneOnceForEachClass)
{
#ifndef COUNTS_LOOK_UPS
	GTEST_SKIP() << "the sanitizer looks up for itself";
#endif
	const auto revive = [](const char* className, int times) {
		for (int i = 0; i < times; i++) {
			BMessage archive;
			archive.AddString("class", className);
			const std::unique_ptr<BArchivable> object(instantiate_object(&archive));
			EXPECT_EQ(strcmp(className, "BStringItem") == 0, object != nullptr);
		}
	};
	for (const char* className : { "BStringItem", "Nobody", "Nobody::Either" }) {
		sLookUps = 0;
		revive(className, 1);
		EXPECT_GT(sLookUps, 0) << className;
		sLookUps = 0;
		revive(className, 1000);
		EXPECT_EQ(0, sLookUps) << className;
	}
}
