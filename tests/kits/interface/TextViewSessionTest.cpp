// Random editing sessions of BTextView beside a plain string.
#include <TextView.h>

#include <gtest/gtest.h>

#include <random>

#include <Application.h>

namespace {

// Says what it is asked to do; a plain string, and its earlier states.
struct Model {
	std::string text;
	std::vector<std::string> before;
	std::vector<std::string> after;

	void Edit(size_t from, size_t to, const std::string& inserted)
	{
		if (from == to && inserted.empty())
			return;
		before.push_back(text);
		after.clear();
		text.replace(from, to - from, inserted);
	}

	void Undo()
	{
		after.push_back(text);
		text = before.back();
		before.pop_back();
	}

	void Redo()
	{
		before.push_back(text);
		text = after.back();
		after.pop_back();
	}
};

const char* const kPieces[] = { "a", "word ", "\n", "two words", "\t", "\xc3\xa4\xc3\xb6",
	"\xd0\x9f\xd1\x80\xd0\xb8\xd0\xb2\xd0\xb5\xd1\x82 ", "\xe4\xb8\xad\xe6\x96\x87",
	"\xf0\x9f\x98\x80", "line one\nline two\n", "\xd8\xb3\xd9\x84\xd8\xa7\xd9\x85",
	"a-hyphenated-and-quite-long-word", "   ", "\n\n\n", "e\xcc\x81" };


BTextView*
make_view(bool wrap)
{
	BTextView* view = new BTextView(
		BRect(0, 0, 150, 200), "text", BRect(2, 2, 120, 200), B_FOLLOW_NONE, B_WILL_DRAW);
	view->SetWordWrap(wrap);
	view->SetStylable(true);
	return view;
}


// A place between two characters.
size_t
random_place(const std::string& text, std::mt19937& random)
{
	size_t place = random() % (text.size() + 1);
	while (place < text.size() && (text[place] & 0xc0) == 0x80)
		place--;
	return place;
}


// What incremental layout found must be what a layout from scratch finds.
void
expect_fresh_layout(BTextView& view, bool wrap)
{
	if (view.TextLength() == 0)
		return; // an empty text remembers a look that no run array says
	const std::unique_ptr<BTextView> fresh(make_view(wrap));
	text_run_array* runs = view.RunArray(0, view.TextLength());
	fresh->SetText(view.Text(), runs);
	BTextView::FreeRunArray(runs);
	ASSERT_EQ(fresh->CountLines(), view.CountLines());
	for (int32 i = 0; i < view.CountLines(); i++) {
		ASSERT_EQ(fresh->OffsetAt(i), view.OffsetAt(i)) << "line " << i;
		ASSERT_EQ(fresh->LineHeight(i), view.LineHeight(i)) << "line " << i;
		ASSERT_EQ(fresh->PointAt(fresh->OffsetAt(i)), view.PointAt(view.OffsetAt(i)));
	}
	ASSERT_EQ(fresh->TextRect(), view.TextRect());
}


void
run_session(uint32 seed, bool wrap)
{
	std::mt19937 random(seed);
	const std::unique_ptr<BTextView> view(make_view(wrap));
	Model model;
	for (int step = 0; step < 300; step++) {
		const int action = static_cast<int>(random() % 10);
		if (action < 5) {
			const size_t at = random_place(model.text, random);
			const std::string piece = kPieces[random() % std::size(kPieces)];
			view->Insert(static_cast<int32>(at), piece.data(), static_cast<int32>(piece.size()));
			model.Edit(at, at, piece);
		} else if (action < 7) {
			size_t from = random_place(model.text, random);
			size_t to = random_place(model.text, random);
			if (from > to)
				std::swap(from, to);
			to = std::min(to, from + 40);
			while (to < model.text.size() && to > from && (model.text[to] & 0xc0) == 0x80)
				to--;
			view->Delete(static_cast<int32>(from), static_cast<int32>(to));
			model.Edit(from, to, "");
		} else if (action == 7) {
			if (!model.before.empty()) {
				view->Undo(NULL);
				model.Undo();
			}
		} else if (action == 8) {
			if (!model.after.empty()) {
				view->Redo(NULL);
				model.Redo();
			}
		} else {
			BFont font(be_plain_font);
			font.SetSize(static_cast<float>(8 + random() % 12));
			size_t from = random_place(model.text, random);
			size_t to = random_place(model.text, random);
			if (from > to)
				std::swap(from, to);
			view->SetFontAndColor(
				static_cast<int32>(from), static_cast<int32>(to), &font, B_FONT_SIZE);
		}
		ASSERT_EQ(model.text, view->Text()) << "seed " << seed << ", step " << step;
		ASSERT_EQ(static_cast<int32>(model.text.size()), view->TextLength());
		if (step % 10 == 0) {
			expect_fresh_layout(*view, wrap);
			if (testing::Test::HasFatalFailure()) {
				ADD_FAILURE() << "seed " << seed << ", step " << step;
				return;
			}
		}
	}
	while (!model.before.empty()) {
		view->Undo(NULL);
		model.Undo();
		ASSERT_EQ(model.text, view->Text());
	}
	while (!model.after.empty()) {
		view->Redo(NULL);
		model.Redo();
		ASSERT_EQ(model.text, view->Text());
	}
}

} // namespace


TEST(TextViewSession, WithoutWrapItAgreesWithAString)
{
	BApplication app("application/x-vnd.Archway-test");
	for (uint32 seed = 1; seed <= 12; seed++)
		run_session(seed, false);
}


TEST(TextViewSession, WithWrapItAgreesWithAString)
{
	BApplication app("application/x-vnd.Archway-test");
	for (uint32 seed = 101; seed <= 112; seed++)
		run_session(seed, true);
}


TEST(TextViewSession, BytesThatAreNotUtf8AreKept)
{
	BApplication app("application/x-vnd.Archway-test");
	const std::unique_ptr<BTextView> view(make_view(true));
	std::mt19937 random(7);
	std::string text;
	for (int i = 0; i < 2000; i++)
		text += static_cast<char>(1 + random() % 255);
	view->SetText(text.data(), static_cast<int32>(text.size()));
	EXPECT_EQ(text, view->Text());
	for (int32 i = 0; i < view->CountLines(); i++)
		view->LineWidth(i);
	for (int i = 0; i < 200; i++) {
		const int32 at = static_cast<int32>(random() % text.size());
		const int32 place = view->OffsetAt(view->PointAt(at));
		EXPECT_GE(place, 0);
		EXPECT_LE(place, view->TextLength());
	}
}
