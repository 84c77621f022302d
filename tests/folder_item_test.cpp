// File items in temporary trees: shell paths and the root mapping, and copies that fail with no
// window (order, replacing, bundles, links, loops and depth are met by the installer tests);
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
    // Where nothing stands there are no items, and no child goes without a name.
    EXPECT_EQ(adobe->Child("x")->Count(), 0);
    EXPECT_TRUE(adobe->Child("x")->Item(1).IsNil());
    EXPECT_TRUE(adobe->Child("").IsNil());

    // Without a root, blanks and backslashes round-trip too.
    unsetenv("ORBELANE_ROOT");
    fs::create_directories(tree.Path() / "odd\\name with blank");
    Ref<FolderItem> item = At("odd\\name with blank");
    EXPECT_NE(item->ShellPath().find("with\\ blank"), std::string::npos);
    EXPECT_EQ(GetFolderItem(item->ShellPath(), 1)->NativePath(), item->NativePath());
    EXPECT_TRUE(GetFolderItem(item->ShellPath(), 1)->Exists());
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

// Where each layout that the program ships in puts its plug-ins.
TEST(ResourcesFolder, EachLayoutFindsItsPlugIns) {
    const std::pair<fs::path, fs::path> layouts[] = {
        {"Applications/Orbelane Verification Storage.app/Contents/MacOS/ovs",
         "Applications/Orbelane Verification Storage.app/Contents/Resources"},
        {"opt/my tools/bin/ovs", "opt/my tools/share/ovs"},
        {"build/ovs", "build/ovs Resources"},
        {"src/MacOS/ovs", "src/MacOS/ovs Resources"},
        {"Contents/ovs", "Contents/ovs Resources"}};
    for (const auto& [executable, resources] : layouts) {
        EXPECT_EQ(ResourcesFolderFor(executable), resources) << executable;
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
