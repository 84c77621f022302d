// What a list cell or a label draws of a text: the whole text when it is of a sensible length,
// otherwise a bounded prefix and an ellipsis, so that a huge text from a damaged store never
// stalls painting nor stays in memory. A list keeps its cells whole all the same, and a text
// area shows its text whole (platform/widgets/text_pane.h).
#pragma once

#include <QString>

#include <string_view>

// Bytes drawn at most: a line's worth many times over.
inline constexpr size_t kShownInCell = 1000;

// At most `limit` bytes from the start of `text`, ending on a whole character.
std::string_view ShownPrefix(std::string_view text, size_t limit);
// The text as Qt draws it: valid UTF-8 up to `limit` bytes, then "…" if anything was left out.
QString ShownText(std::string_view text, size_t limit);
// The same with carriage returns turned into the line feeds of Qt's text widgets.
QString ShownLines(std::string_view text, size_t limit);
