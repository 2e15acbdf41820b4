// A user who does what bytes say, on the windows that the program has open, in whichever of its
// loops it is. He goes on when the program has taken all that he did before. What a byte means:
//
//     ^c !c   the key c with Ctrl, or with Alt
//     ~c      the key c with Shift, which may be one of these:
//     \c      a key without a letter: the one of that place among Tab (a), Backtab, Return,
//             Enter (d), Escape (e), Space, Backspace, Delete (h), Left, Right, Up, Down (l),
//             Home, End, PageUp, PageDown (p), F10, F4, F1, Menu (t)
//     @xy     a click at that place of the window in front, in its 256ths; :xy the right button
//     #n "n   a click, or a double-click, on the field or button of that number
//     &xyuv   drags from a place to another
//     %n      a click into the middle of the window of that number
//     *n      turns the wheel there
//     .n      waits for n of the moments at which something is due
//     =n      does n things at once, without waiting for the program
//     -n      another program's window gets, or loses, the keyboard; the window is minimised, or
//             brought back
//     <       closes the window in front, as its window manager would
//     +       from here on boxes come up, or are answered, by turns
//
// Any other byte is typed. A question, and a file dialog, take the next byte for their answer.
#pragma once

#include <functional>
#include <string_view>

namespace fuzz {

/// Gives such a user a home and Toons of his own and runs the program, which comes back when he has
/// left. The frame editor's fields are right whenever nothing waits; then no handle and no window
/// is left behind, and each Toon on the disk loads.
void runWithUser(std::string_view bytes, const std::function<void()>& program);

} // namespace fuzz
