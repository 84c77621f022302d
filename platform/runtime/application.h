// Application: the platform's application object, its events, and the dispatch rule for
// exceptions that leave an event handler.
#pragma once

#include <functional>
#include <string>

#include "platform/core/ref.h"
#include "platform/runtime/notifications.h"

class MenuBar;

class Application : public _MacOSDistributedNotifications::iNotify {
  public:
    Application();  // registers the object for the appearance notifications
    virtual ~Application();
    Application(const Application&) = delete;
    Application& operator=(const Application&) = delete;

    virtual void Event_Open() {}
    virtual void Event_AppearanceChanged() {}
    // True if the exception was dealt with; an application without a handler answers False.
    virtual bool UnhandledException(const RuntimeException&) { return false; }

    // Runs an event handler and settles what leaves it: EndException and ThreadEndException
    // pass in silence, any other RuntimeException goes to UnhandledException and then, if
    // that answers False, to the last resort. Unlike the global helper of the same name, it
    // hands nothing back.
    void _CallFunctionWithExceptionHandling(const std::function<void()>& function);
    // Raises AppearanceChanged for either of the two appearance notification names.
    void _MacOSNotificationReceived(const std::string& name) override;

    void _x_SetVersionData(long long major, long long minor, long long bug, long long nonRelease,
                           long long stageCode, std::string longVersion, std::string shortVersion,
                           std::string packageInfo);

    long long MajorVersion = 0;
    long long MinorVersion = 0;
    long long BugVersion = 0;
    long long NonReleaseVersion = 0;
    long long StageCode = 0;
    std::string LongVersion;
    std::string ShortVersion;
    std::string PackageInfo;

    Ref<::MenuBar> MenuBar;
};

// The process's application object, once _RuntimeRegisterAppObject has run; Nil before.
Ref<Application> CurrentApplication();
void _RuntimeRegisterAppObject(Ref<Application> app);

// Every handler that the platform calls goes through here: through the application's
// exception rule, and never lets an exception into the event loop.
void RaiseEvent(const std::function<void()>& handler);
// How many handlers have been entered through the call above, for tests that count them.
long long HandlersEntered();
