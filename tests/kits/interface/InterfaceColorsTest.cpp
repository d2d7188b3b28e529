#include <InterfaceDefs.h>

#include <gtest/gtest.h>


TEST(TintColor, GivesTheClassicGrays)
{
	const rgb_color panel = ui_color(B_PANEL_BACKGROUND_COLOR);
	ASSERT_EQ(make_color(216, 216, 216), panel);
	const struct {
		float tint;
		int expected;
	} kTints[] = { { B_LIGHTEN_MAX_TINT, 255 }, { B_LIGHTEN_2_TINT, 240 },
		{ B_LIGHTEN_1_TINT, 232 }, { B_NO_TINT, 216 }, { B_DARKEN_1_TINT, 184 },
		{ B_DARKEN_2_TINT, 152 }, { B_DARKEN_3_TINT, 128 }, { B_DARKEN_4_TINT, 96 },
		{ B_DARKEN_MAX_TINT, 0 } };
	for (const auto& tint : kTints)
		EXPECT_EQ(tint.expected, tint_color(panel, tint.tint).red) << tint.tint;
}


TEST(TintColor, KeepsAlpha)
{
	EXPECT_EQ(17, tint_color(make_color(1, 2, 3, 17), B_DARKEN_2_TINT).alpha);
}


TEST(UiColor, CanBeChanged)
{
	set_ui_color(B_DESKTOP_COLOR, make_color(1, 2, 3));
	EXPECT_EQ(make_color(1, 2, 3), ui_color(B_DESKTOP_COLOR));
	EXPECT_EQ(make_color(0, 0, 0), ui_color((color_which)9999));
	EXPECT_EQ(ui_color(B_NAVIGATION_BASE_COLOR), ui_color(B_KEYBOARD_NAVIGATION_COLOR));
}
