#include "tests/program/ground.h"

#include <chrono>
#include <csignal>
#include <cstdlib>
#include <stdexcept>
#include <thread>

namespace ground {

namespace fs = std::filesystem;

namespace {

/// What the server answers, freed at the end.
template <class Answer>
std::unique_ptr<Answer, decltype(&std::free)> owned(Answer* answer) {
    return {answer, &std::free};
}

QString text(const std::string& plain) {
    return QString::fromStdString(plain);
}

xcb_atom_t atomOf(xcb_connection_t* connection, const std::string& name) {
    const auto intern =
        xcb_intern_atom(connection, 0, static_cast<std::uint16_t>(name.size()), name.c_str());
    return owned(xcb_intern_atom_reply(connection, intern, nullptr))->atom;
}

/// Asks the window manager how large a frame this window would have; whether it has told that. One
/// that is still starting has its name on the screen already, but may lose what it is asked.
bool managerAnswers(xcb_connection_t* connection, xcb_window_t root, xcb_window_t window) {
    xcb_client_message_event_t question{};
    question.response_type = XCB_CLIENT_MESSAGE;
    question.format = 32;
    question.window = window;
    question.type = atomOf(connection, "_NET_REQUEST_FRAME_EXTENTS");
    xcb_send_event(connection, 0, root, XCB_EVENT_MASK_SUBSTRUCTURE_REDIRECT,
                   reinterpret_cast<const char*>(&question));
    const auto get =
        xcb_get_property(connection, 0, window, atomOf(connection, "_NET_FRAME_EXTENTS"),
                         XCB_GET_PROPERTY_TYPE_ANY, 0, 1);
    const auto answer = owned(xcb_get_property_reply(connection, get, nullptr));
    return answer != nullptr && answer->value_len > 0;
}

} // namespace

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

QProcessEnvironment environmentFor(const std::string& display) {
    QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
    environment.remove(text("QT_QPA_PLATFORM"));
    environment.remove(text("WAYLAND_DISPLAY"));
    environment.insert(text("DISPLAY"), text(display));
    return environment;
}

QImage loadPicture(const std::string& name) {
    const QImage picture(text(DORBO_SOURCE_DIR "/resources/bitmaps/" + name + ".bmp"));
    if (picture.isNull()) {
        throw std::runtime_error("no picture " + name);
    }
    return picture.convertToFormat(QImage::Format_RGB32);
}

Process::Process(const std::vector<std::string>& command, const QProcessEnvironment& environment,
                 const fs::path& directory) {
    QStringList arguments;
    for (const std::string& argument : command) {
        arguments.push_back(text(argument));
    }
    process_.setProgram(arguments.takeFirst());
    process_.setArguments(arguments);
    process_.setProcessEnvironment(environment);
    process_.setWorkingDirectory(text(directory));
    process_.setProcessChannelMode(QProcess::ForwardedErrorChannel);
    process_.start();
    if (!process_.waitForStarted()) {
        throw std::runtime_error("can't start " + command.front());
    }
}

Process::~Process() {
    process_.kill();
    process_.waitForFinished();
}

bool Process::running() {
    process_.waitForFinished(0);
    return process_.state() != QProcess::NotRunning;
}

int Process::exitCode() {
    if (!waitFor([this] { return !running(); })) {
        return -2;
    }
    return process_.exitStatus() == QProcess::NormalExit ? process_.exitCode() : -1;
}

void Process::signal(int number) {
    if (running()) {
        kill(static_cast<pid_t>(process_.processId()), number);
    }
}

std::string Process::readLine() {
    while (!process_.canReadLine() && process_.waitForReadyRead()) {
    }
    return process_.readLine().trimmed().toStdString();
}

Ground::Ground(int width, int height) {
    fs::create_directories(settings().parent_path());
    fs::create_directories(toons());
    environment_ = environmentFor("");
    environment_.insert(text("HOME"), text(home()));
    environment_.insert(text("XDG_CONFIG_HOME"), text(home() / "config"));
    environment_.insert(text("XDG_DATA_HOME"), text(home() / "data"));
    environment_.insert(text("XDG_RUNTIME_DIR"), text(home()));
    environment_.insert(text("UBSAN_OPTIONS"), text("print_stacktrace=1"));
    const std::string size = std::to_string(width) + "x" + std::to_string(height) + "x24";
    // The server picks a free display and tells which on its output.
    server_ =
        std::make_unique<Process>(std::vector<std::string>{"Xvfb", "-displayfd", "1", "-screen",
                                                           "0", size, "-nolisten", "tcp"},
                                  environment_, home());
    const std::string display = ":" + server_->readLine();
    environment_.insert(text("DISPLAY"), text(display));
    connection_ = xcb_connect(display.c_str(), nullptr);
    if (xcb_connection_has_error(connection_) != 0) {
        throw std::runtime_error("no connection to Xvfb");
    }
    screen_ = xcb_setup_roots_iterator(xcb_get_setup(connection_)).data;
    manager_ = std::make_unique<Process>(std::vector<std::string>{"openbox"}, environment_, home());
    const xcb_window_t window = makeWindow(1, 1);
    if (!waitFor([&] { return managerAnswers(connection_, screen_->root, window); })) {
        throw std::runtime_error("openbox doesn't start");
    }
    destroyWindow(window);
}

Ground::~Ground() {
    xcb_disconnect(connection_);
    for (Process* process : {manager_.get(), server_.get()}) {
        process->signal(SIGTERM);
        process->exitCode();
    }
}

Process Ground::start(const std::vector<std::string>& arguments) const {
    std::vector<std::string> command{DORBO_PROGRAM};
    command.insert(command.end(), arguments.begin(), arguments.end());
    return launch(command);
}

QImage Ground::grab(xcb_window_t window) const {
    const xcb_window_t from = window == 0 ? screen_->root : window;
    const auto geometry =
        owned(xcb_get_geometry_reply(connection_, xcb_get_geometry(connection_, from), nullptr));
    if (geometry == nullptr) {
        return {};
    }
    const auto get = xcb_get_image(connection_, XCB_IMAGE_FORMAT_Z_PIXMAP, from, 0, 0,
                                   geometry->width, geometry->height, ~0U);
    const auto image = owned(xcb_get_image_reply(connection_, get, nullptr));
    if (image == nullptr) {
        return {};
    }
    return QImage(xcb_get_image_data(image.get()), geometry->width, geometry->height,
                  geometry->width * 4, QImage::Format_RGB32)
        .copy();
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
    const auto tree =
        owned(xcb_query_tree_reply(connection_, xcb_query_tree(connection_, window), nullptr));
    return tree == nullptr || tree->children_len == 0 ? 0 : *xcb_query_tree_children(tree.get());
}

bool Ground::clickReaches(xcb_window_t window) const {
    const std::uint32_t mask = XCB_EVENT_MASK_BUTTON_PRESS;
    xcb_change_window_attributes(connection_, window, XCB_CW_EVENT_MASK, &mask);
    const QSize size = grab(window).size();
    command({"xdotool", "mousemove", "--window", std::to_string(window),
             std::to_string(size.width() / 2), std::to_string(size.height() / 2), "click", "1"});
    const auto told = [&] {
        const auto event = owned(xcb_poll_for_event(connection_));
        return event != nullptr && (event->response_type & 0x7F) == XCB_BUTTON_PRESS;
    };
    const auto pointer = owned(
        xcb_query_pointer_reply(connection_, xcb_query_pointer(connection_, window), nullptr));
    return waitFor(told, 5) && pointer != nullptr && pointer->child == 0;
}

void Ground::press(const std::string& key, xcb_window_t window) const {
    std::vector<std::string> command{"xdotool", "key"};
    if (window != 0) {
        command.insert(command.end(), {"--window", std::to_string(window)});
    }
    command.push_back(key);
    this->command(command);
}

Process Ground::launch(const std::vector<std::string>& words) const {
    return {words, environment_, toons()};
}

int Ground::command(const std::vector<std::string>& words) const {
    return launch(words).exitCode();
}

void Ground::typeInto(const std::string& title, const std::string& text) const {
    // It gives up over a window that goes while it looks: then once more.
    waitFor([&] {
        return command({"xdotool", "search", "--sync", "--onlyvisible", "--name", title,
                        "windowfocus", "--sync"}) == 0;
    });
    command({"xdotool", "type", text});
    press("Return");
}

bool Ground::takeInput() const {
    const auto keyboard = owned(
        xcb_grab_keyboard_reply(connection_,
                                xcb_grab_keyboard(connection_, 0, screen_->root, XCB_CURRENT_TIME,
                                                  XCB_GRAB_MODE_ASYNC, XCB_GRAB_MODE_ASYNC),
                                nullptr));
    return keyboard != nullptr && keyboard->status == XCB_GRAB_STATUS_SUCCESS && takePointer();
}

bool Ground::takePointer() const {
    const auto pointer = owned(xcb_grab_pointer_reply(
        connection_,
        xcb_grab_pointer(connection_, 0, screen_->root, 0, XCB_GRAB_MODE_ASYNC, XCB_GRAB_MODE_ASYNC,
                         XCB_NONE, XCB_NONE, XCB_CURRENT_TIME),
        nullptr));
    return pointer != nullptr && pointer->status == XCB_GRAB_STATUS_SUCCESS;
}

void Ground::giveInputBack() const {
    xcb_ungrab_keyboard(connection_, XCB_CURRENT_TIME);
    xcb_ungrab_pointer(connection_, XCB_CURRENT_TIME);
    xcb_flush(connection_);
}

void Ground::focus(xcb_window_t window) const {
    xcb_set_input_focus(connection_, XCB_INPUT_FOCUS_NONE, window, XCB_CURRENT_TIME);
    grab(); // the server has done that by the time it answers
}

QPoint Ground::pointer() const {
    const auto asked = xcb_query_pointer(connection_, screen_->root);
    const auto told = owned(xcb_query_pointer_reply(connection_, asked, nullptr));
    return told == nullptr ? QPoint(-1, -1) : QPoint(told->root_x, told->root_y);
}

void Ground::loseManager() {
    manager_->signal(SIGTERM);
    manager_->exitCode();
}

void Ground::loseDisplay() {
    server_->signal(SIGKILL);
    server_->exitCode();
}

} // namespace ground
