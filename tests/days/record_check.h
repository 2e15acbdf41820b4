// Holds the record of a saver's shows against what its own plans say: where he is drawn and when,
// which timers tick, what his odometer counts.
#pragma once

#include "platform/types.h"

#include <cstdint>
#include <map>
#include <optional>
#include <set>
#include <string>
#include <string_view>
#include <vector>

class RecordCheck {
  public:
    RecordCheck(SIZE stage, std::uint32_t paces) : stage_(stage), odometer_(paces) {}

    /// Takes the next line of the record.
    void take(const std::string& line);

    /// The stage has gone, and its timers with it; the clock goes on.
    void stageGone();

    /// What didn't hold, in words; the first ones only.
    const std::vector<std::string>& faults() const {
        return faults_;
    }

    /// Adds a fault, of the line taken last, unless this holds.
    void expect(bool holds, const std::string& what);

    std::uint32_t odometer() const {
        return odometer_;
    }

    /// What has been seen so far. A check that has seen nothing has checked nothing.
    struct Seen {
        std::uint64_t lines = 0;
        std::uint64_t toons = 0;
        std::uint64_t walksAbout = 0;
        std::uint64_t walks = 0;
        std::uint64_t draws = 0;
        std::uint64_t ticks = 0;
        std::uint64_t wraps = 0;     // of the odometer
        std::uint64_t told = 0;      // how often he told of his paces
        std::uint64_t toldAfter = 0; // and after the first wrap
    };

    const Seen& seen() const {
        return seen_;
    }

  private:
    struct Timer {
        std::int64_t interval;
        std::int64_t due;
    };

    /// A walk under way, worked out here from where it goes from and to.
    struct Walk {
        std::int64_t begun; // ms
        std::int64_t interval;
        POINT start; // where he was drawn before its first step
        POINT stride;
        LONG strides;
        bool toRight;
        LONG pose;
        LONG shown = 0; // the entry drawn last
    };

    void timerSet();
    void timerKilled();
    void ticked();
    void placed();
    void chosen();
    void planned();
    void drawn();
    void arrived();
    void ended();
    void spoken();

    Walk plan(POINT from, POINT to) const;
    POINT scaled(POINT place) const;
    LONG side(LONG x) const;
    std::string pictureOf(const Walk& walk, LONG entry) const;
    void countPaces(LONG last);
    void walkTarget(POINT to);

    std::string_view value(std::string_view key) const;
    std::int64_t number(std::string_view key) const;
    POINT point(std::string_view key) const;

    SIZE stage_;
    std::uint32_t odometer_;
    std::uint32_t pacesToTell_ = 0;
    std::string line_;
    std::string_view event_;
    std::int64_t now_ = 0;
    std::map<std::string, Timer, std::less<>> timers_;
    std::optional<std::set<std::string>> timersAtEnd_; // of the first show
    std::optional<Walk> walk_;
    POINT drawn_{};               // where he is drawn
    POINT aimed_{};               // where the next walk is planned from
    std::optional<POINT> target_; // that the next walk has to go to
    std::optional<POINT> about_;  // the place of the walk about that hasn't gone out yet
    Seen seen_;
    std::vector<std::string> faults_;
};
