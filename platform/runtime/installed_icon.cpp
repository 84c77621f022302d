// The installed icon, found from the executable's path as the resources are.
#include "platform/runtime/installed_icon.h"

#include <QApplication>
#include <QIcon>

#include <system_error>

#include "platform/core/resources_folder.h"

void UseInstalledIcon() {
    const std::filesystem::path icon = InstalledIconFor(ExecutableFile());
    std::error_code error;
    if (!icon.empty() && std::filesystem::is_regular_file(icon, error)) {
        QApplication::setWindowIcon(QIcon(QString::fromStdString(icon.string())));
    }
}
