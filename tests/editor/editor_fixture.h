// The editor's windows on a screen of 800x800 that nobody sees, a clock moved by hand, and a user
// who presses, clicks and chooses files.
#pragma once

#include "cli/replay.h"
#include "editor/chrome.h"
#include "editor/command_ids.h"
#include "editor/editor_shell.h"
#include "tests/recorded_stage.h"
#include "toon/toon_document.h"

#include <QEvent>
#include <QPoint>

#include <functional>
#include <memory>
#include <set>

class QWidget;

enum class NextFrame { none, behind, at }; // 0; behind a frame of the Toon; at one

/// What the editor can be at, and what goes with it.
struct EditorState {
    const char* name;
    DWORD showStarted;
    DWORD awaitingArrival;
    DWORD playIdle;
    NextFrame next;
    DWORD about; // RandomWalkActive
    const char* label;
    std::set<std::string> timers; // TALK may run beside PAUSE, OPENING beside all
    const char* enabled;          // buttons: File, Play, Walk; minimise goes with Walk
    const char* afterPlay;        // what a press of Play brings about
};

extern const std::vector<EditorState> editorStates;

/// What a window shows of itself, and takes from a user's mouse.
QWidget& widgetOf(HWND window);
void sendMouse(HWND window, QEvent::Type type, QPoint point);

/// Acts within a loop of the program's, as soon as `stands` says so.
void once(const std::function<bool()>& stands, const std::function<void()>& act);

bool editorStands();

class EditorTest : public RecordedStage {
  protected:
    void SetUp() override;
    void TearDown() override;

    void open();
    void openAtRest(); ///< he has come and gone
    void close();

    /// Opens an editor, a Toon in it, and brings it into one of the states by what a user does.
    void reach(const std::string& state);

    /// Which of the states this is, by its variables, its label, its timers and its buttons; a
    /// description of what there is where it is none.
    static std::string stateNow();

    /// That the frame editor has shut Play, or its end has opened it; a load is seen without this.
    static void playIsAlive(bool alive);

    // What a user does, with the toolkit's own events; what it leads to has happened then.
    static void press(HWND button);
    static void click(int x, int y);
    static void key(int command);
    static void openToon(const std::string& name);

    std::filesystem::path toons() const {
        return ground_->toons();
    }

    /// Recorded on a stage of twice the size.
    void putToon(const std::string& name, const std::vector<ToonFrame>& frames) const {
        writeToon(toons() / name, frames, "", MAKELONG(1500, 1400));
    }

    void putToons() const; ///< two.zkt, one.zkt, still.zkt, and none.zkt, which is none

    static inline int filesAsked;
    static inline std::string fileGiven; // empty: the dialog is cancelled
    static inline std::string nameGiven; // the same where it asks under which name to save
    static inline int answerGiven;       // to a question
    static inline std::vector<std::string> boxes;

  private:
    std::unique_ptr<ReplayGround> ground_;
};
