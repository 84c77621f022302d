// SegmentedControl over a row of checkable buttons that touch each other.
#include "platform/segmented_control.h"

#include <QPushButton>
#include <QWidget>

#include "platform/application.h"

namespace {
constexpr const char* kSegmentStyle =
    "QPushButton { border: 1px solid palette(mid); background: palette(button);"
    " color: palette(button-text); padding: 2px; }"
    "QPushButton:checked { background: palette(highlight); color: palette(highlighted-text); }"
    "QPushButton#first { border-top-left-radius: 5px; border-bottom-left-radius: 5px; }"
    "QPushButton#last { border-top-right-radius: 5px; border-bottom-right-radius: 5px; }";
}

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
        auto* button = new QPushButton(QString::fromStdString(items_[i]->title_), &row);
        button->setObjectName(i == 0 ? "first" : i + 1 == items_.size() ? "last" : "middle");
        button->setCheckable(true);
        button->setFocusPolicy(Qt::NoFocus);
        button->setGeometry(x, 0, static_cast<int>(items_[i]->width_), Height());
        button->show();
        x += static_cast<int>(items_[i]->width_);
        QObject::connect(button, &QPushButton::clicked, Context(),
                         [this, index = static_cast<int>(i)] { Clicked(index); });
    }
    ShowSelection();
}

void SegmentedControl::ShowSelection() {
    const auto buttons = LiveWidget().findChildren<QPushButton*>(Qt::FindDirectChildrenOnly);
    for (int i = 0; i < buttons.size() && i < static_cast<int>(items_.size()); ++i) {
        buttons[i]->setChecked(items_[static_cast<size_t>(i)]->selected_);
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
