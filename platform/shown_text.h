// What a control draws of a text: the whole text when it is of a sensible length, otherwise a
// bounded prefix and an ellipsis, so that a huge text from a damaged store never stalls
// painting. The control itself still holds and gives back the whole text.
#pragma once

#include <QString>

#include <string_view>

// Bytes drawn at most: by a list cell or a label, a line's worth many times over; by a text
// area, some thousands of lines.
inline constexpr size_t kShownInCell = 1000;
inline constexpr size_t kShownInTextArea = 100000;

// The text as Qt draws it: valid UTF-8 up to `limit` bytes, then "…" if anything was left out.
QString ShownText(std::string_view text, size_t limit);
// The same with carriage returns turned into the line feeds of Qt's text widgets.
QString ShownLines(std::string_view text, size_t limit);
