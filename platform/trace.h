// The record of a show: one line an event, for replays that are held against a recorded run.
#pragma once

#include "platform/types.h"

/// Takes each line of the record: "t=MS EVENT key=value ...", without its line end. Null, as at
/// program start, keeps no record. Written by whoever wants one.
extern void (*TraceSink)(const char* line);

/// Gives the name under which a timer stands in the record. Null: its number stands there.
extern const char* (*TraceTimerName)(UINT_PTR timer);

/// Adds an event to the record, with the milliseconds since TraceStart in front. format is
/// printf's. Costs one test while no record is kept.
[[gnu::format(printf, 1, 2)]] void Trace(const char* format, ...);

/// Counts time from now on: the clock of the record stands at 0.
void TraceStart();
