// Huge texts from a damaged or hostile store: the list and the report panes keep every byte of
// them, and the list cells and the labels draw a bounded prefix, so that painting never stalls.
#include <QClipboard>
#include <QLabel>

#include <algorithm>

#include "platform/widgets/shown_text.h"
#include "window_fixture.h"

using namespace testsupport;

namespace {

constexpr size_t kHuge = 4 << 20;

using HugeTextTest = WindowTest;

TEST_F(HugeTextTest, TheListAndThePanesHoldEveryByteAndTheCellsDrawAPrefix) {
    // The second report's two blocks list 200000 bars each: many short lines.
    const std::string manyLines =
        demo::ReportText(demo::Layout::A, "5012345678900", "EAN 13", 200000);
    auto window =
        StartUp({{"1", "2018-11-04", "Jar.ai", "B", "Code reads " + std::string(kHuge, '7')},
                 {"2", "2018-11-05", std::string(kHuge, 'd'), "C", manyLines},
                 {"3", "2018-11-06", "Tin.ai", "D", "Code reads 43"}});
    auto list = window->Listbox1();
    const auto drawn = [&](int row, int column) {
        const QAbstractItemModel& model = *View(window).model();
        return model.data(model.index(row, column), Qt::DisplayRole).toString().size();
    };
    ASSERT_EQ(list->ListCount(), 3);
    EXPECT_EQ(list->Cell(0, 2).size(), kHuge + 1) << "the read value, whole";
    EXPECT_EQ(list->Cell(1, 1).size(), kHuge) << "the document, whole";
    EXPECT_EQ(list->Cell(1, 2), " 5012345678900");
    EXPECT_EQ(VariantToString(list->RowTag(2)), "3");
    EXPECT_EQ(drawn(0, 2), static_cast<qsizetype>(kShownInCell) + 1) << "and an ellipsis";
    EXPECT_EQ(drawn(1, 1), static_cast<qsizetype>(kShownInCell) + 1);
    EXPECT_EQ(drawn(2, 2), 3);

    ASSERT_TRUE(DoubleClickRow(window, 1));
    const size_t begin = manyLines.find("= +- mic 0\r") + 11;
    const std::string block = manyLines.substr(begin, manyLines.find("\rBar/Space") - begin);
    EXPECT_TRUE(window->TextArea1()->Text() == "    " + block) << "the measurements, whole";
    EXPECT_EQ(window->Label6(7)->Text().size(), kShownInCell);
    const auto& document = static_cast<QLabel&>(*window->Label6(7)->Widget());
    EXPECT_EQ(document.text().size(), static_cast<qsizetype>(kShownInCell) + 1);

    // Select All and Copy take the whole block, its lines ended by line feeds.
    QWidget* pane = window->TextArea1()->Widget();
    window->Native()->activateWindow();
    pane->setFocus();
    ProcessEvents();
    QGuiApplication::clipboard()->clear();
    QTest::keyClick(pane, Qt::Key_A, Qt::ControlModifier);
    QTest::keyClick(pane, Qt::Key_C, Qt::ControlModifier);
    std::string copied = "    " + block;
    std::replace(copied.begin(), copied.end(), '\r', '\n');
    EXPECT_TRUE(QGuiApplication::clipboard()->text().toStdString() == copied);

    window->PushButton2()->Push();
    EXPECT_EQ(list->ListCount(), 3) << "back on the list, the same rows";
    EXPECT_EQ(list->Cell(1, 1).size(), kHuge);
}

// A shown text keeps whole characters up to its limit, and its lines end in line feeds.
TEST(ShownText, KeepsWholeCharactersUpToTheLimit) {
    EXPECT_EQ(ShownLines("abcd", 3), QString("abc") + QChar(0x2026));
    EXPECT_EQ(ShownLines("a\xC3\xA9\xC3\xA9", 4), QString("a") + QChar(0xE9) + QChar(0x2026));
    EXPECT_EQ(ShownLines("a\rb\r\nc", 10), "a\nb\nc");
}

}  // namespace
