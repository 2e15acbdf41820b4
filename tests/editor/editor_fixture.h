// The editor's windows on a screen of 800x800 that nobody sees, a clock moved by hand, and a user
// who presses, clicks and chooses files.
#pragma once

#include "cli/replay.h"
#include "editor/chrome.h"
#include "editor/command_ids.h"
#include "editor/editor_shell.h"
#include "tests/recorded_stage.h"
#include "toon/toon_document.h"

#include <memory>

class QWidget;
class QWindow;

/// What the editor can be at, and what goes with it.
struct EditorState {
    std::string name;
    std::string event; // that brings it, after a press or a click
    std::string looks; // as EditorTest::looks() tells them
};

extern const std::vector<EditorState> editorStates;

QWidget& widgetOf(HWND window);
QWindow* toolkitWindowOf(HWND window);

bool editorStands();
HWND modalDialog(); ///< one that keeps its caller waiting; null where there is none
bool dialogStands();

class EditorTest : public RecordedStage {
  protected:
    void SetUp() override;
    void TearDown() override;

    void open();
    void openAtRest(); ///< he has come and gone
    void close();
    static int runEditor(); ///< in its own loop, until it is closed

    /// Opens an editor, a Toon in it, and brings it into one of the states by what a user does.
    void reach(const std::string& state);

    /// What there is of a show, the label of Play, and which buttons can be pressed: File, Play and
    /// Walk, with which minimise goes.
    static std::string looks();
    static std::string looksOf(const std::string& state);

    /// That nothing is left of a run of the editor.
    static void expectClosed(const std::string& how);

    // What a user does, with the toolkit's own events; what it leads to has happened then.
    static void press(HWND button);
    static void click(int x, int y);
    static void key(int command);
    static void openToon(const std::string& name);

    /// Recorded on a stage of twice the size.
    static void putToon(const std::string& name, const std::vector<ToonFrame>& frames) {
        writeToon(name, frames, "", MAKELONG(1500, 1400));
    }

    static void putToons(); ///< two.zkt, one.zkt, still.zkt, and none.zkt, which is none

    static inline int filesAsked;
    static inline std::string fileGiven; // empty: the dialog is cancelled
    static inline std::string nameGiven; // the same where it asks under which name to save
    static inline int answerGiven;       // to a question
    static inline std::vector<std::string> boxes;

  private:
    std::unique_ptr<ReplayGround> ground_;
};
