// The list page: every arrival on page 1 loads the whole store into Listbox1, and each cell
// gets its stripe before the list draws its text.
#include "platform/runtime/appearance.h"
#include "platform/runtime/yield.h"
#include "results/report_text.h"
#include "results/results_store.h"
#include "shell/window1.h"

namespace {
constexpr long long kListPage = 1;
constexpr Color kEvenLight = 0xEDF3FE;
constexpr Color kEvenDark = 0x161616;
constexpr Color kOddLight = 0xFFFFFF;
}  // namespace

// A store that can't be read leaves the list as it is: it is cleared only when rows come.
// Whatever is raised ends the load in silence, with the rows added so far.
void Window1::PagePanel1_Change(PagePanel& sender) {
    Ref<SQLiteDatabase> db;
    try {
        if (sender.Value() != kListPage) {
            return;
        }
        db = New<SQLiteDatabase>();
        Ref<RecordSet> rows = OpenStore(*db, kListQuery);
        if (rows) {
            // Once the window is gone, the list raises at its next use.
            Ref<Listbox> list = Listbox1();
            list->DeleteAllRows();
            do {
                list->AddRow();
                const long long row = list->LastIndex();
                const std::string readValue = ListReadValue(*rows->Field("results"));
                list->SetCell(row, 0, *rows->Field("datetime"));
                list->SetCell(row, 1, *rows->Field("document"));
                list->SetCell(row, 2, readValue);
                list->SetCell(row, 3, *rows->Field("grade"));
                list->SetRowTag(row, StringToVariant(rows->Field("id")->StringValue()));
                rows->MoveNext();
                RuntimeBackgroundTask();
            } while (!rows->Eof());
            rows->Close();
        }
        db->Close();
    } catch (...) {
        if (db) {
            db->Close();
        }
    }
}

void Window1::Listbox1_Change(Listbox&) {}

// Asked anew at every paint, so a change of appearance shows at the next repaint.
bool Window1::Listbox1_CellBackgroundPaint(Listbox&, Ref<Graphics> g, long long row,
                                           long long /*column*/) {
    const bool even = row % 2 == 0;
    const bool dark = IsDarkMode();
    if (even) {
        g->ForeColor = dark ? kEvenDark : kEvenLight;
    } else {
        g->ForeColor = dark ? FillColor() : kOddLight;
    }
    g->FillRect(0, 0, g->Width(), g->Height());
    return false;
}
