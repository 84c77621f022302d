// The list page on the real window: loads on every arrival, never clears on a failed read,
// sorts by heading.
#include <QHeaderView>

#include "window_fixture.h"

using namespace testsupport;

namespace {

class ListPageTest : public WindowTest {};

// The store's columns are found by name, in any order and beside others.
TEST_F(ListPageTest, StartUpShowsTheStoredRowsInTheirColumns) {
    Store({Result("1", "Box.ai"),
           {"2", std::nullopt, std::nullopt, std::nullopt, "Code is UPC A\rCode reads 0361"},
           {"3", "2018", "Odd.pdf", "F", "No barcode here"}},
          "create table results_store (results text, extra int, grade text, document text, id "
          "text, datetime text)");
    auto window = StartUp();
    auto list = window->Listbox1();
    ASSERT_EQ(list->ListCount(), 3);
    EXPECT_EQ(Column(window, 0), (std::vector<std::string>{"2018-11-01", "", "2018"}));
    EXPECT_EQ(Column(window, 1), (std::vector<std::string>{"Box.ai", "", "Odd.pdf"}));
    EXPECT_EQ(Column(window, 2), (std::vector<std::string>{" 1", " 0361", ""}));
    EXPECT_EQ(Column(window, 3), (std::vector<std::string>{"A", "", "F"}));
    EXPECT_EQ(VariantToString(list->RowTag(1)), "2");
    EXPECT_EQ(View(window).model()->rowCount(), 3) << "the view shows them";
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

TEST_F(ListPageTest, AClickOnAHeadingSortsAndTheOrderHoldsAcrossReloads) {
    auto window = StartUp({Result("1", "b.ai"), Result("2", "C.ai"), Result("3", "a.ai")});
    auto& header = *View(window).horizontalHeader();
    QTest::mouseClick(header.viewport(), Qt::LeftButton, {},
                      QPoint(header.sectionViewportPosition(1) + 10, header.height() / 2));
    ProcessEvents();
    EXPECT_EQ(Column(window, 1), (std::vector<std::string>{"a.ai", "b.ai", "C.ai"}));
    EXPECT_EQ(VariantToString(window->Listbox1()->RowTag(0)), "3") << "tags go with their rows";

    window->Listbox1()->PressHeading(1);
    ProcessEvents();
    EXPECT_EQ(Column(window, 1), (std::vector<std::string>{"C.ai", "b.ai", "a.ai"}));

    Store({Result("1", "b.ai"), Result("2", "C.ai"), Result("3", "a.ai"), Result("4", "d.ai")});
    window->PushButton2()->Push();
    ProcessEvents();
    EXPECT_EQ(Column(window, 1), (std::vector<std::string>{"d.ai", "C.ai", "b.ai", "a.ai"}));
    EXPECT_EQ(VariantToString(window->Listbox1()->RowTag(0)), "4");
}

}  // namespace
