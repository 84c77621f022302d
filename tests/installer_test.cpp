// "Install Now" on the real window, one press per row of the decision table, reading the
// message that was shown and the files that stand afterwards.
#include <unistd.h>

#include <cstdio>
#include <set>

#include <QAbstractItemView>
#include <QComboBox>

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
        Reset(true);
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
    // Nothing below application data or in /Applications; the plug-ins in the resources or not.
    void Reset(bool sources) {
        fs::remove_all(Data());
        fs::remove_all(tree.Path() / "Applications");
        fs::remove_all(resources);
        if (sources) {
            MakePlugin(resources / "Quilbrant.aip");
            MakePlugin(resources / "Ostrelin.acroplugin");
        }
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
    // Every path in the tree, to tell that a press changed nothing.
    std::set<fs::path> Listing() const {
        std::set<fs::path> paths;
        for (const auto& entry : fs::recursive_directory_iterator(tree.Path())) {
            paths.insert(entry.path());
        }
        return paths;
    }
    bool Installed(const fs::path& folder, const char* plugin) const {
        return fs::exists(folder / plugin / "Contents/MacOS/binary") &&
               fs::exists(folder / plugin / "Contents/.signature") &&
               fs::is_directory(folder / plugin / "Contents/Resources/empty");
    }

    fs::path resources = tree.Path() / "app resources";
};

const char* const kCatchAll = "Unable to install at this time 1";
const char* const kNoAccess = "There was an error copying the plugin please check you have access";
const char* const kNoSource = "Unable to install at this time";
const char* const kStop = "Could not find Illustrator plugins folder.";
const char* const kAiDone = "Installed please restart Illustrator";
const char* const kAcroDone = "Installed please restart Acrobat";
const std::string kXI =
    "/Applications/Adobe Acrobat XI Pro/Adobe Acrobat Pro.app/Contents/Plug-ins";
const std::string kDC = "Adobe/Acrobat/DC/Plug-ins";
const std::string k2017 = "Adobe/Acrobat/2017/Plug-ins";

// Below an Illustrator folder, and its plug-ins folder.
std::string A(const std::string& below) {
    return "Adobe/Adobe Illustrator " + below;
}
std::string P(const std::string& number) {
    return A(number + "/en_US/Plug-ins");
}

// One press on a tree: the folders made below application data (or, from "/", below the root)
// and one file, whether the plug-ins stand in the resources, the message, and the folder that
// then holds the plug-in; where none does, nothing at all has changed. The Illustrator rows
// walk Adobe / the highest "Adobe Illustrator <n>" / its first sub-folder without a leading
// "." / Plug-ins, sought by the name rebuilt from the number.
struct PressCase {
    Row row;
    std::vector<std::string> folders;
    std::string file;
    bool sources;
    const char* message;
    std::string into;
};

