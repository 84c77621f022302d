// The program's own start-up, ended the moment its window is exposed on the list page.
#include <QTimer>
#include <QWidget>
#include <QWindow>

#include <cstdlib>

#include "platform/runtime.h"
#include "shell/startup.h"
#include "shell/window1.h"

int main(int argc, char** argv) {
    RuntimeInit(argc, argv);
    RuntimePerformInitializers();
    QTimer poll;
    QObject::connect(&poll, &QTimer::timeout, [] {
        auto window = Cast<class Window1>(_GetImplicitWindow("Window1.Window1"));
        if (window && window->PagePanel1()->Value() == 1 && window->Native()->windowHandle() &&
            window->Native()->windowHandle()->isExposed()) {
            std::_Exit(0);
        }
    });
    poll.start(0);
    _Main();
    return 1;
}
