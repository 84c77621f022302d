// The list and report pages on the real window. The list loads on every arrival, never clears on
// a failed read, sorts by heading; a double click reads the row again and fills the report.
#include <QHeaderView>

#include "window_fixture.h"

using namespace testsupport;

namespace {

class ListPageTest : public WindowTest {};

// The store's columns are found by name, in any order and beside others, and an integer id
// reads as text. A click on a heading sorts without regard to case, the tags going with their
// rows, and the order holds across reloads.
TEST_F(ListPageTest, StartUpShowsTheStoredRowsInTheirColumnsAndAHeadingSortsThem) {
    const std::string schema =
        "create table results_store (results text, extra int, grade text, document text, id "
        "integer, datetime text)";
    std::vector<demo::StoredResult> rows = {
        Result("1", "b.ai"),
        {"2", std::nullopt, std::nullopt, std::nullopt, "Code is UPC A\rCode reads 0361"},
        {"3", "2018", "C.ai", "F", "No barcode here"}};
    Store(rows, schema);
    auto window = StartUp();
    auto list = window->Listbox1();
    ASSERT_EQ(list->ListCount(), 3);
    EXPECT_EQ(Column(window, 0), (std::vector<std::string>{"2018-11-01", "", "2018"}));
    EXPECT_EQ(Column(window, 1), (std::vector<std::string>{"b.ai", "", "C.ai"}));
    EXPECT_EQ(Column(window, 2), (std::vector<std::string>{" 1", " 0361", ""}));
    EXPECT_EQ(Column(window, 3), (std::vector<std::string>{"A", "", "F"}));
    EXPECT_EQ(VariantToString(list->RowTag(1)), "2");
    EXPECT_EQ(View(window).model()->rowCount(), 3) << "the view shows them";

    auto& header = *View(window).horizontalHeader();
    QTest::mouseClick(header.viewport(), Qt::LeftButton, {},
                      QPoint(header.sectionViewportPosition(1) + 10, header.height() / 2));
    ProcessEvents();
    EXPECT_EQ(Column(window, 1), (std::vector<std::string>{"", "b.ai", "C.ai"}));
    EXPECT_EQ(VariantToString(list->RowTag(0)), "2");
    list->PressHeading(1);
    ProcessEvents();
    EXPECT_EQ(Column(window, 1), (std::vector<std::string>{"C.ai", "b.ai", ""}));
    rows.push_back(Result("4", "a.ai"));
    Store(rows, schema);
    window->PushButton2()->Push();
    ProcessEvents();
    EXPECT_EQ(Column(window, 1), (std::vector<std::string>{"C.ai", "b.ai", "a.ai", ""}));
    EXPECT_EQ(VariantToString(list->RowTag(2)), "4");
}

// Every arrival on the list reloads the rows stored meanwhile, and the other pages load nothing;
// a store emptied or made unreadable leaves the rows and the selection.
TEST_F(ListPageTest, EveryArrivalOnTheListReloadsAndAFailedReadClearsNothing) {
    auto window = StartUp({Result("1", "Box.ai")});
    Store({Result("1", "Box.ai"), Result("2", "Jar.ai")});
    window->MainTabs()->Press(0);
    EXPECT_EQ(window->Listbox1()->ListCount(), 1) << "the installation page loads nothing";
    window->MainTabs()->Press(1);
    EXPECT_EQ(window->Listbox1()->ListCount(), 2);

    Store({Result("1", "Box.ai"), Result("2", "Jar.ai"), Result("3", "Tin.ai")});
    ASSERT_TRUE(DoubleClickRow(window, 0));
    EXPECT_EQ(window->Listbox1()->ListCount(), 2) << "the report page loads nothing";
    window->PushButton2()->Push();
    EXPECT_EQ(window->Listbox1()->ListCount(), 3);

    window->Listbox1()->SetListIndex(1);
    Store({});
    window->MainTabs()->Press(0);
    window->MainTabs()->Press(1);
    EXPECT_EQ(window->Listbox1()->ListCount(), 3);
    EXPECT_EQ(window->Listbox1()->ListIndex(), 1) << "not cleared, selection kept";
    WriteFile(demo::StorePath(tree.Path()), "not a database");
    window->PagePanel1()->SetValue(1);
    EXPECT_EQ(Column(window, 1), (std::vector<std::string>{"Box.ai", "Jar.ai", "Tin.ai"}));
}

TEST_F(ListPageTest, ATableWithoutIdStopsTheLoadAtTheFirstRowInSilence) {
    Store({},
          "create table results_store (datetime text, document text, grade text, results text)");
    ExecSql(demo::StorePath(tree.Path()),  // the schema lacks id: the rows are written by hand
            "insert into results_store values ('2018', 'Box.ai', 'B', 'Code reads 7');"
            "insert into results_store values ('2019', 'Jar.ai', 'C', 'Code reads 8')");
    ::testing::internal::CaptureStderr();
    auto window = StartUp();
    EXPECT_EQ(::testing::internal::GetCapturedStderr().find("Exception"), std::string::npos)
        << "caught in the handler";
    auto list = window->Listbox1();
    ASSERT_EQ(list->ListCount(), 1);
    EXPECT_EQ(list->Cell(0, 3), "B") << "the row being filled keeps its cells";
    EXPECT_EQ(VariantToString(list->RowTag(0)), "");
    EXPECT_EQ(window->PagePanel1()->Value(), 1);
}

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
