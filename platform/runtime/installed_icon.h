// The icon of the application's windows: the one installed with the program.
#pragma once

// Gives every window the installed icon, which a desktop without the program's desktop entry
// shows in the title bar and the task switcher; where none is installed, the desktop's default.
void UseInstalledIcon();
