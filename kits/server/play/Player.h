// Player: carries out the commands of a play script.
#pragma once

#include <functional>
#include <optional>
#include <string>

#include "server/play/PlayTokens.h"
#include "server/play/ScriptedInput.h"
#include "server/play/ViewFinder.h"

namespace BPrivate {

class DesktopThread;


// The player's thread alone. Functions throw PlayError when a command cannot be carried out.
class Player {
public:
	// `ended` tells whether the program is about to end, and is asked while waiting.
	Player(DesktopThread& desktop, std::function<bool()> ended);
	~Player();

	// Output goes to the standard output, or to the file that ARCHWAY_PLAY_OUT names.
	void OpenOutput();
	void WaitForFirstWindow();
	void Perform(PlayTokenReader& reader);
	void WaitUntilIdle();
	void Quit(); // as a user would

private:
	struct Command {
		const char* name;
		void (Player::*perform)(PlayTokenReader& reader);
	};
	static const Command kCommands[];

	struct Gesture {
		BPoint where; // screen
		uint32 modifiers = 0;
		uint32 button = 1;
		int32 times = 1;
		int32 steps = 10;
	};

	// A view with its "at".
	BPoint _TakePlace(PlayTokenReader& reader);
	Gesture _TakeGesture(PlayTokenReader& reader);
	void _TakeOptions(PlayTokenReader& reader, Gesture& gesture);
	uint32 _TakeModifiers(PlayTokenReader& reader);
	WindowNode _TakeWindow(PlayTokenReader& reader);
	static BPoint _PlaceIn(const FoundView& found, const std::string& at);

	void _Click(PlayTokenReader& reader);
	void _Press(PlayTokenReader& reader);
	void _Move(PlayTokenReader& reader);
	void _Release(PlayTokenReader& reader);
	void _Drag(PlayTokenReader& reader);
	void _DragToFolder(const Gesture& gesture, const std::string& folder);
	void _Drop(PlayTokenReader& reader);
	void _Wheel(PlayTokenReader& reader);
	void _Type(PlayTokenReader& reader);
	void _Key(PlayTokenReader& reader);
	void _Menu(PlayTokenReader& reader);
	void _Choose(PlayTokenReader& reader);
	void _Answer(PlayTokenReader& reader);
	void _Open(PlayTokenReader& reader);
	void _Resize(PlayTokenReader& reader);
	void _Activate(PlayTokenReader& reader);
	void _Close(PlayTokenReader& reader);
	void _Picture(PlayTokenReader& reader);
	void _Tree(PlayTokenReader& reader);
	void _Show(PlayTokenReader& reader);
	void _Expect(PlayTokenReader& reader);
	void _Absent(PlayTokenReader& reader);
	void _Windows(PlayTokenReader& reader);
	void _Wait(PlayTokenReader& reader);
	void _RunCommand(PlayTokenReader& reader);
	void _Echo(PlayTokenReader& reader);
	void _Quit(PlayTokenReader& reader);
	void _QuitNow(PlayTokenReader& reader);

	void _ClickAt(const Gesture& gesture);
	void _MoveInSteps(BPoint to, int32 steps);
	void _PressKey(const KeyStroke& stroke);
	// Moves to an item of an open menu, which must be there and enabled.
	void _MoveToMenuItem(const std::string& label);
	std::string _Property(PlayTokenReader& reader, std::string* _described);
	void _Print(const std::string& text);
	void _Inject(BackendEvent event, uint32 window);

	DesktopThread& fDesktop;
	std::function<bool()> fEnded;
	ViewFinder fFinder;
	ScriptedInput fInput;
	std::FILE* fOutput = stdout;
};


} // namespace BPrivate
