// The main-thread guard over Qt's notion of the application's thread.
#include "platform/runtime/main_thread.h"

#include <QCoreApplication>
#include <QThread>

#include "platform/core/exceptions.h"

void RequireMainThread() {
    const QCoreApplication* application = QCoreApplication::instance();
    // Asked for every row of a long load: each thread looks its own object up once.
    thread_local QThread* const current = QThread::currentThread();
    if (application && current != application->thread()) {
        throw ThreadAccessingUIException(
            "A thread has attempted to manipulate a user interface element. This can only be "
            "done from the application's main thread.");
    }
}
