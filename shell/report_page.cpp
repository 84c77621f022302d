// The report page: a double click reads the selected row from the store again and shows it.
#include "platform/core/text.h"
#include "results/report_text.h"
#include "results/results_store.h"
#include "shell/window1.h"

namespace {
constexpr long long kReportPage = 2;
const std::string kIndent = "    ";
}  // namespace

// Nothing here catches: an exception goes to the run-time with the page as it stands, and the
// record set and the database close as their last references go. A text that fails the
// report test changes nothing on the screen.
void Window1::Listbox1_DoubleClick(Listbox& sender) {
    auto db = New<SQLiteDatabase>();
    const std::string id = VariantToString(sender.RowTag(sender.ListIndex()));
    Ref<RecordSet> rows = OpenStore(*db, RowQuery(id));
    if (rows) {
        const std::string text = *rows->Field("results");
        if (PassesReportTest(text)) {
            Label6(7)->SetText(*rows->Field("document"));
            Label6(8)->SetText(*rows->Field("grade"));
            Label6(1)->SetText(ReportReadValue(text));
            Label6(0)->SetText(ReportCodeType(text));
            Label6(2)->SetText(SymbolLength(text));
            Label6(3)->SetText(Scale(text));
            Label6(4)->SetText(Bwr(text));
            Label6(5)->SetText(BarDeviance(text));
            Label6(6)->SetText(FreeLine(text));
            TextArea1()->SetText(kIndent + Trim(MeasurementsBlock(text)));
            TextArea2()->SetText(kIndent + Trim(DeviancesBlock(text)));
            PagePanel1()->SetValue(kReportPage);
        }
        rows->Close();
    }
    db->Close();
}
