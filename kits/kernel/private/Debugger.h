// What debugger() does, so that a test can see a misuse being reported.
#pragma once

namespace BPrivate {

typedef void (*debugger_hook)(const char* message);

// The hook replaces the print and the trap and may return; NULL restores them. Any thread that
// calls debugger() calls the hook. Returns the hook that was set before.
debugger_hook set_debugger_hook(debugger_hook hook);

} // namespace BPrivate
