// Scenes: what a user does in the editor and when, written in lines, for replays.
#pragma once

#include <cstdint>
#include <functional>
#include <istream>
#include <string>
#include <vector>

struct SceneStep {
    std::int64_t moment = 0;   // at which it is done, in ms from the stage's creation on
    std::function<void()> act; // does it in the open editor
};

/// Reads a scene. A line is a moment in ms, none earlier than the one before, and an action with
/// its arguments; empty lines and those that begin with # are passed over:
///
///     click X Y      the left button goes down at that pixel of the stage
///     play  walk  minimise  close
///                    that button is pressed, if it is enabled
///     command N      the command number N of a key reaches the main window; none that opens a menu
///                    or the about box, which a scene can't answer
///     open NAME      Ctrl+O, and the file dialog is answered with the name
///     save NAME      Ctrl+S, and the same if it asks for a name
///     cancel         Ctrl+O, and the file dialog is cancelled
///     edit           Ctrl+E, which opens the frame editor and closes it again
///     answer N       questions from here on are answered so: 6 yes, 7 no, 2 cancel
///     item N         the command number N of a menu item or button reaches the frame editor; none
///                    that opens a dialog
///     frame N        the frame number N is selected in its list
///     field N TEXT   its field number N gets the text, a single word
///     pose N         its pose button is pressed, and the key N in the picker, 1 to 8
///     activate  deactivate
///                    the main window gets, or loses, the keyboard
///     iconify  restore
///                    the window manager minimises the main window, or brings it back
///     end            the main window is asked to close, as the setup dialog does
///
/// Throws a std::runtime_error that names `name`, the line and what is wrong with it.
std::vector<SceneStep> ReadScene(std::istream& in, const std::string& name);
