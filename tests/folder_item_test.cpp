// File items in temporary trees: shell paths, children, order, copies and the root mapping;
// CopyFileOrFolder with no window, whose whole bundles, loops and depth the installer tests meet;
// the resources rule on each layout the program ships in, and the window icon installed beside
// the resources.
#include <sys/stat.h>
#include <unistd.h>

#include <QColor>
#include <QIcon>
#include <QImage>

#include "installer/copy.h"
#include "platform/core/folder_item.h"
#include "platform/core/resources_folder.h"
#include "platform/runtime/runtime.h"
#include "support.h"

using namespace testsupport;
namespace fs = std::filesystem;

namespace {

class FolderItemTest : public RootedTest {
  protected:
    // The item at a path below the tree.
    Ref<FolderItem> At(const fs::path& below) const {
        return GetFolderItem((tree.Path() / below).string(), 3);
    }
    fs::path src = tree.Path() / "src";
    fs::path dst = tree.Path() / "dst";
};

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
    Ref<FolderItem> item = At("odd\\name with blank");
    EXPECT_NE(item->ShellPath().find("with\\ blank"), std::string::npos);
    EXPECT_EQ(GetFolderItem(item->ShellPath(), 1)->NativePath(), item->NativePath());
    EXPECT_TRUE(GetFolderItem(item->ShellPath(), 1)->Exists());
}

TEST_F(FolderItemTest, ItemsComeInNameOrderDotFilesIncluded) {
    for (const char* name : {"b", ".DS_Store", "a", "C"}) {
        WriteFile(tree.Path() / "f" / name, name);
    }
    Ref<FolderItem> folder = At("f");
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
    WriteFile(src / "plugin.aip", "new");
    WriteFile(dst / "plugin.aip", "old");
    Ref<FolderItem> source = At("src/plugin.aip");
    source->CopyFileTo(At("dst"));
    EXPECT_EQ(ReadFile(dst / "plugin.aip"), "new");
    // Into a stray file nothing is written, and nothing raised; into a missing folder is met on
    // the installation page.
    WriteFile(tree.Path() / "DC/Plug-ins", "a stray file");
    source->CopyFileTo(At("DC/Plug-ins"));
    EXPECT_EQ(ReadFile(tree.Path() / "DC/Plug-ins"), "a stray file");

    // A read-only copy of an earlier install is replaced as well.
    fs::permissions(dst / "plugin.aip", fs::perms::owner_read);
    WriteFile(src / "plugin.aip", "newer");
    source->CopyFileTo(At("dst"));
    EXPECT_EQ(ReadFile(dst / "plugin.aip"), "newer");
}

// An item that can't be read would be skipped without a trace: the copy raises instead, and
// writes nothing. Root reads any file, so an unreadable file is tried by others only.
TEST_F(FolderItemTest, CopyFileToRaisesOnAnUnreadableItemAndWritesNothing) {
    fs::create_directories(src);
    fs::create_directories(dst);
    const fs::path link = src / "link", fifo = src / "fifo";
    fs::create_symlink("gone", link);
    ASSERT_EQ(mkfifo(fifo.c_str(), 0600), 0);
    std::vector<fs::path> items = {link, fifo};
    if (geteuid() != 0) {
        items.push_back(src / "secret");
        WriteFile(items.back(), "secret");
        fs::permissions(items.back(), fs::perms::none);
    }
    for (const fs::path& item : items) {
        EXPECT_THROW(GetFolderItem(item.string(), 3)->CopyFileTo(At("dst")), IOException) << item;
    }
    EXPECT_TRUE(fs::is_empty(dst));
}

TEST_F(FolderItemTest, CreateAsFolderRaisesOnlyWhereSomethingElseStands) {
    Ref<FolderItem> missing = GetFolderItem(tree.Path().string(), 3)->Child("Plug-ins");
    EXPECT_FALSE(missing->Exists());
    EXPECT_EQ(missing->Count(), 0);
    WriteFile(tree.Path() / "Plug-ins/Quilbrant.aip", "a leftover");
    fs::create_symlink("gone", tree.Path() / "Plug-ins/Ostrelin.acroplugin");
    fs::create_directories(tree.Path() / "Plug-ins/Folder");
    EXPECT_THROW(At("Plug-ins/Quilbrant.aip")->CreateAsFolder(), IOException);
    EXPECT_THROW(At("Plug-ins/Ostrelin.acroplugin")->CreateAsFolder(), IOException);
    EXPECT_EQ(ReadFile(tree.Path() / "Plug-ins/Quilbrant.aip"), "a leftover");
    At("Plug-ins/Folder")->CreateAsFolder();  // where a folder stands, nothing happens
    At("Missing/Folder")->CreateAsFolder();
    At("Plug-ins/Quilbrant.aip/Contents")->CreateAsFolder();
    EXPECT_FALSE(fs::exists(tree.Path() / "Missing"));  // no parent: no folder, no exception
    EXPECT_TRUE(GetFolderItem(tree.Path().string(), 3)->Child("").IsNil());
}

