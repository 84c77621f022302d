// Listbox over QTableView, which keeps no item per row: fixed columns, a heading that sorts,
// and a delegate that lets CellBackgroundPaint paint each cell's ground before its text.
#include "platform/widgets/listbox.h"

#include <QHeaderView>
#include <QPainter>
#include <QStyledItemDelegate>
#include <QTableView>

#include "platform/runtime/application.h"
#include "platform/runtime/qt_color.h"
#include "platform/widgets/desktop_colors.h"
#include "platform/widgets/list_model.h"
#include "platform/widgets/list_view.h"

namespace {

class CellDelegate : public QStyledItemDelegate {
  public:
    // The view owns the delegate, which goes with it.
    CellDelegate(Listbox& owner, QObject* view) : QStyledItemDelegate(view), owner_(&owner) {}
    void Forget() { owner_ = nullptr; }

    void paint(QPainter* painter, const QStyleOptionViewItem& option,
               const QModelIndex& index) const override {
        if (owner_ && owner_->CellBackgroundPaint && PaintGround(*painter, option, index)) {
            return;
        }
        // The selection moves with the current row, so the style's tint of the focused
        // current row would only hide the ground of an unselected one; the view rings it.
        // The selected row's text reads on the desktop's selection colour.
        QStyleOptionViewItem plain = option;
        plain.state &= ~QStyle::State_HasFocus;
        if (option.state & QStyle::State_Selected) {
            plain.palette.setColor(QPalette::Highlight,
                                   ReadableGround(option.palette.color(QPalette::Highlight),
                                                  option.palette.color(QPalette::HighlightedText)));
        }
        QStyledItemDelegate::paint(painter, plain, index);
    }

    QSize sizeHint(const QStyleOptionViewItem& option, const QModelIndex& index) const override {
        QSize size = QStyledItemDelegate::sizeHint(option, index);
        if (owner_) {
            size.setHeight(owner_->Model().RowHeight());
        }
        return size;
    }

  private:
    // Raises the event on a Graphics that covers the cell; true if the handler took it over.
    bool PaintGround(QPainter& painter, const QStyleOptionViewItem& option,
                     const QModelIndex& index) const {
        painter.save();
        painter.translate(option.rect.topLeft());
        painter.setClipRect(0, 0, option.rect.width(), option.rect.height());
        auto g = New<Graphics>(painter, option.rect.width(), option.rect.height(),
                               FromQColor(option.palette.color(QPalette::Base)));
        // An exception in the handler counts as False.
        bool handled = false;
        RaiseEvent([&, list = owner_] {
            handled = list->CellBackgroundPaint(*list, g, index.row(), index.column());
        });
        painter.restore();
        return handled;
    }

    Listbox* owner_;
};

std::vector<int> ParseWidths(const std::string& text) {
    std::vector<int> widths;
    size_t start = 0;
    while (start <= text.size()) {
        const size_t comma = std::min(text.find(',', start), text.size());
        widths.push_back(std::atoi(text.substr(start, comma - start).c_str()));
        start = comma + 1;
    }
    return widths;
}

ListView& View(QWidget& widget) {
    return static_cast<ListView&>(widget);
}

}  // namespace

Listbox::Listbox() : model_(std::make_unique<ListModel>()) {
    auto* view = new ListView;
    view->setShowGrid(false);
    view->setWordWrap(false);
    view->setCornerButtonEnabled(false);
    view->verticalHeader()->hide();
    view->verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
    view->verticalHeader()->setDefaultSectionSize(Rows().RowHeight());
    view->horizontalHeader()->setDefaultAlignment(Qt::AlignLeft | Qt::AlignVCenter);
    view->setSelectionMode(QAbstractItemView::SingleSelection);
    view->setSelectionBehavior(QAbstractItemView::SelectRows);
    view->setEditTriggers(QAbstractItemView::NoEditTriggers);
    view->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    view->setModel(model_.get());
    view->setItemDelegate(new CellDelegate(*this, view));
    view->horizontalHeader()->setSectionsClickable(true);
    SetWidget(view);

    QObject::connect(view->horizontalHeader(), &QHeaderView::sectionClicked, Context(),
                     [this](int column) { PressHeading(column); });
    QObject::connect(view, &QTableView::doubleClicked, Context(), [this] { RaiseDoubleClick(); });
    view->OpenRequested = [this] { RaiseDoubleClick(); };
    QObject::connect(view->selectionModel(), &QItemSelectionModel::selectionChanged, Context(),
                     [this] {
                         if (Change) {
                             RaiseEvent([this] { Change(*this); });
                         }
                     });
}

Listbox::~Listbox() = default;

void Listbox::DetachWidget() {
    if (auto* view = static_cast<QTableView*>(Widget())) {
        static_cast<CellDelegate*>(view->itemDelegate())->Forget();
        // The model goes with the view, which may still be on its way out.
        model_.release()->setParent(view);
    }
    Control::DetachWidget();
}

