#include "tests/program/ground.h"

#include <chrono>
#include <cstdlib>
#include <fcntl.h>
#include <fstream>
#include <memory>
#include <signal.h>
#include <sstream>
#include <stdexcept>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

namespace ground {

namespace fs = std::filesystem;

bool waitFor(const std::function<bool()>& condition, double seconds) {
    const auto end = std::chrono::steady_clock::now() + std::chrono::duration<double>(seconds);
    while (!condition()) {
        if (std::chrono::steady_clock::now() > end) {
            return false;
        }
        std::this_thread::sleep_for(std::chrono::milliseconds(2));
    }
    return true;
}

Process::Process(const std::vector<std::string>& command,
                 const std::map<std::string, std::string>& set, const fs::path& directory) {
    pid_ = fork();
    if (pid_ < 0) {
        throw std::runtime_error("no process can be made");
    }
    if (pid_ != 0) {
        return;
    }
    for (const auto& [name, value] : set) {
        setenv(name.c_str(), value.c_str(), 1);
    }
    for (const char* name : {"QT_QPA_PLATFORM", "WAYLAND_DISPLAY"}) {
        if (set.count(name) == 0) {
            unsetenv(name);
        }
    }
    std::vector<char*> arguments;
    for (const std::string& argument : command) {
        arguments.push_back(const_cast<char*>(argument.c_str()));
    }
    arguments.push_back(nullptr);
    if (chdir(directory.c_str()) == 0) {
        execvp(arguments[0], arguments.data());
    }
    _exit(127);
}

Process::~Process() {
    if (running()) {
        kill(pid_, SIGKILL);
        waitpid(pid_, &status_, 0);
    }
}

bool Process::running() {
    if (!ended_) {
        ended_ = waitpid(pid_, &status_, WNOHANG) != 0;
    }
    return !ended_;
}

int Process::exitCode(double seconds) {
    if (!waitFor([this] { return !running(); }, seconds)) {
        return -2;
    }
    return WIFEXITED(status_) ? WEXITSTATUS(status_) : -1;
}

void Process::terminate() {
    kill(pid_, SIGTERM);
}

namespace {

/// Starts an Xvfb that picks a free display and tells which.
std::string startServer(int width, int height, std::vector<std::unique_ptr<Process>>& servers) {
    int ends[2];
    if (pipe(ends) != 0) {
        throw std::runtime_error("no pipe");
    }
    const std::string screen = std::to_string(width) + "x" + std::to_string(height) + "x24";
    servers.push_back(std::make_unique<Process>(
        std::vector<std::string>{"Xvfb", "-displayfd", std::to_string(ends[1]), "-screen", "0",
                                 screen, "-nolisten", "tcp"},
        std::map<std::string, std::string>{}, fs::temp_directory_path()));
    close(ends[1]);
    std::string number;
    char byte = 0;
    while (read(ends[0], &byte, 1) == 1 && byte != '\n') {
        number += byte;
    }
    close(ends[0]);
    if (number.empty()) {
        throw std::runtime_error("Xvfb doesn't start");
    }
    return ":" + number;
}

bool managerRuns(xcb_connection_t* connection, xcb_window_t root) {
    const auto intern = xcb_intern_atom(connection, 0, 24, "_NET_SUPPORTING_WM_CHECK");
    const std::unique_ptr<xcb_intern_atom_reply_t, decltype(&std::free)> atom(
        xcb_intern_atom_reply(connection, intern, nullptr), &std::free);
    const auto get =
        xcb_get_property(connection, 0, root, atom->atom, XCB_GET_PROPERTY_TYPE_ANY, 0, 1);
    const std::unique_ptr<xcb_get_property_reply_t, decltype(&std::free)> property(
        xcb_get_property_reply(connection, get, nullptr), &std::free);
    return property != nullptr && property->value_len > 0;
}

} // namespace

Ground::Ground(int width, int height) {
    std::string pattern = fs::temp_directory_path() / "dorbo-ground-XXXXXX";
    if (mkdtemp(pattern.data()) == nullptr) {
        throw std::runtime_error("no directory");
    }
    root_ = pattern;
    fs::create_directories(root_ / "config" / "dorbo");
    fs::create_directories(toons());
    display_ = startServer(width, height, servers_);
    connection_ = xcb_connect(display_.c_str(), nullptr);
    if (xcb_connection_has_error(connection_) != 0) {
        throw std::runtime_error("no connection to Xvfb");
    }
    screen_ = xcb_setup_roots_iterator(xcb_get_setup(connection_)).data;
    servers_.push_back(
        std::make_unique<Process>(std::vector<std::string>{"openbox"}, environment(), root_));
    if (!waitFor([this] { return managerRuns(connection_, screen_->root); })) {
        throw std::runtime_error("openbox doesn't start");
    }
}

Ground::~Ground() {
    xcb_disconnect(connection_);
    while (!servers_.empty()) {
        servers_.back()->terminate();
        servers_.back()->exitCode(5);
        servers_.pop_back();
    }
    std::error_code ignored;
    fs::remove_all(root_, ignored);
}

std::map<std::string, std::string> Ground::environment() const {
    return {{"DISPLAY", display_},
            {"HOME", root_.string()},
            {"XDG_CONFIG_HOME", (root_ / "config").string()},
            {"XDG_RUNTIME_DIR", root_.string()},
            {"UBSAN_OPTIONS", "print_stacktrace=1"}};
}

Process Ground::start(const std::vector<std::string>& arguments) const {
    std::vector<std::string> command{DORBO_PROGRAM};
    command.insert(command.end(), arguments.begin(), arguments.end());
    return {command, environment(), toons()};
}

Grab Ground::grab(xcb_window_t window) const {
    const xcb_window_t from = window == 0 ? screen_->root : window;
    const std::unique_ptr<xcb_get_geometry_reply_t, decltype(&std::free)> geometry(
        xcb_get_geometry_reply(connection_, xcb_get_geometry(connection_, from), nullptr),
        &std::free);
    Grab grab;
    if (geometry == nullptr) {
        return grab;
    }
    const std::unique_ptr<xcb_get_image_reply_t, decltype(&std::free)> image(
        xcb_get_image_reply(connection_,
                            xcb_get_image(connection_, XCB_IMAGE_FORMAT_Z_PIXMAP, from, 0, 0,
                                          geometry->width, geometry->height, ~0U),
                            nullptr),
        &std::free);
    if (image == nullptr) {
        return grab;
    }
    grab.width = geometry->width;
    grab.height = geometry->height;
    const auto* pixels = reinterpret_cast<const std::uint32_t*>(xcb_get_image_data(image.get()));
    const std::size_t count =
        static_cast<std::size_t>(grab.width) * static_cast<std::size_t>(grab.height);
    grab.pixels.reserve(count);
    for (std::size_t i = 0; i < count; ++i) {
        grab.pixels.push_back(pixels[i] & 0xFFFFFFU);
    }
    return grab;
}

xcb_window_t Ground::makeWindow(int width, int height) const {
    const xcb_window_t window = xcb_generate_id(connection_);
    const std::uint32_t values[] = {0x305A8C, 1}; // a colour of no picture; left to no manager
    xcb_create_window(connection_, XCB_COPY_FROM_PARENT, window, screen_->root, 20, 20,
                      static_cast<std::uint16_t>(width), static_cast<std::uint16_t>(height), 0,
                      XCB_WINDOW_CLASS_INPUT_OUTPUT, XCB_COPY_FROM_PARENT,
                      XCB_CW_BACK_PIXEL | XCB_CW_OVERRIDE_REDIRECT,
                      static_cast<const std::uint32_t*>(values));
    xcb_map_window(connection_, window);
    grab(window); // the server has done all that by the time it answers
    return window;
}

void Ground::destroyWindow(xcb_window_t window) const {
    xcb_destroy_window(connection_, window);
    xcb_flush(connection_);
}

void Ground::resizeWindow(xcb_window_t window, int width, int height) const {
    const std::uint32_t size[] = {static_cast<std::uint32_t>(width),
                                  static_cast<std::uint32_t>(height)};
    xcb_configure_window(connection_, window, XCB_CONFIG_WINDOW_WIDTH | XCB_CONFIG_WINDOW_HEIGHT,
                         static_cast<const std::uint32_t*>(size));
    xcb_flush(connection_);
}

xcb_window_t Ground::childOf(xcb_window_t window) const {
    const std::unique_ptr<xcb_query_tree_reply_t, decltype(&std::free)> tree(
        xcb_query_tree_reply(connection_, xcb_query_tree(connection_, window), nullptr),
        &std::free);
    return tree == nullptr || tree->children_len == 0 ? 0 : *xcb_query_tree_children(tree.get());
}

void Ground::press(const std::string& key, xcb_window_t window) const {
    std::vector<std::string> command{"xdotool", "key"};
    if (window != 0) {
        command.insert(command.end(), {"--window", std::to_string(window)});
    }
    command.push_back(key);
    Process(command, environment(), root_).exitCode();
}

std::string Ground::settings() const {
    std::ifstream file(root_ / "config" / "dorbo" / "Dorbo95.ini", std::ios::binary);
    std::ostringstream text;
    text << file.rdbuf();
    return text.str();
}

void Ground::writeSettings(const std::string& text) const {
    std::ofstream(root_ / "config" / "dorbo" / "Dorbo95.ini", std::ios::binary) << text;
}

} // namespace ground
