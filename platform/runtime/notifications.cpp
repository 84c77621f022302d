// Appearance notifications. Off macOS, Qt's palette and theme change events and the
// freedesktop settings portal stand in for the two distributed notifications of the desktop.
#include "platform/runtime/notifications.h"

#include <QApplication>
#include <QEvent>
#include <QObject>
#include <QWidget>

#include <algorithm>

#include "platform/runtime/appearance.h"
#include "platform/runtime/desktop_portal.h"
#include "platform/runtime/timer.h"

std::deque<std::string> _MacOSDistributedNotifications::NotificationQueue;
std::vector<_MacOSDistributedNotifications::iNotify*> _MacOSDistributedNotifications::dispatchTo;

namespace {

class Observer : public QObject {
  public:
    Observer() : portal_([this](Appearance appearance) { SchemeChanged(appearance); }) {}

    // Each application starts from the scheme that the desktop asks for at that moment.
    void FollowDesktopScheme() {
        if (const auto scheme = portal_.Scheme()) {
            Follow(*scheme);
        }
    }

    bool eventFilter(QObject* watched, QEvent* event) override {
        if (followingPortal_) {
            return false;
        }
        if (watched == qApp && event->type() == QEvent::ApplicationPaletteChange) {
            _MacOSDistributedNotifications::gotCalled(
                _MacOSDistributedNotifications::kColorPreferencesChanged);
        } else if (event->type() == QEvent::ThemeChange && watched->isWidgetType() &&
                   static_cast<QWidget*>(watched)->isWindow() && !themeQueued_) {
            // Qt tells every top-level window; the desktop said it once.
            themeQueued_ = true;
            Timer::CallLater(0, [this] { themeQueued_ = false; });
            _MacOSDistributedNotifications::gotCalled(
                _MacOSDistributedNotifications::kThemeChanged);
        }
        return false;
    }

  private:
    // The palette follows first, so that IsDarkMode already answers anew when the event comes.
    void SchemeChanged(Appearance appearance) {
        Follow(appearance);
        _MacOSDistributedNotifications::gotCalled(_MacOSDistributedNotifications::kThemeChanged);
    }

    void Follow(Appearance appearance) {
        followingPortal_ = true;
        FollowDesktopAppearance(appearance);
        followingPortal_ = false;
    }

    DesktopPortal portal_;
    bool themeQueued_ = false;
    bool followingPortal_ = false;  // the palette change that follows is told once, as a theme
};

Observer* mObserverInstance = nullptr;

}  // namespace

void _MacOSDistributedNotifications::Register(iNotify* client) {
    if (!mObserverInstance && !Setup()) {
        return;
    }
    mObserverInstance->FollowDesktopScheme();
    dispatchTo.push_back(client);
}

void _MacOSDistributedNotifications::Unregister(iNotify* client) {
    dispatchTo.erase(std::remove(dispatchTo.begin(), dispatchTo.end(), client), dispatchTo.end());
}

bool _MacOSDistributedNotifications::Setup() {
    if (mObserverInstance) {
        return true;
    }
    if (!qApp) {
        return false;
    }
    mObserverInstance = new Observer;
    mObserverInstance->setParent(qApp);
    qApp->installEventFilter(mObserverInstance);
    return true;
}

void _MacOSDistributedNotifications::gotCalled(const std::string& name) {
    NotificationQueue.push_back(name);
    Timer::CallLater(0, [] { SendToClients(); });
}

void _MacOSDistributedNotifications::SendToClients() {
    while (!NotificationQueue.empty()) {
        const std::string name = NotificationQueue.front();
        for (size_t i = 0; i < dispatchTo.size(); ++i) {
            dispatchTo[i]->_MacOSNotificationReceived(name);
        }
        NotificationQueue.pop_front();
    }
    // The repaint of what follows the appearance is the platform's: rows and frames that are
    // on the screen are drawn again with the new answers.
    for (QWidget* window : QApplication::topLevelWidgets()) {
        window->update();
        for (QWidget* child : window->findChildren<QWidget*>()) {
            child->update();
        }
    }
}
