// The text pane as the mouse meets it: rows wrapped behind blanks or anywhere in a long word,
// characters rather than bytes, every kind of line end, and the selection as it is painted.
#include <QTest>

#include <memory>

#include "platform/widgets/qt_font.h"
#include "platform/widgets/text_pane.h"
#include "support.h"

namespace {

// Where the cell of a character lies in the pane, inside its margin of 4: x a column, y a row.
struct Grid {
    qreal advance;
    int line;
    qreal X(int column) const { return 4 + column * advance; }
    QPoint At(QPoint cell) const { return {qRound(X(cell.x())), 4 + cell.y() * line + line / 2}; }
};

class TextPaneTest : public ::testing::Test {
  protected:
    // Shows the text in a pane `columns` characters and five rows wide, with no frame and no
    // scroll bar to take from that.
    Grid Show(const std::string& text, int columns) {
        QFont font;
        SetFontFamily(font, "Courier");
        pane.setFont(font);
        pane.setFrameShape(QFrame::NoFrame);
        pane.setVerticalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
        const Grid grid{QFontMetricsF(font).horizontalAdvance('0'), QFontMetrics(font).height()};
        pane.resize(qRound(grid.X(columns) + 4 + grid.advance / 2), 5 * grid.line + 8);
        pane.SetText(std::make_shared<const std::string>(text));
        pane.show();
        testsupport::ProcessEvents();
        return grid;
    }
    // Presses at `from`, moves to `to` as often as told, and lets go there.
    void Drag(QPoint from, QPoint to, int moves) {
        QTest::mousePress(pane.viewport(), Qt::LeftButton, {}, from);
        for (int i = 0; i < moves; ++i) {
            QMouseEvent move(QEvent::MouseMove, to, pane.viewport()->mapToGlobal(to), Qt::NoButton,
                             Qt::LeftButton, {});
            QCoreApplication::sendEvent(pane.viewport(), &move);
        }
        QTest::mouseRelease(pane.viewport(), Qt::LeftButton, {}, to);
    }
    TextPane pane;
};

const std::string kBars = "Bar 1 330\rBar 2 660\r\nBar 3 990\nBar 4";

// A drag from one cell to another, or with no move a double click, selects what the pointer
// crosses: over each kind of line end, in rows wrapped behind a blank or in a long word, in
// characters rather than bytes. Each move below the pane scrolls it a row: three moves reach
// row 9 of the text.
TEST_F(TextPaneTest, SelectsWhatThePointerCrosses) {
    const struct {
        std::string text;
        int columns;
        QPoint from, to;
        int moves;
        QString selected;
    } cases[] = {
        {kBars, 20, {4, 0}, {5, 2}, 1, "1 330\nBar 2 660\nBar 3"},
        {kBars, 20, {7, 1}, {}, 0, "660"},
        {"Bar 1 330 Bar 2 660", 10, {0, 1}, {9, 1}, 1, "Bar 2 660"},
        {"0123456789abcdef", 10, {0, 1}, {6, 1}, 1, "abcdef"},
        {"Größe 12µm", 20, {2, 0}, {9, 0}, 1, QString::fromUtf8("öße 12µ")},
        {"0\r1\r2\r3\r4\r5\r6\r7\r8\r9\r10", 10, {0, 0}, {0, 6}, 3, "0\n1\n2\n3\n4\n5\n6\n7\n8\n"},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.text);
        const Grid grid = Show(c.text, c.columns);
        if (c.moves == 0) {
            QTest::mouseDClick(pane.viewport(), Qt::LeftButton, {}, grid.At(c.from));
        } else {
            Drag(grid.At(c.from), grid.At(c.to), c.moves);
        }
        EXPECT_EQ(pane.SelectedText(), c.selected);
    }
}

// The highlight lies under the selected characters of the wrapped row and nowhere else.
TEST_F(TextPaneTest, PaintsTheHighlightUnderTheSelectionAlone) {
    const Grid grid = Show("0123456789abcdef", 10);
    Drag(grid.At({0, 1}), grid.At({3, 1}), 1);
    const QImage image = pane.viewport()->grab().toImage();
    const QRgb highlight = pane.palette().color(QPalette::Highlight).rgb();
    const QRgb base = pane.palette().color(QPalette::Base).rgb();
    // Pixels of that colour in the characters' cells, a pixel in from their sides.
    auto count = [&](int row, int fromColumn, int toColumn, QRgb colour) {
        int found = 0;
        for (int y = 4 + row * grid.line; y < 4 + (row + 1) * grid.line; ++y) {
            for (int x = qCeil(grid.X(fromColumn)) + 1; x < qFloor(grid.X(toColumn)) - 1; ++x) {
                found += image.pixel(x, y) == colour;
            }
        }
        return found;
    };
    const int cells = qFloor(3 * grid.advance - 2) * grid.line;
    EXPECT_GT(count(1, 0, 3, highlight), cells / 2) << "under \"abc\"";
    EXPECT_EQ(count(1, 3, 6, highlight), 0);
    EXPECT_LT(count(1, 3, 6, base), cells) << "\"def\" is drawn on the second row";
    EXPECT_EQ(count(0, 0, 10, highlight), 0);
}

}  // namespace
