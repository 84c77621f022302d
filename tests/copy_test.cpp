// CopyFileOrFolder on real trees, with no window; the installer tests cover whole bundles,
// loops and depth.
#include <unistd.h>

#include <cstdlib>

#include "installer/copy.h"
#include "support.h"

using namespace testsupport;
namespace fs = std::filesystem;

namespace {

class CopyTest : public ::testing::Test {
  protected:
    Ref<FolderItem> Item(const fs::path& path) { return GetFolderItem(path.string(), 3); }
    TempDir tree;
    fs::path src = tree.Path() / "src";
    fs::path dst = tree.Path() / "dst";
};

// The same folder twice, but side by side and not on one path, is no loop.
TEST_F(CopyTest, TheSameFolderLinkedTwiceSideBySideIsNoLoop) {
    WriteFile(tree.Path() / "shared/s.txt", "s");
    fs::create_directories(src / "P.plugin");
    fs::create_directory_symlink(tree.Path() / "shared", src / "P.plugin/one");
    fs::create_directory_symlink(tree.Path() / "shared", src / "P.plugin/two");
    fs::create_directories(dst);
    CopyFileOrFolder(Item(src / "P.plugin"), Item(dst));
    EXPECT_EQ(ReadFile(dst / "P.plugin/one/s.txt"), "s");
    EXPECT_EQ(ReadFile(dst / "P.plugin/two/s.txt"), "s");
}

// A Plug-ins folder that refuses new items, met by a user without the rights to write there:
// the copy returns without raising and leaves nothing, so the install's copy check tells the
// user to check their access. Root may write anywhere, so the check runs as nobody.
TEST_F(CopyTest, AFolderThatRefusesTheCopyIsASilentFailure) {
    WriteFile(src / "P.plugin/Contents/a.txt", "a");
    fs::create_directories(dst / "Plug-ins");
    fs::permissions(tree.Path(), fs::perms::owner_all | fs::perms::group_exec |
                                     fs::perms::others_read | fs::perms::others_exec);
    fs::permissions(dst / "Plug-ins", fs::perms::owner_read | fs::perms::owner_exec |
                                          fs::perms::others_read | fs::perms::others_exec);
    EXPECT_EXIT(
        {
            if (geteuid() == 0 && (setgid(65534) != 0 || setuid(65534) != 0)) {
                std::_Exit(3);
            }
            try {
                CopyFileOrFolder(Item(src / "P.plugin"), Item(dst / "Plug-ins"));
            } catch (const RuntimeException&) {
                std::_Exit(1);
            }
            std::_Exit(fs::exists(dst / "Plug-ins/P.plugin") ? 2 : 0);
        },
        ::testing::ExitedWithCode(0), "");
}

}  // namespace
