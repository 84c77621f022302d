// The readers of the stored report text, on both layouts and the sharp cases.
#include "results/report_text.h"

#include <gtest/gtest.h>

#include <optional>
#include <random>

#include "demo/demo_tree.h"
#include "platform/core/text.h"

namespace {

// Both layouts as the plug-in writes them.
const std::string kLayoutA = demo::ReportText(demo::Layout::A, "1234567890128", "EAN 13", 2);
const std::string kLayoutB = demo::ReportText(demo::Layout::B, "1234567890128", "EAN 13", 2);

// Each reader of lines one and two on both layouts and the sharp cases: the list's read value,
// the report's read value and code type, and whether the report shows at all.
TEST(ReportText, ReadersOfLinesOneAndTwo) {
    const struct {
        std::string text, listValue, reportValue, codeType;
        bool report;
    } cases[] = {
        {kLayoutA, " 1234567890128", " 1234567890128", " EAN 13", true},
        {kLayoutB, " 1234567890128", " 1234567890128", " EAN 13", true},
        {"", "", "", "", false},
        {"Verifier\rCode reads 42", " 42", " 42", "", false},  // on line two only
        {"Code reads 42 and more", " 42 and more", " 42 and more", "", true},
        {"Code reads 42 Code is EAN 8\rnothing", " 42 Code is EAN 8", " 42 Code is EAN 8", " EAN 8",
         true},
        {"Code is Sized at 80 %", "", "", " Sized at 80 %", true},
        {"Code reads 12 Code reads 34", " 12 ", " 12 ", "", true},  // cut at the marker
        {"Code reads\rCode reads 99", "", " 99", "", true},  // the list and the report differ
        {"CODE READS 7\rcode is UPC A", " 7", " 7", " UPC A", true},
        {"Code reads 5\r\nCode is EAN 8\r\n", " 5", " 5", " EAN 8", true},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.text);
        EXPECT_EQ(ListReadValue(c.text), c.listValue);
        EXPECT_EQ(ReportReadValue(c.text), c.reportValue);
        EXPECT_EQ(ReportCodeType(c.text), c.codeType);
        EXPECT_EQ(PassesReportTest(c.text), c.report);
    }
}

TEST(ReportText, AMarkerOnTheWrongLineGivesNothing) {
    const std::string text = "Code reads 1\rCode is 2\r\rBar Deviance 6\rSymbol Length 3";
    EXPECT_EQ(SymbolLength(text) + BarDeviance(text) + Scale(text) + FreeLine(text), "");
}

TEST(ReportText, CrLfCarriesTheLineFeedIntoLineEightAndTheBlocks) {
    std::string text = kLayoutA;
    for (size_t at = text.find('\r'); at != std::string::npos; at = text.find('\r', at + 2)) {
        text.insert(at + 1, "\n");
    }
    EXPECT_EQ(SymbolLength(text), " 29.83 mm") << "the line feed stands ahead of the marker";
    EXPECT_EQ(FreeLine(text), "\nAll bars within tolerance");
    EXPECT_EQ(MeasurementsBlock(text), "\r\nBar 1 660\r\nBar 2 990\r\n");
}

}  // namespace

// The list's reader against the plain rule, read through the general field splitter, on
// texts made of the pieces that trip a search: markers in any case, cut markers, line ends,
// bytes beyond ASCII and bytes that fold to a marker's letters only by a wrong fold.
TEST(ReportText, TheListsReaderAgreesWithTheFieldSplitterOnRandomTexts) {
    const auto behind = [](std::string_view line) -> std::optional<std::string_view> {
        const std::string_view before = NthFieldView(line, "Code reads", 1);
        if (before.size() == line.size()) {
            return std::nullopt;
        }
        return NthFieldView(line.substr(before.size() + 10), "Code reads", 1);
    };
    const auto rule = [&](std::string_view text) {
        if (const auto value = behind(NthFieldView(text, "\r", 1))) {
            return std::string(*value);
        }
        return std::string(behind(NthFieldView(text, "\r", 2)).value_or(""));
    };
    const std::vector<std::string> pieces = {
        "Code reads", "code READS", "Code read", "C",  "c",        "ode reads",
        "\r",         "\r\n",       " ",         "42", "\xC3\xA9", std::string("Code\0reads", 10),
        "\xE3",       "@",          "s"};
    std::mt19937 random(7);
    for (int i = 0; i < 20000; ++i) {
        std::string text;
        for (int n = static_cast<int>(random() % 12); n > 0; --n) {
            text += pieces[random() % pieces.size()];
        }
        ASSERT_EQ(ListReadValue(text), rule(text)) << text;
    }
}
