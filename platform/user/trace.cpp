#include "platform/trace.h"

#include "platform/harness.h"

#include <cstdarg>
#include <cstdio>
#include <string>

void (*TraceSink)(const char* line) = nullptr;
const char* (*TraceTimerName)(UINT_PTR timer) = nullptr;

static std::int64_t traceStart = 0;

void TraceStart() {
    traceStart = seam::clockNow();
}

void Trace(const char* format, ...) {
    if (TraceSink == nullptr) {
        return;
    }
    char event[512];
    va_list arguments;
    va_start(arguments, format);
    std::vsnprintf(event, sizeof event, format, arguments);
    va_end(arguments);
    const std::string line = "t=" + std::to_string(seam::clockNow() - traceStart) + " " + event;
    TraceSink(line.c_str());
}