// The same folder twice, but side by side and not on one path, is no loop.
TEST_F(FolderItemTest, CopyingTheSameFolderLinkedTwiceSideBySideIsNoLoop) {
    WriteFile(tree.Path() / "shared/s.txt", "s");
    fs::create_directories(src / "P.plugin");
    fs::create_directory_symlink(tree.Path() / "shared", src / "P.plugin/one");
    fs::create_directory_symlink(tree.Path() / "shared", src / "P.plugin/two");
    fs::create_directories(dst);
    CopyFileOrFolder(At("src/P.plugin"), At("dst"));
    EXPECT_EQ(ReadFile(dst / "P.plugin/one/s.txt"), "s");
    EXPECT_EQ(ReadFile(dst / "P.plugin/two/s.txt"), "s");
}

// A Plug-ins folder that refuses new items, met by a user without the rights to write there:
// the copy returns without raising and leaves nothing, so the install's copy check tells the
// user to check their access. Root may write anywhere, so the check runs as nobody.
TEST_F(FolderItemTest, AFolderThatRefusesTheCopyIsASilentFailure) {
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
                CopyFileOrFolder(At("src/P.plugin"), At("dst/Plug-ins"));
            } catch (const RuntimeException&) {
                std::_Exit(1);
            }
            std::_Exit(fs::exists(dst / "Plug-ins/P.plugin") ? 2 : 0);
        },
        ::testing::ExitedWithCode(0), "");
}

// The folder is the same whether or not anything stands there yet.
TEST(ResourcesFolder, EachLayoutFindsItsPlugIns) {
    const std::pair<const char*, const char*> layouts[] = {
        // The executable and the folder where its plug-ins are put, relative to the tree.
        {"Applications/Orbelane Verification Storage.app/Contents/MacOS/ovs",
         "Applications/Orbelane Verification Storage.app/Contents/Resources"},
        {"opt/my tools/bin/ovs", "opt/my tools/share/ovs"},
        {"build/ovs", "build/ovs Resources"},
        {"src/MacOS/ovs", "src/MacOS/ovs Resources"},
        {"Contents/ovs", "Contents/ovs Resources"}};
    for (const auto& [executable, resources] : layouts) {
        SCOPED_TRACE(executable);
        TempDir tree;
        EXPECT_EQ(ResourcesFolderFor(tree.Path() / executable), tree.Path() / resources);
        WriteFile(tree.Path() / executable, "ELF");
        WriteFile(tree.Path() / resources / "Quilbrant.aip/Contents/Info.plist", "<plist/>");
        const fs::path folder = ResourcesFolderFor(tree.Path() / executable);
        EXPECT_EQ(folder, tree.Path() / resources);
        EXPECT_TRUE(GetFolderItem(folder.string(), 3)->Child("Quilbrant.aip")->Directory());
    }
}

TEST(ResourcesFolder, TheRunningProgramLooksBesideItsOwnExecutable) {
    SetResourcesFolderForTesting({});
    const fs::path executable = ExecutableFile();
    ASSERT_TRUE(executable.is_absolute()) << executable;
    EXPECT_TRUE(fs::exists(executable));
    EXPECT_EQ(SpecialFolder::Resources()->NativePath(), ResourcesFolderFor(executable));
}

std::string Square(const char* colour) {
    return std::string(R"(<svg xmlns="http://www.w3.org/2000/svg" width="16" height="16">)") +
           R"(<rect width="16" height="16" fill=")" + colour + R"("/></svg>)";
}

// Where the window's icon comes from: the desktop's icon theme by the program's name, else the
// SVG installed with the program, else none.
TEST(ResourcesFolder, WindowIconComesFromTheThemeElseTheInstalledFile) {
    const QStringList searchPaths = QIcon::themeSearchPaths();
    const QString themeName = QIcon::themeName();
    // The colours of the theme's icon of that name and of the installed one, or no such icon.
    const std::pair<const char*, const char*> cases[] = {
        {"#0000ff", "#ff0000"}, {nullptr, "#ff0000"}, {"#0000ff", nullptr}, {nullptr, nullptr}};
    for (const auto& [theme, installed] : cases) {
        TempDir tree;
        const fs::path themes = tree.Path() / "themes", prefix = tree.Path() / "opt/my tools";
        WriteFile(themes / "test/index.theme",
                  "[Icon Theme]\nName=Test\nDirectories=apps\n\n[apps]\nSize=16\nType=Scalable\n");
        if (theme) {
            WriteFile(themes / "test/apps/ovs.svg", Square(theme));
        }
        if (installed) {
            WriteFile(prefix / "share/icons/hicolor/scalable/apps/ovs.svg", Square(installed));
        }
        QIcon::setThemeSearchPaths({QString::fromStdString(themes.string())});
        QIcon::setThemeName("test");
        QGuiApplication::setWindowIcon(QIcon());

        UseInstalledIcon(prefix / "bin/ovs");

        const QPixmap shown = QGuiApplication::windowIcon().pixmap(16);
        const char* expected = theme ? theme : installed;
        EXPECT_EQ(shown.isNull() ? QColor() : shown.toImage().pixelColor(8, 8),
                  expected ? QColor(expected) : QColor())
            << (theme ? "theme " : "") << (installed ? "installed" : "");
    }
    QIcon::setThemeSearchPaths(searchPaths);
    QIcon::setThemeName(themeName);
    QGuiApplication::setWindowIcon(QIcon());
}

}  // namespace
