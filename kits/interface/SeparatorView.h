// BSeparatorView: a line between parts of a window, with a label if there is one.
#pragma once

#include <string>

#include <Alignment.h>
#include <View.h>


// The label is a text or a child view. It stands where the alignment says, and the line passes
// through its middle. A new separator has no size: the program places it.
class _EXPORT BSeparatorView : public BView {
public:
	BSeparatorView(orientation direction, border_style border = B_PLAIN_BORDER);
	BSeparatorView(const char* name, const char* label, orientation direction = B_HORIZONTAL,
		border_style border = B_FANCY_BORDER,
		const BAlignment& place = BAlignment(B_ALIGN_HORIZONTAL_CENTER, B_ALIGN_VERTICAL_CENTER));
	BSeparatorView(const char* name, BView* labelView, orientation direction = B_HORIZONTAL,
		border_style border = B_FANCY_BORDER,
		const BAlignment& place = BAlignment(B_ALIGN_HORIZONTAL_CENTER, B_ALIGN_VERTICAL_CENTER));
	BSeparatorView(const char* label = NULL, orientation direction = B_HORIZONTAL,
		border_style border = B_FANCY_BORDER,
		const BAlignment& place = BAlignment(B_ALIGN_HORIZONTAL_CENTER, B_ALIGN_VERTICAL_CENTER));
	BSeparatorView(BView* labelView, orientation direction = B_HORIZONTAL,
		border_style border = B_FANCY_BORDER,
		const BAlignment& place = BAlignment(B_ALIGN_HORIZONTAL_CENTER, B_ALIGN_VERTICAL_CENTER));
	BSeparatorView(BMessage* archive);
	virtual ~BSeparatorView();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	virtual void AttachedToWindow();
	virtual void Draw(BRect updateRect);
	virtual void FrameResized(float newWidth, float newHeight);
	virtual void GetPreferredSize(float* _width, float* _height);
	virtual status_t Perform(perform_code code, void* argument);

	void SetOrientation(orientation direction);
	void SetAlignment(const BAlignment& place);
	void SetBorderStyle(border_style border);

	// Takes the place of a label view, which is deleted.
	void SetLabel(const char* label);
	// NULL when there is none or when it is a view.
	const char* Label() const;
	// The view becomes a child; an unnamed one gets a name, by which an archive tells it. The one
	// before is deleted, or removed and left to the caller.
	void SetLabel(BView* view, bool deletePrevious);
	BView* LabelView() const;

private:
	void _Init(const char* label, BView* labelView);
	void _RemoveLabelView(bool deleteIt);
	void _Change();
	BAlignment _Place() const;
	BRect _LabelFrame() const;
	void _GetLabelSize(float* _width, float* _height) const;
	float _Thickness() const;
	void _PlaceLabelView();
	void _DrawLine(BRect line);

	std::string fLabel; // empty: none
	BView* fLabelView; // child; it may have been taken out
	bool fLabelViewChanged; // since the archive was read
	// As they were read, also when they are no values of their types.
	int32 fOrientation;
	int32 fHorizontal;
	int32 fVertical;
	int32 fBorder;
};
