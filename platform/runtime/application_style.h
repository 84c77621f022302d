// The application's style: the desktop's own, with one icon read only when it is first drawn.
#pragma once

#include <QProxyStyle>

// The menu bar asks for the icon of its overflow button as it is built, and shows that button
// only when its menus don't fit. Reading the icon's file loads Qt's image format plug-ins, 4.5%
// of the instructions from start to a painted window; this style hands the icon over unread.
class ApplicationStyle : public QProxyStyle {
  public:
    QIcon standardIcon(StandardPixmap standardIcon, const QStyleOption* option = nullptr,
                       const QWidget* widget = nullptr) const override;
};
