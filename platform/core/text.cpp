// Text field operations. The common case is ASCII text searched for an ASCII separator; it
// runs on bytes without decoding. Anything else is decoded and folded one character at a time.
#include "platform/core/text.h"

#include <QChar>
#include <QString>

#include <locale.h>
#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstdlib>
#include <limits>
#include <vector>

#ifdef __APPLE__
#include <xlocale.h>
#endif

namespace {

struct Match {
    size_t position = std::string_view::npos;
    size_t length = 0;
    bool Found() const { return position != std::string_view::npos; }
};

bool IsAscii(std::string_view text) {
    return std::all_of(text.begin(), text.end(),
                       [](char c) { return static_cast<unsigned char>(c) < 0x80; });
}

// Decodes one character at `at`; a byte that does not start a valid sequence stands for
// itself, mapped to a code point that no valid character folds to.
char32_t DecodeAt(std::string_view text, size_t at, size_t& length) {
    const auto lead = static_cast<unsigned char>(text[at]);
    const int extra = lead >= 0xF5   ? 0  // no character starts with these bytes
                      : lead >= 0xF0 ? 3
                      : lead >= 0xE0 ? 2
                      : lead >= 0xC2 ? 1
                                     : 0;
    if (lead < 0x80) {
        length = 1;
        return lead;
    }
    if (extra == 0 || at + extra >= text.size()) {
        length = 1;
        return 0x110000 + lead;
    }
    char32_t code = lead & (0x3F >> extra);
    for (int i = 1; i <= extra; ++i) {
        if (!IsContinuation(text[at + i])) {
            length = 1;
            return 0x110000 + lead;
        }
        code = (code << 6) | (static_cast<unsigned char>(text[at + i]) & 0x3F);
    }
    length = static_cast<size_t>(extra) + 1;
    return code;
}

char32_t Fold(char32_t code) {
    return code < 0x110000 ? QChar::toCaseFolded(code) : code;
}

Match FindFolded(std::string_view source, size_t from, std::string_view find) {
    std::vector<char32_t> needle;
    for (size_t at = 0, length = 0; at < find.size(); at += length) {
        needle.push_back(Fold(DecodeAt(find, at, length)));
    }
    for (size_t at = from, length = 0; at < source.size(); at += length) {
        DecodeAt(source, at, length);
        size_t end = at;
        size_t matched = 0;
        while (matched < needle.size() && end < source.size()) {
            size_t step = 0;
            if (Fold(DecodeAt(source, end, step)) != needle[matched]) {
                break;
            }
            end += step;
            ++matched;
        }
        if (matched == needle.size()) {
            return {at, end - at};
        }
    }
    return {};
}

// Case-insensitive search for the whole of `find`, from byte offset `from`.
Match Find(std::string_view source, size_t from, std::string_view find) {
    if (find.empty() || from > source.size()) {
        return {};
    }
    if (!IsAscii(find)) {
        return FindFolded(source, from, find);
    }
    std::string lower(find);
    std::transform(lower.begin(), lower.end(), lower.begin(), FoldAscii);
    const size_t at = FindLowerAscii(source, lower, from);
    return at == std::string_view::npos ? Match{} : Match{at, find.size()};
}

size_t CharacterCount(std::string_view text) {
    return static_cast<size_t>(
        std::count_if(text.begin(), text.end(), [](char c) { return !IsContinuation(c); }));
}

// Byte offset of the character that follows `count` characters from the start.
size_t ByteOffsetOf(std::string_view text, long long count) {
    size_t at = 0;
    while (count > 0 && at < text.size()) {
        ++at;
        while (at < text.size() && IsContinuation(text[at])) {
            ++at;
        }
        --count;
    }
    return at;
}

bool IsTrimmed(char c) {
    return c == ' ' || c == '\t' || c == '\r' || c == '\n' || c == '\v' || c == '\f';
}

}  // namespace

std::string_view NthFieldView(std::string_view source, std::string_view separator, long long n) {
    if (n < 1) {
        return {};
    }
    if (separator.empty()) {
        return n == 1 ? source : std::string_view();
    }
    size_t fieldStart = 0;
    for (long long field = 1;; ++field) {
        const Match match = Find(source, fieldStart, separator);
        if (field == n) {
            const size_t end = match.Found() ? match.position : source.size();
            return source.substr(fieldStart, end - fieldStart);
        }
        if (!match.Found()) {
            return {};
        }
        fieldStart = match.position + match.length;
    }
}

