// HeadlessBackend: a screen in memory, for tests, scripts and pictures.
#pragma once

#include "backend/Backend.h"
#include "backend/SimulatedDrag.h"
#include "backend/headless/TaskQueue.h"

namespace BPrivate {

class HeadlessWindow;


// The size of the screen comes from ARCHWAY_SCREEN ("1600x1000", logical), its scale from
// ARCHWAY_SCALE. It has its own small window manager and file manager: windows lie in layers,
// activation is immediate, and a drag that leaves all windows can end on a folder.
class HeadlessBackend : public Backend {
public:
	HeadlessBackend();
	~HeadlessBackend() override;

	const char* Name() const override { return "headless"; }
	status_t Open(BackendSink* sink) override;
	void Run() override;
	void Stop() override;
	void Post(std::function<void()> task) override;
	void PostLater(bigtime_t delay, std::function<void()> task) override;
	void RunNested(bigtime_t timeout) override;

	BRect ScreenFrame() const override;
	float Scale() const override { return fScale; }
	bool IsImmediate() const override { return true; }

	std::unique_ptr<BackendWindow> MakeWindow(
		FrontImage* image, const WindowTraits& traits) override;
	BackendWindow* WindowAt(BPoint screen) const override;
	void Inject(const BackendEvent& event) override;

	bool ActivatedByPress(const BackendWindow* window) const override { return false; }
	void SetPointerGrab(BackendWindow* window) override {}
	void SetCursorHidden(bool hidden) override {}
	void Beep() override { fBeeps++; }
	void SetDragPicture(const ScreenPicture* picture, BPoint offset) override;
	bool StartDesktopDrag(const DataOffer& offer, int32 session, uint32 buttons) override;

	void SetClipboard(const DataOffer& offer) override;
	DataOffer Clipboard() override { return fClipboard; }
	bool OwnsClipboard() const override { return true; }
	ScreenPicture Picture(BRect screen) override;

	int32 CountBeeps() const { return fBeeps; }

	// For windows.
	void AddWindow(HeadlessWindow* window);
	void RemoveWindow(HeadlessWindow* window);
	void RaiseWindow(HeadlessWindow* window); // to the front of its layer
	void LowerWindow(HeadlessWindow* window, BackendWindow* behind);
	void ShownChanged(HeadlessWindow* window);
	void SetActive(HeadlessWindow* window);
	void ReportFrame(HeadlessWindow* window);

private:
	void _InjectPointer(BackendEvent event);
	void _Report(BackendEvent::Type type, HeadlessWindow* window);
	HeadlessWindow* _NextActive() const;

	BackendSink* fSink = nullptr; // borrowed
	TaskQueue fTasks;
	bool fStopped = false;
	int32 fBeeps = 0;
	int32 fWidth = 1600, fHeight = 1000; // logical
	float fScale = 1;

	std::vector<HeadlessWindow*> fWindows; // borrowed; back to front
	HeadlessWindow* fActive = nullptr;
	BPoint fPointer;
	HeadlessWindow* fPressed = nullptr; // gets the pointer until the buttons are up
	DataOffer fClipboard;

	ScreenPicture fDragPicture;
	BPoint fDragOffset;
	SimulatedDrag fDrag;
};


} // namespace BPrivate
