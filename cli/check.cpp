#include "cli/check.h"

#include "cli/help.h"
#include "cli/interruption.h"
#include "cli/json_text.h"
#include "cli/replay.h"
#include "cli/show_write.h"

#include "stage/walk.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cinttypes>
#include <cmath>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <exception>
#include <filesystem>

namespace {

constexpr std::int64_t longestShow = 4LL * 60 * 60 * 1000; // ms

// ---- The show ---------------------------------------------------------------------------------

/// What the record of a show tells.
struct ActedShow {
    bool chosen = false; // the saver took it for a Toon
    bool loaded = false;
    bool ended = false;
    std::int64_t last = 0;     // ms
    std::int64_t pauseDue = 0; // ms, when the pause under way would end; 0 without one
    std::size_t frame = 0;     // last gone for, from 1
    bool leaves = false;
    std::vector<Finding> findings;
};

void TakeWalk(ActedShow& show, POINT from, POINT to) {
    const std::int64_t strides = StridesWanted(from.x, from.y, to.x, to.y, WALK_STRIDE);
    if (strides > WALK_MOST_STRIDES) {
        const char* which = show.leaves ? "the walk off" : "the walk to it";
        show.findings.push_back({show.frame, "",
                                 std::string(which) + " would take " + std::to_string(strides) +
                                     " strides; he takes " + std::to_string(WALK_MOST_STRIDES) +
                                     ", each longer"});
    }
}

void TakeLine(ActedShow& show, const std::string& line) {
    constexpr std::string_view message = "message text=";
    constexpr std::string_view choice = "choice file=";
    const char* event = line.c_str() + std::min(line.find(' ') + 1, line.size());
    const std::string_view words = event;
    unsigned index = 0;
    std::int64_t interval = 0;
    POINT from{};
    POINT to{};
    std::sscanf(line.c_str(), "t=%" SCNd64, &show.last);
    if (std::sscanf(event, "frame index=%u", &index) == 1) {
        show.frame = index + 1;
    } else if (std::sscanf(event, "walk from=[%d,%d] to=[%d,%d]", &from.x, &from.y, &to.x, &to.y) ==
               4) {
        TakeWalk(show, from, to);
    } else if (std::sscanf(event, "timer_set timer=PAUSE id=%*u ms=%" SCNd64, &interval) == 1) {
        show.pauseDue = show.last + interval;
    } else if (words == "tick timer=PAUSE") {
        show.pauseDue = 0;
    } else if (words.starts_with("walk_off ")) {
        show.leaves = true;
    } else if (words.starts_with("load ")) {
        show.loaded = true;
    } else if (words.starts_with(message)) {
        const std::string said(words.substr(message.size()));
        show.findings.push_back({0, "", "the saver says \"" + said + "\""});
    } else if (words.starts_with(choice)) {
        show.chosen = show.chosen || words.size() > choice.size();
    } else if (words == "show_done") {
        show.ended = true;
    }
}

ActedShow ActOut(const std::string& path) {
    ReplayOptions options;
    options.toons = {std::filesystem::absolute(path)};
    options.longest = longestShow;
    options.anyName = false;
    ActedShow show;
    ReplayHooks hooks;
    hooks.line = [&](const std::string& line) { TakeLine(show, line); };
    hooks.goesOn = [] { return Interruption() == 0; };
    Replay(options, hooks);
    return show;
}

/// Whether something would have happened behind the last line of a show that hasn't ended.
bool GoesOn(const ActedShow& show) {
    constexpr std::int64_t longestStep = 500; // ms, while he walks, arrives or talks
    return show.pauseDue > longestShow || show.last + longestStep >= longestShow;
}

void AddShow(ToonReport& report, const std::string& path) {
    const ActedShow show = ActOut(path);
    auto& findings = report.findings;
    if (!show.chosen) {
        findings.push_back({0, "",
                            Advice("the saver passes over a file of this name",
                                   "a name that ends in .zkt, of up to 127 bytes,")});
        return;
    }
    findings.insert(findings.end(), show.findings.begin(), show.findings.end());
    if (!show.loaded) {
        findings.push_back({0, "", "the saver doesn't load it"});
    } else if (show.ended) {
        constexpr double second = 1000;
        report.seconds = static_cast<double>(show.last) / second;
    } else if (GoesOn(show)) {
        findings.push_back({show.frame, "", "the show still goes on here after four hours", false});
    } else {
        findings.push_back({show.frame, "", "he stands still here for ever"});
    }
}

// ---- The file ---------------------------------------------------------------------------------

/// A file that ends within a frame.
void CheckSize(ToonReport& report, std::size_t size) {
    const std::size_t rest = (size - sizeof(ToonHeader)) % sizeof(ToonFrame);
    if (rest == sizeof(ToonFrame) - 1) {
        report.findings.push_back({0, "", "its last byte is missing, and counts as zero"});
    } else if (rest != 0) {
        report.findings.push_back({0, "",
                                   "it has " + Counted(static_cast<std::int64_t>(rest), "byte") +
                                       " too many behind its last whole frame"});
    }
}

/// Tells if bytes stand behind a text's NUL, or in its place.
void CheckBehindText(ToonReport& report, std::size_t frame, const Field& field,
                     const char* record) {
    const char* begin = record + field.offset;
    const char* end = begin + field.size;
    const char* behind = begin + TextOf(field, record).size();
    if (std::any_of(behind, end, [](char byte) { return byte != '\0'; })) {
        const bool closed = *behind == '\0';
        report.findings.push_back({frame, field.name,
                                   closed ? "bytes stand behind its NUL, which nobody reads"
                                          : "it has no NUL; its last byte gives way to one",
                                   false});
    }
}

/// What no loader looks at.
void CheckUnseen(ToonReport& report, const Toon& toon) {
    const auto count = static_cast<std::int64_t>(toon.frames.size());
    for (const Field& field : headerFields) {
        if (field.kind == FieldKind::text) {
            CheckBehindText(report, 0, field, BytesOf(toon.header));
        }
    }
    if (TextOf(headerFields.front(), BytesOf(toon.header)) != ToonMagic) {
        report.findings.push_back({0, "magic", "it is not the usual one", false});
    }
    if (toon.header.frameCount != count) {
        report.findings.push_back({0, "",
                                   "the header counts " + Counted(toon.header.frameCount, "frame") +
                                       ", the file has " + std::to_string(count),
                                   false});
    }
    for (std::size_t i = 0; i < toon.frames.size(); ++i) {
        CheckBehindText(report, i + 1, frameFields.back(), BytesOf(toon.frames[i]));
        if (toon.frames[i].reserved != 0) {
            report.findings.push_back({i + 1, "", "its reserved bytes aren't zero", false});
        }
    }
}

void AddFindings(ToonReport& report, std::vector<Finding> found) {
    report.findings.insert(report.findings.end(), found.begin(), found.end());
}

} // namespace

