// The cooperative yield. The run-time has no other thread to give way to, so a long loop uses
// it to keep its window drawn: at most every 50 ms the hooks show what they have and what is
// due on screen is painted. The event queue is never touched, so input, timers, posted
// calls, deferred deletions and appearance notifications all wait until the handler has
// returned, and no handler can be entered a second time.
#include "platform/runtime/yield.h"

#include <QApplication>
#include <QBackingStore>
#include <QEvent>
#include <QWidget>

#include <algorithm>
#include <vector>

namespace {

constexpr std::chrono::nanoseconds kPaintInterval = std::chrono::milliseconds(50);

std::chrono::nanoseconds interval = kPaintInterval;
std::chrono::steady_clock::time_point lastPaint;
std::function<void(std::chrono::nanoseconds)> paintObserver;
std::vector<YieldHook*> hooks;
bool painting = false;

// Paints the window's dirty areas now, through the same path as a queued update request, and
// puts the whole window on screen again: areas that other windows uncovered meanwhile are
// told of by expose events, which wait in the queue with the input.
void PaintWindow(QWidget& window) {
    QEvent request(QEvent::UpdateRequest);
    QCoreApplication::sendEvent(&window, &request);
    if (QBackingStore* store = window.backingStore(); store && window.windowHandle()) {
        store->flush(QRegion(window.rect()), window.windowHandle());
    }
}

}  // namespace

YieldHook::YieldHook(std::function<void()> show) : show_(std::move(show)) {
    hooks.push_back(this);
}

YieldHook::~YieldHook() {
    hooks.erase(std::remove(hooks.begin(), hooks.end(), this), hooks.end());
}

void RuntimeBackgroundTask() {
    if (interval == std::chrono::nanoseconds::max() || painting) {
        return;
    }
    const auto start = std::chrono::steady_clock::now();
    if (start - lastPaint < interval) {
        return;
    }
    lastPaint = start;
    if (!qobject_cast<QApplication*>(QCoreApplication::instance())) {
        return;  // no windows without a widget application
    }
    painting = true;
    for (YieldHook* hook : std::vector<YieldHook*>(hooks)) {
        hook->show_();
    }
    // A window that is not yet on screen has nothing to paint on; its first expose paints it.
    for (QWidget* window : QApplication::topLevelWidgets()) {
        if (window->isVisible() && window->testAttribute(Qt::WA_Mapped)) {
            PaintWindow(*window);
        }
    }
    painting = false;
    if (paintObserver) {
        paintObserver(std::chrono::steady_clock::now() - start);
    }
}

bool YieldIsPainting() {
    return painting;
}

void SetYieldIntervalForTesting(std::chrono::nanoseconds testInterval) {
    interval = testInterval;
}

void SetYieldPaintObserverForTesting(std::function<void(std::chrono::nanoseconds)> observer) {
    paintObserver = std::move(observer);
}
