// Start-up: the application object and the menu bar before any window, the default window
// at late start-up, then the event loop.
#include "shell/startup.h"

#include "platform/runtime/runtime.h"
#include "shell/app.h"
#include "shell/main_menu_bar.h"
#include "shell/window1.h"

void _Main() {
    try {
        _RuntimeSetExceptionHelper(&_CallFunctionWithExceptionHandling);
        _RuntimeSetReleaseStamp(2018.04);
        _EarlyStartup();
        _RunFrameworkInitialization(&_LateStartup);
        _RuntimeRun();
    } catch (const RuntimeException& e) {
        // Finalisers and RuntimeExit still run in main once the last resort comes back.
        _UnhandledException(e);
    }
}

// The application object is built after the platform's classes and before any window.
void _EarlyStartup() {
    _SetSupportsHiDPI(true);
    _RuntimeInitExternalClasses();
    _InitPluginEntrypoints();
    _InitFileTypes();
    _NewAppInstance();
    _ApplicationAddMenuHandlers();
}

// The system declares no file types.
void _InitFileTypes() {}

// Registration comes last, so the platform never sees the application without its version
// record and menu bar.
void _NewAppInstance() {
    auto app = std::make_shared<App>();
    app->Constructor();
    app->_x_SetVersionData(1, 0, 0, 0, 3, "", "", "");
    app->MenuBar = MainMenuBar();
    _RuntimeRegisterAppObject(Ref<Application>(app));
}

// The system has no application-level menu handlers.
void _ApplicationAddMenuHandlers() {}

void _LateStartup() {
    _MakeDefaultView();
}

// The first use of the accessor builds the window, unless App.Event_Open came first.
void _MakeDefaultView() {
    Window1();
}
