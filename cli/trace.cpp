#include "cli/trace.h"

#include "cli/check.h"
#include "cli/help.h"
#include "cli/interruption.h"
#include "cli/options.h"
#include "platform/codepage.h"

#include <cerrno>
#include <csignal>
#include <cstdio>
#include <cstring>
#include <exception>
#include <fstream>
#include <stdexcept>

static std::string readTraceArguments(const std::vector<std::string>& line,
                                      StageArguments& arguments) {
    std::string wrong = ReadArguments(line,
                                      {optionSize, optionSeed, optionShows, optionPaces,
                                       optionTraceMode, optionScript, optionWalkAbout},
                                      arguments);
    const bool edits = arguments.stage.mode == ReplayMode::editor;
    if (wrong.empty() && !edits && !arguments.script.empty()) {
        return "--script is for --mode editor";
    }
    if (wrong.empty() && !edits && arguments.names.empty() && !arguments.walkAbout) {
        return "it takes a Toon, or --walk-about";
    }
    if (!arguments.walkAbout) {
        arguments.stage.toons = arguments.names;
    }
    return wrong;
}

static int fail(const std::string& what) {
    std::fprintf(stderr, "toon trace: %s\n", what.c_str());
    return 1;
}

static std::vector<SceneStep> readScript(const std::string& file) {
    std::ifstream in(file);
    if (!in) {
        throw std::runtime_error(file + ": it can't be read");
    }
    return ReadScene(in, file);
}

/// A line as people read it: what he says is UTF-8, and stands on one line whatever it holds.
static std::string shownLine(const std::string& line) {
    const std::size_t key = line.find(" text=");
    if (key == std::string::npos) {
        return line;
    }
    std::string shown = line;
    if (line.find(" bubble_show ") < key) {
        shown = line.substr(0, key) + seam::utf8FromWindows1252(line.substr(key));
    }
    for (std::size_t at = 0; (at = shown.find('\n', at)) != std::string::npos; at += 2) {
        shown.replace(at, 1, "\\n");
    }
    return shown;
}

/// Prints the record. Whoever reads it may go before its end, as `head` does.
static int printTrace(const ReplayOptions& options) {
    int error = 0;
    ReplayHooks hooks;
    hooks.line = [&](const std::string& line) {
        if (error == 0 && std::puts(shownLine(line).c_str()) < 0) {
            error = errno;
        }
    };
    hooks.goesOn = [&] { return error == 0 && Interruption() == 0; };
    const ReplayEnd end = Replay(options, hooks);
    if (error == 0 && std::fflush(stdout) != 0) {
        error = errno;
    }
    if (Interruption() != 0 || error == EPIPE) {
        return EndBySignal(error == EPIPE ? SIGPIPE : Interruption());
    }
    if (error != 0) {
        return fail(std::string("the record can't be written: ") + std::strerror(error));
    }
    const bool plays = options.mode != ReplayMode::editor; // where a box is part of the scene
    return end.message.empty() || !plays ? 0 : fail("the saver says: " + end.message);
}

int TraceCommand(const std::vector<std::string>& line) {
    StageArguments arguments;
    const std::string wrong = readTraceArguments(line, arguments);
    if (!wrong.empty()) {
        return TellWrongUsage("trace", wrong);
    }
    const bool plays = arguments.stage.mode != ReplayMode::editor;
    const std::string unplayable = plays ? WhyUnplayable(arguments.stage.toons) : "";
    if (!unplayable.empty()) {
        return fail(unplayable);
    }
    CatchInterruptions();
    try {
        if (!arguments.script.empty()) {
            arguments.stage.scene = readScript(arguments.script);
        }
        return printTrace(arguments.stage);
    } catch (const std::exception& error) {
        return fail(error.what());
    }
}
