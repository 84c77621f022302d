// Serves a stand-in settings portal on the session bus until it is ended, so that the program
// started on that bus shows the appearance given here.
// Usage: orbelane-stand-in-portal light|dark
#include <QCoreApplication>
#include <QDBusConnection>

#include <cstdio>
#include <string>

#include "scripts/stand_in_portal.h"

int main(int argc, char** argv) {
    const std::string scheme = argc > 1 ? argv[1] : "";
    if (scheme != "light" && scheme != "dark") {
        std::fprintf(stderr, "usage: %s light|dark\n", argv[0]);
        return 2;
    }
    QCoreApplication application(argc, argv);
    QObject portal;
    auto* settings = new StandInSettings(&portal);
    settings->scheme = scheme == "dark" ? StandInSettings::kDark : StandInSettings::kLight;
    QDBusConnection bus = QDBusConnection::sessionBus();
    if (!bus.registerObject(StandInSettings::kPath, &portal) ||
        !bus.registerService(StandInSettings::kService)) {
        std::fprintf(stderr, "no session bus, or the portal's name is taken\n");
        return 1;
    }
    return QCoreApplication::exec();
}
