// The application object and the rule for exceptions that leave an event handler.
#include "platform/runtime/application.h"

#include <cstdio>

#include "platform/runtime/notifications.h"

namespace {
Ref<Application> theApplication;
long long handlersEntered = 0;
}  // namespace

Application::Application() {
    _MacOSDistributedNotifications::Register(this);
}

Application::~Application() {
    _MacOSDistributedNotifications::Unregister(this);
}

void Application::_CallFunctionWithExceptionHandling(const std::function<void()>& function) {
    try {
        function();
    } catch (const EndException&) {
        // Ending the application or a thread is no failure: nobody hears of it.
    } catch (const ThreadEndException&) {
    } catch (const RuntimeException& e) {
        if (!UnhandledException(e)) {
            _UnhandledException(e);
        }
    }
}

void Application::_MacOSNotificationReceived(const std::string& name) {
    if (name == _MacOSDistributedNotifications::kThemeChanged ||
        name == _MacOSDistributedNotifications::kColorPreferencesChanged) {
        RaiseEvent([this] { Event_AppearanceChanged(); });
    }
}

void Application::_x_SetVersionData(long long major, long long minor, long long bug,
                                    long long nonRelease, long long stageCode,
                                    std::string longVersion, std::string shortVersion,
                                    std::string packageInfo) {
    MajorVersion = major;
    MinorVersion = minor;
    BugVersion = bug;
    NonReleaseVersion = nonRelease;
    StageCode = stageCode;
    LongVersion = std::move(longVersion);
    ShortVersion = std::move(shortVersion);
    PackageInfo = std::move(packageInfo);
}

Ref<Application> CurrentApplication() {
    return theApplication;
}

void _RuntimeRegisterAppObject(Ref<Application> app) {
    theApplication = std::move(app);
}

void RaiseEvent(const std::function<void()>& handler) {
    ++handlersEntered;
    // A C++ exception must not cross Qt's event loop; one that is no RuntimeException,
    // which the run-time would raise again, ends here at the last resort instead. Without an
    // application object the rule is that of one without an UnhandledException handler.
    try {
        if (theApplication) {
            theApplication->_CallFunctionWithExceptionHandling(handler);
        } else {
            handler();
        }
    } catch (const EndException&) {
    } catch (const ThreadEndException&) {
    } catch (const RuntimeException& e) {
        _UnhandledException(e);
    } catch (const std::exception& e) {
        std::fprintf(stderr, "Unhandled std::exception: %s\n", e.what());
    }
}

long long HandlersEntered() {
    return handlersEntered;
}
