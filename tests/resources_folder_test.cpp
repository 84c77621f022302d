// The resources rule and the installed icon on each layout the program ships in, built in a
// temporary folder.
#include "platform/core/resources_folder.h"

#include "platform/core/folder_item.h"
#include "support.h"

using namespace testsupport;
namespace fs = std::filesystem;

namespace {

struct Layout {
    const char* name;
    const char* executable;  // relative to the temporary folder
    const char* resources;   // where the plug-ins are put, relative to it
    const char* icon;        // the window's installed icon, relative to it; "" for none
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
    EXPECT_EQ(InstalledIconFor(executable), *layout.icon ? tree.Path() / layout.icon : fs::path());
}

INSTANTIATE_TEST_SUITE_P(
    Layouts, ResourcesFolderTest,
    ::testing::Values(
        Layout{"BundleWithBlanks",
               "Applications/Orbelane Verification Storage.app/Contents/MacOS/ovs",
               "Applications/Orbelane Verification Storage.app/Contents/Resources", ""},
        Layout{"InstalledUnderAPrefixWithBlanks", "opt/my tools/bin/ovs", "opt/my tools/share/ovs",
               "opt/my tools/share/icons/hicolor/128x128/apps/ovs.png"},
        Layout{"BuildTree", "build/ovs", "build/ovs Resources", ""},
        Layout{"BuildTreeInAFolderNamedMacOS", "src/MacOS/ovs", "src/MacOS/ovs Resources", ""},
        Layout{"BuildTreeInAFolderNamedContents", "Contents/ovs", "Contents/ovs Resources", ""}),
    [](const ::testing::TestParamInfo<Layout>& info) { return std::string(info.param.name); });

TEST(ResourcesFolder, TheRunningProgramLooksBesideItsOwnExecutable) {
    SetResourcesFolderForTesting({});
    const fs::path executable = ExecutableFile();
    ASSERT_TRUE(executable.is_absolute()) << executable;
    EXPECT_TRUE(fs::exists(executable));
    EXPECT_EQ(SpecialFolder::Resources()->NativePath(), ResourcesFolderFor(executable));
}

}  // namespace