std::string NthField(std::string_view source, std::string_view separator, long long n) {
    return std::string(NthFieldView(source, separator, n));
}

long long CountFields(std::string_view source, std::string_view separator) {
    if (separator.empty()) {
        return 1;
    }
    long long fields = 1;
    for (Match m = Find(source, 0, separator); m.Found();
         m = Find(source, m.position + m.length, separator)) {
        ++fields;
    }
    return fields;
}

long long InStr(long long start, std::string_view source, std::string_view find) {
    const size_t from = ByteOffsetOf(source, std::max(start, 1LL) - 1);
    const Match match = Find(source, from, find);
    if (!match.Found()) {
        return 0;
    }
    return static_cast<long long>(CharacterCount(source.substr(0, match.position))) + 1;
}

std::string Left(std::string_view source, long long count) {
    return std::string(source.substr(0, ByteOffsetOf(source, count)));
}

std::string Trim(std::string_view source) {
    size_t begin = 0;
    size_t end = source.size();
    while (begin < end && IsTrimmed(source[begin])) {
        ++begin;
    }
    while (end > begin && IsTrimmed(source[end - 1])) {
        --end;
    }
    return std::string(source.substr(begin, end - begin));
}

// Reads [blanks][sign]digits[.digits][e[sign]digits]; no words such as "inf" or "nan".
double Val(std::string_view source) {
    size_t at = 0;
    while (at < source.size() && (source[at] == ' ' || source[at] == '\t')) {
        ++at;
    }
    const size_t begin = at;
    auto digits = [&] {
        const size_t from = at;
        while (at < source.size() && source[at] >= '0' && source[at] <= '9') {
            ++at;
        }
        return at - from;
    };
    if (at < source.size() && (source[at] == '+' || source[at] == '-')) {
        ++at;
    }
    size_t mantissa = digits();
    if (at < source.size() && source[at] == '.') {
        ++at;
        mantissa += digits();
    }
    if (mantissa == 0) {
        return 0.0;
    }
    const size_t beforeExponent = at;
    if (at < source.size() && (source[at] == 'e' || source[at] == 'E')) {
        ++at;
        if (at < source.size() && (source[at] == '+' || source[at] == '-')) {
            ++at;
        }
        if (digits() == 0) {
            at = beforeExponent;
        }
    }
    // In the C locale, whatever the desktop's; beyond the range of a double, strtod gives what a
    // double holds there: infinity, or the nearest representable value.
    static const locale_t cLocale = newlocale(LC_ALL_MASK, "C", nullptr);
    return strtod_l(std::string(source.substr(begin, at - begin)).c_str(), nullptr, cLocale);
}

std::string Str(long long value, std::string_view /*format*/) {
    return std::to_string(value);
}

std::string Chr(long long code) {
    if (code < 0 || code > 0x10FFFF) {
        return {};
    }
    const auto c = static_cast<char32_t>(code);
    return QString::fromUcs4(&c, 1).toStdString();
}

int RuntimeStringCompare(std::string_view first, std::string_view second) {
    size_t a = 0;
    size_t b = 0;
    // ASCII on both sides, the common case, needs no decoding.
    while (a < first.size() && b < second.size() &&
           (static_cast<unsigned char>(first[a]) | static_cast<unsigned char>(second[b])) < 0x80) {
        const char ca = FoldAscii(first[a]);
        const char cb = FoldAscii(second[b]);
        if (ca != cb) {
            return ca < cb ? -1 : 1;
        }
        ++a;
        ++b;
    }
    while (a < first.size() && b < second.size()) {
        size_t lengthA = 0;
        size_t lengthB = 0;
        const char32_t ca = Fold(DecodeAt(first, a, lengthA));
        const char32_t cb = Fold(DecodeAt(second, b, lengthB));
        if (ca != cb) {
            return ca < cb ? -1 : 1;
        }
        a += lengthA;
        b += lengthB;
    }
    if (a == first.size() && b == second.size()) {
        return 0;
    }
    return a == first.size() ? -1 : 1;
}

bool TextEquals(std::string_view first, std::string_view second) {
    return RuntimeStringCompare(first, second) == 0;
}

long long Int64FromDouble(double value) {
    if (std::isnan(value)) {
        return 0;
    }
    constexpr double kLimit = 9223372036854775807.0;
    if (value >= kLimit) {
        return std::numeric_limits<long long>::max();
    }
    if (value <= -kLimit) {
        return std::numeric_limits<long long>::min();
    }
    return static_cast<long long>(std::trunc(value));
}
