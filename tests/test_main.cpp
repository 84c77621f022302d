// Test entry: one Qt application on the offscreen platform for all tests.
#include <QApplication>

#include <gtest/gtest.h>

#include "platform/runtime/runtime.h"

int main(int argc, char** argv) {
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM")) {
        qputenv("QT_QPA_PLATFORM", "offscreen");
    }
    // No test reaches the desktop's session bus, whose portal would choose the appearance; the
    // portal's own tests put a private bus here.
    qputenv("DBUS_SESSION_BUS_ADDRESS", "");
    QApplication app(argc, argv);
    RuntimeInit(argc, argv);  // the rest of the run-time, as the program brings it up
    UseUnhintedText();        // as the program draws its text
    QApplication::setQuitOnLastWindowClosed(false);
    ::testing::InitGoogleTest(&argc, argv);
    return RUN_ALL_TESTS();
}
