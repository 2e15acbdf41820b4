// Acts shows out on a clock moved by hand, without a screen, and keeps the record of what happened:
// the saver's, the player's or the editor's own road from its window's creation on, the same each
// time for the same seed.
#pragma once

#include "cli/scene.h"
#include "platform/harness.h"

#include <cstdint>
#include <filesystem>
#include <functional>
#include <optional>
#include <string>
#include <vector>

/// An empty directory for Toons, which is the current one while this lives, and an empty home for
/// the settings; both are gone at the end. Throws a std::exception if they can't be made.
class ReplayGround {
  public:
    ReplayGround();
    ReplayGround(const ReplayGround&) = delete;
    ReplayGround& operator=(const ReplayGround&) = delete;
    ~ReplayGround();

    std::filesystem::path toons() const {
        return root_ / "toons";
    }

    std::filesystem::path settingsFile() const {
        return root_ / "home/dorbo/Dorbo95.ini";
    }

  private:
    std::filesystem::path before_;
    std::filesystem::path root_;
    std::optional<std::string> homeBefore_;
    bool lentRuntime_ = false;
};

/// Brings what outlives a stage to how it stands in a fresh process, so that the next stage doesn't
/// depend on those before it. The settings and the random numbers stay: a stage reads the first at
/// its start and seeds the second. For the time between two stages only.
void ForgetEarlierStages();

/// Who shows it: the saver, the player of a single Toon, which knows one show only, or the editor,
/// where a user acts. The editor's stage is as large as the screen lets it be: 750x700 on the one
/// that the toolkit gives us where there is none. Its main window and it are made at one moment,
/// from which times count.
enum class ReplayMode { saver, player, editor };

struct ReplayOptions {
    ReplayMode mode = ReplayMode::saver;
    std::vector<std::string>
        toons;        // files; copied into a directory of their own. None: walks about
    int width = 1024; // of the stage, in pixels; not of the editor's
    int height = 768;
    std::uint32_t seed = 1;  // of the random numbers
    int shows = 1;           // after how many ends of a show the stage closes; not the editor's
    std::uint32_t paces = 0; // the odometer at the start; 0 plays intro.zkt first
    std::int64_t longest = 24LL * 60 * 60 * 1000; // ms, after which the stage closes at the latest
    bool statements = true;                       // whether walks about use the table of statements
    std::vector<SceneStep> scene;                 // what is done in the editor
    bool anyName = true; // a Toon is played whatever its file is called; else as the saver finds it
};

/// Who is told of a show while it runs. What is empty isn't called.
struct ReplayHooks {
    /// Each line of the record.
    std::function<void(const std::string& line)> line = {};

    /// What has been drawn becomes visible: the moment in ms from the stage's creation on, the
    /// bounds of what was drawn, and the whole stage. More than one call of a moment: the last one
    /// stands.
    std::function<void(std::int64_t moment, const RECT& drawn, const seam::PixelView& stage)>
        picture = {};

    /// Asked before each moment at which something happens; false closes the stage.
    std::function<bool()> goesOn = {};
};

struct ReplayEnd {
    std::int64_t moment = 0; // at which the stage closed, in ms
    int shows = 0;           // that have ended
    std::string message;     // what the first message box said; empty if none came up
};

/// Acts shows out as the saver or the player does, or a scene of the editor, of which a step comes
/// after all that falls due at its moment. A stage that stands still for good, as after a
/// Toon that doesn't load, or a scene's last step, is closed; message boxes are answered with OK,
/// file dialogs as the scene says. The settings are those of a fresh user and lie in a directory
/// that goes at the end. What a hook throws closes the stage and is passed on, but for `line`,
/// which must not throw. Throws a std::exception that tells why if the files can't be copied or
/// there is no room for the stage.
ReplayEnd Replay(const ReplayOptions& options, const ReplayHooks& hooks);