const PressCase kPresses[] = {
    {kPrompt, {}, "", false, "Choose which version of Acrobat you are using", ""},
    // A row that is no product forms no target, and the copy raises on it.
    {kDivider, {}, "", true, kCatchAll, ""},
    {kAcrobatX, {kXI}, "", true, kNoAccess, ""},  // the target folder is never created
    {kAcrobatXI, {kXI}, "", true, kAcroDone, kXI},
    {kAcrobat2017, {k2017}, "", true, kAcroDone, k2017},
    {kAcrobatDC, {kDC}, "", true, kAcroDone, kDC},
    // A leftover or an alias of the plug-in's name where the plug-in's folder goes; a file
    // named Plug-ins.
    {kAcrobatDC, {}, kDC + "/Ostrelin.acroplugin", true, kCatchAll, ""},
    {kAcrobatDC, {}, kDC, true, kNoAccess, ""},
    // A missing source is told once the target is settled, whatever the target.
    {kAcrobatX, {}, "", false, kNoSource, ""},
    {kDivider, {}, "", false, kNoSource, ""},
    {kAcrobatDC, {kDC}, "", false, kNoSource, ""},
    {kIllustrator, {P("26")}, "", false, kNoSource, ""},
    // Every stop of the walk tells the user, even with the plug-in missing.
    {kIllustrator, {}, "", false, kStop, ""},
    {kIllustrator, {}, "Adobe", false, kStop, ""},
    {kIllustrator, {A("24")}, "", false, kStop, ""},
    {kIllustrator, {}, P("24"), false, kStop, ""},
    {kIllustrator, {P("22.9")}, "", true, kStop, ""},
    {kIllustrator, {P("-5"), P("-1")}, "", true, kStop, ""},
    {kIllustrator, {"Adobe/Adobe Illustrator/en_US/Plug-ins"}, "", true, kStop, ""},
    // With dot files alone, Plug-ins is sought in the numbered folder itself.
    {kIllustrator, {A("26/.hidden")}, "", true, kStop, ""},
    {kIllustrator, {A("26/Plug-ins")}, "", true, kStop, ""},
    {kIllustrator, {A("27/a_first"), A("27/b_second/Plug-ins")}, "", true, kStop, ""},
    {kIllustrator, {P("22"), P("23")}, A("23/.DS_Store"), true, kAiDone, P("23")},
    {kIllustrator, {P("CC 2018"), P("2018")}, "", true, kAiDone, P("2018")},
    {kIllustrator, {P("Settings"), P("0")}, "", true, kAiDone, P("0")},
    {kIllustrator, {A("25/.config/Plug-ins"), P("25")}, "", true, kAiDone, P("25")},
};

TEST_F(InstallerTest, EachRowOfTheDecisionTable) {
    StartUp();
    const auto below = [&](const std::string& path) {
        return path.starts_with('/') ? tree.Path() / path.substr(1) : Data() / path;
    };
    for (const PressCase& c : kPresses) {
        SCOPED_TRACE(::testing::Message() << "row " << &c - kPresses);
        Reset(c.sources);
        for (const std::string& folder : c.folders) {
            fs::create_directories(below(folder));
        }
        if (!c.file.empty()) {
            WriteFile(below(c.file), "");
        }
        const auto before = Listing();
        EXPECT_EQ(Press(c.row), c.message);
        if (c.into.empty()) {
            EXPECT_EQ(Listing(), before);
            continue;
        }
        // A second press over an install, whose files may be read-only, installs again.
        const char* plugin = c.row == kIllustrator ? "Quilbrant.aip" : "Ostrelin.acroplugin";
        EXPECT_TRUE(Installed(below(c.into), plugin));
        fs::permissions(below(c.into) / plugin / "Contents/MacOS/binary", fs::perms::owner_read);
        WriteFile(resources / plugin / "Contents/MacOS/binary", "version 2");
        EXPECT_EQ(Press(c.row), c.message);
        EXPECT_EQ(ReadFile(below(c.into) / plugin / "Contents/MacOS/binary"), "version 2");
    }
}

const std::string kCopied = "Plug-ins/Ostrelin.acroplugin/Contents/";

std::string Deep() {
    std::string deepest = "Resources";
    for (int level = 0; level < 200; ++level) {
        deepest += "/d";
    }
    return deepest;
}

