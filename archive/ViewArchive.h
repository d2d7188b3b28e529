// Loading, comparing, printing and converting archives of view trees.
#pragma once

#include <SupportDefs.h>

class BArchivable;
class BMessage;
class BView;

// The view archived in the application's own resources under type 'ARCV', or NULL when there is no
// such resource, its bytes are no message, or the object is no view. The caller owns the view.
BView* ViewFromResource(int32 id);
BView* ViewFromResource(const char* name);

// Revives an archived object as it would be revived as a child of another view: a platform that
// puts stand-ins in the place of children of unknown classes gives one for it. NULL when the
// archive cannot be revived. The caller owns the object.
BArchivable* InstantiateAsChild(BMessage* archive);

// Whether two archives have the same code and the same fields: same types, same entries in the
// same order, byte for byte, nested archives by the same rule. The order of fields does not matter.
// False when either is NULL.
bool Equal(const BMessage* a, const BMessage* b);

// Prints an archive on standard output, indented by that many tabs. Of fields with one name the
// values of the first are shown.
void DumpMessage(const BMessage* message, int depth);

// Converts an archive and every archive nested in it between the resource form, where the class
// list of a placeholder ends with "LayoutInheritedView", and the live form, where it starts with
// it. The caller passes depth 0.
void SwapInheritedViews(BMessage* archive, int depth);
