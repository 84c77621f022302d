// MsgBox over QMessageBox, with the test seam.
#include "platform/message_box.h"

#include <QApplication>
#include <QMessageBox>
#include <QString>

namespace {
std::function<void(const std::string&)> testHandler;
}

void MsgBox(const std::string& text) {
    if (testHandler) {
        testHandler(text);
        return;
    }
    QMessageBox box(QApplication::activeWindow());
    box.setText(QString::fromStdString(text));
    box.setStandardButtons(QMessageBox::Ok);
    box.exec();
}

void SetMsgBoxHandlerForTesting(std::function<void(const std::string&)> handler) {
    testHandler = std::move(handler);
}