void Listbox::SetProperty(const std::string& name, const PropertyValue& value) {
    Control::SetProperty(name, value);
    QTableView& view = View(LiveWidget());
    if (name == "HasHeading") {
        view.horizontalHeader()->setVisible(std::get<bool>(value));
    } else if (name == "DefaultRowHeight") {
        Rows().SetRowHeight(static_cast<int>(std::get<long long>(value)));
        view.verticalHeader()->setDefaultSectionSize(Rows().RowHeight());
    }
}

// Columns, headings and widths together, once the block has given all three: each new set of
// columns resets the model and its header.
void Listbox::PropertiesApplied() {
    Control::PropertiesApplied();
    if (!Property("ColumnCount") && !Property("InitialValue")) {
        return;
    }
    ListView& view = View(LiveWidget());
    QStringList headings =
        QString::fromStdString(PropertyOr<std::string>("InitialValue")).split('\t');
    const int count = static_cast<int>(PropertyOr<long long>("ColumnCount"));
    while (headings.size() < count) {
        headings.append(QString());
    }
    headings = headings.mid(0, std::max(count, 1));
    Rows().SetColumns(headings);
    // A screen reader names the list by its heading.
    view.setAccessibleName(headings.join(", "));
    view.horizontalHeader()->setSectionResizeMode(
        PropertyOr<bool>("ColumnsResizable") ? QHeaderView::Interactive : QHeaderView::Fixed);
    if (Property("ColumnWidths")) {
        view.SetDesignedWidths(ParseWidths(PropertyOr<std::string>("ColumnWidths")));
    }
}

// Return on the selected row opens it as a double click does.
void Listbox::RaiseDoubleClick() {
    if (DoubleClick) {
        RaiseEvent([this] { DoubleClick(*this); });
    }
}

void Listbox::DeleteAllRows() {
    Rows().Reset();
}

void Listbox::AddRow(const std::vector<std::string>& texts) {
    RowStore& store = Rows().Store();
    store.AddRow();
    const size_t row = store.Count() - 1;
    for (size_t i = 0; i < texts.size() && static_cast<int>(i) < Rows().Columns(); ++i) {
        store.SetField(row, static_cast<int>(i), texts[i]);
    }
    Rows().RowAdded();
}

long long Listbox::LastIndex() const {
    return static_cast<long long>(Rows().Store().Count()) - 1;
}

long long Listbox::ListCount() const {
    return static_cast<long long>(Rows().Store().Count());
}

std::string Listbox::Cell(long long row, long long column) const {
    CheckCell(row, column);
    return std::string(Rows().Store().Field(static_cast<size_t>(row), static_cast<int>(column)));
}

void Listbox::SetCell(long long row, long long column, std::string_view text) {
    CheckCell(row, column);
    ListModel& rows = Rows();
    rows.Store().SetField(static_cast<size_t>(row), static_cast<int>(column), text);
    rows.CellChanged(static_cast<size_t>(row), static_cast<int>(column));
}

Variant Listbox::RowTag(long long row) const {
    CheckCell(row, 0);
    return StringToVariant(
        std::string(Rows().Store().Field(static_cast<size_t>(row), Rows().Columns())));
}

void Listbox::SetRowTag(long long row, const Variant& tag) {
    CheckCell(row, 0);
    Rows().Store().SetField(static_cast<size_t>(row), Rows().Columns(), tag.text);
}

long long Listbox::ListIndex() const {
    const QModelIndexList selected = View(LiveWidget()).selectionModel()->selectedRows();
    return selected.isEmpty() ? -1 : selected.first().row();
}

void Listbox::SetListIndex(long long row) {
    QTableView& view = View(LiveWidget());
    Rows().Flush();
    if (row < 0) {
        view.clearSelection();
        return;
    }
    CheckCell(row, 0);
    view.setCurrentIndex(Rows().index(static_cast<int>(row), 0));
}

void Listbox::PressHeading(long long column) {
    const bool again = Rows().SortColumn() == column;
    const Qt::SortOrder order = again && Rows().SortOrder() == Qt::AscendingOrder
                                    ? Qt::DescendingOrder
                                    : Qt::AscendingOrder;
    QTableView& view = View(LiveWidget());
    view.horizontalHeader()->setSortIndicatorShown(true);
    view.horizontalHeader()->setSortIndicator(static_cast<int>(column), order);
    Rows().sort(static_cast<int>(column), order);
}

ListModel& Listbox::Rows() const {
    if (!model_) [[unlikely]] {
        throw NilObjectException("The list's window is gone");
    }
    return *model_;
}

void Listbox::CheckCell(long long row, long long column) const {
    const ListModel& rows = Rows();
    if (row < 0 || static_cast<size_t>(row) >= rows.Store().Count() || column < 0 ||
        column >= rows.Columns()) {
        throw OutOfBoundsException("List cell out of bounds");
    }
}
