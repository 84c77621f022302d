// Timer.CallLater over Qt's single-shot timer; the callback runs as an event handler.
#include "platform/runtime/timer.h"

#include <QCoreApplication>
#include <QTimer>

#include "platform/runtime/application.h"

void Timer::CallLater(int delayMilliseconds, std::function<void()> callback) {
    QTimer::singleShot(delayMilliseconds, QCoreApplication::instance(),
                       [callback = std::move(callback)] { RaiseEvent(callback); });
}
