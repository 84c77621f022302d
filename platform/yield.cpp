// The cooperative yield. The run-time has no other thread to give way to, so a long loop uses
// it to keep its window drawn: at most every 50 ms the lists show the rows added so far and
// what is due on screen is painted. The event queue is never touched, so input, timers,
// posted calls, deferred deletions and appearance notifications all wait until the handler
// has returned, and no handler can be entered a second time.
#include "platform/yield.h"

#include <QApplication>
#include <QBackingStore>
#include <QEvent>
#include <QTableView>
#include <QWidget>

#include <ctime>

#include "platform/exceptions.h"
#include "platform/list_model.h"

namespace {

constexpr std::chrono::nanoseconds kPaintInterval = std::chrono::milliseconds(50);

// The yield comes once per row of a million-row load, so the clock must be cheap: the coarse
// clock costs a quarter of the precise one, and its few milliseconds of grain are nothing
// against the interval.
std::chrono::nanoseconds CoarseNow() {
#ifdef CLOCK_MONOTONIC_COARSE
    timespec now{};
    clock_gettime(CLOCK_MONOTONIC_COARSE, &now);
    return std::chrono::seconds(now.tv_sec) + std::chrono::nanoseconds(now.tv_nsec);
#else
    return std::chrono::steady_clock::now().time_since_epoch();
#endif
}

std::chrono::nanoseconds interval = kPaintInterval;
std::chrono::nanoseconds lastPaint{0};
std::function<void(std::chrono::nanoseconds)> paintObserver;
bool painting = false;

// Paints the window's dirty areas now, through the same path as a queued update request, and
// puts the whole window on screen again: areas that other windows uncovered meanwhile are
// told of by expose events, which wait in the queue with the input.
void PaintWindow(QWidget& window) {
    for (QTableView* view : window.findChildren<QTableView*>()) {
        ShowRowsAddedSoFar(*view);
    }
    QEvent request(QEvent::UpdateRequest);
    QCoreApplication::sendEvent(&window, &request);
    if (QBackingStore* store = window.backingStore(); store && window.windowHandle()) {
        store->flush(QRegion(window.rect()), window.windowHandle());
    }
}

void PaintWhatIsDue() {
    const auto start = std::chrono::steady_clock::now();
    if (!qobject_cast<QApplication*>(QCoreApplication::instance())) {
        return;  // no windows without a widget application
    }
    struct PaintingFlag {
        PaintingFlag() { painting = true; }
        ~PaintingFlag() { painting = false; }
    } flag;
    // A window that is not yet on screen has nothing to paint on; its first expose paints it.
    for (QWidget* window : QApplication::topLevelWidgets()) {
        if (window->isVisible() && window->testAttribute(Qt::WA_Mapped)) {
            PaintWindow(*window);
        }
    }
    if (paintObserver) {
        paintObserver(std::chrono::steady_clock::now() - start);
    }
}

}  // namespace

void RuntimeBackgroundTask() {
    if (interval == std::chrono::nanoseconds::max()) {
        return;
    }
    const std::chrono::nanoseconds now = CoarseNow();
    if (painting || now - lastPaint < interval) {
        return;
    }
    lastPaint = now;
    PaintWhatIsDue();
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
