#include "server/WindowRecord.h"

#include "server/ServerWindow.h"

namespace BPrivate {

namespace {

// The platform's values of looks, feels and flags; the window class is above this folder.
constexpr uint32 kBorderedLook = 20, kNoBorderLook = 19;
constexpr uint32 kModalAppFeel = 1, kModalSubsetFeel = 2, kModalAllFeel = 3;
constexpr uint32 kFloatingAppFeel = 4, kFloatingSubsetFeel = 5, kFloatingAllFeel = 6;
constexpr uint32 kNotMovable = 0x1, kNotResizable = 0x2, kNotHResizable = 0x4, kNotVResizable = 0x8;
constexpr uint32 kNotClosable = 0x20, kNotZoomable = 0x40, kAvoidFocus = 0x2000;
constexpr uint32 kNotMinimizable = 0x4000;

bool
IsModalFeel(uint32 feel)
{
	return feel == kModalAppFeel || feel == kModalSubsetFeel || feel == kModalAllFeel;
}


bool
IsFloatingFeel(uint32 feel)
{
	return feel == kFloatingAppFeel || feel == kFloatingSubsetFeel || feel == kFloatingAllFeel;
}


WindowTraits::Kind
KindOf(uint32 feel)
{
	if (feel == kMenuWindowFeel || feel == kTipWindowFeel)
		return WindowTraits::Kind::Menu;
	if (IsModalFeel(feel))
		return WindowTraits::Kind::Modal;
	return IsFloatingFeel(feel) ? WindowTraits::Kind::Floating : WindowTraits::Kind::Normal;
}

} // namespace


WindowRecord::WindowRecord(uint32 id, WindowClient* client, const Properties& properties) :
	reportedFrame(properties.frame), fId(id), fProperties(properties), fClient(client)
{
}


WindowRecord::Properties
WindowRecord::GetProperties() const
{
	std::lock_guard lock(fLock);
	return fProperties;
}


BRect
WindowRecord::Frame() const
{
	std::lock_guard lock(fLock);
	return fProperties.frame;
}


uint32
WindowRecord::Feel() const
{
	std::lock_guard lock(fLock);
	return fProperties.feel;
}


uint32
WindowRecord::Flags() const
{
	std::lock_guard lock(fLock);
	return fProperties.flags;
}


bool
WindowRecord::IsMenu() const
{
	return Feel() == kMenuWindowFeel;
}


bool
WindowRecord::IsModal() const
{
	return IsModalFeel(Feel());
}


bool
WindowRecord::IsFloating() const
{
	return IsFloatingFeel(Feel());
}


// A question that the user does not want to answer is closed whatever its flags.
bool
WindowRecord::MayClose() const
{
	return (Flags() & kNotClosable) == 0 || IsModal();
}


bool
WindowRecord::FloatsOverAll() const
{
	return Feel() == kFloatingAllFeel;
}


bool
WindowRecord::HasSubset() const
{
	const uint32 feel = Feel();
	return feel == kModalSubsetFeel || feel == kFloatingSubsetFeel;
}


void
WindowRecord::Change(const std::function<void(Properties&)>& change)
{
	std::lock_guard lock(fLock);
	change(fProperties);
}


void
WindowRecord::BeginFrame(BRect frame)
{
	std::lock_guard lock(fLock);
	fProperties.frame = frame;
	fFramesUnderWay++;
}


bool
WindowRecord::FrameApplied()
{
	std::lock_guard lock(fLock);
	return --fFramesUnderWay == 0;
}


bool
WindowRecord::ReportFrame(BRect frame)
{
	std::lock_guard lock(fLock);
	if (fFramesUnderWay > 0)
		return false;
	fProperties.frame = frame;
	return true;
}


WindowTraits
WindowRecord::Traits() const
{
	const Properties properties = GetProperties();
	const uint32 flags = properties.flags;

	WindowTraits traits;
	traits.kind = KindOf(properties.feel);
	traits.title = properties.title;
	traits.frame = properties.frame;
	traits.minWidth = properties.minWidth;
	traits.maxWidth = properties.maxWidth;
	traits.minHeight = properties.minHeight;
	traits.maxHeight = properties.maxHeight;
	if ((flags & (kNotResizable | kNotHResizable)) != 0)
		traits.minWidth = traits.maxWidth = properties.frame.Width();
	if ((flags & (kNotResizable | kNotVResizable)) != 0)
		traits.minHeight = traits.maxHeight = properties.frame.Height();
	traits.hasBorder = properties.look != kNoBorderLook && traits.kind != WindowTraits::Kind::Menu;
	traits.hasTitle = traits.hasBorder && properties.look != kBorderedLook;
	traits.movable = (flags & kNotMovable) == 0;
	traits.resizable = (flags & kNotResizable) == 0;
	traits.closable = (flags & kNotClosable) == 0;
	traits.zoomable = (flags & kNotZoomable) == 0;
	traits.minimizable = (flags & kNotMinimizable) == 0;
	traits.takesFocus = (flags & kAvoidFocus) == 0 && traits.kind != WindowTraits::Kind::Menu;
	return traits;
}


void
WindowRecord::Deliver(std::unique_ptr<BMessage> message)
{
	std::lock_guard lock(fClientLock);
	if (fClient != nullptr)
		fClient->PostInput(message.release());
}


void
WindowRecord::Detach()
{
	std::lock_guard lock(fClientLock);
	fClient = nullptr;
}


} // namespace BPrivate
