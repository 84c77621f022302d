// The cooperative yield at the end of each pass of a long loop. It keeps the window drawn and
// runs nothing else: no input, timer or posted call.
#pragma once

#include <chrono>
#include <functional>

void RuntimeBackgroundTask();

// True while the yield paints. A control whose paint would run the application's own code
// leaves it for later then: the handler that gave way is still running.
bool YieldIsPainting();

// What a control has to show during a long loop, such as the rows a list has been given so
// far: while the hook lives, each yield that paints calls it before it paints the windows.
class YieldHook {
  public:
    explicit YieldHook(std::function<void()> show);
    ~YieldHook();
    YieldHook(const YieldHook&) = delete;
    YieldHook& operator=(const YieldHook&) = delete;

  private:
    friend void RuntimeBackgroundTask();
    std::function<void()> show_;
};

// The least time between two painting yields: 50 ms unless set. Zero paints at every yield;
// nanoseconds::max() makes the yield an empty one that does not even read the clock.
void SetYieldIntervalForTesting(std::chrono::nanoseconds interval);
// Called at the end of each yield that painted, while input is still held back, with the time
// that the painting took.
void SetYieldPaintObserverForTesting(std::function<void(std::chrono::nanoseconds)> observer);
