// A window started as at program start, over a temporary tree with a results store.
#pragma once

#include <QImage>
#include <QMainWindow>
#include <QMenuBar>
#include <QTableView>
#include <QTest>

#include "demo/demo_tree.h"
#include "platform/runtime/appearance.h"
#include "platform/runtime/yield.h"
#include "shell/startup.h"
#include "shell/window1.h"
#include "support.h"

namespace testsupport {

// A stored row dated by its id, which is also its read value.
inline demo::StoredResult Result(const std::string& id, const std::string& document) {
    return {id, "2018-11-0" + id, document, "A", "Code reads " + id + "\rCode is EAN 8"};
}

class WindowTest : public RootedTest {
  protected:
    // What a test may have changed: the appearance, while its window stands, and the yield.
    void TearDown() override {
        SetAppearanceForTesting(Appearance::Light);
        SetYieldIntervalForTesting(std::chrono::milliseconds(50));
        SetYieldPaintObserverForTesting(nullptr);
        ProcessEvents();
        RootedTest::TearDown();
    }
    // The start-up that the event loop would run, without the loop.
    Ref<class Window1> StartUp() {
        _EarlyStartup();
        _LateStartup();
        CurrentApplication()->Event_Open();
        ProcessEvents();
        return Window1();
    }
    // The same over a store of these rows.
    Ref<class Window1> StartUp(const std::vector<demo::StoredResult>& rows) {
        Store(rows);
        return StartUp();
    }
    void Store(const std::vector<demo::StoredResult>& rows,
               const std::string& schema = demo::kSchema) {
        std::filesystem::remove(demo::StorePath(tree.Path()));
        demo::WriteStore(demo::StorePath(tree.Path()), rows, schema);
    }
    // A menu or an item of the window's native menu bar, by name.
    template <class T>
    static T* InMenuBar(const Ref<class Window1>& window, const char* name) {
        return static_cast<QMainWindow*>(window->Native())->menuBar()->findChild<T*>(name);
    }
    QTableView& View(const Ref<class Window1>& window) {
        return *static_cast<QTableView*>(window->Listbox1()->Widget());
    }
    // A real double click on a row of the list; whether the report page shows then.
    bool DoubleClickRow(const Ref<class Window1>& window, int row) {
        QTableView& view = View(window);
        ProcessEvents();
        const QRect rect = view.visualRect(view.model()->index(row, 1));
        QTest::mouseClick(view.viewport(), Qt::LeftButton, {}, rect.center());
        QTest::mouseDClick(view.viewport(), Qt::LeftButton, {}, rect.center());
        return window->PagePanel1()->Value() == 2;
    }
    // A pixel of the widget as painted now; Stripe gives one inside a row of the list.
    QRgb Pixel(QWidget* widget, int x, int y) {
        ProcessEvents();
        return widget->grab().toImage().pixel(x, y);
    }
    QRgb Stripe(const Ref<class Window1>& window, int row) {
        return Pixel(View(window).viewport(), 120, row * 25 + 12);
    }
    static QRgb Rgb(Color color) { return qRgb(Red(color), Green(color), Blue(color)); }
    // A control as the window shows it, with what lies beneath it.
    static QImage Shown(const Ref<class Window1>& window, const Control& control) {
        ProcessEvents();
        return window->Client()
            ->grab(QRect(control.Left(), control.Top(), control.Width(), control.Height()))
            .toImage();
    }
    std::vector<std::string> Column(const Ref<class Window1>& window, int column) {
        std::vector<std::string> cells;
        auto list = window->Listbox1();
        for (long long row = 0; row < list->ListCount(); ++row) {
            cells.push_back(list->Cell(row, column));
        }
        return cells;
    }
};

}  // namespace testsupport
