// The cooperative yield's painting: what the controls ask of it, and seams for tests and
// benchmarks.
#pragma once

#include <chrono>
#include <functional>

// True while the yield paints. A control whose paint would run the application's own code
// leaves it for later then: the handler that gave way is still running.
bool YieldIsPainting();

// The least time between two painting yields: 50 ms unless set. Zero paints at every yield;
// nanoseconds::max() makes the yield an empty one that does not even read the clock.
void SetYieldIntervalForTesting(std::chrono::nanoseconds interval);
// Called at the end of each yield that painted, while input is still held back, with the time
// that the painting took.
void SetYieldPaintObserverForTesting(std::function<void(std::chrono::nanoseconds)> observer);
