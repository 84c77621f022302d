// The stored report text: lines ended by carriage returns, values found by line number and
// marker. Every missing piece reads as the empty text.
#pragma once

#include <string>
#include <string_view>

// The read value as the list shows it: from line 1 if "Code reads" is there, else line 2.
std::string ListReadValue(std::string_view text);
// The read value and the code type as the report shows them; they try lines 1 and 2 in
// opposite orders.
std::string ReportReadValue(const std::string& text);
std::string ReportCodeType(const std::string& text);
// Whether a text can be shown as a report: "Code reads" or "Code is" on its first line.
bool PassesReportTest(const std::string& text);

std::string SymbolLength(const std::string& text);  // line 4
std::string Scale(const std::string& text);         // line 5
std::string Bwr(const std::string& text);           // line 6
std::string BarDeviance(const std::string& text);   // line 7
std::string FreeLine(const std::string& text);      // line 8, whole

std::string MeasurementsBlock(const std::string& text);
std::string DeviancesBlock(const std::string& text);
