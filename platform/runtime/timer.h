// Timer.CallLater: a call from the event loop, once, after a delay.
#pragma once

#include <functional>

namespace Timer {
void CallLater(int delayMilliseconds, std::function<void()> callback);
}
