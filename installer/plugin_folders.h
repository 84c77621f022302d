// Where each Adobe product keeps its plug-ins.
#pragma once

#include <string>

#include "platform/core/folder_item.h"

// Illustrator: Adobe / the highest "Adobe Illustrator <n>" / its first sub-folder without a
// leading "." / Plug-ins, below application data. Where the walk stops, the user is told
// "Could not find Illustrator plugins folder." and the result is Nil; an "Adobe" or numbered
// folder that can't be listed raises IOException.
Ref<FolderItem> IllustratorPluginsFolder(const Ref<FolderItem>& applicationData);

// Acrobat: the plug-ins folder of that popup row, formed and not looked at; Nil for a row
// that is no Acrobat product.
Ref<FolderItem> AcrobatPluginsFolder(const std::string& product,
                                     const Ref<FolderItem>& applicationData);
