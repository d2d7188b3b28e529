// QtBackend: real windows, by Qt Gui on the display thread.
#pragma once

#include <memory>
#include <vector>

#include <QGuiApplication>
#include <QObject>

#include "backend/Backend.h"
#include "backend/SimulatedDrag.h"
#include "backend/qt/QtKeys.h"

namespace BPrivate {

class DragPicture;
class QtWindow;


class QtBackend : public QObject, public Backend {
public:
	QtBackend();
	~QtBackend() override;

	const char* Name() const override { return "qt"; }
	status_t Open(BackendSink* sink) override;
	void Run() override;
	void Stop() override;
	void Post(std::function<void()> task) override;
	void PostLater(bigtime_t delay, std::function<void()> task) override;
	void RunNested(bigtime_t timeout) override;

	BRect ScreenFrame() const override;
	float Scale() const override { return fScale; }
	bool IsImmediate() const override { return false; }

	std::unique_ptr<BackendWindow> MakeWindow(
		FrontImage* image, const WindowTraits& traits) override;
	BackendWindow* WindowAt(BPoint screen) const override;
	void Inject(const BackendEvent& event) override;

	bool ActivatedByPress(const BackendWindow* window) const override;
	void SetPointerGrab(BackendWindow* window) override;
	void SetCursorHidden(bool hidden) override;
	void Beep() override;
	void SetDragPicture(const ScreenPicture* picture, BPoint offset) override;
	bool StartDesktopDrag(const DataOffer& offer, int32 session, uint32 buttons) override;
	void SetClipboard(const DataOffer& offer) override;
	DataOffer Clipboard() override;
	bool OwnsClipboard() const override;
	ScreenPicture Picture(BRect screen) override;

	// For windows.
	BackendSink& Sink() { return *fSink; }
	float Ratio() const { return fRatio; } // device pixels per unit of Qt
	QRect ToQt(BRect screen) const;
	BRect FromQt(const QRect& screen) const;
	BPoint FromQt(const QPointF& screen) const; // whole logical units
	void AddWindow(QtWindow* window);
	void RemoveWindow(QtWindow* window);
	void NoteRequest(QtWindow* window); // for the keyboard, by the program
	bool IsCursorHidden() const { return fCursorHidden; }

	uint32 UpdateModifiers(Qt::KeyboardModifiers modifiers);
	uint32 NoteModifierKey(const QKeyEvent& event, bool down);
	uint32 CurrentModifiers() const { return fModifiers.Current(); }
	// The time is the desktop's, in milliseconds.
	void ReportPointer(const BackendEvent& event, quint64 timestamp);
	void ReportDrag(const BackendEvent& event);
	void PointerLeft(QtWindow* window);
	void DragLeft(QtWindow* window);

protected:
	bool event(QEvent* event) override;

private:
	void _FindScale();
	void _FocusChanged(QWindow* window);
	void _ReportModifiers();
	void _InjectPointer(const BackendEvent& event);
	void _RunDrag(const DataOffer& offer, int32 session);

	std::unique_ptr<QGuiApplication> fApplication;
	BackendSink* fSink = nullptr; // borrowed
	float fScale = 1; // device pixels per logical unit
	float fRatio = 1;
	std::vector<QtWindow*> fWindows; // borrowed; the one that was active last at the end
	ModifierState fModifiers;
	BPoint fPointer;
	bool fCursorHidden = false;
	bool fInDrag = false; // a drag of ours is in the desktop's hands

	QtWindow* fActivated = nullptr; // borrowed
	bigtime_t fActivatedAt = 0;
	QtWindow* fRequested = nullptr; // borrowed; the program asked for it
	quint64 fPressTime = 0; // of the press that is being reported

	QtWindow* fGrabbing = nullptr; // borrowed
	QtWindow* fScriptPressed = nullptr; // borrowed; gets the pointer of a script until the release
	bool fScripted = false; // a script moves the pointer, which the desktop knows nothing of
	SimulatedDrag fSimulated;
	std::unique_ptr<DragPicture> fDragPicture;
};


} // namespace BPrivate
