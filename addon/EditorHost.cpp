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
ReplaceInEditor(const BView* panel, BView* former, BView* view)
{
	ViewEditor* editor = EditorOf(panel);
	if (editor == nullptr)
		return false;

	editor->ReplaceView(former, view);
	return true;
}
