// The resources rule, over the executable's path that Qt reports on every platform.
#include "platform/core/resources_folder.h"

#include <QCoreApplication>
#include <QFile>

namespace fs = std::filesystem;

fs::path ResourcesFolderFor(const fs::path& executable) {
    const fs::path folder = executable.parent_path();
    const std::string name = executable.filename().string();
    if (folder.filename() == "MacOS" && folder.parent_path().filename() == "Contents") {
        return folder.parent_path() / "Resources";
    }
    if (folder.filename() == "bin") {
        return folder.parent_path() / "share" / name;
    }
    return folder / (name + " Resources");
}

fs::path InstalledIconFor(const fs::path& executable) {
    const fs::path folder = executable.parent_path();
    if (folder.filename() != "bin") {
        return {};
    }
    const std::string name = executable.filename().string();
    return folder.parent_path() / "share/icons/hicolor/128x128/apps" / (name + ".png");
}

fs::path ExecutableFile() {
    if (QCoreApplication::instance() == nullptr) {
        return {};
    }
    return fs::path(QFile::encodeName(QCoreApplication::applicationFilePath()).toStdString());
}
