#include "tests/days/record_check.h"

#include "platform/harness.h"
#include "saver/show_cycle.h"
#include "stage/random_walk.h"
#include "toon/toon_document.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <utility>

namespace {

constexpr std::size_t mostFaults = 20;
constexpr LONG mostStrides = 248;

bool same(POINT left, POINT right) {
    return left.x == right.x && left.y == right.y;
}

std::string text(POINT point) {
    return '[' + std::to_string(point.x) + ',' + std::to_string(point.y) + ']';
}

template <typename Number>
Number parsed(std::string_view digits) {
    Number number = 0;
    std::from_chars(digits.data(), digits.data() + digits.size(), number);
    return number;
}

} // namespace

void RecordCheck::expect(bool holds, const std::string& what) {
    if (!holds && faults_.size() < mostFaults) {
        faults_.push_back(what + ": " + line_);
    }
}

std::string_view RecordCheck::value(std::string_view key) const {
    const std::string sought = ' ' + std::string(key) + '=';
    const std::size_t found = line_.find(sought);
    if (found == std::string::npos) {
        return {};
    }
    const std::size_t begin = found + sought.size();
    return std::string_view(line_).substr(begin, line_.find(' ', begin) - begin);
}

std::int64_t RecordCheck::number(std::string_view key) const {
    return parsed<std::int64_t>(value(key));
}

POINT RecordCheck::point(std::string_view key) const {
    const std::string_view whole = value(key);
    const std::size_t comma = whole.find(',');
    if (comma == std::string_view::npos) {
        return {};
    }
    return {parsed<LONG>(whole.substr(1)), parsed<LONG>(whole.substr(comma + 1))};
}

void RecordCheck::take(const std::string& line) {
    static const std::map<std::string_view, void (RecordCheck::*)()> handlers = {
        {"timer_set", &RecordCheck::timerSet}, {"timer_kill", &RecordCheck::timerKilled},
        {"tick", &RecordCheck::ticked},        {"reset_character", &RecordCheck::placed},
        {"enter", &RecordCheck::placed},       {"frame", &RecordCheck::chosen},
        {"walk_off", &RecordCheck::chosen},    {"random_walk", &RecordCheck::chosen},
        {"walk", &RecordCheck::planned},       {"draw", &RecordCheck::drawn},
        {"walk_done", &RecordCheck::arrived},  {"show_done", &RecordCheck::ended},
        {"bubble_show", &RecordCheck::spoken},
    };
    line_ = line;
    ++seen_.lines;
    const std::size_t blank = line_.find(' ');
    const std::int64_t moment = parsed<std::int64_t>(std::string_view(line_).substr(2, blank));
    expect(moment >= now_, "time went back");
    now_ = moment;
    event_ = std::string_view(line_).substr(blank + 1);
    event_ = event_.substr(0, event_.find(' '));
    if (const auto handler = handlers.find(event_); handler != handlers.end()) {
        (this->*handler->second)();
    }
    expect(event_ != "walk_refused" && event_ != "message", "this mustn't come up");
}

void RecordCheck::stageGone() {
    timers_.clear();
    walk_.reset();
    target_.reset();
    about_.reset();
}

// ---- Timers -------------------------------------------------------------------------------------

void RecordCheck::timerSet() {
    const std::int64_t interval = number("ms");
    timers_.insert_or_assign(std::string(value("timer")), Timer{interval, now_ + interval});
}

void RecordCheck::timerKilled() {
    const auto found = timers_.find(value("timer"));
    expect((found != timers_.end()) == (number("was_set") != 0), "a timer unlike the record");
    if (found != timers_.end()) {
        timers_.erase(found);
    }
}

void RecordCheck::ticked() {
    ++seen_.ticks;
    const auto found = timers_.find(value("timer"));
    if (found == timers_.end()) {
        expect(false, "a tick of a timer that isn't set");
        return;
    }
    expect(found->second.due == now_, "due at " + std::to_string(found->second.due));
    found->second.due += found->second.interval;
}

// ---- Places -------------------------------------------------------------------------------------

void RecordCheck::placed() {
    drawn_ = aimed_ = point("draw");
}

LONG RecordCheck::side(LONG x) const {
    return stage_.cx / 2 <= x ? stage_.cx + 50 : -150;
}

/// As walks about are, by the size of the Toon that is in memory.
POINT RecordCheck::scaled(POINT place) const {
    const std::int64_t width = LOWORD(ToonDocHeader.windowSize);
    const std::int64_t height = HIWORD(ToonDocHeader.windowSize);
    if (width == 0 || height == 0) {
        return place;
    }
    return {static_cast<LONG>(place.x * std::int64_t{stage_.cx} / width),
            static_cast<LONG>(place.y * std::int64_t{stage_.cy} / height)};
}

void RecordCheck::chosen() {
    const POINT place = point("target");
    if (event_ != "random_walk") {
        about_.reset();
        target_ = place;
        return;
    }
    about_ = place;
    target_ = scaled(place);
    if (number("statement") == STATEMENT_PACES) {
        pacesToTell_ = odometer_;
    }
}

