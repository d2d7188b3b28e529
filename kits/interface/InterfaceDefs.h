// What several classes of this kit share: keys, modifiers, orientations, colours of the interface.
#pragma once

#include <GraphicsDefs.h>
#include <OS.h>
#include <SupportDefs.h>

class BBitmap;
class BRect;

// Keys as characters.
enum {
	B_BACKSPACE = 0x08,
	B_RETURN = 0x0a,
	B_ENTER = 0x0a,
	B_SPACE = 0x20,
	B_TAB = 0x09,
	B_ESCAPE = 0x1b,
	B_SUBSTITUTE = 0x1a,

	B_LEFT_ARROW = 0x1c,
	B_RIGHT_ARROW = 0x1d,
	B_UP_ARROW = 0x1e,
	B_DOWN_ARROW = 0x1f,

	B_INSERT = 0x05,
	B_DELETE = 0x7f,
	B_HOME = 0x01,
	B_END = 0x04,
	B_PAGE_UP = 0x0b,
	B_PAGE_DOWN = 0x0c,

	B_FUNCTION_KEY = 0x10
};

// Key codes that go with B_FUNCTION_KEY.
enum {
	B_F1_KEY = 0x02,
	B_F2_KEY,
	B_F3_KEY,
	B_F4_KEY,
	B_F5_KEY,
	B_F6_KEY,
	B_F7_KEY,
	B_F8_KEY,
	B_F9_KEY,
	B_F10_KEY,
	B_F11_KEY,
	B_F12_KEY,
	B_PRINT_KEY = 0x0e,
	B_SCROLL_KEY = 0x0f,
	B_PAUSE_KEY = 0x10,
	B_NUM_LOCK_KEY = 0x22,
	B_CAPS_LOCK_KEY = 0x3b,
	B_SPACE_BAR_KEY = 0x5e,
	B_NUMPAD_EQUAL_KEY = 0x6a
};

enum {
	B_SHIFT_KEY = 0x00000001,
	B_COMMAND_KEY = 0x00000002,
	B_CONTROL_KEY = 0x00000004,
	B_CAPS_LOCK = 0x00000008,
	B_SCROLL_LOCK = 0x00000010,
	B_NUM_LOCK = 0x00000020,
	B_OPTION_KEY = 0x00000040,
	B_MENU_KEY = 0x00000080,
	B_LEFT_SHIFT_KEY = 0x00000100,
	B_RIGHT_SHIFT_KEY = 0x00000200,
	B_LEFT_COMMAND_KEY = 0x00000400,
	B_RIGHT_COMMAND_KEY = 0x00000800,
	B_LEFT_CONTROL_KEY = 0x00001000,
	B_RIGHT_CONTROL_KEY = 0x00002000,
	B_LEFT_OPTION_KEY = 0x00004000,
	B_RIGHT_OPTION_KEY = 0x00008000,
	B_NO_COMMAND_KEY = 0x00010000
};

enum {
	B_CONTROL_TABLE = 0x00000001,
	B_OPTION_CAPS_SHIFT_TABLE = 0x00000002,
	B_OPTION_CAPS_TABLE = 0x00000004,
	B_OPTION_SHIFT_TABLE = 0x00000008,
	B_OPTION_TABLE = 0x00000010,
	B_CAPS_SHIFT_TABLE = 0x00000020,
	B_CAPS_TABLE = 0x00000040,
	B_SHIFT_TABLE = 0x00000080,
	B_NORMAL_TABLE = 0x00000100
};

enum mode_mouse { B_NORMAL_MOUSE = 0, B_CLICK_TO_FOCUS_MOUSE = -1, B_FOCUS_FOLLOWS_MOUSE = 1 };
enum mode_focus_follows_mouse {
	B_NORMAL_FOCUS_FOLLOWS_MOUSE = 0,
	B_WARP_FOCUS_FOLLOWS_MOUSE = 1,
	B_INSTANT_WARP_FOCUS_FOLLOWS_MOUSE = 2
};

// Archives hold these as plain numbers, so each type has room for any of them.
enum border_style : uint32 { B_PLAIN_BORDER, B_FANCY_BORDER, B_NO_BORDER };

enum orientation : uint32 { B_HORIZONTAL, B_VERTICAL };

