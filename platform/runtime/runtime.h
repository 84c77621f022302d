// The run-time operations that start-up calls, in the order in which it calls them, mapped
// onto Qt's application lifecycle.
#pragma once

#include <filesystem>
#include <functional>
#include <memory>

#include "platform/core/exceptions.h"

using ExceptionHelper = std::shared_ptr<RuntimeException> (*)(const std::function<void(void*)>&,
                                                              void*);

// Makes the file-system root absolute, has database reads give way through the yield, then
// makes the Qt application object unless one exists already (tests make their own). Of the
// arguments only the program's name is used.
void RuntimeInit(int argc, char** argv);
// Has the application draw its text unhinted; RuntimeInit does so for the application it makes.
void UseUnhintedText();
// Gives the windows the icon installed with `executable`: its name in the desktop's icon theme
// first, so that a theme may restyle it, else the installed file. RuntimeInit does so off macOS.
void UseInstalledIcon(const std::filesystem::path& executable);
void RuntimePerformInitializers();
void _RuntimeSetExceptionHelper(ExceptionHelper helper);
void _RuntimeSetReleaseStamp(double stamp);
void _SetSupportsHiDPI(bool flag);
void _RuntimeInitExternalClasses();
void _InitPluginEntrypoints();
// Keeps `lateStartup`, which _RuntimeRun calls once from the event loop, before the
// application's Open event.
void _RunFrameworkInitialization(std::function<void()> lateStartup);
// Runs the event loop until the application quits.
void _RuntimeRun();
// Work that must be done before the Qt application goes, such as releasing the windows.
void RuntimeAtFinalize(std::function<void()> work);
void RuntimePerformFinalizers();
int RuntimeExit();

// Asks the platform to quit: closes the windows and ends the event loop.
void QuitMenuAction();
