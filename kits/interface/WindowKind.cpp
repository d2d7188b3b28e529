// Types of windows, and the looks and feels that they stand for.
#include <Window.h>

#include "interface/private/WindowInternals.h"

namespace {

struct TypeTraits {
	window_type type;
	window_look look;
	window_feel feel;
};

constexpr TypeTraits kTypes[] = {
	{ B_TITLED_WINDOW, B_TITLED_WINDOW_LOOK, B_NORMAL_WINDOW_FEEL },
	{ B_DOCUMENT_WINDOW, B_DOCUMENT_WINDOW_LOOK, B_NORMAL_WINDOW_FEEL },
	{ B_MODAL_WINDOW, B_MODAL_WINDOW_LOOK, B_MODAL_APP_WINDOW_FEEL },
	{ B_FLOATING_WINDOW, B_FLOATING_WINDOW_LOOK, B_FLOATING_APP_WINDOW_FEEL },
	{ B_BORDERED_WINDOW, B_BORDERED_WINDOW_LOOK, B_NORMAL_WINDOW_FEEL },
	{ B_UNTYPED_WINDOW, B_TITLED_WINDOW_LOOK, B_NORMAL_WINDOW_FEEL },
};


const TypeTraits*
find_traits(window_type type)
{
	for (const TypeTraits& traits : kTypes) {
		if (traits.type == type)
			return &traits;
	}
	return nullptr;
}


const TypeTraits&
traits_of(window_type type)
{
	const TypeTraits* traits = find_traits(type);
	return traits != nullptr ? *traits : kTypes[0];
}


window_type
type_of(window_look look, window_feel feel)
{
	for (const TypeTraits& traits : kTypes) {
		if (traits.look == look && traits.feel == feel)
			return traits.type;
	}
	return B_UNTYPED_WINDOW;
}

} // namespace


BWindow::BWindow(
	BRect frame, const char* title, window_type type, uint32 flags, uint32 workspaces) :
	BLooper(title, B_DISPLAY_PRIORITY)
{
	const TypeTraits& traits = traits_of(type);
	_Init(frame, title, traits.look, traits.feel, flags, workspaces, type);
}


BWindow::BWindow(BRect frame, const char* title, window_look look, window_feel feel, uint32 flags,
	uint32 workspaces) :
	BLooper(title, B_DISPLAY_PRIORITY)
{
	_Init(frame, title, look, feel, flags, workspaces, type_of(look, feel));
}


status_t
BWindow::SetType(window_type type)
{
	const TypeTraits* traits = find_traits(type);
	if (traits == nullptr)
		return B_BAD_VALUE;
	fInternals->type = type;
	fInternals->look = traits->look;
	fInternals->feel = traits->feel;
	return fInternals->ApplyKind();
}


window_type
BWindow::Type() const
{
	return fInternals->type;
}


status_t
BWindow::SetLook(window_look look)
{
	if (look == fInternals->look)
		return B_OK;
	fInternals->look = look;
	fInternals->type = type_of(look, Feel());
	return fInternals->ApplyKind();
}


window_look
BWindow::Look() const
{
	return fInternals->look;
}


status_t
BWindow::SetFeel(window_feel feel)
{
	if (feel == fInternals->feel)
		return B_OK;
	fInternals->feel = feel;
	fInternals->type = type_of(Look(), feel);
	return fInternals->ApplyKind();
}


window_feel
BWindow::Feel() const
{
	return fInternals->feel;
}
