// Bounded prefixes of long texts for drawing.
#include "platform/widgets/shown_text.h"

#include "platform/core/text.h"

std::string_view ShownPrefix(std::string_view text, size_t limit) {
    if (text.size() <= limit) {
        return text;
    }
    size_t end = limit;
    while (end > 0 && IsContinuation(text[end])) {
        --end;
    }
    return text.substr(0, end);
}

QString ShownText(std::string_view text, size_t limit) {
    const std::string_view shown = ShownPrefix(text, limit);
    QString out = QString::fromUtf8(shown.data(), static_cast<qsizetype>(shown.size()));
    if (shown.size() < text.size()) {
        out += QChar(0x2026);
    }
    return out;
}

QString ShownLines(std::string_view text, size_t limit) {
    QString out = ShownText(text, limit);
    out.replace(QLatin1String("\r\n"), QLatin1String("\n"));
    out.replace(QLatin1Char('\r'), QLatin1Char('\n'));
    return out;
}
