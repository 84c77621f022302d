// Start-up and lifecycle of the run-time over QApplication.
#include "platform/runtime/runtime.h"

#include <QApplication>
#include <QFile>
#include <QFileInfo>
#include <QFont>
#include <QIcon>
#include <QPointer>
#include <QTimer>
#include <QWidget>

#include <utility>
#include <vector>

#ifdef __GLIBC__
#include <malloc.h>
#endif

#include "platform/core/database.h"
#include "platform/core/folder_item.h"
#include "platform/core/resources_folder.h"
#include "platform/runtime/application.h"
#include "platform/runtime/application_style.h"
#include "platform/runtime/yield.h"

namespace {
ExceptionHelper exceptionHelper = nullptr;
std::function<void()> pendingLateStartup;
int exitStatus = 0;
std::unique_ptr<QApplication> ownApplication;
std::vector<std::function<void()>> finalizers;

// Qt reads options such as -reverse or -platform from its arguments, and nothing on the
// command line may influence start-up: Qt gets the program's name alone.
int argcKept = 1;
char* argvKept[] = {nullptr, nullptr};

constexpr qint64 kOpenWaitLimitMs = 500;

std::vector<QPointer<QWidget>> heldWindows;

// Shown, but not yet on screen: Qt has not handled the expose that maps it.
bool IsUnmapped(const QWidget* window) {
    return window->isVisible() && !window->testAttribute(Qt::WA_Mapped);
}

bool WindowsOnScreen() {
    for (QWidget* window : QApplication::topLevelWidgets()) {
        if (IsUnmapped(window)) {
            return false;
        }
    }
    return true;
}

// The windows shown at late start-up are first painted after the application's Open, which
// moves the user from the page a window is built on to the first page: painting the other
// page would only show it for an instant, at the price of its fonts and text layout.
void HoldFirstPaint() {
    for (QWidget* window : QApplication::topLevelWidgets()) {
        if (IsUnmapped(window)) {
            window->setUpdatesEnabled(false);
            heldWindows.emplace_back(window);
        }
    }
}

void ReleaseFirstPaint() {
    for (const auto& window : std::exchange(heldWindows, {})) {
        if (window) {
            // A sync that came while the updates were held keeps its dirty areas and posts
            // no request for them again, so the request is posted here.
            window->setUpdatesEnabled(true);
            QCoreApplication::postEvent(window, new QEvent(QEvent::UpdateRequest),
                                        Qt::LowEventPriority);
        }
    }
}

void RaiseOpen() {
    ReleaseFirstPaint();
    if (auto app = CurrentApplication()) {
        RaiseEvent([app] { app->Event_Open(); });
    }
}

// The application's Open brings the user to the first page, whose load may be long. It waits
// until the windows are on screen, half a second at most, so that the yield of that load has
// a window to paint the rows on as they come. A window is on screen once Qt has handled the
// expose that maps it, so each expose is followed by a look.
class OpenOnceShown : public QObject {
  public:
    OpenOnceShown() : QObject(QApplication::instance()) {
        QApplication::instance()->installEventFilter(this);
        QTimer::singleShot(kOpenWaitLimitMs, this, [this] { Raise(); });
        if (WindowsOnScreen()) {
            Raise();
        }
    }

    bool eventFilter(QObject*, QEvent* event) override {
        if (event->type() == QEvent::Expose) {
            QMetaObject::invokeMethod(
                this,
                [this] {
                    if (WindowsOnScreen()) {
                        Raise();
                    }
                },
                Qt::QueuedConnection);
        }
        return false;
    }

  private:
    void Raise() {
        if (std::exchange(raised_, true)) {
            return;
        }
        QApplication::instance()->removeEventFilter(this);
        deleteLater();
        RaiseOpen();
    }

    bool raised_ = false;
};
}  // namespace