bool MayBeWritten(const std::string& path) {
    constexpr mode_t anybodyWrites = S_IWUSR | S_IWGRP | S_IWOTH;
    struct stat status = {};
    return stat(path.c_str(), &status) == 0 && (status.st_mode & anybodyWrites) != 0 &&
           faccessat(AT_FDCWD, path.c_str(), W_OK, AT_EACCESS) == 0;
}

bool ToonReport::faulty() const {
    return std::any_of(findings.begin(), findings.end(),
                       [](const Finding& finding) { return finding.fault; });
}

ToonReport CheckToon(const std::string& path) {
    ToonReport report;
    Toon toon{};
    std::size_t size = 0;
    const std::string error = ReadToon(path, toon, size);
    if (!error.empty()) {
        report.findings.push_back({0, "", error});
        return report;
    }
    report.loads = true;
    report.frames = static_cast<std::int64_t>(toon.frames.size());
    for (const ToonFrame& frame : toon.frames) {
        report.pauses += std::max<LONG>(frame.pause, 0);
    }
    CheckSize(report, size);
    AddFindings(report, OddValues(toon));
    CheckUnseen(report, toon);
    if (!MayBeWritten(path)) {
        report.findings.push_back({0, "", "it is read-only; the saver loads no such file"});
    } else if (!toon.frames.empty()) {
        AddShow(report, path);
    }
    return report;
}

// ---- The command ------------------------------------------------------------------------------

