// CopyFileOrFolder: one item, a file or a whole folder tree, into a folder, under its own name.
#include "installer/copy.h"

#include "platform/runtime/yield.h"

void CopyFileOrFolder(Ref<FolderItem> source, Ref<FolderItem> destination) {
    if (!source->Directory()) {
        source->CopyFileTo(destination);
        return;
    }
    // A link back up the tree would recurse without end: the folder met again on the current
    // path raises StackOverflowException here, before anything of it is created.
    FolderLoopCheck loopCheck(*source);
    Ref<FolderItem> newFolder = destination->Child(source->Name());
    newFolder->CreateAsFolder();
    for (long long index = 1; index <= source->Count(); ++index) {
        if (source->Item(index)->Directory()) {
            CopyFileOrFolder(source->Item(index), newFolder);
        } else {
            source->Item(index)->CopyFileTo(newFolder);
        }
        RuntimeBackgroundTask();
    }
}
