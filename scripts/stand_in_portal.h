// A stand-in for the desktop's settings portal (org.freedesktop.portal.Settings) that keeps only
// the colour scheme: 0 for no preference, 1 for dark, 2 for light. The portal's tests and the
// README's pictures put it on a session bus of their own.
#pragma once

#include <QDBusAbstractAdaptor>
#include <QDBusVariant>

#include <atomic>

class StandInSettings : public QDBusAbstractAdaptor {
    Q_OBJECT
    Q_CLASSINFO("D-Bus Interface", "org.freedesktop.portal.Settings")

  public:
    static constexpr const char* kService = "org.freedesktop.portal.Desktop";
    static constexpr const char* kPath = "/org/freedesktop/portal/desktop";
    static constexpr uint kNoPreference = 0, kDark = 1, kLight = 2;

    explicit StandInSettings(QObject* portal) : QDBusAbstractAdaptor(portal) {}

    // The desktop switches: the portal tells everyone who listens. On the portal's thread.
    void Switch(uint newScheme);

    std::atomic<uint> scheme{kNoPreference};

  public slots:
    // As the portal's own Read, the value comes wrapped twice.
    QDBusVariant Read(const QString& group, const QString& key);

  signals:
    void SettingChanged(const QString& group, const QString& key, const QDBusVariant& value);
};
