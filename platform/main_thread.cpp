// The main-thread guard over Qt's notion of the application's thread.
#include "platform/main_thread.h"

#include <QCoreApplication>
#include <QThread>

#include "platform/exceptions.h"

void RequireMainThread() {
    const QCoreApplication* application = QCoreApplication::instance();
    if (application && QThread::currentThread() != application->thread()) {
        throw ThreadAccessingUIException(
            "A thread has attempted to manipulate a user interface element. This can only be "
            "done from the application's main thread.");
    }
}
