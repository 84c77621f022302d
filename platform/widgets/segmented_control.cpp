// SegmentedControl over a row of checkable buttons that touch each other.
#include "platform/widgets/segmented_control.h"

#include <QKeyEvent>
#include <QPushButton>
#include <QWidget>

#include <functional>

#include "platform/runtime/application.h"

namespace {
constexpr const char* kSegmentStyle =
    "QPushButton { border: 1px solid palette(mid); background: palette(button);"
    " color: palette(button-text); padding: 2px; }"
    "QPushButton:checked { background: palette(highlight); color: palette(highlighted-text); }"
    "QPushButton#first { border-top-left-radius: 5px; border-bottom-left-radius: 5px; }"
    "QPushButton#last { border-top-right-radius: 5px; border-bottom-right-radius: 5px; }"
    "QPushButton:focus { border: 2px solid palette(highlight); }"
    "QPushButton:focus:checked { border: 2px solid palette(highlighted-text); }";

// A segment takes the focus by Tab or a click; the arrow keys choose its neighbour.
class SegmentButton : public QPushButton {
  public:
    SegmentButton(const QString& title, QWidget* parent, std::function<void(int)> step)
        : QPushButton(title, parent), step_(std::move(step)) {}

  protected:
    void keyPressEvent(QKeyEvent* event) override {
        switch (event->key()) {
            case Qt::Key_Left:
            case Qt::Key_Up:
                step_(-1);
                break;
            case Qt::Key_Right:
            case Qt::Key_Down:
                step_(1);
                break;
            default:
                QPushButton::keyPressEvent(event);
        }
    }

  private:
    std::function<void(int)> step_;
};
}  // namespace

void SegmentedControlItem::SetTitle(const std::string& title) {
    title_ = title;
    if (owner_) {
        owner_->Rebuild();
    }
}

void SegmentedControlItem::SetWidth(long long width) {
    width_ = width;
    if (owner_) {
        owner_->Rebuild();
    }
}

void SegmentedControlItem::SetSelected(bool selected) {
    selected_ = selected;
    if (owner_) {
        owner_->ShowSelection();
    }
}

void SegmentedControl::ItemList::Append(const Ref<SegmentedControlItem>& item) {
    item->owner_ = &owner_;
    owner_.items_.push_back(item);
    owner_.Rebuild();
}

Ref<SegmentedControlItem> SegmentedControl::ItemList::operator[](long long index) const {
    if (index < 0 || index >= Count()) {
        throw OutOfBoundsException("Segment index out of bounds");
    }
    return owner_.items_[static_cast<size_t>(index)];
}

long long SegmentedControl::ItemList::Count() const {
    return static_cast<long long>(owner_.items_.size());
}

SegmentedControl::SegmentedControl() {
    auto* row = new QWidget;
    row->setStyleSheet(kSegmentStyle);
    SetWidget(row);
}

void SegmentedControl::SizeToFit() {
    long long width = 0;
    for (const auto& item : items_) {
        width += item->width_;
    }
    Control::SetProperty("Width", width);
}

void SegmentedControl::Press(long long segmentIndex) {
    const auto buttons = LiveWidget().findChildren<QPushButton*>(Qt::FindDirectChildrenOnly);
    if (segmentIndex >= 0 && segmentIndex < buttons.size()) {
        buttons[static_cast<int>(segmentIndex)]->click();
    }
}

// One button a segment, side by side from the left, each as wide as its item.
void SegmentedControl::Rebuild() {
    QWidget& row = LiveWidget();
    qDeleteAll(row.findChildren<QPushButton*>(Qt::FindDirectChildrenOnly));
    int x = 0;
    for (size_t i = 0; i < items_.size(); ++i) {
        const int index = static_cast<int>(i);
        auto* button = new SegmentButton(QString::fromStdString(items_[i]->title_), &row,
                                         [this, index](int step) { Step(index + step); });
        button->setObjectName(i == 0 ? "first" : i + 1 == items_.size() ? "last" : "middle");
        button->setCheckable(true);
        button->setFocusPolicy(Qt::StrongFocus);
        button->setGeometry(x, 0, static_cast<int>(items_[i]->width_), Height());
        button->show();
        x += static_cast<int>(items_[i]->width_);
        QObject::connect(button, &QPushButton::clicked, Context(),
                         [this, index] { Clicked(index); });
    }
    ShowSelection();
}

void SegmentedControl::ShowSelection() {
    const auto buttons = LiveWidget().findChildren<QPushButton*>(Qt::FindDirectChildrenOnly);
    for (int i = 0; i < buttons.size() && i < static_cast<int>(items_.size()); ++i) {
        buttons[i]->setChecked(items_[static_cast<size_t>(i)]->selected_);
    }
}

// An arrow key moves the focus to the neighbouring segment and chooses it, as a click would;
// there is no neighbour beyond the ends.
void SegmentedControl::Step(int index) {
    const auto buttons = LiveWidget().findChildren<QPushButton*>(Qt::FindDirectChildrenOnly);
    if (index >= 0 && index < buttons.size()) {
        buttons[index]->setFocus(Qt::TabFocusReason);
        buttons[index]->click();
    }
}

// The selection moves first, then Action comes with the segment's number.
void SegmentedControl::Clicked(int index) {
    for (size_t i = 0; i < items_.size(); ++i) {
        items_[i]->selected_ = static_cast<int>(i) == index;
    }
    ShowSelection();
    if (Action) {
        RaiseEvent([this, index] { Action(*this, index); });
    }
}
