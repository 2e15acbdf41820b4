// Wakes the toolkit's loops when a timer of ours is due or something has been queued.
#pragma once

#include <cstdint>
#include <optional>

class QWidget;

namespace seam {

/// Sees to it that the toolkit's loop wakes at the deadline, by the system's clock; at none if
/// there is no deadline.
void armWaker(std::optional<std::int64_t> deadline);

/// Makes a running loop of the toolkit's call drainWithinToolkitLoop soon.
void wakeToolkitLoop();

/// Handles a bounded number of waiting messages while a loop of the toolkit's is innermost; else
/// does nothing. The queue supplies it; the waker calls it.
void drainWithinToolkitLoop();

/// Stands for a loop of the toolkit's while it runs, that of a box or a menu.
class ToolkitLoop {
  public:
    explicit ToolkitLoop(const QWidget& shown);
    ToolkitLoop(const ToolkitLoop&) = delete;
    ToolkitLoop& operator=(const ToolkitLoop&) = delete;
    ~ToolkitLoop();
};

/// Whether what the innermost of these loops shows has been answered, so that it is about to end.
bool toolkitLoopIsOver();

/// Closes the menu of the toolkit that is open, or else ends its innermost box as its Cancel would,
/// or else a drag.
void rejectToolkitModal();

} // namespace seam
