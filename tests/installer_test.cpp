// "Install Now" on the real window, one press per row of the decision table, reading the
// message that was shown and the files that stand afterwards.
#include <unistd.h>

#include <cstdio>

#include <QAbstractItemView>
#include <QComboBox>

#include "installer/plugin_folders.h"
#include "window_fixture.h"

using namespace testsupport;
namespace fs = std::filesystem;

namespace {

// The rows of the product popup.
enum Row { kPrompt, kAcrobatX, kAcrobatXI, kAcrobat2017, kAcrobatDC, kDivider, kIllustrator };

class InstallerTest : public WindowTest {
  protected:
    void SetUp() override {
        SetResourcesFolderForTesting(resources);
        MakePlugin(resources / "Quilbrant.aip");
        MakePlugin(resources / "Ostrelin.acroplugin");
    }
    void TearDown() override {
        SetResourcesFolderForTesting({});
        WindowTest::TearDown();
    }
    static void MakePlugin(const fs::path& bundle) {
        WriteFile(bundle / "Contents/Info.plist", "<plist/>");
        WriteFile(bundle / "Contents/MacOS/binary", std::string(4096, 'x'));
        WriteFile(bundle / "Contents/.signature", "sig");
        fs::create_directories(bundle / "Contents/Resources/empty");
    }
    fs::path Data() const { return demo::ApplicationDataPath(tree.Path()); }
    fs::path Illustrator(const std::string& version) const {
        return Data() / "Adobe" / ("Adobe Illustrator " + version);
    }
    // Selects the row and presses "Install Now"; returns the one message shown.
    std::string Press(Row row) {
        auto window = Window1();
        window->MainTabs()->Press(0);
        window->PopupMenu1()->SetListIndex(row);
        MessageLog log;
        window->PushButton1()->Push();
        EXPECT_EQ(window->PopupMenu1()->ListIndex(), row) << "the popup keeps its choice";
        EXPECT_LE(log.messages.size(), 1u);
        return log.messages.empty() ? std::string() : log.messages.front();
    }
    bool Installed(const fs::path& folder, const char* plugin) const {
        return fs::exists(folder / plugin / "Contents/MacOS/binary") &&
               fs::exists(folder / plugin / "Contents/.signature") &&
               fs::is_directory(folder / plugin / "Contents/Resources/empty");
    }

