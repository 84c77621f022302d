// App.Event_Open: the one-time move from the page the window is built on to the list page.
#include "shell/app.h"

#include "shell/window1.h"

void App::Event_Open() {
    // The window is built with "Installation" selected, and setting the page does not move
    // the selection, so both segments are set before the page.
    Window1()->MainTabs()->Items()[0]->SetSelected(false);
    Window1()->MainTabs()->Items()[1]->SetSelected(true);
    Window1()->PagePanel1()->SetValue(1);
}