RecordCheck::Walk RecordCheck::plan(POINT from, POINT to) const {
    const LONG dx = to.x - from.x;
    const LONG dy = to.y - from.y;
    const LONG distance = static_cast<LONG>(std::max(1.0, std::hypot(dx, dy)));
    const LONG wanted = distance / 20;
    const LONG strides = wanted == 0 ? 1 : std::min((wanted + 7) / 8 * 8, mostStrides);
    return {
        now_,   210 - 20 * std::int64_t{ToonSpeed}, drawn_, {dx / strides, dy / strides}, strides,
        dx > 0, static_cast<LONG>(number("pose"))};
}

void RecordCheck::countPaces(LONG last) {
    const std::uint32_t before = odometer_;
    odometer_ += static_cast<std::uint32_t>(last / 4);
    seen_.wraps += odometer_ < before ? 1 : 0;
    expect(parsed<std::int64_t>(value("paces")) == std::int64_t{odometer_},
           "the odometer isn't " + std::to_string(odometer_));
}

/// A walk goes where the event before it said; a walk about's second one goes off the stage.
void RecordCheck::walkTarget(POINT to) {
    if (!target_ && about_) {
        target_ = scaled({side(about_->x), about_->y});
        about_.reset();
    }
    expect(target_ && same(*target_, to), "nobody asked him there");
    target_.reset();
}

void RecordCheck::planned() {
    ++seen_.walks;
    expect(!walk_, "a walk while another is under way");
    const POINT from = point("from");
    const POINT to = point("to");
    expect(same(from, aimed_), "planned from elsewhere than " + text(aimed_));
    walkTarget(to);
    const Walk walk = plan(from, to);
    const POINT step = point("step");
    expect(number("interval") == walk.interval, "not the speed's interval");
    const LONG last = walk.strides + 1;
    expect(number("n") == walk.strides && number("last") == last && same(step, walk.stride) &&
               number("dir") == (walk.toRight ? 1 : 2),
           "the plan isn't n=" + std::to_string(walk.strides) + " step=" + text(walk.stride));
    const auto timer = timers_.find("WALK");
    expect(timer != timers_.end() && timer->second.interval == walk.interval, "its timer");
    countPaces(last);
    walk_ = walk;
    aimed_ = to;
}

std::string RecordCheck::pictureOf(const Walk& walk, LONG entry) const {
    const LONG n = walk.strides;
    if (entry == n + 1) {
        return "pose0" + std::to_string(walk.pose + 1);
    }
    const std::string side = walk.toRight ? "fdl" : "fdr";
    if (entry == n || (entry == 1 && n > 1)) {
        return side + "tn2";
    }
    if (entry == n - 1) {
        return side + "tn1";
    }
    const LONG cycle = entry < 8 ? entry : 1 + (entry - 8) % 7;
    return side + (walk.toRight ? "2r" : "2l") + std::to_string(cycle + 1);
}

void RecordCheck::drawn() {
    ++seen_.draws;
    if (!walk_) {
        expect(false, "a step without a walk");
        return;
    }
    Walk& walk = *walk_;
    const LONG entry = ++walk.shown;
    const LONG moved = std::min(entry, walk.strides); // in his pose he stands
    const POINT at{walk.start.x + moved * walk.stride.x, walk.start.y + moved * walk.stride.y};
    expect(number("i") == entry, "entry " + std::to_string(entry) + " comes next");
    expect(same(point("at"), at), "he should be at " + text(at));
    expect(value("bitmap") == pictureOf(walk, entry), "not " + pictureOf(walk, entry));
    expect(now_ == walk.begun + entry * walk.interval, "not the moment of this step");
    drawn_ = at;
}

void RecordCheck::arrived() {
    expect(walk_ && walk_->shown == walk_->strides + 1 &&
               now_ == walk_->begun + (walk_->strides + 2) * walk_->interval,
           "the walk isn't over");
    walk_.reset();
}

// ---- Shows --------------------------------------------------------------------------------------

/// The first walk about of a stage tells of its end twice; the first message ends no show.
void RecordCheck::ended() {
    expect(!walk_, "a show ended on the way");
    std::set<std::string> live;
    for (const auto& [name, timer] : timers_) {
        live.insert(name);
    }
    if (!timersAtEnd_) {
        timersAtEnd_ = live;
    }
    expect(live == *timersAtEnd_, "other timers than at the end of the first show");
    expect(seam::liveHandles().timers == timers_.size(), "timers that the record doesn't know");
    if (RandomWalkActive == 0) {
        ++(NextToonFile[0] == '\0' ? seen_.walksAbout : seen_.toons);
    }
}

void RecordCheck::spoken() {
    static constexpr std::string_view before = "I've walked a total of ";
    const std::size_t found = line_.find(before);
    if (found == std::string::npos) {
        return;
    }
    ++seen_.told;
    seen_.toldAfter += seen_.wraps > 0 ? 1 : 0;
    const std::string expected = std::string(before) + std::to_string(pacesToTell_) + " Paces!!";
    expect(line_.find(expected) == found, "he should say " + expected);
}
