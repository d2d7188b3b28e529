// BAlert: a modal window with a text and one to three buttons.
#pragma once

#include <InterfaceDefs.h>
#include <Invoker.h>
#include <Window.h>

#include <memory>

class BButton;
class BInvoker;
class BTextView;

enum alert_type : uint32 { B_EMPTY_ALERT = 0, B_INFO_ALERT, B_IDEA_ALERT, B_WARNING_ALERT, B_STOP_ALERT };

enum button_spacing : uint32 { B_EVEN_SPACING = 0, B_OFFSET_SPACING };


// The rightmost button is the default button. Go() deletes the alert.
class _EXPORT BAlert : public BWindow {
public:
	BAlert(const char* title, const char* text, const char* button0, const char* button1 = NULL,
		const char* button2 = NULL, button_width width = B_WIDTH_AS_USUAL,
		alert_type type = B_INFO_ALERT);
	BAlert(const char* title, const char* text, const char* button0, const char* button1,
		const char* button2, button_width width, button_spacing spacing,
		alert_type type = B_INFO_ALERT);
	BAlert(BMessage* archive);
	virtual ~BAlert();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	// The button at the index also answers this character.
	void SetShortcut(int32 index, char key);
	char Shortcut(int32 index) const;

	// Shows the alert and waits. The result is the index of the pressed button, -1 when the alert
	// was closed otherwise. A calling window is redrawn meanwhile but gets no other messages.
	int32 Go();
	// Shows the alert and returns. The invoker's message is sent with int32 "which" added when a
	// button was pressed. The invoker is owned; NULL sends nothing.
	status_t Go(BInvoker* invoker);

	virtual void MessageReceived(BMessage* message);
	virtual void FrameResized(float newWidth, float newHeight);
	virtual void DispatchMessage(BMessage* message, BHandler* handler);
	virtual bool QuitRequested();
	virtual void Quit();

	BButton* ButtonAt(int32 index) const;
	BTextView* TextView() const;
	alert_type Type() const;

	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 what, const char* property);
	virtual status_t GetSupportedSuites(BMessage* message);
	virtual status_t Perform(perform_code code, void* data);

	// Where a window of this size goes: centred, its top at a quarter of the screen.
	static BPoint AlertPosition(float width, float height);

private:
	BAlert(const BAlert&) = delete;
	BAlert& operator=(const BAlert&) = delete;

	struct Wait;

	void _Init(const char* text, const char* const labels[]);
	void _LayOut();
	float _SizeButtons();
	void _FindViews();
	bool _HandleShortcut(BMessage* message);
	void _Answer(int32 which);

	std::shared_ptr<Wait> fWait; // shared with the Go() that waits in another thread
	std::unique_ptr<BInvoker> fInvoker; // of a Go() that does not wait
	BTextView* fTextView; // child
	BButton* fButtons[3]; // children, NULL where there are fewer
	char fKeys[3]; // 0: none
	alert_type fType;
	button_width fButtonWidth;
	button_spacing fSpacing;
};