// One install of the Acrobat DC plug-in over a tree that the user or the bundle made odd: the
// message shown, and one item that must stand afterwards with what it holds, or must not stand.
TEST_F(InstallerTest, AnOddTreeIsToldAndLosesNothing) {
    const struct {
        void (*make)(const fs::path& bundle, const fs::path& plugins);
        const char* message;
        std::string item;      // below the product's folder
        const char* contents;  // nullptr: the item must not exist
    } cases[] = {
        {[](const fs::path& b, const fs::path&) {
             fs::create_symlink("nowhere", b / "Contents/Resources/link");
         },
         kCatchAll, kCopied + "Info.plist", "<plist/>"},
        {[](const fs::path& b, const fs::path&) {
             fs::create_directory_symlink("..", b / "Contents/loop");
         },
         kCatchAll, kCopied + ".signature", "sig"},
        {[](const fs::path& b, const fs::path&) {
             WriteFile(b / "Contents" / Deep() / "strings", "deep");
         },
         kAcroDone, kCopied + Deep() + "/strings", "deep"},
        // The same folder linked twice side by side, and not on one path, is no loop.
        {[](const fs::path& b, const fs::path&) {
             WriteFile(b.parent_path() / "shared/s.txt", "s");
             fs::create_directory_symlink(b.parent_path() / "shared", b / "Contents/one");
             fs::create_directory_symlink(b.parent_path() / "shared", b / "Contents/two");
         },
         kAcroDone, kCopied + "two/s.txt", "s"},
        // An alias to nothing where the plug-in's folder goes is left as it is.
        {[](const fs::path&, const fs::path& p) {
             fs::create_symlink("gone", p / "Ostrelin.acroplugin");
         },
         kCatchAll, "Plug-ins/Ostrelin.acroplugin", nullptr},
        // A plug-in that is a plain file is never written in the Plug-ins folder's place.
        {[](const fs::path& b, const fs::path& p) {
             fs::remove(p);
             fs::remove_all(b);
             WriteFile(b, "plug-in");
         },
         kNoAccess, "Plug-ins", nullptr},
    };
    StartUp();
    for (const auto& c : cases) {
        SCOPED_TRACE(::testing::Message() << "case " << &c - cases);
        Reset(true);
        fs::create_directories(Data() / kDC);
        c.make(resources / "Ostrelin.acroplugin", Data() / kDC);
        EXPECT_EQ(Press(kAcrobatDC), c.message);
        const fs::path item = Data() / "Adobe/Acrobat/DC" / c.item;
        if (c.contents == nullptr) {
            EXPECT_FALSE(fs::exists(item));
        } else {
            EXPECT_EQ(ReadFile(item), c.contents);
        }
    }
    EXPECT_EQ(Window1()->PagePanel1()->Value(), 0) << "the program goes on";
}

// A folder that the user may not list, in the bundle, as the bundle or on the Illustrator walk:
// never "Installed", and what was copied before it stays. Root lists any folder, so each press
// runs in a child process as nobody.
TEST_F(InstallerTest, AnUnlistableFolderEndsInTheCatchAllMessage) {
    const struct {
        Row row;
        std::string folder;  // made unlistable, below application data or the resources
        std::string kept;    // below application data: copied before the folder was met, if any
    } cases[] = {
        {kAcrobatDC, "Ostrelin.acroplugin/Contents/Resources",
         kDC + "/Ostrelin.acroplugin/Contents/MacOS/binary"},
        {kIllustrator, "Quilbrant.aip", P("24") + "/Quilbrant.aip"},
        {kIllustrator, "Adobe", ""},
        {kIllustrator, A("24"), ""},
    };
    StartUp();
    fs::permissions(tree.Path(), fs::perms::owner_all | fs::perms::others_exec);
    for (const auto& c : cases) {
        SCOPED_TRACE(c.folder);
        Reset(true);
        for (const fs::path& folder : {Data() / P("24"), Data() / kDC}) {
            fs::create_directories(folder);
            fs::permissions(folder, fs::perms::all);
        }
        const fs::path unlistable =
            c.folder.starts_with("Adobe") ? Data() / c.folder : resources / c.folder;
        fs::permissions(unlistable, fs::perms::none);
        EXPECT_EXIT(
            {
                if (geteuid() == 0 && (setgid(65534) != 0 || setuid(65534) != 0)) {
                    std::_Exit(3);
                }
                const std::string message = Press(c.row);
                std::fprintf(stderr, "%s\n", message.c_str());
                std::_Exit(message == kCatchAll ? 0 : 1);
            },
            ::testing::ExitedWithCode(0), "");
        fs::permissions(unlistable, fs::perms::owner_all);
        if (c.kept.empty()) {
            EXPECT_TRUE(fs::is_empty(Data() / P("24")) && fs::is_empty(Data() / kDC));
        } else {
            EXPECT_TRUE(fs::exists(Data() / c.kept));
        }
    }
}

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

}  // namespace
