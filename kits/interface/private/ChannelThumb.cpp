#include "interface/private/ChannelThumb.h"

#include <map>
#include <mutex>
#include <tuple>

#include <Application.h>
#include <Bitmap.h>
#include <View.h>

#include "interface/private/Look.h"

namespace BPrivate {

namespace {

typedef std::tuple<bool, uint32, uint8, uint8, uint8> Key;


// Painted through a view, and without one afterwards: a bitmap with views costs a thread.
std::shared_ptr<BBitmap>
paint_thumb(BRect bounds, orientation posture, uint32 lookState, rgb_color base)
{
	BBitmap canvas(bounds, B_RGBA32, true);
	if (!canvas.IsValid())
		return nullptr;
	BView* view = new BView(bounds, "thumb", B_FOLLOW_NONE, B_WILL_DRAW);
	canvas.AddChild(view);
	canvas.Lock();
	view->SetHighColor(base);
	view->FillRect(bounds);
	Look::DrawSliderBlockThumb(view, bounds, posture, base, lookState);
	view->Sync();
	canvas.Unlock();
	auto thumb = std::make_shared<BBitmap>(&canvas);
	return thumb->IsValid() ? thumb : nullptr;
}

} // namespace


std::shared_ptr<BBitmap>
channel_thumb(orientation posture, uint32 lookState, rgb_color base)
{
	static std::mutex sLock;
	static std::map<Key, std::weak_ptr<BBitmap>> sThumbs;

	if (be_app == NULL)
		return nullptr;
	const bool horizontal = posture == B_HORIZONTAL;
	const Key key(horizontal, lookState, base.red, base.green, base.blue);
	const std::lock_guard<std::mutex> lock(sLock);
	if (auto known = sThumbs[key].lock())
		return known;

	std::erase_if(sThumbs, [](const auto& entry) { return entry.second.expired(); });
	const float width = horizontal ? kThumbAlong : kThumbAcross;
	const float height = horizontal ? kThumbAcross : kThumbAlong;
	auto thumb = paint_thumb(BRect(0, 0, width - 1, height - 1), posture, lookState, base);
	sThumbs[key] = thumb;
	return thumb;
}


} // namespace BPrivate
