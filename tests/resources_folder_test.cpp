// The resources rule on each layout the program ships in, and the window icon installed beside
// the resources, built in a temporary folder.
#include "platform/core/resources_folder.h"

#include <QColor>
#include <QGuiApplication>
#include <QIcon>
#include <QImage>

#include "platform/core/folder_item.h"
#include "platform/runtime/runtime.h"
#include "support.h"

using namespace testsupport;
namespace fs = std::filesystem;

namespace {

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
    const struct {
        const char* theme;      // the colour of the theme's icon of that name, or none
        const char* installed;  // of the icon installed with the program, or none
        const char* shown;      // in the window's icon, or none at all
    } cases[] = {{"#0000ff", "#ff0000", "#0000ff"},
                 {nullptr, "#ff0000", "#ff0000"},
                 {"#0000ff", nullptr, "#0000ff"},
                 {nullptr, nullptr, nullptr}};
    for (const auto& icon : cases) {
        SCOPED_TRACE(&icon - cases);
        TempDir tree;
        const fs::path themes = tree.Path() / "themes";
        WriteFile(themes / "test/index.theme",
                  "[Icon Theme]\nName=Test\nDirectories=apps\n\n[apps]\nSize=16\nType=Scalable\n");
        if (icon.theme) {
            WriteFile(themes / "test/apps/ovs.svg", Square(icon.theme));
        }
        const fs::path prefix = tree.Path() / "opt/my tools";
        if (icon.installed) {
            WriteFile(prefix / "share/icons/hicolor/scalable/apps/ovs.svg", Square(icon.installed));
        }
        QIcon::setThemeSearchPaths({QString::fromStdString(themes.string())});
        QIcon::setThemeName("test");
        QGuiApplication::setWindowIcon(QIcon());

        UseInstalledIcon(prefix / "bin/ovs");

        const QPixmap shown = QGuiApplication::windowIcon().pixmap(16);
        if (icon.shown) {
            EXPECT_EQ(shown.toImage().pixelColor(8, 8), QColor(icon.shown));
        } else {
            EXPECT_TRUE(shown.isNull());
        }
    }
    QIcon::setThemeSearchPaths(searchPaths);
    QIcon::setThemeName(themeName);
    QGuiApplication::setWindowIcon(QIcon());
}

}  // namespace
