// Days of the saver's shows, Toons and walks about mixed, on the clock moved by hand: whether his
// record keeps to its own plans, and whether anything grows. What the clock shows goes past 2^31 ms
// in thirty days, and the odometer, which starts shortly below it, past 2^32.
//
//     days [--days 30 | --hours 6] [--run HOURS] [--size 1920x1080] [--seed 1]
//
// With --run a key ends the saver after so many hours of the clock, the user's choice in the
// settings file changes from Toons to walking about or back, and the saver starts again. Without,
// one window stands all the time; there the choice between the two, which the saver reads at its
// start only, is made before each show by a coin of this program.
#include "cli/replay.h"
#include "platform/kernel.h"
#include "platform/trace.h"
#include "platform/user.h"
#include "saver/saver_guard.h"
#include "saver/show_cycle.h"
#include "stage/random_walk.h"
#include "tests/days/holdings.h"
#include "tests/days/record_check.h"
#include "toon/settings.h"
#include "toon/toon_document.h"

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <ctime>
#include <exception>
#include <filesystem>
#include <fstream>
#include <random>
#include <stdexcept>

#include <unistd.h>

namespace {

constexpr std::int64_t hour = 60LL * 60 * 1000;
constexpr std::int64_t hoursOfDay = 24;
constexpr std::uint32_t pacesAtStart = 0xFFFFFFFFU - 8000; // hours of walking below the wrap
constexpr LONG tileOfSamples = 2;
constexpr const char* runClass = "DaysClass";

struct Options {
    std::int64_t hours = 6;
    std::int64_t run = 0; // 0: as long as all
    SIZE size{1920, 1080};
    DWORD seed = 1;
};

struct Sample {
    std::int64_t moment;
    Holdings holdings;
};

/// What the hook of the record works on.
struct Course {
    RecordCheck check;
    std::mt19937 coin;
    bool tossed;         // whether the coin decides between the shows
    std::size_t wanted;  // samples
    std::int64_t period; // ms from sample to sample
    std::vector<Sample> samples;
};

Course* course = nullptr;

std::int64_t nextSample() {
    return static_cast<std::int64_t>(course->samples.size() + 1) * course->period;
}

long long hourOf(const Sample& sample) {
    return sample.moment / hour;
}

void tell(const Sample& sample) {
    const RecordCheck::Seen& seen = course->check.seen();
    std::printf("%6lld %8llu %8llu %12u %10zu %8zu %7zu %6zu %9zu\n", hourOf(sample),
                static_cast<unsigned long long>(seen.toons),
                static_cast<unsigned long long>(seen.walksAbout), course->check.odometer(),
                sample.holdings.heap, HandlesOf(sample.holdings), sample.holdings.handles.timers,
                sample.holdings.files, sample.holdings.resident);
    std::fflush(stdout);
}

void sample() {
    course->samples.push_back({seam::clockNow(), HoldingsNow()});
    tell(course->samples.back());
}

/// Which kind of show comes next; before a walk about no Toon may be left chosen, as at the start
/// of a saver.
void toss() {
    WalkingStyle = course->coin() % 2 == 0 ? 1 : 0;
    if (WalkingStyle == 0) {
        NextToonFile[0] = '\0';
    }
}

/// Samples are taken where a walk about ends on one and the same tile, or a run does, so that like
/// is compared with like: tiles differ in size.
void takeLine(const char* line) {
    course->check.take(line);
    if (!std::string_view(line).ends_with(" show_done") || RandomWalkActive != 0) {
        return;
    }
    if (!course->tossed) {
        return;
    }
    if (NextToonFile[0] == '\0' && BackgroundIndex == tileOfSamples &&
        seam::clockNow() >= nextSample()) {
        sample();
    }
    toss();
}

void copyToons(const std::filesystem::path& target) {
    for (const auto& toon : std::filesystem::directory_iterator(DORBO_TOONS)) {
        if (toon.path().extension() == ".zkt") {
            std::filesystem::copy_file(toon.path(), target / toon.path().filename());
        }
    }
}

HWND openSaver(SIZE size) {
    WNDCLASSA windowClass{};
    windowClass.lpfnWndProc = SaverGuardProc;
    windowClass.hInstance = GetModuleHandleA(nullptr);
    windowClass.lpszClassName = runClass;
    RegisterClassA(&windowClass); // refused, and none the worse, from the second time on
    return CreateWindowExA(0, runClass, "", WS_POPUP | WS_VISIBLE, 0, 0, size.cx, size.cy, nullptr,
                           nullptr, windowClass.hInstance, nullptr);
}

std::string savedPaces(const std::filesystem::path& file) {
    static constexpr std::string_view key = "Paces Walked=";
    std::ifstream in(file);
    for (std::string line; std::getline(in, line);) {
        if (line.starts_with(key)) {
            return line.substr(key.size(), line.find('\r') - key.size());
        }
    }
    return "";
}

/// Whether the key has to wait for what the next sample needs.
bool sampleMissing() {
    return course->tossed ? course->samples.size() < course->wanted
                          : BackgroundIndex != tileOfSamples;
}

/// From the saver's start to the key that ends it.
void runSaver(const Options& options, std::int64_t end, const std::filesystem::path& settings) {
    const std::uint32_t before = course->check.odometer();
    SaverClosing = 0; // as in the process that the next saver would be
    const HWND window = openSaver(options.size);
    course->check.expect(PacesWalked == before, "the settings' odometer wasn't read");
    auto due = seam::nextDeadline();
    bool stands = true;
    constexpr std::int64_t patience = 10 * hour;
    while (stands && due && *due <= end + (sampleMissing() ? patience : 0)) {
        stands = seam::runUntil(*due);
        due = seam::nextDeadline();
    }
    course->check.expect(stands && due, "the saver stands still, or went by itself");
    stands = stands && seam::runUntil(std::max(end, seam::clockNow()));
    PostMessageA(window, WM_KEYDOWN, ' ', 0);
    seam::runUntil(seam::clockNow());
    course->check.expect(IsWindow(window) == FALSE, "a key doesn't end the saver");
    course->check.stageGone();
    const std::uint32_t paces = course->check.odometer();
    course->check.expect(PacesWalked == paces && savedPaces(settings) == std::to_string(paces),
                         "the odometer saved is " + savedPaces(settings));
}

void firstSettings() {
    WalkingStyle = Statements = Backgrounds = 1;
    PacesWalked = pacesAtStart;
    GetCurrentDirectoryA(sizeof Directory, Directory);
    SettingsSave();
}

void runAll(const Options& options, const ReplayGround& ground) {
    const std::int64_t end = options.hours * hour;
    const std::int64_t run = options.run == 0 ? end : options.run * hour;
    int style = 1;
    for (std::int64_t begin = 0; begin < end; begin += run) {
        runSaver(options, std::min(begin + run, end), ground.settingsFile());
        if (!course->tossed && seam::clockNow() >= nextSample()) {
            sample();
        }
        style = 1 - style;
        SettingsLoad(); // as the setup does before its OK
        WalkingStyle = style;
        SettingsSave();
    }
}

/// Whether anything has grown since the first sample.
void compareSamples() {
    // What has been drawn of fonts is kept, and some glyphs come up late.
    constexpr std::size_t slack = 4096; // bytes
    RecordCheck& check = course->check;
    check.expect(course->samples.size() >= 2, "nothing to compare");
    for (const Sample& later : course->samples) {
        const Holdings& first = course->samples.front().holdings;
        const std::string when = " at hour " + std::to_string(hourOf(later));
        check.expect(later.holdings.handles == first.handles, "other handles" + when);
        check.expect(later.holdings.files == first.files, "other open files" + when);
        check.expect(later.holdings.heap <= first.heap + slack, "more heap" + when);
    }
}

/// A course in which something never happened has shown nothing about it.
void expectAllSeen() {
    const RecordCheck::Seen& seen = course->check.seen();
    const bool all = seen.toons > 0 && seen.walksAbout > 0 && seen.wraps == 1 &&
                     seen.toldAfter > 0 && seen.told > seen.toldAfter;
    course->check.expect(all, "too little happened");
}

void report(const Options& options, double wall, double cpu) {
    const RecordCheck::Seen& seen = course->check.seen();
    const double days = static_cast<double>(options.hours) / hoursOfDay;
    std::printf(
        "%llu lines, %llu walks, %llu steps and %llu ticks held against the plans\n"
        "paces told %llu times, %llu of them after %llu wrap\n"
        "%.2f days in %.1f s, %.1f s of CPU: %.2f days a minute\n",
        static_cast<unsigned long long>(seen.lines), static_cast<unsigned long long>(seen.walks),
        static_cast<unsigned long long>(seen.draws), static_cast<unsigned long long>(seen.ticks),
        static_cast<unsigned long long>(seen.told), static_cast<unsigned long long>(seen.toldAfter),
        static_cast<unsigned long long>(seen.wraps), days, wall, cpu, days * 60 / wall);
    for (const std::string& fault : course->check.faults()) {
        std::printf("FAULT %s\n", fault.c_str());
    }
}

Options readOptions(int count, char** words) {
    Options options;
    for (int i = 1; i + 1 < count; i += 2) {
        const std::string name = words[i];
        const char* value = words[i + 1];
        if (name == "--days") {
            options.hours = std::atoll(value) * hoursOfDay;
        } else if (name == "--hours") {
            options.hours = std::atoll(value);
        } else if (name == "--run") {
            options.run = std::atoll(value);
        } else if (name == "--seed") {
            options.seed = static_cast<DWORD>(std::strtoul(value, nullptr, 10));
        } else if (name != "--size" ||
                   std::sscanf(value, "%dx%d", &options.size.cx, &options.size.cy) != 2) {
            throw std::runtime_error(name + ": unknown");
        }
    }
    if (count % 2 == 0 || options.hours < 1 || options.run < 0) {
        throw std::runtime_error(
            "days [--days N | --hours N] [--run HOURS] [--size WxH] [--seed N]");
    }
    return options;
}

/// Starts this program once more, without the allocator's store of freed blocks, which it would
/// count as in use.
void countExactly(char** words) {
    constexpr const char* tunables = "GLIBC_TUNABLES";
    if (std::getenv(tunables) == nullptr) {
        setenv(tunables, "glibc.malloc.tcache_count=0", 1);
        execv("/proc/self/exe", words);
        throw std::runtime_error("it can't be started again");
    }
}

int showDays(const Options& options) {
    setenv("QT_QPA_PLATFORM", "offscreen", 1);
    setenv("DORBO_SCALE", "1", 1);
    const std::int64_t period = options.hours >= 2 * hoursOfDay ? hoursOfDay : 1;
    Course all{{options.size, pacesAtStart},
               std::mt19937(options.seed),
               options.run == 0,
               static_cast<std::size_t>(options.hours / period),
               period * hour,
               {}};
    course = &all;
    course->samples.reserve(static_cast<std::size_t>(options.hours));
    const ReplayGround ground;
    copyToons(ground.toons());
    ForgetEarlierStages();
    firstSettings();
    seam::useManualClock(options.seed);
    TraceStart();
    TraceSink = takeLine;
    std::puts("  hour    Toons   abouts     odometer       heap  handles  timers  files  resident");
    const auto begun = std::chrono::steady_clock::now();
    runAll(options, ground);
    const std::chrono::duration<double> wall = std::chrono::steady_clock::now() - begun;
    const double cpu = static_cast<double>(std::clock()) / CLOCKS_PER_SEC;
    compareSamples();
    expectAllSeen();
    report(options, wall.count(), cpu);
    return all.check.faults().empty() ? EXIT_SUCCESS : EXIT_FAILURE;
}

} // namespace

int main(int count, char** words) {
    try {
        countExactly(words);
        return showDays(readOptions(count, words));
    } catch (const std::exception& error) {
        std::fprintf(stderr, "days: %s\n", error.what());
        return 2;
    }
}
