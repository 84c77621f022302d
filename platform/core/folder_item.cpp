// FolderItem over std::filesystem. Every operation uses the error-code forms: a failure of
// the file system shows in Exists, Directory and Count, and raises only where a folder that
// stands can't be listed.
#include "platform/core/folder_item.h"

#include <algorithm>
#include <chrono>
#include <cstdlib>
#include <system_error>

#include <QFile>
#include <QStandardPaths>

#include "platform/core/resources_folder.h"

namespace fs = std::filesystem;

namespace {

fs::path resourcesForTesting;

std::string WithoutTrailingSlashes(std::string path) {
    while (path.size() > 1 && path.back() == '/') {
        path.pop_back();
    }
    return path;
}

std::string Unescape(const std::string& shellPath) {
    std::string out;
    for (size_t i = 0; i < shellPath.size(); ++i) {
        if (shellPath[i] == '\\' && i + 1 < shellPath.size()) {
            ++i;
        }
        out += shellPath[i];
    }
    return out;
}

Ref<FolderItem> MakeFromNative(const std::string& native) {
    if (native.empty() || native[0] != '/') {
        return nullptr;
    }
    return New<FolderItem>(fs::path(native));
}

}  // namespace

FolderItem::FolderItem(fs::path nativePath) : path_(WithoutTrailingSlashes(nativePath.string())) {}

Ref<FolderItem> FolderItem::Child(const std::string& name) const {
    if (name.empty()) {
        return nullptr;
    }
    return New<FolderItem>(path_ / name);
}

Ref<FolderItem> FolderItem::Item(long long index) const {
    const auto& children = Children();
    if (index < 1 || index > static_cast<long long>(children.size())) {
        return nullptr;
    }
    return New<FolderItem>(path_ / children[static_cast<size_t>(index - 1)]);
}

long long FolderItem::Count() const {
    return static_cast<long long>(Children().size());
}

std::string FolderItem::Name() const {
    return path_.filename().string();
}

// A symbolic link counts as something at the path even if it leads nowhere.
bool FolderItem::Exists() const {
    std::error_code error;
    return fs::exists(fs::symlink_status(path_, error));
}

bool FolderItem::Directory() const {
    std::error_code error;
    return fs::is_directory(path_, error);
}

std::string FolderItem::ShellPath() const {
    std::string path = path_.string();
    const std::string root = FileSystemRoot().string();
    if (!root.empty() && path.compare(0, root.size(), root) == 0 &&
        (path.size() == root.size() || path[root.size()] == '/')) {
        path.erase(0, root.size());
        if (path.empty()) {
            path.push_back('/');  // not `= "/"`, which trips a false -Wrestrict in GCC 12
        }
    }
    std::string out;
    for (char c : path) {
        if (c == ' ' || c == '\\') {
            out += '\\';
        }
        out += c;
    }
    return out;
}

// Children are sorted by name, so that the order is the same on every machine.
const std::vector<std::string>& FolderItem::Children() const {
    std::error_code error;
    const auto stamp = fs::last_write_time(path_, error);
    // Folder times tick coarsely: a listing made within a tick of the last change may have
    // missed a later change in the same tick, so it is trusted only once the time is older.
    constexpr auto kTick = std::chrono::milliseconds(20);
    if (!error && childrenRead_ && stamp == childrenStamp_ && listedAt_ - stamp > kTick) {
        return children_;
    }
    children_.clear();
    childrenRead_ = false;
    if (error) {
        return children_;  // nothing stands there
    }
    fs::directory_iterator it(path_, error);
    if (error == std::errc::not_a_directory) {
        return children_;  // a file has no children
    }
    for (const fs::directory_iterator end; !error && it != end; it.increment(error)) {
        children_.push_back(it->path().filename().string());
    }
    if (error) {
        children_.clear();
        throw IOException("Can't list the folder (" + error.message() + "): " + path_.string());
    }
    std::sort(children_.begin(), children_.end());
    childrenStamp_ = stamp;
    listedAt_ = fs::file_time_type::clock::now();
    childrenRead_ = true;
    return children_;
}

Ref<FolderItem> GetFolderItem(const std::string& path, long long mode) {
    if (mode == 3) {
        return MakeFromNative(path);
    }
    if (mode != 1) {
        return nullptr;
    }
    const std::string logical = Unescape(path);
    if (logical.empty() || logical[0] != '/') {
        return nullptr;
    }
    return MakeFromNative(FileSystemRoot().string() + logical);
}

Ref<FolderItem> SpecialFolder::Resources() {
    static Ref<FolderItem> resources;
    fs::path folder = resourcesForTesting;
    if (folder.empty()) {
        folder = ResourcesFolderFor(ExecutableFile());
    }
    // Made once, and again only when the one made before no longer exists or has moved.
    if (resources.IsNil() || !resources->Exists() || resources->NativePath() != folder) {
        resources = GetFolderItem(folder.string(), 3);
    }
    return resources;
}

Ref<FolderItem> SpecialFolder::ApplicationData() {
    const fs::path root = FileSystemRoot();
    if (!root.empty()) {
        return GetFolderItem((root / "Users/user/Library/Application Support").string(), 3);
    }
    // ~/Library/Application Support on macOS, the XDG data home elsewhere.
    const QString data = QStandardPaths::writableLocation(QStandardPaths::GenericDataLocation);
    return GetFolderItem(QFile::encodeName(data).toStdString(), 3);
}

fs::path FileSystemRoot() {
    const char* root = std::getenv("ORBELANE_ROOT");
    if (!root || !*root) {
        return {};
    }
    return fs::path(WithoutTrailingSlashes(root));
}

void MakeFileSystemRootAbsolute() {
    const fs::path root = FileSystemRoot();
    if (root.empty() || root.is_absolute()) {
        return;
    }
    std::error_code error;
    const fs::path absolute = fs::absolute(root, error).lexically_normal();
    if (!error) {
        setenv("ORBELANE_ROOT", WithoutTrailingSlashes(absolute.string()).c_str(), 1);
    }
}

void SetResourcesFolderForTesting(const fs::path& folder) {
    resourcesForTesting = folder;
}
