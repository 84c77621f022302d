// The Illustrator walk and the Acrobat path table.
#include "installer/plugin_folders.h"

#include "platform/core/text.h"
#include "platform/runtime/message_box.h"
#include "platform/runtime/yield.h"

namespace {

const std::string kSearch = "Adobe Illustrator ";
const std::string kNotFound = "Could not find Illustrator plugins folder.";
constexpr long long kNoNumber = -1;

bool IsFolder(const Ref<FolderItem>& item) {
    return item && item->Exists() && item->Directory();
}

// Every stop of the walk tells the user, so that a press on "Install Now" never ends in
// silence.
Ref<FolderItem> Stop() {
    MsgBox(kNotFound);
    return nullptr;
}

// The number at the end of the name, cut towards zero: 22.9 gives 22, a word gives 0.
long long NumberOf(const std::string& name) {
    return Int64FromDouble(Val(NthField(name, " ", CountFields(name, " "))));
}

}  // namespace

// An "Adobe" or numbered folder that can't be listed raises IOException at Count, which ends
// the press in "Unable to install at this time 1" rather than at a stop: the folder may well
// hold Illustrator, so "Could not find Illustrator plugins folder." would mislead.
Ref<FolderItem> IllustratorPluginsFolder(const Ref<FolderItem>& applicationData) {
    Ref<FolderItem> current = applicationData->Child("Adobe");
    if (!IsFolder(current)) {
        return Stop();
    }
    long long highest = kNoNumber;
    for (long long index = 1; index <= current->Count(); ++index) {
        const std::string name = current->Item(index)->Name();
        if (InStr(0, name, kSearch) >= 1) {
            const long long number = NumberOf(name);
            if (highest < number) {
                highest = number;
            }
        }
        RuntimeBackgroundTask();
    }
    if (highest == kNoNumber) {
        return Stop();
    }
    // The folder is looked up by the name rebuilt from the number, not by the name that gave it.
    current = current->Child(kSearch + Str(highest));
    if (!IsFolder(current) || !(current->Count() > 0)) {
        return Stop();
    }
    // The first child without a leading "."; if there is none, the numbered folder itself.
    for (long long index = 1; index <= current->Count(); ++index) {
        if (!TextEquals(Left(current->Item(index)->Name(), 1), ".")) {
            current = current->Item(index);
            break;
        }
        RuntimeBackgroundTask();
    }
    current = current->Child("Plug-ins");
    if (!IsFolder(current)) {
        return Stop();
    }
    return current;
}

Ref<FolderItem> AcrobatPluginsFolder(const std::string& product,
                                     const Ref<FolderItem>& applicationData) {
    if (TextEquals(product, "Acrobat X")) {
        return GetFolderItem(
            "/Applications/Adobe\\ Acrobat\\ X\\ Pro/Adobe\\ Acrobat\\ Pro.app/Contents/Plug-ins/",
            1);
    }
    if (TextEquals(product, "Acrobat XI")) {
        return GetFolderItem(
            "/Applications/Adobe\\ Acrobat\\ XI\\ Pro/Adobe\\ Acrobat\\ Pro.app/Contents/Plug-ins/",
            1);
    }
    if (TextEquals(product, "Acrobat 2017")) {
        return GetFolderItem(applicationData->ShellPath() + "/Adobe/Acrobat/2017/Plug-ins", 1);
    }
    if (TextEquals(product, "Acrobat DC")) {
        return GetFolderItem(applicationData->ShellPath() + "/Adobe/Acrobat/DC/Plug-ins", 1);
    }
    return nullptr;
}
