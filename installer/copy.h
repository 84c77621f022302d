// The recursive copy of one plug-in item into a folder.
#pragma once

#include "platform/core/folder_item.h"

// Copies `source`, a file or a whole folder tree, into the folder `destination` under its own
// name. The folder is created first and filled afterwards; nothing is checked and nothing
// caught, so an exception at any depth leaves the items copied so far in place. A folder that
// can't be listed, the source or one below it, raises IOException once its copy is created.
void CopyFileOrFolder(Ref<FolderItem> source, Ref<FolderItem> destination);
