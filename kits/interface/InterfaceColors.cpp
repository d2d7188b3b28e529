#include <InterfaceDefs.h>

#include <algorithm>
#include <atomic>
#include <math.h>

namespace {

struct DefaultColor {
	color_which which;
	uint8 red, green, blue;
};

constexpr DefaultColor kDefaults[] = {
	{ B_PANEL_BACKGROUND_COLOR, 216, 216, 216 },
	{ B_PANEL_TEXT_COLOR, 0, 0, 0 },
	{ B_DOCUMENT_BACKGROUND_COLOR, 255, 255, 255 },
	{ B_DOCUMENT_TEXT_COLOR, 0, 0, 0 },
	{ B_CONTROL_BACKGROUND_COLOR, 222, 222, 222 },
	{ B_CONTROL_TEXT_COLOR, 0, 0, 0 },
	{ B_CONTROL_BORDER_COLOR, 172, 172, 172 },
	{ B_CONTROL_HIGHLIGHT_COLOR, 102, 152, 203 },
	{ B_CONTROL_MARK_COLOR, 27, 82, 140 },
	{ B_NAVIGATION_BASE_COLOR, 0, 0, 229 },
	{ B_NAVIGATION_PULSE_COLOR, 0, 0, 0 },
	{ B_SHINE_COLOR, 255, 255, 255 },
	{ B_SHADOW_COLOR, 0, 0, 0 },
	{ B_LINK_TEXT_COLOR, 51, 102, 187 },
	{ B_LINK_HOVER_COLOR, 102, 152, 203 },
	{ B_LINK_VISITED_COLOR, 145, 112, 155 },
	{ B_LINK_ACTIVE_COLOR, 121, 142, 203 },
	{ B_MENU_BACKGROUND_COLOR, 216, 216, 216 },
	{ B_MENU_SELECTED_BACKGROUND_COLOR, 153, 153, 153 },
	{ B_MENU_ITEM_TEXT_COLOR, 0, 0, 0 },
	{ B_MENU_SELECTED_ITEM_TEXT_COLOR, 0, 0, 0 },
	{ B_MENU_SELECTED_BORDER_COLOR, 0, 0, 0 },
	{ B_LIST_BACKGROUND_COLOR, 255, 255, 255 },
	{ B_LIST_SELECTED_BACKGROUND_COLOR, 190, 190, 190 },
	{ B_LIST_ITEM_TEXT_COLOR, 0, 0, 0 },
	{ B_LIST_SELECTED_ITEM_TEXT_COLOR, 0, 0, 0 },
	{ B_SCROLL_BAR_THUMB_COLOR, 216, 216, 216 },
	{ B_TOOL_TIP_BACKGROUND_COLOR, 255, 255, 216 },
	{ B_TOOL_TIP_TEXT_COLOR, 0, 0, 0 },
	{ B_STATUS_BAR_COLOR, 50, 150, 255 },
	{ B_SUCCESS_COLOR, 46, 204, 64 },
	{ B_FAILURE_COLOR, 255, 65, 54 },
	{ B_WINDOW_TAB_COLOR, 255, 203, 0 },
	{ B_WINDOW_TEXT_COLOR, 0, 0, 0 },
	{ B_WINDOW_INACTIVE_TAB_COLOR, 232, 232, 232 },
	{ B_WINDOW_INACTIVE_TEXT_COLOR, 80, 80, 80 },
	{ B_WINDOW_BORDER_COLOR, 224, 224, 224 },
	{ B_WINDOW_INACTIVE_BORDER_COLOR, 232, 232, 232 },
	{ B_DESKTOP_COLOR, 51, 102, 152 },
};

constexpr int32 kColorCount = B_FAILURE_COLOR + 1;


// Each colour is one word, so that readers need no lock.
class ColorTable {
public:
	ColorTable()
	{
		for (std::atomic<uint32>& color : fColors)
			color = _Pack(make_color(0, 0, 0));
		for (const DefaultColor& color : kDefaults)
			Set(color.which, make_color(color.red, color.green, color.blue));
	}

	rgb_color Get(int32 which) const
	{
		const uint32 color = fColors[_IsValid(which) ? which : B_NO_COLOR];
		return make_color(color >> 24, color >> 16, color >> 8, color);
	}

	void Set(int32 which, rgb_color color)
	{
		if (_IsValid(which))
			fColors[which] = _Pack(color);
	}

private:
	static bool _IsValid(int32 which) { return which > B_NO_COLOR && which < kColorCount; }
	static uint32 _Pack(rgb_color color)
	{
		return (uint32)color.red << 24 | (uint32)color.green << 16 | (uint32)color.blue << 8
			| color.alpha;
	}

	std::atomic<uint32> fColors[kColorCount];
};


ColorTable&
Colors()
{
	static ColorTable sColors;
	return sColors;
}

} // namespace


rgb_color
ui_color(color_which which)
{
	return Colors().Get(which);
}


void
set_ui_color(const color_which& which, const rgb_color& color)
{
	Colors().Set(which, color);
}


rgb_color
tint_color(rgb_color color, float tint)
{
	auto tinted = [tint](uint8 component) {
		const float result = tint <= 1 ? 255 - (255 - component) * tint : component * (2 - tint);
		return (uint8)std::clamp(lroundf(result), 0L, 255L);
	};
	return make_color(tinted(color.red), tinted(color.green), tinted(color.blue), color.alpha);
}
