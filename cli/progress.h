// A bar on the terminal that tells how far a command has come.
#pragma once

#include <chrono>
#include <cstdint>
#include <string>

/// Shows itself on stderr if that is a terminal, a few times a second, and goes with its record.
class Progress {
  public:
    Progress(std::string what, std::int64_t whole);
    Progress(const Progress&) = delete;
    Progress& operator=(const Progress&) = delete;
    ~Progress();

    void show(std::int64_t done);

  private:
    using Clock = std::chrono::steady_clock;

    std::string what_;
    std::int64_t whole_;
    bool onTerminal_;
    Clock::time_point next_;
    bool shown_ = false;
};
