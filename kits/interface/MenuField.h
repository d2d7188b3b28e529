// BMenuField: a labelled menu that shows its marked item.
#pragma once

#include <Menu.h>
#include <View.h>

class BMenuBar;
class _BMCMenuBar_;


// The menu passed in is owned from then on: it is the submenu of the only item of a menu bar,
// the child "_mc_mb_", which lies right of the divider.
class BMenuField : public BView {
public:
	BMenuField(BRect frame, const char* name, const char* label, BMenu* menu,
		uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP,
		uint32 flags = B_WILL_DRAW | B_NAVIGABLE);
	// A bar of fixed size takes all the room right of the divider.
	BMenuField(BRect frame, const char* name, const char* label, BMenu* menu, bool fixedSize,
		uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP,
		uint32 flags = B_WILL_DRAW | B_NAVIGABLE);
	BMenuField(BMessage* archive);
	virtual ~BMenuField();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	virtual void Draw(BRect updateRect);
	virtual void AttachedToWindow();
	virtual void AllAttached();
	virtual void MouseDown(BPoint where);
	virtual void KeyDown(const char* bytes, int32 numBytes);
	virtual void MakeFocus(bool focus = true);
	virtual void MessageReceived(BMessage* message);
	virtual void WindowActivated(bool active);
	virtual void MouseUp(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 code, const BMessage* message);
	virtual void DetachedFromWindow();
	virtual void AllDetached();
	virtual void FrameMoved(BPoint newPosition);
	virtual void FrameResized(float width, float height);

	BMenu* Menu() const;
	BMenuBar* MenuBar() const;
	// The bar's item; its label is the text that the field shows.
	BMenuItem* MenuItem() const;

	virtual void SetLabel(const char* label);
	const char* Label() const;
	virtual void SetEnabled(bool enabled);
	bool IsEnabled() const;
	// Of the label; shown at the next redraw.
	virtual void SetAlignment(alignment label);
	alignment Alignment() const;
	virtual void SetDivider(float position);
	float Divider() const;

	void ShowPopUpMarker();
	void HidePopUpMarker();

	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property);
	virtual status_t GetSupportedSuites(BMessage* data);
	virtual status_t Perform(perform_code code, void* data);
	virtual void ResizeToPreferred();
	virtual void GetPreferredSize(float* _width, float* _height);

private:
	friend class _BMCMenuBar_;

	void _Init();
	void _CreateBar(BMenu* menu);
	BRect _BarFrame() const;
	void _FitBar();
	void _OpenMenu(bool byKey);
	float _LabelWidth() const;

	char* fLabel; // owned
	alignment fAlignment;
	float fDivider;
	bool fEnabled;
	bool fFixedSize;
	bool fPopUpMarker;
};
