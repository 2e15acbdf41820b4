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

#include <QTimer>

#include <cstdint>
#include <filesystem>
#include <functional>
#include <optional>
#include <string>
#include <string_view>

class QWindow;

namespace fuzz {

/// What a user meets.
struct Place {
    std::function<void()> run;   // the program's; it comes back when the user has left
    std::function<void()> close; // asks its windows to close, one of them each time it is called
    std::function<void()> check; // whether all is in order; nothing waits and no box is up then
};

class User {
  public:
    /// The place stays. Files are chosen in that directory.
    User(std::string_view bytes, std::filesystem::path files, const Place& place);
    ~User();

    User(const User&) = delete;
    User& operator=(const User&) = delete;

  private:
    std::uint8_t next();
    bool programIsBusy();
    void goOn();
    void act();
    bool point(std::uint8_t what);
    void pressKey(int key, Qt::KeyboardModifiers held, const QString& text);
    void pressNamed(std::uint8_t which, Qt::KeyboardModifiers held);
    void clickPlace(Qt::MouseButton button);
    void clickField(bool twice);
    void drag();
    void clickWindow();
    void turnWheel();
    void otherProgram();
    void turnBoxes();
    void leave();
    std::optional<std::string> chooseFile();

    std::string_view bytes_;
    std::filesystem::path files_;
    const Place& place_;
    QTimer timer_;
    int pause_ = 0;    // turns to let pass
    int haste_ = 0;    // things to do without waiting
    int patience_ = 0; // turns that the program has had for what waits
    int leaving_ = 0;
    bool realBoxes_ = true;
};

} // namespace fuzz
