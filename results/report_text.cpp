// Readers of the report text.
#include "results/report_text.h"

#include "platform/text.h"

namespace {
const std::string kLineEnd = Chr(13);
const std::string kCodeReads = "Code reads";
const std::string kCodeIs = "Code is";
const std::string kMeasurements = "Actual Measurements = +- mic 0";
const std::string kDeviances = "Bar/Space Deviances = +- mic 0";
}  // namespace

std::string Line(const std::string& text, long long n) {
    return NthField(text, kLineEnd, n);
}

std::string ValueBehind(const std::string& line, const std::string& marker) {
    return NthField(line, marker, 2);
}

std::string ListReadValue(const std::string& text) {
    const std::string first = Line(text, 1);
    if (InStr(0, first, kCodeReads) > 0) {
        return ValueBehind(first, kCodeReads);
    }
    return ValueBehind(Line(text, 2), kCodeReads);
}

std::string ReportReadValue(const std::string& text) {
    std::string value = ValueBehind(Line(text, 1), kCodeReads);
    if (value.empty()) {
        value = ValueBehind(Line(text, 2), kCodeReads);
    }
    return value;
}

std::string ReportCodeType(const std::string& text) {
    std::string value = ValueBehind(Line(text, 2), kCodeIs);
    if (value.empty()) {
        value = ValueBehind(Line(text, 1), kCodeIs);
    }
    return value;
}

bool PassesReportTest(const std::string& text) {
    const std::string first = Line(text, 1);
    return InStr(0, first, kCodeReads) > 0 || InStr(0, first, kCodeIs) > 0;
}

std::string SymbolLength(const std::string& text) {
    return ValueBehind(Line(text, 4), "Symbol Length");
}

std::string Scale(const std::string& text) {
    return ValueBehind(Line(text, 5), "Code is Sized at");
}

std::string Bwr(const std::string& text) {
    return ValueBehind(Line(text, 6), "BWR Measured As");
}

std::string BarDeviance(const std::string& text) {
    return ValueBehind(Line(text, 7), "Bar Deviance");
}

std::string FreeLine(const std::string& text) {
    return Line(text, 8);
}

std::string MeasurementsBlock(const std::string& text) {
    return NthField(NthField(text, kMeasurements, 2), kDeviances, 1);
}

// Taken from the whole text, not from behind the measurements marker.
std::string DeviancesBlock(const std::string& text) {
    return NthField(text, kDeviances, 2);
}
