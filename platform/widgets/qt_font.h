// The one crossing between the font names of the control table and drawing and Qt's fonts.
#pragma once

#include <QFont>

#include <string>

// Sets a named family on a Qt font; empty and "System" keep the desktop's family. The family
// and its style hint are the same wherever the name is used, so that a family missing on this
// desktop is looked up once for its stand-in, not once for each use.
void SetFontFamily(QFont& font, const std::string& family);
