// Archives of controls whose fields hold anything: they are revived, shown and used, and what was
// not changed comes out as it went in.

#include <cmath>
#include <cstdint>
#include <random>
#include <string>
#include <vector>

#include <ChannelSlider.h>
#include <OptionPopUp.h>

#include "ControlFixture.h"
#include "support/Dump.h"

namespace {

constexpr int kArchives = 150; // of each class

const char* const kChannelFields[] = { "be:_m_channel_count", "be:_m_value_channel",
	"be:_m_min_label", "be:_m_max_label", "be:_m_channel_min", "be:_m_channel_max",
	"be:_m_channel_val", "_mod_msg", "_orient", "_msg", "_label", "_val", "_disable", "_frame" };
const char* const kOptionFields[] = { "_msg", "_label", "_val", "_disable", "_views", "_frame" };

constexpr int32 kNumbers[] = { 0, 1, 2, 3, 31, 32, 33, 1000, -1, -100, INT32_MAX, INT32_MIN };
constexpr float kReals[] = { 0, 1, -1, 0.5f, 3, 300, -1e9f, 1e30f, INFINITY };


class Damager {
public:
	explicit Damager(unsigned seed) : fRandom(seed) {}

	template<size_t Size> void Damage(BMessage* archive, const char* const (&names)[Size])
	{
		for (int32 changes = 1 + _Number(4); changes > 0; changes--) {
			const char* name = names[_Number(Size)];
			archive->RemoveName(name);
			const int32 kind = _Number(7);
			const int32 entries = _Number(6) == 0 ? 200 : 1 + _Number(5);
			for (int32 i = 0; i < entries && kind != 0; i++)
				_Add(archive, name, kind);
		}
	}

private:
	int32 _Number(size_t limit) { return static_cast<int32>(fRandom() % limit); }

	float _Real() { return kReals[_Number(std::size(kReals))]; }

	void _Add(BMessage* archive, const char* name, int32 kind)
	{
		const int32 number = kNumbers[_Number(std::size(kNumbers))];
		const BMessage nested(static_cast<uint32>(number));
		switch (kind) {
			case 1:
			case 2:
				archive->AddInt32(name, number);
				break;
			case 3:
				archive->AddString(
					name, std::string(static_cast<size_t>(_Number(70)), 'x').c_str());
				break;
			case 4:
				archive->AddMessage(name, &nested);
				break;
			case 5:
				archive->AddBool(name, (number & 1) != 0);
				break;
			default:
				archive->AddRect(name, BRect(_Real(), _Real(), _Real(), _Real()));
				break;
		}
	}

	std::mt19937 fRandom;
};


// As a child of a shown view, by mouse and keys; the window is locked, as it is for hooks.
void
Use(BView* view)
{
	const BRect bounds = view->Bounds();
	for (const char* key : { "\x1c", "\x1d", "\x1e", "\x1f", "\x01", "\x04" }) {
		view->KeyDown(key, 1);
		view->KeyUp(key, 1);
	}
	for (const BPoint where : { BPoint(5, 5), BPoint(60, 20), bounds.RightBottom() }) {
		view->MouseDown(where);
		view->MouseMoved(where + BPoint(20, -20), B_INSIDE_VIEW, nullptr);
		view->MouseUp(where);
	}
	float width;
	float height;
	view->GetPreferredSize(&width, &height);
	view->ResizeToPreferred();
}


template<class Control, size_t Size>
void
Try(const BMessage& sound, const char* const (&names)[Size])
{
	ControlFixture fixture;
	for (unsigned seed = 0; seed < kArchives; seed++) {
		SCOPED_TRACE("seed " + std::to_string(seed));
		BMessage archive(sound);
		Damager(seed).Damage(&archive, names);
		Control* control = Revive<Control>(archive).release();
		ASSERT_NE(nullptr, control);
		fixture.Add(control);
		fixture.Locked([&] {
			EXPECT_EQ("", test::first_difference(archive, ArchiveOf(*control)));
			Use(control);
		});
		// Whatever was made of it is read and written again.
		fixture.Locked([&] {
			const BMessage used = ArchiveOf(*control);
			const std::unique_ptr<Control> again = Revive<Control>(used);
			EXPECT_EQ("", test::first_difference(used, ArchiveOf(*again)));
			control->RemoveSelf();
		});
		delete control;
	}
}

} // namespace


TEST(RandomFields, OfChannelSlidersAreKept)
{
	BMessage archive;
	{
		BApplication app("application/x-vnd.Archway-test");
		BChannelSlider slider(
			BRect(10, 10, 209, 90), "s", "Label", new BMessage('invk'), B_VERTICAL, 3);
		slider.SetLimitLabels("low", "high");
		slider.SetModificationMessage(new BMessage('modi'));
		slider.SetAllValue(30);
		archive = ArchiveOf(slider);
	}
	Try<BChannelSlider>(archive, kChannelFields);
}


TEST(RandomFields, OfOptionPopUpsAreKept)
{
	BMessage archive;
	{
		BApplication app("application/x-vnd.Archway-test");
		BOptionPopUp popUp(BRect(10, 10, 209, 40), "o", "Label", new BMessage('invk'));
		popUp.AddOption("One", 1);
		popUp.AddOption("Two", 2);
		archive = ArchiveOf(popUp);
	}
	Try<BOptionPopUp>(archive, kOptionFields);
}


TEST(RandomFields, FramesWithoutNumbersAreUsedLikeOthers)
{
	ControlFixture fixture;
	BChannelSlider slider(BRect(0, 0, 99, 40), "s", "Label", NULL, 3);
	BOptionPopUp popUp(BRect(0, 0, 99, 40), "o", "Label", NULL);
	popUp.AddOption("One", 1);
	for (const BView* view : { static_cast<BView*>(&slider), static_cast<BView*>(&popUp) }) {
		for (const BRect frame : { BRect(NAN, NAN, NAN, NAN), BRect(0, 0, NAN, INFINITY),
				 BRect(-INFINITY, -INFINITY, INFINITY, INFINITY) }) {
			BMessage archive = ArchiveOf(*view);
			archive.ReplaceRect("_frame", frame);
			BView* revived = fixture.Add(Revive<BView>(archive).release());
			fixture.Locked([&] {
				Use(revived);
				EXPECT_EQ(B_OK, revived->Archive(&archive));
				revived->RemoveSelf();
			});
			delete revived;
		}
	}
}
