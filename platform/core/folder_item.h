// FolderItem: a path in the file system, whether or not anything stands there, and the
// functions that make one. Off macOS, the system's absolute paths (the results store,
// /Applications, application data) lie under the root that ORBELANE_ROOT names; the logic
// never sees that root: ShellPath leaves it out and GetFolderItem puts it back.
#pragma once

#include <filesystem>
#include <string>
#include <vector>

#include "platform/core/ref.h"

class FolderItem {
  public:
    explicit FolderItem(std::filesystem::path nativePath);

    // The item of that name directly below this one; it need not exist. Nil for no name.
    Ref<FolderItem> Child(const std::string& name) const;
    // Child number `index` from 1 to Count, in the order of their names; Nil outside.
    Ref<FolderItem> Item(long long index) const;
    // 0 where nothing or a file stands. A folder that can't be listed raises IOException, here
    // and in Item: taken for empty, it would be copied as an empty folder that passes for whole.
    long long Count() const;
    std::string Name() const;
    bool Exists() const;
    bool Directory() const;
    // The absolute path with a backslash before each blank and each backslash.
    std::string ShellPath() const;
    const std::filesystem::path& NativePath() const { return path_; }
    // Copies this item into the folder `destination` under its own name, replacing an item of
    // that name. Into anything but a folder it writes nothing. Failures: see CreateAsFolder.
    void CopyFileTo(const Ref<FolderItem>& destination) const;
    // Creates a folder here; where one stands already, it does nothing. Both writing
    // operations raise IOException when a failure would pass a later Exists unseen: an item
    // that can't be read (a dangling link, an unreadable file, a FIFO), or something other
    // than the intended item left at the path (a file where the folder goes, a failed
    // replacement, a partial copy). Where the destination only refuses new items (it is
    // missing, not a folder, or not writable) and nothing stands at the path, they write
    // nothing and raise nothing: Exists tells.
    void CreateAsFolder() const;

  private:
    const std::vector<std::string>& Children() const;

    std::filesystem::path path_;
    // The sorted names of the children, read again only when the folder has changed, so that
    // a loop that asks Count and Item at each pass reads the folder once.
    mutable std::vector<std::string> children_;
    mutable std::filesystem::file_time_type childrenStamp_;
    mutable std::filesystem::file_time_type listedAt_;
    mutable bool childrenRead_ = false;
};

// Entry check of a recursive walk over folders: raises StackOverflowException when `folder`,
// the same device and inode, is already being walked further up the current path, which only
// a link back up the tree can make. Depth itself is bounded only by the tree.
class FolderLoopCheck {
  public:
    explicit FolderLoopCheck(const FolderItem& folder);
    ~FolderLoopCheck();
    FolderLoopCheck(const FolderLoopCheck&) = delete;
    FolderLoopCheck& operator=(const FolderLoopCheck&) = delete;

  private:
    bool entered_ = false;
};

// Mode 1: a shell path, where a backslash escapes the character behind it. Mode 3: a native
// path, nothing escaped. Nil for another mode or a path that is not absolute.
Ref<FolderItem> GetFolderItem(const std::string& path, long long mode);

namespace SpecialFolder {
// The application's own resources, found from the executable's path (platform/resources_folder.h):
// in the bundle, under the installation prefix or beside the executable in a build tree.
Ref<FolderItem> Resources();
// The user's application data folder.
Ref<FolderItem> ApplicationData();
}  // namespace SpecialFolder

// The root under which absolute paths lie: ORBELANE_ROOT, or empty for the real file system.
std::filesystem::path FileSystemRoot();
// A relative ORBELANE_ROOT is taken from the folder where the program starts: made absolute
// once, at start, so that every path formed later is absolute.
void MakeFileSystemRootAbsolute();
// Tests give the resources folder of the program under test; an empty path restores it.
void SetResourcesFolderForTesting(const std::filesystem::path& folder);
