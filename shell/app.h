// App: the application object. It places the user on the list page at Open and follows the
// desktop's appearance.
#pragma once

#include "platform/runtime/application.h"

class App : public Application {
  public:
    void Constructor() {}
    void Event_Open() override;
    void Event_AppearanceChanged() override;
};
