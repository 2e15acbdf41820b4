// Where the real program is tried: an X server with a window manager, a home, and scripted input.
#pragma once

#include <cstdint>
#include <filesystem>
#include <functional>
#include <map>
#include <memory>
#include <string>
#include <vector>
#include <xcb/xcb.h>

namespace ground {

/// Asks until the condition holds, for at most `seconds`; whether it came to hold.
bool waitFor(const std::function<bool()>& condition, double seconds = 20);

/// A process of ours; killed at the end if it still runs.
class Process {
  public:
    Process(const std::vector<std::string>& command, const std::map<std::string, std::string>& set,
            const std::filesystem::path& directory);
    Process(const Process&) = delete;
    Process& operator=(const Process&) = delete;
    ~Process();

    bool running();

    /// Waits for the end and gives the exit code; -1 if it was killed, -2 if it hasn't ended in
    /// time.
    int exitCode(double seconds = 20);

    void terminate();

  private:
    int pid_ = -1;
    int status_ = 0;
    bool ended_ = false;
};

struct Grab {
    int width = 0;
    int height = 0;
    std::vector<std::uint32_t> pixels;

    std::uint32_t at(int x, int y) const {
        return pixels[static_cast<std::size_t>(y) * static_cast<std::size_t>(width) +
                      static_cast<std::size_t>(x)];
    }

    friend bool operator==(const Grab&, const Grab&) = default;
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
    Grab grab(xcb_window_t window = 0) const;

    /// Shows a window of our own, as another program would.
    xcb_window_t makeWindow(int width, int height) const;
    void destroyWindow(xcb_window_t window) const;

    void resizeWindow(xcb_window_t window, int width, int height) const;

    /// The window that lies in a window of ours; 0 if none does.
    xcb_window_t childOf(xcb_window_t window) const;

    /// Presses and releases a key, by its X name; where the keyboard is, or in a window.
    void press(const std::string& key, xcb_window_t window = 0) const;

    /// The settings file's text; empty while there is none.
    std::string settings() const;
    void writeSettings(const std::string& text) const;

    std::filesystem::path toons() const {
        return root_ / "toons";
    }

  private:
    std::map<std::string, std::string> environment() const;

    std::filesystem::path root_;
    std::string display_;
    std::vector<std::unique_ptr<Process>> servers_;
    xcb_connection_t* connection_ = nullptr;
    xcb_screen_t* screen_ = nullptr;
};

} // namespace ground
