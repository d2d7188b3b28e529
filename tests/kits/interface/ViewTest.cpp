#include <gtest/gtest.h>

#include <Application.h>
#include <View.h>
#include <Window.h>

#include "support/Driver.h"

namespace {

class BoxView : public BView {
public:
	using BView::BView;

	void Draw(BRect updateRect) override
	{
		fDrawn++;
		fUpdate = updateRect;
		SetHighColor(255, 0, 0);
		FillRect(BRect(10, 10, 19, 19));
		SetHighColor(0, 0, 0);
		StrokeRect(Bounds());
		DrawString("Hello, window", BPoint(30, 30));
	}

	int fDrawn = 0;
	BRect fUpdate;
};


struct Fixture {
	Fixture() : app("application/x-vnd.Archway-test") {}

	BWindow* Open(BRect frame = BRect(100, 100, 299, 199))
	{
		return new BWindow(frame, "Test", B_TITLED_WINDOW, 0);
	}

	BApplication app;
	Driver driver;
};


void
close(BWindow* window)
{
	window->Lock();
	window->Quit();
}

} // namespace


TEST(View, IsDrawnInAShownWindow)
{
	Fixture fixture;
	BWindow* window = fixture.Open();
	auto view = new BoxView(window->Bounds(), "box", B_FOLLOW_ALL, B_WILL_DRAW);
	view->SetViewColor(200, 220, 240);
	window->AddChild(view);
	window->Show();
	Driver::WaitUntilIdle();

	EXPECT_EQ(1, view->fDrawn);
	EXPECT_EQ(BRect(0, 0, 199, 99), view->fUpdate);
	EXPECT_EQ((rgb_color { 255, 0, 0, 255 }), fixture.driver.PixelAt(BPoint(110, 110)));
	EXPECT_EQ((rgb_color { 200, 220, 240, 255 }), fixture.driver.PixelAt(BPoint(125, 110)));
	EXPECT_EQ((rgb_color { 0, 0, 0, 255 }), fixture.driver.PixelAt(BPoint(100, 100)));
	if (const char* path = getenv("PICTURE"))
		fixture.driver.Screenshot(path);
	close(window);
}
