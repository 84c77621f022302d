// The yardstick: a minimal Qt Widgets program that shows one window and ends once it is exposed.
#include <QApplication>
#include <QLabel>
#include <QTimer>
#include <QWidget>
#include <QWindow>

#include <cstdlib>

int main(int argc, char** argv) {
    QApplication app(argc, argv);
    QWidget window;
    window.resize(968, 628);
    // With an argument, one line of text: the yardstick then pays for the font database too.
    if (argc > 1) {
        new QLabel("Orbelane Verification Storage", &window);
    }
    window.show();
    QTimer poll;
    QObject::connect(&poll, &QTimer::timeout, [&] {
        if (window.windowHandle() && window.windowHandle()->isExposed()) {
            std::_Exit(0);
        }
    });
    poll.start(0);
    return QApplication::exec();
}