    fs::path resources = tree.Path() / "app resources";
};

TEST_F(InstallerTest, ThePromptRowAsksForAProductAndTouchesNothing) {
    fs::remove_all(resources);
    StartUp();
    EXPECT_EQ(Press(kPrompt), "Choose which version of Acrobat you are using");
    EXPECT_FALSE(fs::exists(Data()));
}

TEST_F(InstallerTest, IllustratorInstallsIntoTheHighestNumberedFolder) {
    fs::create_directories(Illustrator("22") / "en_US/Plug-ins");
    fs::create_directories(Illustrator("23") / "en_US/Plug-ins");
    WriteFile(Illustrator("23") / ".DS_Store", "");
    StartUp();
    EXPECT_EQ(Press(kIllustrator), "Installed please restart Illustrator");
    EXPECT_TRUE(Installed(Illustrator("23") / "en_US/Plug-ins", "Quilbrant.aip"));
    EXPECT_FALSE(fs::exists(Illustrator("22") / "en_US/Plug-ins/Quilbrant.aip"));

    // A second install over the first installs again.
    WriteFile(resources / "Quilbrant.aip/Contents/MacOS/binary", "version 2");
    EXPECT_EQ(Press(kIllustrator), "Installed please restart Illustrator");
    EXPECT_EQ(ReadFile(Illustrator("23") / "en_US/Plug-ins/Quilbrant.aip/Contents/MacOS/binary"),
              "version 2");
}

// Every stop of the walk tells the user, even with the plug-in missing from the resources. A
// stop ending in "/" is a folder, any other a file.
TEST_F(InstallerTest, EveryStopOfTheWalkIsToldBeforeTheMissingSource) {
    fs::remove_all(resources / "Quilbrant.aip");
    StartUp();
    for (const std::string stop : {"", "Adobe", "Adobe/Adobe Illustrator 24/",
                                   "Adobe/Adobe Illustrator 24/en_US/Plug-ins"}) {
        fs::remove_all(Data());
        fs::create_directories(Data());
        if (stop.ends_with('/')) {
            fs::create_directories(Data() / stop);
        } else if (!stop.empty()) {
            WriteFile(Data() / stop, "");
        }
        EXPECT_EQ(Press(kIllustrator), "Could not find Illustrator plugins folder.") << stop;
    }
}

TEST_F(InstallerTest, AcrobatXAndXIAreToldApartAndLieUnderApplications) {
    const fs::path xi =
        tree.Path() / "Applications/Adobe Acrobat XI Pro/Adobe Acrobat Pro.app/Contents/Plug-ins";
    fs::create_directories(xi);
    StartUp();
    EXPECT_EQ(Press(kAcrobatX),
              "There was an error copying the plugin please check you have access");
    EXPECT_FALSE(fs::exists(tree.Path() / "Applications/Adobe Acrobat X Pro"))
        << "the target folder is never created";
    EXPECT_EQ(Press(kAcrobatXI), "Installed please restart Acrobat");
    EXPECT_TRUE(Installed(xi, "Ostrelin.acroplugin"));
}

// A missing source is told once the target is settled, whatever the target.
TEST_F(InstallerTest, AMissingResourcesFolderIsToldAsAMissingSource) {
    fs::remove_all(resources);
    fs::create_directories(Illustrator("26") / "en_US/Plug-ins");
    fs::create_directories(Data() / "Adobe/Acrobat/DC/Plug-ins");
    StartUp();
    for (Row row : {kAcrobatX, kDivider, kIllustrator, kAcrobatDC}) {
        EXPECT_EQ(Press(row), "Unable to install at this time") << row;
    }
    EXPECT_TRUE(fs::is_empty(Illustrator("26") / "en_US/Plug-ins"));
}

TEST_F(InstallerTest, TheDividerRowRaisesOnItsNilTarget) {
    StartUp();
    EXPECT_EQ(Press(kDivider), "Unable to install at this time 1");
}

// One install of the Acrobat DC plug-in over a tree that the user or the bundle made odd: the
// message shown, and one item that must stand afterwards with what it holds, or must not stand.
struct OddTree {
    friend void PrintTo(const OddTree& c, std::ostream* os) { *os << c.name; }
    const char* name;
    void (*make)(const fs::path& bundle, const fs::path& product);
    const char* message;
    std::string item;      // below the product's folder
    const char* contents;  // nullptr: the item must not exist
};

class OddTreeTest : public InstallerTest, public ::testing::WithParamInterface<OddTree> {};

TEST_P(OddTreeTest, TellsTheUserAndLosesNothing) {
    const fs::path product = Data() / "Adobe/Acrobat/DC";
    fs::create_directories(product);
    GetParam().make(resources / "Ostrelin.acroplugin", product);
    StartUp();
    EXPECT_EQ(Press(kAcrobatDC), GetParam().message);
    if (GetParam().contents == nullptr) {
        EXPECT_FALSE(fs::exists(product / GetParam().item));
    } else {
        EXPECT_EQ(ReadFile(product / GetParam().item), GetParam().contents);
    }
    EXPECT_EQ(Window1()->PagePanel1()->Value(), 0) << "the program goes on";
}

const char* const kCatchAll = "Unable to install at this time 1";
const char* const kNoAccess = "There was an error copying the plugin please check you have access";
const std::string kCopied = "Plug-ins/Ostrelin.acroplugin/Contents/";

std::string Deep() {
    std::string deepest = "Resources";
    for (int level = 0; level < 200; ++level) {
        deepest += "/d";
    }
    return deepest;
}

INSTANTIATE_TEST_SUITE_P(
    Bundles, OddTreeTest,
    ::testing::Values(
        // A leftover or an alias of the plug-in's name where the plug-in's folder goes.
        OddTree{"AFileWhereThePluginFolderGoes",
                [](const fs::path&, const fs::path& p) {
                    WriteFile(p / "Plug-ins/Ostrelin.acroplugin", "alias");
                },
                kCatchAll, "Plug-ins/Ostrelin.acroplugin", "alias"},
        OddTree{"ADanglingLinkInTheBundle",
                [](const fs::path& b, const fs::path& p) {
                    fs::create_directories(p / "Plug-ins");
                    fs::create_symlink("nowhere", b / "Contents/Resources/link");
                },
                kCatchAll, kCopied + "Info.plist", "<plist/>"},
        OddTree{"ALinkLoopInTheBundle",
                [](const fs::path& b, const fs::path& p) {
                    fs::create_directories(p / "Plug-ins");
                    fs::create_directory_symlink("..", b / "Contents/loop");
                },
                kCatchAll, kCopied + ".signature", "sig"},
        OddTree{"ABundleTwoHundredLevelsDeep",
                [](const fs::path& b, const fs::path& p) {
                    fs::create_directories(p / "Plug-ins");
                    WriteFile(b / "Contents" / Deep() / "strings", "deep");
                },
                "Installed please restart Acrobat", kCopied + Deep() + "/strings", "deep"},
        OddTree{"AFileNamedPlugIns",
                [](const fs::path&, const fs::path& p) { WriteFile(p / "Plug-ins", "a file"); },
                kNoAccess, "Plug-ins", "a file"},
        // A plug-in that is a plain file is never written in the Plug-ins folder's place.
        OddTree{"AFilePluginWithoutAPlugInsFolder",
                [](const fs::path& b, const fs::path&) {
                    fs::remove_all(b);
                    WriteFile(b, "plug-in");
                },
                kNoAccess, "Plug-ins", nullptr}),
    [](const auto& info) { return std::string(info.param.name); });

// A folder that the user may not list, in the bundle, as the bundle or on the Illustrator walk:
// never "Installed", and what was copied before it stays. Root lists any folder, so the press
// runs in a child process as nobody.
struct Unlistable {
    const char* name;
    Row row;
    std::string folder;  // made unlistable, below application data or the resources
    std::string kept;    // below application data: copied before the folder was met, if any
};

class UnlistableTest : public InstallerTest, public ::testing::WithParamInterface<Unlistable> {};

TEST_P(UnlistableTest, EndsInTheCatchAllMessage) {
    const fs::path plugins[] = {Illustrator("24") / "en_US/Plug-ins",
                                Data() / "Adobe/Acrobat/DC/Plug-ins"};
    for (const fs::path& folder : plugins) {
        fs::create_directories(folder);
        fs::permissions(folder, fs::perms::all);
    }
    const std::string& folder = GetParam().folder;
    const fs::path unlistable = folder.starts_with("Adobe") ? Data() / folder : resources / folder;
    fs::permissions(tree.Path(), fs::perms::owner_all | fs::perms::others_exec);
    fs::permissions(unlistable, fs::perms::none);
    StartUp();
    EXPECT_EXIT(
        {
            if (geteuid() == 0 && (setgid(65534) != 0 || setuid(65534) != 0)) {
                std::_Exit(3);
            }
            const std::string message = Press(GetParam().row);
            std::fprintf(stderr, "%s\n", message.c_str());
            std::_Exit(message == kCatchAll ? 0 : 1);
        },
        ::testing::ExitedWithCode(0), "");
    fs::permissions(unlistable, fs::perms::owner_all);
    if (GetParam().kept.empty()) {
        EXPECT_TRUE(fs::is_empty(plugins[0]) && fs::is_empty(plugins[1]));
    } else {
        EXPECT_TRUE(fs::exists(Data() / GetParam().kept));
    }
}

INSTANTIATE_TEST_SUITE_P(
    Folders, UnlistableTest,
    ::testing::Values(
        Unlistable{"ASubFolderOfTheBundle", kAcrobatDC, "Ostrelin.acroplugin/Contents/Resources",
                   "Adobe/Acrobat/DC/" + kCopied + "MacOS/binary"},
        Unlistable{"TheBundle", kIllustrator, "Quilbrant.aip",
                   "Adobe/Adobe Illustrator 24/en_US/Plug-ins/Quilbrant.aip"},
        Unlistable{"TheAdobeFolder", kIllustrator, "Adobe", ""},
        Unlistable{"TheNumberedFolder", kIllustrator, "Adobe/Adobe Illustrator 24", ""}),
    [](const auto& info) { return std::string(info.param.name); });

// Return and Enter on the installation page press "Install Now" wherever the focus is; in the
// open popup they choose a row instead.
TEST_F(InstallerTest, ReturnPressesInstallNowFromAnywhereOnThePage) {
    auto window = StartUp();
    window->MainTabs()->Press(0);
    ProcessEvents();
    QWidget* client = window->Client();
    std::vector<QWidget*> targets{client};
    for (QWidget* widget : client->findChildren<QWidget*>()) {
        if (widget->isVisible()) {
            targets.push_back(widget);
        }
    }
    ASSERT_GT(targets.size(), 5u);
    for (QWidget* target : targets) {
        for (Qt::Key key : {Qt::Key_Return, Qt::Key_Enter}) {
            MessageLog log;
            QTest::keyClick(target, key,
                            key == Qt::Key_Enter ? Qt::KeypadModifier : Qt::NoModifier);
            EXPECT_EQ(log.messages,
                      std::vector<std::string>{"Choose which version of Acrobat you are using"})
                << target->metaObject()->className() << " " << target->objectName().toStdString();
        }
    }

    auto* popup = static_cast<QComboBox*>(window->PopupMenu1()->Widget());
    popup->showPopup();
    ProcessEvents();
    QTest::keyClick(popup->view(), Qt::Key_Down);
    MessageLog log;
    QTest::keyClick(popup->view(), Qt::Key_Return);
    ProcessEvents();
    EXPECT_TRUE(log.messages.empty());
    EXPECT_EQ(window->PopupMenu1()->Text(), "Acrobat X");

    window->MainTabs()->Press(1);
    QTest::keyClick(client, Qt::Key_Return);
    EXPECT_TRUE(log.messages.empty()) << "no default button on the list page";
}

// The walk by itself, on the names that it meets.
struct WalkCase {
    friend void PrintTo(const WalkCase& c, std::ostream* os) { *os << c.name; }
    const char* name;
    std::vector<std::string>
        folders;           // below Adobe; each gets en_US/Plug-ins unless it ends in "/"
    std::string expected;  // the number of the folder whose en_US/Plug-ins is found, "" for a stop
};

class WalkTest : public ::testing::TestWithParam<WalkCase> {
  protected:
    TempDir tree;
    ScopedRoot root{tree.Path()};
};

TEST_P(WalkTest, FindsTheHighestNumberedFolder) {
    const fs::path data = demo::ApplicationDataPath(tree.Path());
    for (const std::string& folder : GetParam().folders) {
        if (folder.back() == '/') {
            fs::create_directories(data / "Adobe" / folder);
        } else {
            fs::create_directories(data / "Adobe" / folder / "en_US/Plug-ins");
        }
    }
    MessageLog log;
    Ref<FolderItem> target = IllustratorPluginsFolder(SpecialFolder::ApplicationData());
    if (GetParam().expected.empty()) {
        EXPECT_TRUE(target.IsNil());
        EXPECT_EQ(log.messages,
                  std::vector<std::string>{"Could not find Illustrator plugins folder."});
    } else {
        ASSERT_FALSE(target.IsNil());
        EXPECT_EQ(target->NativePath(),
                  data / "Adobe" / ("Adobe Illustrator " + GetParam().expected) / "en_US/Plug-ins");
        EXPECT_TRUE(log.messages.empty());
    }
}

INSTANTIATE_TEST_SUITE_P(
    Names, WalkTest,
    ::testing::Values(
        // The folder is sought by the name rebuilt from its number.
        WalkCase{"TwentyTwoNineAloneStops", {"Adobe Illustrator 22.9"}, ""},
        WalkCase{
            "WordBeforeTheNumber", {"Adobe Illustrator CC 2018", "Adobe Illustrator 2018"}, "2018"},
        WalkCase{"LastFieldNoNumberGivesZero",
                 {"Adobe Illustrator Settings", "Adobe Illustrator 0"},
                 "0"},
        WalkCase{"NegativeNumbersDoNotCount", {"Adobe Illustrator -5", "Adobe Illustrator -1"}, ""},
        WalkCase{"NoBlankBehindDoesNotCount", {"Adobe Illustrator"}, ""},
        WalkCase{"DotFilesBeforeTheSubFolder",
                 {"Adobe Illustrator 25/.hidden/", "Adobe Illustrator 25/.config/Plug-ins/",
                  "Adobe Illustrator 25"},
                 "25"},
        WalkCase{"OnlyDotFilesMeansPlugInsIsSoughtInTheNumberedFolder",
                 {"Adobe Illustrator 26/.hidden/"},
                 ""},
        WalkCase{
            "PlugInsDirectlyInsideIsTakenForTheSubFolder", {"Adobe Illustrator 26/Plug-ins/"}, ""},
        WalkCase{"TheFirstOfTwoSubFoldersIsTaken",
                 {"Adobe Illustrator 27/a_first/", "Adobe Illustrator 27/b_second/Plug-ins/"},
                 ""}),
    [](const auto& info) { return std::string(info.param.name); });

// X, XI and DC are met on the window above; the path of 2017 and the Nil cases are left.
TEST(AcrobatFolders, TheRestOfThePathTable) {
    TempDir tree;
    ScopedRoot root{tree.Path()};
    Ref<FolderItem> data = SpecialFolder::ApplicationData();
    EXPECT_EQ(AcrobatPluginsFolder("Acrobat 2017", data)->NativePath(),
              tree.Path() / "Users/user/Library/Application Support/Adobe/Acrobat/2017/Plug-ins");
    EXPECT_TRUE(AcrobatPluginsFolder("-", data).IsNil());
}

}  // namespace