enum button_width : uint32 { B_WIDTH_AS_USUAL, B_WIDTH_FROM_WIDEST, B_WIDTH_FROM_LABEL };

enum alignment : int32 {
	B_ALIGN_LEFT = 0,
	B_ALIGN_RIGHT,
	B_ALIGN_CENTER,
	B_ALIGN_HORIZONTAL_CENTER = B_ALIGN_CENTER,
	B_ALIGN_HORIZONTAL_UNSET = -1,
	B_ALIGN_USE_FULL_WIDTH = -2
};

enum vertical_alignment : int32 {
	B_ALIGN_TOP = 0x10,
	B_ALIGN_MIDDLE = 0x20,
	B_ALIGN_BOTTOM = 0x30,
	B_ALIGN_VERTICAL_CENTER = B_ALIGN_MIDDLE,
	B_ALIGN_VERTICAL_UNSET = -1,
	B_ALIGN_NO_VERTICAL = -1,
	B_ALIGN_USE_FULL_HEIGHT = -2
};

#define B_UTF8_BULLET "\xe2\x80\xa2"
#define B_UTF8_ELLIPSIS "\xe2\x80\xa6"
#define B_UTF8_OPEN_QUOTE "\xe2\x80\x9c"
#define B_UTF8_CLOSE_QUOTE "\xe2\x80\x9d"
#define B_UTF8_COPYRIGHT "\xc2\xa9"
#define B_UTF8_REGISTERED "\xc2\xae"
#define B_UTF8_TRADEMARK "\xe2\x84\xa2"
#define B_UTF8_SMILING_FACE "\xe2\x98\xbb"
#define B_UTF8_HIROSHI "\xe5\xbc\x98"

struct key_info {
	uint32 modifiers;
	uint8 key_states[16]; // bit 7 - (key & 7) of byte key / 8 is set while the key is down
};

struct key_map {
	uint32 version;
	uint32 caps_key;
	uint32 scroll_key;
	uint32 num_key;
	uint32 left_shift_key;
	uint32 right_shift_key;
	uint32 left_command_key;
	uint32 right_command_key;
	uint32 left_control_key;
	uint32 right_control_key;
	uint32 left_option_key;
	uint32 right_option_key;
	uint32 menu_key;
	uint32 lock_settings;
	int32 control_map[128];
	int32 option_caps_shift_map[128];
	int32 option_caps_map[128];
	int32 option_shift_map[128];
	int32 option_map[128];
	int32 caps_shift_map[128];
	int32 caps_map[128];
	int32 shift_map[128];
	int32 normal_map[128];
	int32 acute_dead_key[32];
	int32 grave_dead_key[32];
	int32 circumflex_dead_key[32];
	int32 dieresis_dead_key[32];
	int32 tilde_dead_key[32];
	uint32 acute_tables;
	uint32 grave_tables;
	uint32 circumflex_tables;
	uint32 dieresis_tables;
	uint32 tilde_tables;
};

struct mouse_map {
	uint32 left;
	uint32 right;
	uint32 middle;
};

struct scroll_bar_info {
	bool proportional;
	bool double_arrows;
	int32 knob;
	int32 min_knob_size;
};

status_t get_scroll_bar_info(scroll_bar_info* info);
status_t set_scroll_bar_info(scroll_bar_info* info);

// Times are microseconds.
status_t get_mouse_type(int32* type);
status_t set_mouse_type(int32 type);
status_t get_mouse_map(mouse_map* map);
status_t set_mouse_map(mouse_map* map);
status_t get_click_speed(bigtime_t* speed);
status_t set_click_speed(bigtime_t speed);
status_t get_mouse_speed(int32* speed);
status_t set_mouse_speed(int32 speed);
status_t get_mouse_acceleration(int32* speed);
status_t set_mouse_acceleration(int32 speed);
status_t get_key_repeat_rate(int32* rate);
status_t set_key_repeat_rate(int32 rate);
status_t get_key_repeat_delay(bigtime_t* delay);
status_t set_key_repeat_delay(bigtime_t delay);

// The modifiers held now, not those of an event.
uint32 modifiers();
status_t get_key_info(key_info* info);
void get_key_map(key_map** map, char** keyBuffer);
status_t get_keyboard_id(uint16* id);
void set_modifier_key(uint32 modifier, uint32 key);
void set_keyboard_locks(uint32 modifiers);
bigtime_t idle_time();