namespace {

std::string Summary(const ToonReport& report) {
    std::string text = Counted(report.frames, "frame");
    if (report.seconds) {
        text += ", " + Counted(std::llround(*report.seconds), "second") + " (" +
                std::to_string(report.pauses) + " of pauses)";
    }
    return text;
}

void PrintLines(const std::string& path, const ToonReport& report) {
    for (const Finding& finding : report.findings) {
        std::printf("%s: %s%s%s\n", path.c_str(),
                    finding.fault ? "" : "note: ", Where(finding.frame, finding.field).c_str(),
                    finding.what.c_str());
    }
    if (report.loads) {
        std::printf("%s: %s\n", path.c_str(), Summary(report).c_str());
    }
}

void PrintJsonFinding(const Finding& finding) {
    std::printf("{\"fault\": %s, ", finding.fault ? "true" : "false");
    if (finding.frame != 0) {
        std::printf("\"frame\": %zu, ", finding.frame);
    }
    if (!finding.field.empty()) {
        std::printf("\"field\": %s, ", JsonText(finding.field).c_str());
    }
    std::printf("\"what\": %s}", JsonText(finding.what).c_str());
}

void PrintJson(const std::string& path, const ToonReport& report) {
    std::printf("  {\n    \"file\": %s,\n    \"ok\": %s,\n", JsonText(path).c_str(),
                report.faulty() ? "false" : "true");
    if (report.loads) {
        std::printf("    \"frames\": %" PRId64 ",\n    \"pauses\": %" PRId64 ",\n", report.frames,
                    report.pauses);
    }
    if (report.seconds) {
        std::printf("    \"seconds\": %.3f,\n", *report.seconds);
    }
    std::printf("    \"findings\": [");
    const char* between = "\n      ";
    for (const Finding& finding : report.findings) {
        std::fputs(between, stdout);
        PrintJsonFinding(finding);
        between = ",\n      ";
    }
    std::printf("%s]\n  }", report.findings.empty() ? "" : "\n    ");
}

} // namespace

namespace {

ToonReport CheckOrTell(const std::string& file) {
    try {
        return CheckToon(file);
    } catch (const std::exception& error) {
        ToonReport report;
        report.findings.push_back({0, "", std::string("it can't be acted out: ") + error.what()});
        return report;
    }
}

/// Prints what is found of each file, up to the one that is under way when a signal comes. Whether
/// any is faulty.
bool PrintAll(const std::vector<std::string>& files, bool json) {
    bool faulty = false;
    const char* between = "[\n";
    for (const std::string& file : files) {
        const ToonReport report = CheckOrTell(file);
        if (Interruption() != 0) {
            return faulty;
        }
        faulty = faulty || report.faulty();
        if (json) {
            std::fputs(between, stdout);
            between = ",\n";
            PrintJson(file, report);
        } else {
            PrintLines(file, report);
        }
    }
    if (json) {
        std::fputs("\n]\n", stdout);
    }
    return faulty;
}

} // namespace

std::string ReadPlayable(const std::string& path, Toon& toon) {
    std::size_t size = 0;
    std::string error = ReadToon(path, toon, size);
    if (error.empty() && toon.frames.empty()) {
        error = "it has no frame";
    }
    return error.empty() ? "" : std::string(path).append(": ").append(error);
}

std::string WhyUnplayable(const std::vector<std::string>& paths) {
    for (const std::string& path : paths) {
        Toon toon{};
        std::string error = ReadPlayable(path, toon);
        if (!error.empty()) {
            return error;
        }
    }
    return "";
}

int CheckCommand(const std::vector<std::string>& arguments) {
    std::vector<std::string> files = arguments;
    const bool json = std::erase(files, "--json") != 0;
    const auto option = std::find_if(
        files.begin(), files.end(), [](const std::string& file) { return file.starts_with("--"); });
    if (option != files.end()) {
        return TellWrongUsage("check", *option + " is no option");
    }
    if (files.empty()) {
        return TellWrongUsage("check", "it takes a FILE.zkt");
    }
    setenv("QT_QPA_PLATFORM", "offscreen", 1);
    setenv("DORBO_SCALE", "1", 1);
    CatchInterruptions();
    const bool faulty = PrintAll(files, json);
    const bool printed = std::fflush(stdout) == 0 && std::ferror(stdout) == 0;
    if (Interruption() != 0) {
        return EndBySignal(Interruption());
    }
    if (!printed) {
        const int error = errno;
        std::fprintf(stderr, "toon check: the report can't be printed: %s\n", std::strerror(error));
        return error == EPIPE ? EndBySignal(SIGPIPE) : 1;
    }
    return faulty ? 1 : 0;
}
