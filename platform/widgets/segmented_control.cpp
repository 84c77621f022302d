// SegmentedControl over a row of buttons that stay chosen and touch each other.
#include "platform/widgets/segmented_control.h"

#include <QPushButton>
#include <QWidget>

#include "platform/runtime/application.h"
#include "platform/widgets/segment_widgets.h"

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
    if (index < 0 || index >= static_cast<long long>(owner_.items_.size())) {
        throw OutOfBoundsException("Segment index out of bounds");
    }
    return owner_.items_[static_cast<size_t>(index)];
}

SegmentedControl::SegmentedControl() {
    SetWidget(new SegmentRow);
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
        const SegmentButton::Ends ends{i == 0, i + 1 == items_.size()};
        auto* button = new SegmentButton(QString::fromStdString(items_[i]->title_), &row, ends,
                                         [this, index](int step) { Step(index + step); });
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
