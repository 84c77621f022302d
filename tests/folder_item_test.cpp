// File items in temporary trees: shell paths, children, order, copies and the root mapping.
#include "platform/folder_item.h"
#include "support.h"

using namespace testsupport;
namespace fs = std::filesystem;

namespace {

class FolderItemTest : public ::testing::Test {
  protected:
    TempDir tree;
    ScopedRoot root{tree.Path()};
};

TEST_F(FolderItemTest, ShellPathsWithBlanksRoundTripWithoutTheRoot) {
    fs::create_directories(tree.Path() / "Users/user/Library/Application Support/Adobe");
    Ref<FolderItem> data = SpecialFolder::ApplicationData();
    EXPECT_EQ(data->ShellPath(), "/Users/user/Library/Application\\ Support");
    Ref<FolderItem> adobe = GetFolderItem(data->ShellPath() + "/Adobe", 1);
    ASSERT_FALSE(adobe.IsNil());
    EXPECT_TRUE(adobe->Directory());
    EXPECT_EQ(adobe->NativePath(), tree.Path() / "Users/user/Library/Application Support/Adobe");
    EXPECT_EQ(adobe->Name(), "Adobe");
}

TEST_F(FolderItemTest, BackslashesInNamesSurviveTheRoundTrip) {
    fs::create_directories(tree.Path() / "odd\\name with blank");
    Ref<FolderItem> odd = GetFolderItem((tree.Path() / "odd\\name with blank").string(), 3);
    Ref<FolderItem> back = GetFolderItem(odd->ShellPath(), 1);
    EXPECT_EQ(back->NativePath(), odd->NativePath());
    EXPECT_TRUE(back->Exists());
}

TEST_F(FolderItemTest, APathEndingInSlashIsTheFolderItself) {
    fs::create_directories(tree.Path() / "Applications/Acrobat/Plug-ins");
    Ref<FolderItem> plugins = GetFolderItem("/Applications/Acrobat/Plug-ins/", 1);
    EXPECT_EQ(plugins->Name(), "Plug-ins");
    EXPECT_TRUE(plugins->Directory());
    EXPECT_EQ(plugins->Child("x")->NativePath(), tree.Path() / "Applications/Acrobat/Plug-ins/x");
    EXPECT_TRUE(GetFolderItem("relative/path", 1).IsNil());
    EXPECT_TRUE(GetFolderItem("/x", 2).IsNil());
}

TEST_F(FolderItemTest, AMissingChildCanBeAskedAndCreated) {
    Ref<FolderItem> top = GetFolderItem(tree.Path().string(), 3);
    Ref<FolderItem> missing = top->Child("Plug-ins");
    EXPECT_FALSE(missing->Exists());
    EXPECT_FALSE(missing->Directory());
    EXPECT_EQ(missing->Count(), 0);
    missing->CreateAsFolder();
    EXPECT_TRUE(missing->Directory());
    missing->CreateAsFolder();  // where a folder stands, nothing happens
    EXPECT_TRUE(missing->Directory());
    EXPECT_TRUE(top->Child("").IsNil());
    top->Child("a")->Child("b")->CreateAsFolder();  // no parent: no folder, and no exception
    EXPECT_FALSE(top->Child("a")->Exists());
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
}

TEST_F(FolderItemTest, CountSeesAChangeMadeRightAfterAListing) {
    fs::create_directories(tree.Path() / "f");
    Ref<FolderItem> folder = GetFolderItem((tree.Path() / "f").string(), 3);
    EXPECT_EQ(folder->Count(), 0);
    WriteFile(tree.Path() / "f/new", "x");
    EXPECT_EQ(folder->Count(), 1);
    fs::remove(tree.Path() / "f/new");
    EXPECT_EQ(folder->Count(), 0);
}

TEST_F(FolderItemTest, CopyFileToPutsTheCopyInsideAFolderAndReplaces) {
    WriteFile(tree.Path() / "src/plugin.aip", "new");
    WriteFile(tree.Path() / "dst/plugin.aip", "old");
    Ref<FolderItem> source = GetFolderItem((tree.Path() / "src/plugin.aip").string(), 3);
    source->CopyFileTo(GetFolderItem((tree.Path() / "dst").string(), 3));
    EXPECT_EQ(ReadFile(tree.Path() / "dst/plugin.aip"), "new");
    source->CopyFileTo(GetFolderItem((tree.Path() / "none/x").string(), 3));  // fails silently
    EXPECT_FALSE(fs::exists(tree.Path() / "none"));
    EXPECT_THROW(source->CopyFileTo(nullptr), NilObjectException);
}

TEST_F(FolderItemTest, WithoutARootPathsStandAsTheyAre) {
    unsetenv("ORBELANE_ROOT");
    Ref<FolderItem> item = GetFolderItem((tree.Path() / "a b").string(), 3);
    EXPECT_EQ(GetFolderItem(item->ShellPath(), 1)->NativePath(), tree.Path() / "a b");
    EXPECT_NE(item->ShellPath().find("a\\ b"), std::string::npos);
}

TEST_F(FolderItemTest, ATestCanGiveTheResourcesFolderAndTakeItBack) {
    SetResourcesFolderForTesting(tree.Path());
    EXPECT_EQ(SpecialFolder::Resources()->NativePath(), tree.Path());
    SetResourcesFolderForTesting({});
    EXPECT_NE(SpecialFolder::Resources()->NativePath(), tree.Path());
}

}  // namespace
