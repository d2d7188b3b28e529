// make_panels FOLDER: writes the example files. This is how a program makes a design that a
// resource editor can open: build the views, archive them, keep the archive as a resource.

#include <cstdio>
#include <cstring>
#include <string>
#include <vector>

#include <Application.h>
#include <File.h>
#include <Message.h>
#include <Resources.h>
#include <Window.h>

#include "Panels.h"

namespace {


struct Design {
	const char* file;
	int32 id;
	const char* name;
	BView* (*make)();
};

constexpr Design kDesigns[] = {
	{ "preferences.rsrc", 1, "Preferences", MakePreferences },
	{ "preferences.rsrc", 2, "About", MakeAboutPanel },
	{ "find-dialog.rsrc", 1, "Find", MakeFindDialog },
	{ "colours.rsrc", 1, "Colours", MakeColorPanel },
};


// In a window controls take their colours and sizes, so the design is archived after it was in one.
status_t
ArchiveDesign(const Design& design, BMessage* _archive)
{
	BView* view = design.make();
	BWindow* window = new BWindow(
		view->Frame().OffsetByCopy(50, 50), design.name, B_TITLED_WINDOW, B_ASYNCHRONOUS_CONTROLS);
	window->AddChild(view);
	const status_t status = view->Archive(_archive, true);
	window->Lock();
	window->Quit();
	return status;
}


status_t
AddDesign(const std::string& path, const Design& design)
{
	BFile file(path.c_str(), B_READ_WRITE | B_CREATE_FILE | (design.id == 1 ? B_ERASE_FILE : 0));
	status_t status = file.InitCheck();
	BResources resources;
	if (status == B_OK)
		status = resources.SetTo(&file);

	BMessage archive;
	if (status == B_OK)
		status = ArchiveDesign(design, &archive);
	std::vector<char> bytes(static_cast<size_t>(archive.FlattenedSize()));
	const ssize_t size = static_cast<ssize_t>(bytes.size());
	if (status == B_OK)
		status = archive.Flatten(bytes.data(), size);
	if (status == B_OK)
		status = resources.AddResource('ARCV', design.id, bytes.data(), bytes.size(), design.name);
	return status == B_OK ? resources.Sync() : status;
}


} // namespace


int
main(int argc, char** argv)
{
	if (argc != 2) {
		fprintf(stderr, "usage: make_panels FOLDER\n");
		return 2;
	}
	BApplication application("application/x-vnd.Archway-panels");
	for (const Design& design : kDesigns) {
		const std::string path = std::string(argv[1]) + '/' + design.file;
		const status_t status = AddDesign(path, design);
		if (status != B_OK) {
			fprintf(stderr, "make_panels: %s: %s\n", path.c_str(), strerror(status));
			return 1;
		}
	}
	return 0;
}
