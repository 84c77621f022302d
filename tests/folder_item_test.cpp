// File items in temporary trees: shell paths, children, order, copies and the root mapping.
#include <sys/stat.h>
#include <unistd.h>

#include "platform/core/folder_item.h"
#include "support.h"

using namespace testsupport;
namespace fs = std::filesystem;

namespace {

class FolderItemTest : public RootedTest {};

TEST_F(FolderItemTest, ShellPathsRoundTrip) {
    fs::create_directories(tree.Path() / "Users/user/Library/Application Support/Adobe");
    Ref<FolderItem> data = SpecialFolder::ApplicationData();
    EXPECT_EQ(data->ShellPath(), "/Users/user/Library/Application\\ Support");
    // A path ending in a slash is the folder itself.
    Ref<FolderItem> adobe = GetFolderItem(data->ShellPath() + "/Adobe/", 1);
    ASSERT_FALSE(adobe.IsNil());
    EXPECT_TRUE(adobe->Directory());
    EXPECT_EQ(adobe->Name(), "Adobe");
    EXPECT_EQ(adobe->Child("x")->NativePath(),
              tree.Path() / "Users/user/Library/Application Support/Adobe/x");
    EXPECT_TRUE(GetFolderItem("relative/path", 1).IsNil());
    EXPECT_TRUE(GetFolderItem("/x", 2).IsNil());

    // Without a root, blanks and backslashes round-trip too.
    unsetenv("ORBELANE_ROOT");
    fs::create_directories(tree.Path() / "odd\\name with blank");
    Ref<FolderItem> item = GetFolderItem((tree.Path() / "odd\\name with blank").string(), 3);
    EXPECT_NE(item->ShellPath().find("with\\ blank"), std::string::npos);
    EXPECT_EQ(GetFolderItem(item->ShellPath(), 1)->NativePath(), item->NativePath());
    EXPECT_TRUE(GetFolderItem(item->ShellPath(), 1)->Exists());
}

TEST_F(FolderItemTest, ItemsComeInNameOrderDotFilesIncluded) {
    for (const char* name : {"b", ".DS_Store", "a", "C"}) {
        WriteFile(tree.Path() / "f" / name, name);
    }
    Ref<FolderItem> folder = GetFolderItem((tree.Path() / "f").string(), 3);
    ASSERT_EQ(folder->Count(), 4);
    std::vector<std::string> names;
    for (long long i = 1; i <= folder->Count(); ++i) {
        names.push_back(folder->Item(i)->Name());
    }
    EXPECT_EQ(names, (std::vector<std::string>{".DS_Store", "C", "a", "b"}));
    EXPECT_TRUE(folder->Item(0).IsNil());
    EXPECT_TRUE(folder->Item(5).IsNil());
    WriteFile(tree.Path() / "f/new", "x");  // seen right after a listing
    EXPECT_EQ(folder->Count(), 5);
}

TEST_F(FolderItemTest, CopyFileToPutsTheCopyInsideAFolderOnly) {
    WriteFile(tree.Path() / "src/plugin.aip", "new");
    WriteFile(tree.Path() / "dst/plugin.aip", "old");
    Ref<FolderItem> source = GetFolderItem((tree.Path() / "src/plugin.aip").string(), 3);
    source->CopyFileTo(GetFolderItem((tree.Path() / "dst").string(), 3));
    EXPECT_EQ(ReadFile(tree.Path() / "dst/plugin.aip"), "new");
    // Into a stray file nothing is written, and nothing raised; into a missing folder is met on
    // the installation page.
    WriteFile(tree.Path() / "DC/Plug-ins", "a stray file");
    source->CopyFileTo(GetFolderItem((tree.Path() / "DC/Plug-ins").string(), 3));
    EXPECT_EQ(ReadFile(tree.Path() / "DC/Plug-ins"), "a stray file");

    // A read-only copy of an earlier install is replaced as well.
    fs::permissions(tree.Path() / "dst/plugin.aip", fs::perms::owner_read);
    WriteFile(tree.Path() / "src/plugin.aip", "newer");
    source->CopyFileTo(GetFolderItem((tree.Path() / "dst").string(), 3));
    EXPECT_EQ(ReadFile(tree.Path() / "dst/plugin.aip"), "newer");
}

// An item that can't be read would be skipped without a trace: the copy raises instead, and
// writes nothing. Root reads any file, so an unreadable file is tried by others only.
TEST_F(FolderItemTest, CopyFileToRaisesOnAnUnreadableItemAndWritesNothing) {
    fs::create_directories(tree.Path() / "src");
    fs::create_directories(tree.Path() / "dst");
    const fs::path link = tree.Path() / "src/link", fifo = tree.Path() / "src/fifo";
    fs::create_symlink("gone", link);
    ASSERT_EQ(mkfifo(fifo.c_str(), 0600), 0);
    std::vector<fs::path> items = {link, fifo};
    if (geteuid() != 0) {
        items.push_back(tree.Path() / "src/secret");
        WriteFile(items.back(), "secret");
        fs::permissions(items.back(), fs::perms::none);
    }
    for (const fs::path& item : items) {
        EXPECT_THROW(GetFolderItem(item.string(), 3)
                         ->CopyFileTo(GetFolderItem((tree.Path() / "dst").string(), 3)),
                     IOException)
            << item;
    }
    EXPECT_TRUE(fs::is_empty(tree.Path() / "dst"));
}

TEST_F(FolderItemTest, CreateAsFolderRaisesOnlyWhereSomethingElseStands) {
    Ref<FolderItem> missing = GetFolderItem(tree.Path().string(), 3)->Child("Plug-ins");
    EXPECT_FALSE(missing->Exists());
    EXPECT_EQ(missing->Count(), 0);
    WriteFile(tree.Path() / "Plug-ins/Quilbrant.aip", "a leftover");
    fs::create_symlink("gone", tree.Path() / "Plug-ins/Ostrelin.acroplugin");
    fs::create_directories(tree.Path() / "Plug-ins/Folder");
    auto at = [&](const char* path) { return GetFolderItem((tree.Path() / path).string(), 3); };
    EXPECT_THROW(at("Plug-ins/Quilbrant.aip")->CreateAsFolder(), IOException);
    EXPECT_THROW(at("Plug-ins/Ostrelin.acroplugin")->CreateAsFolder(), IOException);
    EXPECT_EQ(ReadFile(tree.Path() / "Plug-ins/Quilbrant.aip"), "a leftover");
    at("Plug-ins/Folder")->CreateAsFolder();  // where a folder stands, nothing happens
    at("Missing/Folder")->CreateAsFolder();
    at("Plug-ins/Quilbrant.aip/Contents")->CreateAsFolder();
    EXPECT_FALSE(fs::exists(tree.Path() / "Missing"));  // no parent: no folder, no exception
    EXPECT_TRUE(GetFolderItem(tree.Path().string(), 3)->Child("").IsNil());
}

}  // namespace
