#include "backend/SimulatedDrag.h"

#include "backend/FolderDrop.h"

namespace BPrivate {


void
SimulatedDrag::Start(const DataOffer& offer, int32 session)
{
	fOffer = offer;
	fSession = session;
	fOver = nullptr;
}


void
SimulatedDrag::Follow(const BackendEvent& event, BackendWindow* under, BackendSink& sink)
{
	using Type = BackendEvent::Type;

	BackendEvent told = event;
	told.session = fSession;
	const auto tell = [&](Type type, BackendWindow* window) {
		told.type = type;
		told.window = window;
		sink.HandleEvent(told);
	};

	if (event.type == Type::PointerLeft)
		under = nullptr;
	if (under != fOver) {
		if (fOver != nullptr)
			tell(Type::DragLeft, fOver);
		fOver = under;
		if (under != nullptr)
			tell(Type::DragEntered, under);
	}
	if (event.type != Type::ButtonReleased || event.buttons != 0) {
		if (under != nullptr)
			tell(Type::DragMoved, under);
		return;
	}

	fSession = 0;
	fOver = nullptr;
	if (under != nullptr)
		tell(Type::Dropped, under);
	told.flag = under != nullptr;
	tell(Type::DragFinished, nullptr);
}


void
SimulatedDrag::DropOnFolder(const BackendEvent& event, BackendSink& sink)
{
	if (fSession == 0)
		return;
	BackendEvent finished = event;
	finished.type = BackendEvent::Type::DragFinished;
	finished.flag = drop_on_folder(fOffer, event.text);
	fSession = 0;
	fOver = nullptr;
	sink.HandleEvent(finished);
}


void
SimulatedDrag::WindowGone(const BackendWindow* window)
{
	if (fOver == window)
		fOver = nullptr;
}


} // namespace BPrivate
