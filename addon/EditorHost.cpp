#include "editors/EditorHost.h"

#include "addon/ViewEditor.h"

namespace {


ViewEditor*
EditorOf(const BView* panel)
{
	for (BView* view = panel->Parent(); view != nullptr; view = view->Parent()) {
		if (ViewEditor* editor = dynamic_cast<ViewEditor*>(view))
			return editor;
	}
	return nullptr;
}


} // namespace


bool
HasEditor(const BView* panel)
{
	return EditorOf(panel) != nullptr;
}


bool
SelectInEditor(const BView* panel, BView* view)
{
	ViewEditor* editor = EditorOf(panel);
	if (editor == nullptr)
		return false;

	editor->SelectView(view);
	return true;
}
