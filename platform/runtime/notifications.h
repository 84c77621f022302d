// The path by which a change of the desktop's appearance becomes the application's
// AppearanceChanged event: an observer queues the notification's name, and the queue is
// delivered to the registered clients later, from the event loop.
#pragma once

#include <deque>
#include <string>
#include <vector>

class _MacOSDistributedNotifications {
  public:
    // What a client implements to hear of the notifications.
    class iNotify {
      public:
        virtual void _MacOSNotificationReceived(const std::string& name) = 0;

      protected:
        ~iNotify() = default;
    };

    static constexpr const char* kThemeChanged = "AppleInterfaceThemeChangedNotification";
    static constexpr const char* kColorPreferencesChanged =
        "AppleColorPreferencesChangedNotification";

    static void Register(iNotify* client);
    static void Unregister(iNotify* client);
    static bool Setup();
    // The observer's callback: queue the name and ask for SendToClients from the event loop.
    static void gotCalled(const std::string& name);
    static void SendToClients();

    static std::deque<std::string> NotificationQueue;
    static std::vector<iNotify*> dispatchTo;
};
