// CopyFileOrFolder on real trees, with no window; the installer tests cover whole bundles.
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

TEST_F(CopyTest, AFileGoesIntoTheFolderUnderItsOwnName) {
    WriteFile(src / "Quilbrant.aip", "binary");
    fs::create_directories(dst);
    CopyFileOrFolder(Item(src / "Quilbrant.aip"), Item(dst));
    EXPECT_EQ(ReadFile(dst / "Quilbrant.aip"), "binary");
}

TEST_F(CopyTest, NilArgumentsRaise) {
    WriteFile(src / "P.plugin/x", "x");
    EXPECT_THROW(CopyFileOrFolder(nullptr, Item(dst)), NilObjectException);
    EXPECT_THROW(CopyFileOrFolder(Item(src / "P.plugin"), nullptr), NilObjectException);
    EXPECT_FALSE(fs::exists(dst));
}

TEST_F(CopyTest, ALinkLoopRaisesStackOverflowAndLeavesWhatWasCopied) {
    WriteFile(src / "P.plugin/a.txt", "a");
    fs::create_directory_symlink(".", src / "P.plugin/loop");
    fs::create_directories(dst);
    EXPECT_THROW(CopyFileOrFolder(Item(src / "P.plugin"), Item(dst)), StackOverflowException);
    EXPECT_TRUE(fs::exists(dst / "P.plugin/loop/loop/a.txt"));
    // The depth counter is back at zero: a plain copy works afterwards.
    CopyFileOrFolder(Item(src / "P.plugin/a.txt"), Item(dst));
}

}  // namespace
