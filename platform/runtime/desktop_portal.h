// The desktop's colour scheme as the freedesktop settings portal tells it on the session bus:
// read when asked, and followed through the portal's SettingChanged signal.
#pragma once

#include <functional>
#include <optional>

#include "platform/runtime/appearance.h"

#ifdef __APPLE__
// macOS has no such portal: Qt follows the system's appearance and tells a change by its events.
class DesktopPortal {
  public:
    explicit DesktopPortal(std::function<void(Appearance)>) {}
    std::optional<Appearance> Scheme() const { return std::nullopt; }
};
#else
#include <QDBusVariant>
#include <QObject>

class DesktopPortal : public QObject {
    Q_OBJECT

  public:
    // Connects to the session bus, if there is one, and listens for changes of the scheme.
    explicit DesktopPortal(std::function<void(Appearance)> changed);

    // The scheme that the desktop asks for now; nothing without a bus or a portal, or when
    // the desktop states no preference.
    std::optional<Appearance> Scheme() const;

  private slots:
    void SettingChanged(const QString& group, const QString& key, const QDBusVariant& value);

  private:
    std::function<void(Appearance)> changed_;
    bool connected_ = false;
};
#endif
