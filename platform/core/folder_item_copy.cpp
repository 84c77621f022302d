// FolderItem's writing operations, CopyFileTo and CreateAsFolder, and the loop check of a
// recursive walk.
//
// Their failures follow one rule, so that the copy check of an install, which asks only
// whether the copied item exists, never takes a failed copy for a good one, and a folder that
// refuses the copy still reads as one that refused it: a failure that would leave the later
// Exists unaware (an unreadable item to copy, or a foreign or partial item at the path) raises
// IOException; a destination that merely refuses new items, with nothing left at the path, is
// a silent failure that Exists reports.
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <system_error>
#include <utility>
#include <vector>

#include "platform/core/folder_item.h"

namespace fs = std::filesystem;

namespace {

// Failures in which the destination folder turns the new item away before anything is made.
bool RefusedByDestination(const std::error_code& error) {
    return error == std::errc::permission_denied || error == std::errc::operation_not_permitted ||
           error == std::errc::read_only_file_system ||
           error == std::errc::no_such_file_or_directory || error == std::errc::not_a_directory;
}

[[noreturn]] void Raise(const std::string& what, const fs::path& path) {
    throw IOException(what + ": " + path.string());
}

// A plain file to copy must open for reading; a link is followed. Anything that is neither
// such a file nor a folder (a dangling link, a FIFO, a device) can't be copied faithfully.
void RequireReadable(const fs::path& path) {
    const int fd = ::open(path.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC);
    if (fd < 0) {
        Raise("Can't read the item to copy", path);
    }
    struct stat status {};
    const bool regular = ::fstat(fd, &status) == 0 && S_ISREG(status.st_mode);
    ::close(fd);
    if (!regular) {
        Raise("Not a file or folder", path);
    }
}

void CopyOneFile(const fs::path& from, const fs::path& to, std::error_code& error) {
    fs::copy_file(from, to, fs::copy_options::overwrite_existing, error);
    // A read-only file of an earlier copy is replaced as a whole, as cp -f would.
    if (error == std::errc::permission_denied && fs::is_regular_file(fs::symlink_status(to))) {
        std::error_code removed;
        if (fs::remove(to, removed)) {
            error.clear();
            fs::copy_file(from, to, error);
        }
    }
}

std::vector<std::pair<dev_t, ino_t>> walkedFolders;

}  // namespace

void FolderItem::CopyFileTo(const Ref<FolderItem>& destination) const {
    const fs::path folder = destination->NativePath();
    const fs::path target = folder / path_.filename();
    std::error_code error;
    const bool isFolder = fs::is_directory(path_, error);
    if (!isFolder) {
        RequireReadable(path_);
    }
    if (!fs::is_directory(folder, error)) {
        return;  // not a folder: nothing is written at the destination's own path
    }
    if (isFolder) {
        fs::copy(path_, target, fs::copy_options::recursive | fs::copy_options::overwrite_existing,
                 error);
    } else {
        CopyOneFile(path_, target, error);
    }
    if (error && (FolderItem(target).Exists() || !RefusedByDestination(error))) {
        Raise("Copy failed (" + error.message() + ")", target);
    }
}

void FolderItem::CreateAsFolder() const {
    std::error_code error;
    fs::create_directory(path_, error);
    if (error && (Exists() || !RefusedByDestination(error))) {
        Raise("Can't create a folder (" + error.message() + ")", path_);
    }
}

FolderLoopCheck::FolderLoopCheck(const FolderItem& folder) {
    struct stat status {};
    if (::stat(folder.NativePath().c_str(), &status) != 0) {
        return;  // nothing there to walk, so nothing to meet again
    }
    const std::pair<dev_t, ino_t> id{status.st_dev, status.st_ino};
    for (const auto& walked : walkedFolders) {
        if (walked == id) {
            throw StackOverflowException("Stack overflow: a folder contains itself");
        }
    }
    walkedFolders.push_back(id);
    entered_ = true;
}

FolderLoopCheck::~FolderLoopCheck() {
    if (entered_) {
        walkedFolders.pop_back();
    }
}