// Text keeps its designed shapes, unhinted, as macOS draws it: hinting would also set up
// FreeType's hinter for every face and size at start-up, and load each glyph through it. Set
// through the base class, the fonts that some desktops give to kinds of widget stay as they are.
void UseUnhintedText() {
#ifndef Q_OS_MACOS
    QFont font = QGuiApplication::font();
    font.setHintingPreference(QFont::PreferNoHinting);
    QGuiApplication::setFont(font);
#endif
}

void UseInstalledIcon(const std::filesystem::path& executable) {
    const QString file = QFile::decodeName(InstalledIconFor(executable).c_str());
    const QIcon installed = QFileInfo::exists(file) ? QIcon(file) : QIcon();
    QGuiApplication::setWindowIcon(
        QIcon::fromTheme(QFile::decodeName(executable.filename().c_str()), installed));
}

void RuntimeInit(int argc, char** argv) {
#ifdef __GLIBC__
    // A fixed threshold: the buffers of a huge text get mappings of their own and go back to
    // the system when freed, rather than raise glibc's sliding threshold and stay in the heap.
    mallopt(M_MMAP_THRESHOLD, 1 << 20);
#endif
    MakeFileSystemRootAbsolute();
    // A read that waits for a lock, or works through a query that gives no row, gives way as
    // a long loop does.
    SQLiteDatabase::SetWaitHook(&RuntimeBackgroundTask);
    if (QApplication::instance()) {
        return;
    }
    static char fallbackName[] = "orbelane";
    argvKept[0] = argc > 0 && argv[0] ? argv[0] : fallbackName;
    ownApplication = std::make_unique<QApplication>(argcKept, argvKept);
    QApplication::setStyle(new ApplicationStyle);
    UseUnhintedText();
    // The desktop ties the window to the installed desktop entry, and so to its icon, by this
    // name; the entry is named after the executable.
    QGuiApplication::setDesktopFileName(QCoreApplication::applicationName());
#ifndef Q_OS_MACOS
    // On macOS the Dock shows the bundle's own icon, and windows bear none.
    UseInstalledIcon(ExecutableFile());
#endif
    // On macOS the application lives on with its menu bar when the window closes; elsewhere
    // a program without a window would have no way left to quit, so it ends with its window.
#ifdef Q_OS_MACOS
    QApplication::setQuitOnLastWindowClosed(false);
#endif
}

// C++ has run every static initialiser before main; the Qt classes need none.
void RuntimePerformInitializers() {}

void _RuntimeSetExceptionHelper(ExceptionHelper helper) {
    exceptionHelper = helper;
}

// Nothing asks which release of the run-time the program expects.
void _RuntimeSetReleaseStamp(double) {}

// Qt 6 always draws for high-density screens.
void _SetSupportsHiDPI(bool) {}

// The platform's classes are C++ types, known to the compiler; nothing to make known.
void _RuntimeInitExternalClasses() {}

// The segmented control is built into this platform layer; no library to bind.
void _InitPluginEntrypoints() {}

void _RunFrameworkInitialization(std::function<void()> lateStartup) {
    pendingLateStartup = std::move(lateStartup);
}

void _RuntimeRun() {
    // Late start-up and then the application's Open, once each, from the event loop.
    QTimer::singleShot(0, QApplication::instance(), [] {
        auto lateStartup = std::exchange(pendingLateStartup, nullptr);
        if (lateStartup && exceptionHelper) {
            auto exception = exceptionHelper([&](void*) { lateStartup(); }, nullptr);
            if (exception) {
                _UnhandledException(*exception);
            }
        } else if (lateStartup) {
            RaiseEvent(lateStartup);
        }
        HoldFirstPaint();
        new OpenOnceShown;
    });
    exitStatus = QApplication::exec();
}

void RuntimeAtFinalize(std::function<void()> work) {
    finalizers.push_back(std::move(work));
}

void RuntimePerformFinalizers() {
    for (const auto& work : finalizers) {
        work();
    }
    _RuntimeRegisterAppObject(nullptr);
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
}

int RuntimeExit() {
    ownApplication.reset();
    return exitStatus;
}

void QuitMenuAction() {
    QApplication::closeAllWindows();
    QApplication::quit();
}
