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

// The application's icon as installed beside those resources, in the desktop's icon theme
// folders: PREFIX/share/icons/hicolor/scalable/apps/exe.svg for PREFIX/bin/exe.
std::filesystem::path InstalledIconFor(const std::filesystem::path& executable);

// The running program's executable, as Qt reports it; empty before the application object.
std::filesystem::path ExecutableFile();
