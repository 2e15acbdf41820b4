// The one message queue, and how its messages are brought about.
#pragma once

#include "platform/user.h"

namespace seam {

/// Queues a message behind the posted ones, or behind the input that waits. time is filled
/// in. Wakes whichever loop is waiting. A posted WM_CLOSE isn't queued behind one that waits.
void queuePosted(const MSG& message);
void queueInput(const MSG& message);

/// Whether any message waits, posted or input.
bool messagesWait();

/// Waits for the next message of any window and takes it, but no quit.
void waitForMessage(MSG& message);

/// Drops what is queued for a window that goes.
void forgetMessagesOf(HWND window);

/// Something has come up (a paint, a timer) that a loop of the toolkit's own has to see to.
void wake();

/// Shows what has been drawn on any window.
void flushWindows();

/// Throws what a handler threw while the toolkit's loop, now ended, was innermost.
void rethrowFromToolkitLoop();

/// Whether the innermost running loop is one of the toolkit's: a message box's.
bool toolkitLoopIsInnermost();

} // namespace seam
