// The global functions of mouse and keyboard, and the beep.
#include <InterfaceDefs.h>

#include <atomic>
#include <cstring>

#include <Beep.h>
#include <OS.h>
#include <View.h>

#include "server/Desktop.h"

using BPrivate::Desktop;

namespace {

// The desktop decides these; what a program sets is what it reads back.
struct InputSettings {
	std::atomic<int32> mouseType { 3 };
	std::atomic<uint32> left { B_PRIMARY_MOUSE_BUTTON };
	std::atomic<uint32> right { B_SECONDARY_MOUSE_BUTTON };
	std::atomic<uint32> middle { B_TERTIARY_MOUSE_BUTTON };
	std::atomic<int32> mouseSpeed { 65536 };
	std::atomic<int32> mouseAcceleration { 65536 };
	std::atomic<int32> repeatRate { 250 };
	std::atomic<bigtime_t> repeatDelay { 200000 };
	std::atomic<bool> focusFollowsMouse { false };
};

InputSettings sSettings;


template<typename Value>
status_t
get(const std::atomic<Value>& setting, Value* _value)
{
	if (_value == nullptr)
		return B_BAD_VALUE;
	*_value = setting;
	return B_OK;
}

} // namespace


status_t
get_scroll_bar_info(scroll_bar_info* info)
{
	if (info == nullptr)
		return B_BAD_VALUE;
	*info = { true, false, 2, 15 };
	return B_OK;
}


status_t
set_scroll_bar_info(scroll_bar_info* info)
{
	return info != nullptr ? B_UNSUPPORTED : B_BAD_VALUE;
}


// #pragma mark - mouse


status_t
get_mouse_type(int32* type)
{
	return get(sSettings.mouseType, type);
}


status_t
set_mouse_type(int32 type)
{
	if (type < 1 || type > 3)
		return B_BAD_VALUE;
	sSettings.mouseType = type;
	return B_OK;
}


status_t
get_mouse_map(mouse_map* map)
{
	if (map == nullptr)
		return B_BAD_VALUE;
	*map = { sSettings.left, sSettings.right, sSettings.middle };
	return B_OK;
}


status_t
set_mouse_map(mouse_map* map)
{
	if (map == nullptr)
		return B_BAD_VALUE;
	sSettings.left = map->left;
	sSettings.right = map->right;
	sSettings.middle = map->middle;
	return B_OK;
}


status_t
get_click_speed(bigtime_t* speed)
{
	if (speed == nullptr)
		return B_BAD_VALUE;
	const Desktop* desktop = Desktop::Get();
	*speed = desktop != nullptr ? desktop->DoubleClickTime() : 500000;
	return B_OK;
}


status_t
set_click_speed(bigtime_t speed)
{
	if (speed <= 0)
		return B_BAD_VALUE;
	Desktop* desktop = Desktop::Get();
	if (desktop == nullptr)
		return B_ERROR;
	desktop->SetDoubleClickTime(speed);
	return B_OK;
}


status_t
get_mouse_speed(int32* speed)
{
	return get(sSettings.mouseSpeed, speed);
}


status_t
set_mouse_speed(int32 speed)
{
	sSettings.mouseSpeed = speed;
	return B_OK;
}


status_t
get_mouse_acceleration(int32* speed)
{
	return get(sSettings.mouseAcceleration, speed);
}


status_t
set_mouse_acceleration(int32 speed)
{
	sSettings.mouseAcceleration = speed;
	return B_OK;
}


void
set_focus_follows_mouse(bool follow)
{
	sSettings.focusFollowsMouse = follow;
}


bool
focus_follows_mouse()
{
	return sSettings.focusFollowsMouse;
}


// #pragma mark - keyboard


status_t
get_key_repeat_rate(int32* rate)
{
	return get(sSettings.repeatRate, rate);
}


status_t
set_key_repeat_rate(int32 rate)
{
	sSettings.repeatRate = rate;
	return B_OK;
}


status_t
get_key_repeat_delay(bigtime_t* delay)
{
	return get(sSettings.repeatDelay, delay);
}


status_t
set_key_repeat_delay(bigtime_t delay)
{
	sSettings.repeatDelay = delay;
	return B_OK;
}


uint32
modifiers()
{
	const Desktop* desktop = Desktop::Get();
	return desktop != nullptr ? desktop->Modifiers() : 0;
}


status_t
get_key_info(key_info* info)
{
	if (info == nullptr)
		return B_BAD_VALUE;
	std::memset(info, 0, sizeof(*info));
	const Desktop* desktop = Desktop::Get();
	if (desktop == nullptr)
		return B_ERROR;
	info->modifiers = desktop->Modifiers();
	desktop->GetKeyStates(info->key_states);
	return B_OK;
}


// The desktop's key map is not to be had in this form.
void
get_key_map(key_map** map, char** keyBuffer)
{
	if (map != nullptr)
		*map = nullptr;
	if (keyBuffer != nullptr)
		*keyBuffer = nullptr;
}


status_t
get_keyboard_id(uint16* id)
{
	if (id == nullptr)
		return B_BAD_VALUE;
	*id = 0xab83;
	return B_OK;
}


void
set_modifier_key(uint32 modifier, uint32 key)
{
}


void
set_keyboard_locks(uint32 modifiers)
{
}


bigtime_t
idle_time()
{
	static std::atomic<uint32> sSerial { 0 };
	static std::atomic<bigtime_t> sSince { system_time() };
	const Desktop* desktop = Desktop::Get();
	if (desktop == nullptr)
		return 0;
	const uint32 serial = desktop->PointerSerial();
	if (sSerial.exchange(serial) != serial)
		sSince = system_time();
	return system_time() - sSince;
}


// #pragma mark - workspaces


int32
count_workspaces()
{
	return 1;
}


void
set_workspace_count(int32 count)
{
}


int32
current_workspace()
{
	return 0;
}


void
activate_workspace(int32 workspace)
{
}


// #pragma mark - sound


status_t
beep()
{
	Desktop* desktop = Desktop::Get();
	if (desktop == nullptr)
		return B_ERROR;
	desktop->Beep();
	return B_OK;
}


status_t
system_beep(const char* eventName)
{
	return beep();
}


status_t
add_system_beep_event(const char* eventName, uint32 flags)
{
	return B_OK;
}
