// Where the real program is tried: an X server with a window manager, a home, and scripted input.
#pragma once

#include <filesystem>
#include <functional>
#include <memory>
#include <string>
#include <vector>
#include <xcb/xcb.h>

#include <QImage>
#include <QProcess>
#include <QTemporaryDir>

namespace ground {

/// Asks until the condition holds, for at most `seconds`; whether it came to hold.
bool waitFor(const std::function<bool()>& condition, double seconds = 20);

/// One of the program's bitmaps.
QImage loadPicture(const std::string& name);

/// The environment of this process, but that the display is this one and the only one.
QProcessEnvironment environmentFor(const std::string& display);

/// A process of ours; killed at the end if it still runs.
class Process {
  public:
    Process(const std::vector<std::string>& command, const QProcessEnvironment& environment,
            const std::filesystem::path& directory);
    ~Process();

    bool running();

    /// Waits for the end and gives the exit code; -1 if it was killed, -2 if it hasn't ended in
    /// time.
    int exitCode();

    void signal(int number);

    /// Waits for a line of its output; empty if it ends without one.
    std::string readLine();

  private:
    QProcess process_;
};

/// An Xvfb of our own with openbox, a temporary home and a directory for Toons.
class Ground {
  public:
    explicit Ground(int width = 800, int height = 600);
    Ground(const Ground&) = delete;
    Ground& operator=(const Ground&) = delete;
    ~Ground();

    /// Starts dorbo with these arguments in the directory of the Toons.
    Process start(const std::vector<std::string>& arguments) const;

    /// A picture of the whole screen, or of a window of ours.
    QImage grab(xcb_window_t window = 0) const;

    /// Shows a window of our own, as another program would.
    xcb_window_t makeWindow(int width, int height) const;
    void destroyWindow(xcb_window_t window) const;

    void resizeWindow(xcb_window_t window, int width, int height) const;

    /// The window that lies in another one; 0 if none does.
    xcb_window_t childOf(xcb_window_t window) const;

    /// Clicks in the middle of a window of ours; whether it is told of that, and the pointer is in
    /// it and not in a window that lies there.
    bool clickReaches(xcb_window_t window) const;

    /// Starts another program on the display.
    Process launch(const std::vector<std::string>& words) const;

    /// Runs another program on the display to its end and gives its exit code.
    int command(const std::vector<std::string>& words) const;

    /// Presses and releases a key, by its X name; where the keyboard is, or in a window.
    void press(const std::string& key, xcb_window_t window = 0) const;

    /// Types a text and Return into the window with this title as soon as it is there.
    void typeInto(const std::string& title, const std::string& text) const;

    /// Takes keyboard and pointer, as an open menu does; false if somebody else holds them.
    bool takeInput() const;
    bool takePointer() const;
    void giveInputBack() const;

    /// Gives the keyboard to a window, or to none.
    void focus(xcb_window_t window) const;

    bool inputIsFree() const {
        const bool taken = takeInput();
        giveInputBack();
        return taken;
    }

    QPoint pointer() const; ///< where on the screen it is

    /// The window manager ends: nobody sees to windows and keyboard any more.
    void loseManager();

    /// The X server dies.
    void loseDisplay();

    std::filesystem::path toons() const {
        return home() / "toons";
    }

    std::filesystem::path settings() const {
        return home() / "config/dorbo/Dorbo95.ini";
    }

    std::filesystem::path home() const {
        return root_.path().toStdString();
    }

    /// Where the programs keep the user's Toons.
    std::filesystem::path toonHome() const {
        return home() / "data/dorbo/toons";
    }

  private:
    QTemporaryDir root_;
    QProcessEnvironment environment_;
    std::unique_ptr<Process> server_;
    std::unique_ptr<Process> manager_;
    xcb_connection_t* connection_ = nullptr;
    xcb_screen_t* screen_ = nullptr;
};

} // namespace ground
