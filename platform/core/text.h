// Text field operations of the run-time: case-insensitive, positions in characters of UTF-8
// text, whole-text separators. Invalid UTF-8 is taken byte by byte and never fails.
#pragma once

#include <string>
#include <string_view>

std::string NthField(std::string_view source, std::string_view separator, long long n);
// NthField without the copy: a view into `source`.
std::string_view NthFieldView(std::string_view source, std::string_view separator, long long n);
long long CountFields(std::string_view source, std::string_view separator);

// A byte inside a UTF-8 character, not at its start.
inline bool IsContinuation(char byte) {
    return (static_cast<unsigned char>(byte) & 0xC0) == 0x80;
}

// An ASCII capital as its small letter; every other byte as it is.
inline char FoldAscii(char c) {
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c + ('a' - 'A')) : c;
}

// Byte offset of the first `lower`, case aside, in `source` from byte `from`; npos where there
// is none. `lower` is ASCII in small letters, so the search is byte by byte. Inline, so that the
// list, which looks for the same marker in every row, compares against its known letters.
inline size_t FindLowerAscii(std::string_view source, std::string_view lower, size_t from = 0) {
    if (lower.empty() || from > source.size() || lower.size() > source.size() - from) {
        return std::string_view::npos;
    }
    for (size_t at = from; at <= source.size() - lower.size(); ++at) {
        size_t i = 0;
        while (i < lower.size() && FoldAscii(source[at + i]) == lower[i]) {
            ++i;
        }
        if (i == lower.size()) {
            return at;
        }
    }
    return std::string_view::npos;
}

// Position of the first occurrence of `find` at or after character `start` (0 or 1 mean the
// beginning), counted in characters from 1; 0 when there is none or `find` is empty.
long long InStr(long long start, std::string_view source, std::string_view find);
std::string Left(std::string_view source, long long count);
std::string Trim(std::string_view source);
double Val(std::string_view source);
std::string Str(long long value, std::string_view format = {});
std::string Chr(long long code);
// 0 when the two texts are equal, case aside; otherwise the sign of their order.
int RuntimeStringCompare(std::string_view first, std::string_view second);
bool TextEquals(std::string_view first, std::string_view second);

// The run-time's conversion of a double to a 64-bit integer: towards zero, saturating at the
// ends of the range, and 0 for a NaN.
long long Int64FromDouble(double value);
