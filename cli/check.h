// Tells what the saver would do with a Toon file, without a screen.
#pragma once

#include "cli/toon_record.h"

#include <optional>
#include <string>
#include <vector>

struct ToonReport {
    bool loads = false; // what follows is known
    std::int64_t frames = 0;
    std::int64_t pauses = 0;       // seconds of them all
    std::optional<double> seconds; // that the show lasts, if it comes to an end
    std::vector<Finding> findings; // in the order of the file

    /// Whether anything is wrong.
    bool faulty() const;
};

/// Reads a file and acts it out on a stage of 1024 x 768 for up to four hours of the show's time.
/// Throws a std::exception if that can't be done.
ToonReport CheckToon(const std::string& path);

/// Whether the saver and the editor open the file: they open what they may write, root or not.
bool MayBeWritten(const std::string& path);

/// Reads a file that can be acted out; else gives why it can't, as "FILE: reason".
std::string ReadPlayable(const std::string& path, Toon& toon);

/// Which of the files is no Toon that can be acted out and why, as "FILE: reason"; empty if all
/// are.
std::string WhyUnplayable(const std::vector<std::string>& paths);

/// `toon check [--json] FILE.zkt...`: prints what was found, a line each; gives the exit code.
int CheckCommand(const std::vector<std::string>& arguments);
