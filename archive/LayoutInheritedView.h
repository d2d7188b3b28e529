// LayoutInheritedView: stands in the editor for a view of a class that only its user's program has.
#pragma once

#include <BeBuild.h>
#include <Message.h>
#include <Rect.h>
#include <String.h>
#include <View.h>

class BRegion;


// What a placeholder adds to a plain view: the user's class name, and where it is drawn.
class LayoutInherited {
public:
	const char* ClassName() const;
	void SetClassName(const char* name); // NULL counts as ""

protected:
	LayoutInherited(const char* className);

	// Draws the class name where no child covers it, at the place it had before if possible.
	void SpecialDraw(BView* view);

private:
	BRect _PlaceLabel(BView* view, float width, float height) const;

	BString fClassName;
	BRect fLabelFrame; // in the view's coordinates; invalid until the first drawing
};


// A plain view that archives itself as two class names: its own, so that the editor revives it,
// and the user's. SwapInheritedViews() exchanges them for the user's program. Further names that an
// archive has are carried along.
class _EXPORT LayoutInheritedView : public LayoutInherited, public BView {
public:
	LayoutInheritedView(BRect frame, const char* name, uint32 resizingMode, uint32 flags);
	LayoutInheritedView(BMessage* archive);

	static BArchivable* Instantiate(BMessage* archive);
	status_t Archive(BMessage* archive, bool deep = true) const override;

	void Draw(BRect updateRect) override;

private:
	BMessage fBaseClasses; // the archived "class" entries behind the user's
};
