// MsgBox over QMessageBox, with the test seam.
#include "platform/runtime/message_box.h"

#include <QApplication>
#include <QMessageBox>
#include <QString>

#include "platform/runtime/main_thread.h"

namespace {
std::function<void(const std::string&)> testHandler;
}

void MsgBox(const std::string& text) {
    RequireMainThread();
    if (testHandler) {
        testHandler(text);
        return;
    }
    QWidget* parent = QApplication::activeWindow();
    QMessageBox box(parent);
    // The program's window title rather than the executable's name.
    box.setWindowTitle(parent ? parent->windowTitle() : QString());
    box.setText(QString::fromStdString(text));
    box.setStandardButtons(QMessageBox::Ok);
    box.exec();
}

void SetMsgBoxHandlerForTesting(std::function<void(const std::string&)> handler) {
    testHandler = std::move(handler);
}
