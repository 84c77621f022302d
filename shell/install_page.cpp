// The installation page: the product list and "Install Now", with every message of a press.
#include "installer/copy.h"
#include "installer/plugin_folders.h"
#include "platform/core/text.h"
#include "platform/runtime/message_box.h"
#include "shell/window1.h"

namespace {
const std::string kPrompt = "Choose Your Adobe Product";
const std::string kIllustrator = "Illustrator CC";
const std::string kIllustratorPlugin = "Quilbrant.aip";
const std::string kAcrobatPlugin = "Ostrelin.acroplugin";
const std::string kNoSource = "Unable to install at this time";
const std::string kFailed = "Unable to install at this time 1";
const std::string kNotCopied = "There was an error copying the plugin please check you have access";

bool Stands(const Ref<FolderItem>& item) {
    return item && item->Exists();
}
}  // namespace

void Window1::PopupMenu1_Open(PopupMenu& sender) {
    for (const char* row :
         {"Acrobat X", "Acrobat XI", "Acrobat 2017", "Acrobat DC", "-", "Illustrator CC"}) {
        sender.AddRow(row);
    }
}

// One message a press. The copy check is the only sign of a copy that failed without raising;
// anything raised, at any depth of the copy, ends in the one catch below and nothing is undone.
void Window1::PushButton1_Action(PushButton&) {
    try {
        if (TextEquals(PopupMenu1()->Text(), kPrompt)) {
            MsgBox("Choose which version of Acrobat you are using");
            return;
        }
        Ref<FolderItem> resources = SpecialFolder::Resources();
        Ref<FolderItem> applicationData = SpecialFolder::ApplicationData();
        const std::string product = PopupMenu1()->Text();
        if (TextEquals(product, kIllustrator)) {
            // The source is formed before the walk, but looked at only once the walk succeeds.
            Ref<FolderItem> source = resources->Child(kIllustratorPlugin);
            Ref<FolderItem> target = IllustratorPluginsFolder(applicationData);
            if (target.IsNil()) {
                return;
            }
            if (!Stands(source)) {
                MsgBox(kNoSource);
                return;
            }
            CopyFileOrFolder(source, target);
            MsgBox(Stands(target->Child(kIllustratorPlugin))
                       ? "Installed please restart Illustrator"
                       : kNotCopied);
        } else {
            // A row that is no product forms no target; the copy then raises on it.
            Ref<FolderItem> target = AcrobatPluginsFolder(product, applicationData);
            Ref<FolderItem> source = resources->Child(kAcrobatPlugin);
            if (!Stands(source)) {
                MsgBox(kNoSource);
                return;
            }
            CopyFileOrFolder(source, target);
            MsgBox(Stands(target->Child(kAcrobatPlugin)) ? "Installed please restart Acrobat"
                                                         : kNotCopied);
        }
    } catch (...) {
        MsgBox(kFailed);
    }
}

void Window1::CopyFileOrFolder(Ref<FolderItem> source, Ref<FolderItem> destination) {
    ::CopyFileOrFolder(std::move(source), std::move(destination));
}
