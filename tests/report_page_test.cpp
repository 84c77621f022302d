// The report page on the real window: a double click reads the row again and fills the form.
#include "window_fixture.h"

using namespace testsupport;

namespace {

const std::string kReport =
    "Code is EAN 13\rCode reads 5012345678900\r\rSymbol Length 29.83 mm\rCode is Sized at 80 "
    "%\rBWR Measured As 15 mic\rBar Deviance 6 mic\rAll bars within tolerance\rActual "
    "Measurements = +- mic 0\r  Bar 1 330\r    Bar 2 660\r\rBar/Space Deviances = +- mic 0\rBar 1 "
    "+4\rBar 2 -2\r";

class ReportPageTest : public WindowTest {
  protected:
    std::vector<std::string> Values(const Ref<class Window1>& window) {
        std::vector<std::string> values;
        for (long long i = 0; i <= 8; ++i) {
            values.push_back(window->Label6(i)->Text());
        }
        return values;
    }
};

// A double click fills every value and both panes; a missing marker leaves its value empty, and
// a pane without its block shows four blanks.
TEST_F(ReportPageTest, ADoubleClickFillsEveryValueAndBothPanes) {
    auto window = StartUp({{"a", "2018-11-04 10:00", "Cereal Box Front.ai", "A", "Code reads 1"},
                           {"b", "2018-11-04 11:00", "Label 250ml Bottle.pdf", "C", kReport},
                           {"n", "", "N.ai", "D", "Code is X"}});
    ASSERT_TRUE(DoubleClickRow(window, 1));
    EXPECT_TRUE(window->MainTabs()->Items()[1]->Selected());
    EXPECT_EQ(Values(window),
              (std::vector<std::string>{" EAN 13", " 5012345678900", " 29.83 mm", " 80 %",
                                        " 15 mic", " 6 mic", "All bars within tolerance",
                                        "Label 250ml Bottle.pdf", "C"}));
    EXPECT_EQ(window->TextArea1()->Text(), "    Bar 1 330\r    Bar 2 660");
    EXPECT_EQ(window->TextArea2()->Text(), "    Bar 1 +4\rBar 2 -2");
    EXPECT_TRUE(window->Label6(8)->Widget()->isVisible());

    window->PushButton2()->Push();
    ASSERT_TRUE(DoubleClickRow(window, 2));
    EXPECT_EQ(Values(window),
              (std::vector<std::string>{" X", "", "", "", "", "", "", "N.ai", "D"}));
    EXPECT_EQ(window->TextArea1()->Text() + "|" + window->TextArea2()->Text(), "    |    ");
}

// The row is read afresh at each double click; a text that fails the test or a row deleted
// meanwhile leaves the list and the old report.
TEST_F(ReportPageTest, ARowThatCannotBeShownLeavesTheListAndTheOldReport) {
    const demo::StoredResult failing{"b", "", "Second.ai", "B", "Verifier\rCode reads 99"};
    auto window = StartUp({{"a", "", "First.ai", "A", kReport}, failing});
    Store({{"a", "", "First, second version.ai", "A", kReport}, failing});
    ASSERT_TRUE(DoubleClickRow(window, 0));
    EXPECT_EQ(window->Label6(7)->Text(), "First, second version.ai");
    const auto shown = Values(window);
    window->PushButton2()->Push();

    DoubleClickRow(window, 1);
    EXPECT_EQ(window->PagePanel1()->Value(), 1);
    EXPECT_EQ(Values(window), shown);
    EXPECT_EQ(window->TextArea1()->Text(), "    Bar 1 330\r    Bar 2 660");

    Store({{"z", "", "Other.ai", "B", kReport}});
    DoubleClickRow(window, 0);
    EXPECT_EQ(window->PagePanel1()->Value(), 1);
    EXPECT_EQ(Values(window), shown);
}

TEST_F(ReportPageTest, AMissingColumnRaisesOutOfTheHandlerAndThePageStays) {
    auto window = StartUp({{"a", "", "Doc.ai", "A", kReport}});
    // The same row in a table without the document column.
    Store({}, "create table results_store (id text, results text)");
    ExecSql(demo::StorePath(tree.Path()),
            "insert into results_store values ('a', '" + kReport + "')");

    ::testing::internal::CaptureStderr();
    DoubleClickRow(window, 0);
    const std::string printed = ::testing::internal::GetCapturedStderr();
    EXPECT_NE(printed.find("NilObjectException"), std::string::npos) << printed;
    EXPECT_EQ(window->PagePanel1()->Value(), 1);
    EXPECT_EQ(window->Label6(7)->Text(), "Code Type");
    window->MainTabs()->Press(0);
    EXPECT_EQ(window->PagePanel1()->Value(), 0) << "the program goes on";
}

}  // namespace
