// An hour of the saver's show, without a screen, on a clock moved by hand.
#include "cli/replay.h"

#include <cstdlib>

#include <benchmark/benchmark.h>

namespace {

void hourOfShow(benchmark::State& state) {
    setenv("QT_QPA_PLATFORM", "offscreen", 0);
    ReplayOptions options;
    for (const char* name : {"intro", "lost-thought", "shortest-way"}) {
        options.toons.push_back(std::string(DORBO_TOONS "/") + name + ".zkt");
    }
    options.width = 1920;
    options.height = 1080;
    options.shows = 70; // of 49 to 55 seconds each
    std::string last;
    for (auto _ : state) {
        Replay(options, {[&](const std::string& line) { last = line; }});
    }
    constexpr std::size_t timePrefix = 2; // "t="
    state.counters["seconds_shown"] = std::stod(last.substr(timePrefix)) / 1000;
}

BENCHMARK(hourOfShow)->Unit(benchmark::kSecond)->Iterations(1)->Repetitions(3);

} // namespace

BENCHMARK_MAIN();
