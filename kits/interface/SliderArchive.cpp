// BSlider: the fields of its archives.
#include <Slider.h>

#include <Message.h>

#include "interface/private/ControlArchive.h"
#include "interface/private/SliderDefaults.h"
#include "interface/private/ViewArchive.h"


BArchivable*
BSlider::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BSlider") ? new BSlider(archive) : NULL;
}


namespace {

// R5 writes the thumb's style as an int32, later systems as an int16.
thumb_style
ReadStyle(const BMessage* archive)
{
	int16 shortStyle;
	if (archive->FindInt16("_sstyle", &shortStyle) == B_OK)
		return static_cast<thumb_style>(shortStyle);
	int32 style;
	if (archive->FindInt32("_sstyle", &style) == B_OK)
		return static_cast<thumb_style>(style);
	return B_BLOCK_THUMB;
}

} // namespace


void
BSlider::_ReadArchive(BMessage* archive)
{
	fModificationMessage = BPrivate::read_message(archive, "_mod_msg");

	int32 number;
	if (archive->FindInt32("_sdelay", &number) == B_OK)
		fSnoozeAmount = number;
	if (archive->FindInt32("_bcolor", &number) == B_OK)
		fBarColor = BPrivate::color_from_bytes(number);
	if (archive->FindInt32("_fcolor", &number) == B_OK) {
		fFillColor = BPrivate::color_from_bytes(number);
		fUseFillColor = true;
	}

	const char* label;
	if (archive->FindString("_minlbl", &label) == B_OK) {
		fMinLabel = label;
		fHasMinLabel = true;
	}
	if (archive->FindString("_maxlbl", &label) == B_OK) {
		fMaxLabel = label;
		fHasMaxLabel = true;
	}

	if (archive->FindInt32("_min", &number) == B_OK)
		fMinValue = number;
	if (archive->FindInt32("_max", &number) == B_OK)
		fMaxValue = number;
	if (archive->FindInt32("_incrementvalue", &number) == B_OK)
		fKeyIncrement = number;
	if (archive->FindInt32("_hashcount", &number) == B_OK)
		fHashMarkCount = number;
	int16 location;
	if (archive->FindInt16("_hashloc", &location) == B_OK)
		fHashMarks = static_cast<hash_mark_location>(location);
	fStyle = ReadStyle(archive);
	if (archive->FindInt32("_orient", &number) == B_OK)
		fOrientation = static_cast<orientation>(number);
	float thickness;
	if (archive->FindFloat("_bthickness", &thickness) == B_OK)
		fBarThickness = thickness;
}


status_t
BSlider::Archive(BMessage* archive, bool deep) const
{
	const status_t status = BControl::Archive(archive, deep);
	if (status != B_OK)
		return status;
	BPrivate::ArchiveWriter writer(archive);
	_WriteArchive(writer, archive);
	return writer.Status();
}


void
BSlider::_WriteArchive(BPrivate::ArchiveWriter& writer, BMessage* archive) const
{
	BPrivate::write_message(writer, archive, "_mod_msg", fModificationMessage.get());
	writer.Int32("_sdelay", fSnoozeAmount, BPrivate::kDefaultSnooze);
	writer.Int32("_bcolor", BPrivate::color_to_bytes(fBarColor),
		BPrivate::color_to_bytes(BPrivate::default_bar_color()));

	// The presence of the field says whether the colour is used.
	const int32 fill = BPrivate::color_to_bytes(fFillColor);
	int32 read;
	const bool used = writer.Source().FindInt32("_fcolor", &read) == B_OK;
	if (!writer.Keep("_fcolor", used == fUseFillColor && (!used || read == fill))
		&& fUseFillColor) {
		archive->AddInt32("_fcolor", fill);
	}

	writer.String("_minlbl", MinLimitLabel(), NULL);
	writer.String("_maxlbl", MaxLimitLabel(), NULL);
	writer.Int32("_min", fMinValue, 0);
	writer.Int32("_max", fMaxValue, 100);
	writer.Int32("_incrementvalue", fKeyIncrement, 1);
	writer.Int32("_hashcount", fHashMarkCount, 11);
	writer.Int16("_hashloc", static_cast<int16>(fHashMarks), B_HASH_MARKS_NONE);
	if (!writer.Keep("_sstyle", ReadStyle(&writer.Source()) == fStyle))
		archive->AddInt16("_sstyle", static_cast<int16>(fStyle));
	writer.Int32("_orient", fOrientation, B_HORIZONTAL);
	writer.Float("_bthickness", fBarThickness, BPrivate::kDefaultThickness);
}
