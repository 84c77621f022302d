// The settings portal (org.freedesktop.portal.Settings): the key color-scheme of the group
// org.freedesktop.appearance is 1 for dark, 2 for light and 0 for no preference.
#include "platform/runtime/desktop_portal.h"

#ifndef __APPLE__

#include <QDBusConnection>
#include <QDBusMessage>
#include <QFileInfo>

namespace {

constexpr const char* kService = "org.freedesktop.portal.Desktop";
constexpr const char* kPath = "/org/freedesktop/portal/desktop";
constexpr const char* kInterface = "org.freedesktop.portal.Settings";
constexpr const char* kGroup = "org.freedesktop.appearance";
constexpr const char* kKey = "color-scheme";
constexpr const char* kConnectionName = "desktop-portal";
// A portal that is running answers at once; a missing one must not hold up the start.
constexpr int kReadTimeoutMs = 1000;

// The session bus as the desktop announces it, or its usual place in the user's run-time
// folder. A bus is never started here: without one the desktop has no portal either.
QString SessionBusAddress() {
    if (qEnvironmentVariableIsSet("DBUS_SESSION_BUS_ADDRESS")) {
        return qEnvironmentVariable("DBUS_SESSION_BUS_ADDRESS");
    }
    const QString runtime = qEnvironmentVariable("XDG_RUNTIME_DIR");
    if (!runtime.isEmpty() && QFileInfo(runtime + "/bus").exists()) {
        return "unix:path=" + runtime + "/bus";
    }
    return {};
}

// The value comes wrapped in one variant or, from Read, in two.
std::optional<Appearance> SchemeOf(QVariant value) {
    while (value.canConvert<QDBusVariant>() && value.userType() == qMetaTypeId<QDBusVariant>()) {
        value = value.value<QDBusVariant>().variant();
    }
    bool ok = false;
    const uint scheme = value.toUInt(&ok);
    if (!ok) {
        return std::nullopt;
    }
    if (scheme == 1) {
        return Appearance::Dark;
    }
    if (scheme == 2) {
        return Appearance::Light;
    }
    return std::nullopt;
}

}  // namespace

DesktopPortal::DesktopPortal(std::function<void(Appearance)> changed)
    : changed_(std::move(changed)) {
    const QString address = SessionBusAddress();
    if (address.isEmpty()) {
        return;
    }
    // The slot's signature names the type; Qt knows it only once it is registered.
    qRegisterMetaType<QDBusVariant>();
    QDBusConnection bus = QDBusConnection::connectToBus(address, kConnectionName);
    connected_ = bus.isConnected();
    if (connected_) {
        bus.connect(kService, kPath, kInterface, "SettingChanged", this,
                    SLOT(SettingChanged(QString, QString, QDBusVariant)));
    }
}

std::optional<Appearance> DesktopPortal::Scheme() const {
    if (!connected_) {
        return std::nullopt;
    }
    QDBusMessage read = QDBusMessage::createMethodCall(kService, kPath, kInterface, "Read");
    read << QString(kGroup) << QString(kKey);
    const QDBusMessage reply =
        QDBusConnection(kConnectionName).call(read, QDBus::Block, kReadTimeoutMs);
    if (reply.type() != QDBusMessage::ReplyMessage || reply.arguments().isEmpty()) {
        return std::nullopt;
    }
    return SchemeOf(reply.arguments().constFirst());
}

// "No preference" counts as light: the desktop shows its default, light, appearance.
void DesktopPortal::SettingChanged(const QString& group, const QString& key,
                                   const QDBusVariant& value) {
    if (group != kGroup || key != kKey) {
        return;
    }
    changed_(SchemeOf(value.variant()).value_or(Appearance::Light));
}

#endif
