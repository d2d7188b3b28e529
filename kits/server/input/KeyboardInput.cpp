#include "server/input/KeyboardInput.h"

#include <algorithm>

#include <AppDefs.h>

#include "server/DesktopThread.h"
#include "server/input/WindowPolicy.h"

namespace BPrivate {

namespace {

// What an input method's message is about.
constexpr int32 kMethodStarted = 0, kMethodStopped = 1, kMethodChanged = 2;


size_t
CharacterLength(unsigned char first)
{
	if (first < 0xc0)
		return 1;
	return first < 0xe0 ? 2 : first < 0xf0 ? 3 : 4;
}


void
AddText(BMessage& message, const std::string& text)
{
	for (size_t i = 0; i < std::min<size_t>(text.size(), 3); i++)
		message.AddInt8("byte", static_cast<int8>(text[i]));
	message.AddString("bytes", text.c_str());
}

} // namespace


KeyboardInput::KeyboardInput(DesktopThread& desktop) : fDesktop(desktop)
{
}


void
KeyboardInput::HandleEvent(const BackendEvent& event)
{
	using Type = BackendEvent::Type;

	switch (event.type) {
		case Type::KeyPressed:
		case Type::KeyReleased:
			_Key(event, event.type == Type::KeyPressed);
			break;
		case Type::TextEntered:
			_Text(event);
			break;
		case Type::TextComposed:
			_Compose(event);
			break;
		case Type::ModifiersChanged:
			_SetModifiers(event);
			break;
		default:
			break;
	}
}


// A window that a modal one blocks may be active for the moment that the desktop takes to change.
WindowReference
KeyboardInput::_Target() const
{
	const WindowPolicy& policy = fDesktop.Policy();
	const WindowReference menu = policy.LastMenu();
	if (menu != nullptr && menu->wantsAllPointerEvents)
		return menu;
	if (WindowReference blocker = policy.BlockerOf(policy.Active()))
		return blocker;
	return policy.Active();
}


std::unique_ptr<BMessage>
KeyboardInput::_MakeMessage(uint32 what, const BackendEvent& event) const
{
	const std::array<uint8, 16> states = fDesktop.Input().KeyStates();

	auto message = std::make_unique<BMessage>(what);
	message->AddInt64("when", event.when);
	if (what != B_MODIFIERS_CHANGED)
		message->AddInt32("key", event.key);
	message->AddInt32("modifiers", static_cast<int32>(event.modifiers));
	for (const uint8 state : states)
		message->AddData("states", B_UINT8_TYPE, &state, 1);
	return message;
}


void
KeyboardInput::_Key(const BackendEvent& event, bool down)
{
	fDesktop.Input().SetKey(event.key, down);
	const WindowReference target = _Target();
	if (target == nullptr)
		return;

	if (event.text.empty()) {
		target->Deliver(_MakeMessage(down ? B_UNMAPPED_KEY_DOWN : B_UNMAPPED_KEY_UP, event));
		return;
	}

	auto message = _MakeMessage(down ? B_KEY_DOWN : B_KEY_UP, event);
	AddText(*message, event.text);
	message->AddInt32("raw_char", event.rawCharacter);
	if (down && event.repeat > 0)
		message->AddInt32("be:key_repeat", event.repeat);
	target->Deliver(std::move(message));
}


// Text of an input method comes as keys without a place on the keyboard, one for each character.
void
KeyboardInput::_Text(const BackendEvent& event)
{
	const WindowReference target = _Target();
	if (target == nullptr)
		return;

	for (size_t i = 0; i < event.text.size();) {
		const size_t length = CharacterLength(static_cast<unsigned char>(event.text[i]));
		const std::string character = event.text.substr(i, length);
		i += length;

		auto message = _MakeMessage(B_KEY_DOWN, event);
		AddText(*message, character);
		message->AddInt32("raw_char", length == 1 ? static_cast<unsigned char>(character[0]) : 0);
		target->Deliver(std::move(message));
	}
}


void
KeyboardInput::_Compose(const BackendEvent& event)
{
	const WindowReference target = _Target();
	if (target == nullptr)
		return;

	const auto send = [&](int32 opcode) {
		auto message = std::make_unique<BMessage>(B_INPUT_METHOD_EVENT);
		message->AddInt64("when", event.when);
		message->AddInt32("be:opcode", opcode);
		if (opcode == kMethodChanged)
			message->AddString("be:string", event.text.c_str());
		target->Deliver(std::move(message));
	};
	if (!fComposing && !event.text.empty()) {
		fComposing = true;
		send(kMethodStarted);
	}
	if (!fComposing)
		return;
	send(kMethodChanged);
	if (event.text.empty()) {
		fComposing = false;
		send(kMethodStopped);
	}
}


void
KeyboardInput::_SetModifiers(const BackendEvent& event)
{
	const uint32 before = fDesktop.Input().Modifiers();
	if (before == event.modifiers)
		return;

	fDesktop.Input().SetModifiers(event.modifiers);
	const WindowReference target = _Target();
	if (target == nullptr)
		return;
	auto message = _MakeMessage(B_MODIFIERS_CHANGED, event);
	message->AddInt32("be:old_modifiers", static_cast<int32>(before));
	target->Deliver(std::move(message));
}


} // namespace BPrivate
