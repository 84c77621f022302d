// Readers of the report text.
#include "results/report_text.h"

#include <optional>
#include <string_view>

#include "platform/core/text.h"

namespace {
const std::string kLineEnd = Chr(13);
const std::string kCodeReads = "Code reads";
const std::string kCodeIs = "Code is";
const std::string kMeasurements = "Actual Measurements = +- mic 0";
const std::string kDeviances = "Bar/Space Deviances = +- mic 0";

// The readers look at views into the text and copy only the value they return: the list
// reads a value from every row of the store. Line n counts from 1; past the last line it is
// the empty text.
std::string_view LineView(std::string_view text, long long n) {
    return NthFieldView(text, kLineEnd, n);
}

// Whether `line` holds `marker`, case aside: one search, where Behind() makes two.
bool Has(std::string_view line, std::string_view marker) {
    return NthFieldView(line, marker, 1).size() != line.size();
}

// The text behind the first `marker` on `line`, case aside, up to its next occurrence; none
// when the line lacks the marker.
std::optional<std::string_view> Behind(std::string_view line, std::string_view marker) {
    const std::string_view before = NthFieldView(line, marker, 1);
    if (before.size() == line.size()) {
        return std::nullopt;
    }
    // The markers are ASCII, so what matches one, case aside, is as long as the marker.
    return NthFieldView(line.substr(before.size() + marker.size()), marker, 1);
}

std::string ValueBehind(std::string_view line, std::string_view marker) {
    return std::string(Behind(line, marker).value_or(std::string_view()));
}

// "Code reads" as the list's search compares it: in small letters.
constexpr std::string_view kCodeReadsLower = "code reads";

// Behind() for the list, which reads a value from every row of a store: one search for the
// marker in small letters, where the field splitter makes three general searches a line.
// Both follow the same rule.
std::optional<std::string_view> ReadValueBehind(std::string_view line) {
    const size_t at = FindLowerAscii(line, kCodeReadsLower);
    if (at == std::string_view::npos) {
        return std::nullopt;
    }
    const std::string_view rest = line.substr(at + kCodeReadsLower.size());
    return rest.substr(0, FindLowerAscii(rest, kCodeReadsLower));
}
}  // namespace

std::string ListReadValue(std::string_view text) {
    const size_t firstEnd = text.find(kLineEnd[0]);
    if (const auto value = ReadValueBehind(text.substr(0, firstEnd))) {
        return std::string(*value);
    }
    if (firstEnd == std::string_view::npos) {
        return {};
    }
    const std::string_view second = text.substr(firstEnd + 1);
    return std::string(ReadValueBehind(second.substr(0, second.find(kLineEnd[0]))).value_or(""));
}

std::string ReportReadValue(const std::string& text) {
    std::string value = ValueBehind(LineView(text, 1), kCodeReads);
    if (value.empty()) {
        value = ValueBehind(LineView(text, 2), kCodeReads);
    }
    return value;
}

std::string ReportCodeType(const std::string& text) {
    std::string value = ValueBehind(LineView(text, 2), kCodeIs);
    if (value.empty()) {
        value = ValueBehind(LineView(text, 1), kCodeIs);
    }
    return value;
}

bool PassesReportTest(const std::string& text) {
    const std::string_view first = LineView(text, 1);
    return Has(first, kCodeReads) || Has(first, kCodeIs);
}

std::string SymbolLength(const std::string& text) {
    return ValueBehind(LineView(text, 4), "Symbol Length");
}

std::string Scale(const std::string& text) {
    return ValueBehind(LineView(text, 5), "Code is Sized at");
}

std::string Bwr(const std::string& text) {
    return ValueBehind(LineView(text, 6), "BWR Measured As");
}

std::string BarDeviance(const std::string& text) {
    return ValueBehind(LineView(text, 7), "Bar Deviance");
}

std::string FreeLine(const std::string& text) {
    return std::string(LineView(text, 8));
}

std::string MeasurementsBlock(const std::string& text) {
    return std::string(NthFieldView(NthFieldView(text, kMeasurements, 2), kDeviances, 1));
}

// Taken from the whole text, not from behind the measurements marker.
std::string DeviancesBlock(const std::string& text) {
    return NthField(text, kDeviances, 2);
}
