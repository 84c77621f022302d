// The stand-in portal's colour scheme, read and switched.
#include "scripts/stand_in_portal.h"

namespace {
constexpr const char* kGroup = "org.freedesktop.appearance";
constexpr const char* kKey = "color-scheme";
}  // namespace

void StandInSettings::Switch(uint newScheme) {
    scheme = newScheme;
    emit SettingChanged(kGroup, kKey, QDBusVariant(QVariant(newScheme)));
}

QDBusVariant StandInSettings::Read(const QString& group, const QString& key) {
    const QVariant value = group == kGroup && key == kKey ? QVariant(scheme.load()) : QVariant();
    return QDBusVariant(QVariant::fromValue(QDBusVariant(value)));
}
