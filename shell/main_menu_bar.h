// MainMenuBar: the one menu bar of the application and of every window.
#pragma once

#include "platform/widgets/menu.h"

class MainMenuBar : public MenuBar {
  public:
    MainMenuBar();
    void Untitled0();  // the File menu
    void Untitled1();  // the Edit menu
};

// The implicit instance: made on first use, then the same object for the whole run. (The
// accessor shares the class's name, so the type is written `class MainMenuBar` after it.)
Ref<class MainMenuBar> MainMenuBar();
