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

struct Layout {
    friend void PrintTo(const Layout& c, std::ostream* os) { *os << c.name; }
    const char* name;
    const char* executable;  // relative to the temporary folder
    const char* resources;   // where the plug-ins are put, relative to it
};

class ResourcesFolderTest : public ::testing::TestWithParam<Layout> {
  protected:
    TempDir tree;
};

// The folder is the same whether or not anything stands there yet.
TEST_P(ResourcesFolderTest, FindsThePlugInsOfItsLayout) {
    const Layout& layout = GetParam();
    const fs::path executable = tree.Path() / layout.executable;
    EXPECT_EQ(ResourcesFolderFor(executable), tree.Path() / layout.resources);
    WriteFile(executable, "ELF");
    WriteFile(tree.Path() / layout.resources / "Quilbrant.aip/Contents/Info.plist", "<plist/>");
    const fs::path folder = ResourcesFolderFor(executable);
    EXPECT_EQ(folder, tree.Path() / layout.resources);
    EXPECT_TRUE(GetFolderItem(folder.string(), 3)->Child("Quilbrant.aip")->Directory());
}

INSTANTIATE_TEST_SUITE_P(
    Layouts, ResourcesFolderTest,
    ::testing::Values(
        Layout{"BundleWithBlanks",
               "Applications/Orbelane Verification Storage.app/Contents/MacOS/ovs",
               "Applications/Orbelane Verification Storage.app/Contents/Resources"},
        Layout{"InstalledUnderAPrefixWithBlanks", "opt/my tools/bin/ovs", "opt/my tools/share/ovs"},
        Layout{"BuildTree", "build/ovs", "build/ovs Resources"},
        Layout{"BuildTreeInAFolderNamedMacOS", "src/MacOS/ovs", "src/MacOS/ovs Resources"},
        Layout{"BuildTreeInAFolderNamedContents", "Contents/ovs", "Contents/ovs Resources"}),
    [](const ::testing::TestParamInfo<Layout>& info) { return std::string(info.param.name); });

TEST(ResourcesFolder, TheRunningProgramLooksBesideItsOwnExecutable) {
    SetResourcesFolderForTesting({});
    const fs::path executable = ExecutableFile();
    ASSERT_TRUE(executable.is_absolute()) << executable;
    EXPECT_TRUE(fs::exists(executable));
    EXPECT_EQ(SpecialFolder::Resources()->NativePath(), ResourcesFolderFor(executable));
}

// Where the window's icon comes from: the desktop's icon theme by the program's name, else the
// SVG installed with the program, else none.
struct IconCase {
    const char* name;
    const char* themeColour;      // the theme's icon of that name, or none
    const char* installedColour;  // the icon installed with the program, or none
    const char* shownColour;      // in the window's icon, or none at all
};

class InstalledIconTest : public ::testing::TestWithParam<IconCase> {
  protected:
    ~InstalledIconTest() override {
        QIcon::setThemeSearchPaths(searchPaths_);
        QIcon::setThemeName(themeName_);
        QGuiApplication::setWindowIcon(QIcon());
    }

    static std::string Square(const char* colour) {
        return std::string(R"(<svg xmlns="http://www.w3.org/2000/svg" width="16" height="16">)") +
               R"(<rect width="16" height="16" fill=")" + colour + R"("/></svg>)";
    }

    TempDir tree;

  private:
    const QStringList searchPaths_ = QIcon::themeSearchPaths();
    const QString themeName_ = QIcon::themeName();
};

TEST_P(InstalledIconTest, WindowIconComesFromTheThemeElseTheInstalledFile) {
    const IconCase& icon = GetParam();
    const fs::path themes = tree.Path() / "themes";
    WriteFile(themes / "test/index.theme",
              "[Icon Theme]\nName=Test\nDirectories=apps\n\n[apps]\nSize=16\nType=Scalable\n");
    if (icon.themeColour) {
        WriteFile(themes / "test/apps/ovs.svg", Square(icon.themeColour));
    }
    const fs::path prefix = tree.Path() / "opt/my tools";
    if (icon.installedColour) {
        WriteFile(prefix / "share/icons/hicolor/scalable/apps/ovs.svg",
                  Square(icon.installedColour));
    }
    QIcon::setThemeSearchPaths({QString::fromStdString(themes.string())});
    QIcon::setThemeName("test");

    UseInstalledIcon(prefix / "bin/ovs");

    const QIcon shown = QGuiApplication::windowIcon();
    if (!icon.shownColour) {
        EXPECT_TRUE(shown.pixmap(16).isNull());
        return;
    }
    EXPECT_EQ(shown.pixmap(16).toImage().pixelColor(8, 8), QColor(icon.shownColour));
}

INSTANTIATE_TEST_SUITE_P(Sources, InstalledIconTest,
                         ::testing::Values(IconCase{"ThemeFirst", "#0000ff", "#ff0000", "#0000ff"},
                                           IconCase{"InstalledFile", nullptr, "#ff0000", "#ff0000"},
                                           IconCase{"ThemeAlone", "#0000ff", nullptr, "#0000ff"},
                                           IconCase{"None", nullptr, nullptr, nullptr}),
                         [](const ::testing::TestParamInfo<IconCase>& info) {
                             return std::string(info.param.name);
                         });

}  // namespace
