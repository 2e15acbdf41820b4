// Tables of the keys that stand for commands, and which of the loops has such keys for itself.
//
// How deep a loop runs is told by how many messages are being handled round it. Each depth begins
// without a table and has one from the first call that names it, so that the loop of a dialog, a
// player or a box within that of another window leaves the keys to the toolkit.
#pragma once

#include "platform/menus.h"
#include "platform/user/keys.h"

#include <optional>
#include <string_view>
#include <vector>

namespace seam {

struct Accelerator {
    KeyStroke key;
    WORD command = 0;
};

/// Reads a table: on each line "alt" or "ctrl", a letter or digit, and the command's number; #
/// begins a remark. Nothing if a line can't be read.
std::optional<std::vector<Accelerator>> parseAccelerators(std::string_view text);

/// While it lives, loops run one deeper.
class InnerDepth {
  public:
    InnerDepth();
    InnerDepth(const InnerDepth&) = delete;
    InnerDepth& operator=(const InnerDepth&) = delete;
    ~InnerDepth();
};

/// A loop asks for its next message. If the last one hasn't been through TranslateAcceleratorA, it
/// isn't the loop that has asked for a table.
void loopAsksForMessage();

} // namespace seam