int32 count_workspaces();
void set_workspace_count(int32 count);
int32 current_workspace();
void activate_workspace(int32 workspace);
void set_focus_follows_mouse(bool follow);
bool focus_follows_mouse();

enum color_which : int32 {
	B_NO_COLOR = 0,
	B_PANEL_BACKGROUND_COLOR = 1,
	B_PANEL_TEXT_COLOR = 10,
	B_DOCUMENT_BACKGROUND_COLOR = 11,
	B_DOCUMENT_TEXT_COLOR = 12,
	B_CONTROL_BACKGROUND_COLOR = 13,
	B_CONTROL_TEXT_COLOR = 14,
	B_CONTROL_BORDER_COLOR = 15,
	B_CONTROL_HIGHLIGHT_COLOR = 16,
	B_CONTROL_MARK_COLOR = 27,
	B_NAVIGATION_BASE_COLOR = 4,
	B_NAVIGATION_PULSE_COLOR = 17,
	B_SHINE_COLOR = 18,
	B_SHADOW_COLOR = 19,
	B_LINK_TEXT_COLOR = 33,
	B_LINK_HOVER_COLOR = 34,
	B_LINK_VISITED_COLOR = 35,
	B_LINK_ACTIVE_COLOR = 36,
	B_MENU_BACKGROUND_COLOR = 2,
	B_MENU_SELECTED_BACKGROUND_COLOR = 6,
	B_MENU_ITEM_TEXT_COLOR = 7,
	B_MENU_SELECTED_ITEM_TEXT_COLOR = 8,
	B_MENU_SELECTED_BORDER_COLOR = 9,
	B_LIST_BACKGROUND_COLOR = 28,
	B_LIST_SELECTED_BACKGROUND_COLOR = 29,
	B_LIST_ITEM_TEXT_COLOR = 30,
	B_LIST_SELECTED_ITEM_TEXT_COLOR = 31,
	B_SCROLL_BAR_THUMB_COLOR = 32,
	B_TOOL_TIP_BACKGROUND_COLOR = 20,
	B_TOOL_TIP_TEXT_COLOR = 21,
	B_STATUS_BAR_COLOR = 37,
	B_SUCCESS_COLOR = 100,
	B_FAILURE_COLOR = 101,
	B_WINDOW_TAB_COLOR = 3,
	B_WINDOW_TEXT_COLOR = 22,
	B_WINDOW_INACTIVE_TAB_COLOR = 23,
	B_WINDOW_INACTIVE_TEXT_COLOR = 24,
	B_WINDOW_BORDER_COLOR = 25,
	B_WINDOW_INACTIVE_BORDER_COLOR = 26,
	B_DESKTOP_COLOR = 5,

	// The names of R5 for some of them.
	B_KEYBOARD_NAVIGATION_COLOR = B_NAVIGATION_BASE_COLOR,
	B_MENU_SELECTION_BACKGROUND_COLOR = B_MENU_SELECTED_BACKGROUND_COLOR
};

// An unknown colour is black. Any thread.
rgb_color ui_color(color_which which);
void set_ui_color(const color_which& which, const rgb_color& color);

// Below 1 mixes with white (0 is white), above 1 with black (2 is black). Alpha stays.
rgb_color tint_color(rgb_color color, float tint);

const float B_LIGHTEN_MAX_TINT = 0.0f;
const float B_LIGHTEN_2_TINT = 0.385f;
const float B_LIGHTEN_1_TINT = 0.590f;
const float B_NO_TINT = 1.0f;
const float B_DARKEN_1_TINT = 1.147f;
const float B_DARKEN_2_TINT = 1.295f;
const float B_DARKEN_3_TINT = 1.407f;
const float B_DARKEN_4_TINT = 1.555f;
const float B_DARKEN_MAX_TINT = 2.0f;
const float B_DISABLED_LABEL_TINT = B_DARKEN_3_TINT;
const float B_HIGHLIGHT_BACKGROUND_TINT = B_DARKEN_2_TINT;
const float B_DISABLED_MARK_TINT = B_LIGHTEN_2_TINT;
