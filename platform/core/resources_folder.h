// Where the application's own resources lie, told from the executable's path alone.
#pragma once

#include <filesystem>

// The resources folder of the program whose executable stands at `executable`:
// - in an application bundle, X.app/Contents/MacOS/exe: X.app/Contents/Resources, the folder
//   that the bundle's resourcePath names;
// - installed, PREFIX/bin/exe: PREFIX/share/exe;
// - anywhere else, as in a build tree: the folder "exe Resources" beside the executable.
// The layout is read from the path and nothing on disk is looked at, so that the answer does not
// change while folders come and go.
std::filesystem::path ResourcesFolderFor(const std::filesystem::path& executable);

// The window icon installed with the program under a prefix, beside the desktop entry's own
// scalable one: PREFIX/share/icons/hicolor/128x128/apps/exe.png, a picture that Qt reads without
// plug-ins. Empty for the other layouts: a bundle has its icon in its Info.plist, and a build
// tree none.
std::filesystem::path InstalledIconFor(const std::filesystem::path& executable);

// The running program's executable, as Qt reports it; empty before the application object.
std::filesystem::path ExecutableFile();
