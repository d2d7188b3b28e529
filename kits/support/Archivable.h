// BArchivable: an object that can be written to a message and made again from it.
#pragma once

#include <SupportDefs.h>
#include <image.h>

class BMessage;

class BArchivable {
public:
	BArchivable();
	BArchivable(BMessage* from);
	virtual ~BArchivable();

	// Writes the name of the dynamic class as the first entry of "class".
	virtual status_t Archive(BMessage* into, bool deep = true) const;
	static BArchivable* Instantiate(BMessage* archive);

	virtual status_t Perform(perform_code code, void* argument);
};

typedef BArchivable* (*instantiation_func)(BMessage*);

// The object that the archive describes, made by the static Instantiate(BMessage*) of the class
// named first; NULL when there is none. The caller owns it. *_id gets the image that holds the
// class, or the error. Any thread may call it.
BArchivable* instantiate_object(BMessage* from, image_id* _id);
BArchivable* instantiate_object(BMessage* from);

// Whether any entry of "class" is the given class; sets errno to B_OK, B_BAD_VALUE or
// B_MISMATCHED_VALUES.
bool validate_instantiation(BMessage* from, const char* className);

// NULL when no loaded image has the class, or its signature is another one than the given.
instantiation_func find_instantiation_func(const char* className, const char* signature);
instantiation_func find_instantiation_func(const char* className);
// Needs both "class" and "add_on".
instantiation_func find_instantiation_func(BMessage* archive);
