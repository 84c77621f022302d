// The plain controls over Qt widgets.
#include "platform/widgets/controls.h"

#include <QComboBox>
#include <QLabel>
#include <QPushButton>
#include <QSignalBlocker>
#include <QStandardItemModel>
#include <QTabWidget>

#include "platform/runtime/application.h"
#include "platform/runtime/main_thread.h"
#include "platform/widgets/shown_text.h"
#include "platform/widgets/text_pane.h"

namespace {

std::vector<std::string> SplitRows(const std::string& text) {
    std::vector<std::string> rows;
    size_t start = 0;
    for (size_t at = 0; at <= text.size(); ++at) {
        if (at == text.size() || text[at] == '\r' || text[at] == '\n') {
            if (at > start || at < text.size()) {
                rows.push_back(text.substr(start, at - start));
            }
            start = at + 1;
        }
    }
    return rows;
}

}  // namespace

PagePanel::PagePanel() {
    SetWidget(new QWidget);
}

void PagePanel::SetProperty(const std::string& name, const PropertyValue& value) {
    Control::SetProperty(name, value);
    if (name == "Value") {
        SetValue(std::get<long long>(value));
    }
}

void PagePanel::SetValue(long long value) {
    RequireMainThread();
    value_ = value;
    if (auto window = Host()) {
        window->UpdateVisibility();
    }
    if (Change) {
        RaiseEvent([this] { Change(*this); });
    }
}

PushButton::PushButton() {
    auto* button = new QPushButton;
    QObject::connect(button, &QPushButton::clicked, Context(), [this] {
        if (Action) {
            RaiseEvent([this] { Action(*this); });
        }
    });
    SetWidget(button);
}

void PushButton::SetProperty(const std::string& name, const PropertyValue& value) {
    Control::SetProperty(name, value);
    auto& button = static_cast<QPushButton&>(LiveWidget());
    if (name == "Caption") {
        button.setText(QString::fromStdString(std::get<std::string>(value)));
    } else if (name == "Default") {
        button.setDefault(std::get<bool>(value));
        button.setAutoDefault(std::get<bool>(value));
    }
}

void PushButton::Push() {
    static_cast<QPushButton&>(LiveWidget()).click();
}

bool PushButton::PressAsDefault() {
    if (!PropertyOr<bool>("Default") || !IsShown() || !LiveWidget().isEnabled()) {
        return false;
    }
    Push();
    return true;
}

PopupMenu::PopupMenu() {
    SetWidget(new QComboBox);
}

void PopupMenu::SetProperty(const std::string& name, const PropertyValue& value) {
    Control::SetProperty(name, value);
    if (name == "InitialValue") {
        for (const auto& row : SplitRows(std::get<std::string>(value))) {
            AddRow(row);
        }
    } else if (name == "ListIndex") {
        SetListIndex(std::get<long long>(value));
    }
}

void PopupMenu::AddRow(const std::string& text) {
    auto& box = static_cast<QComboBox&>(LiveWidget());
    rows_.push_back(text);
    box.addItem(QString::fromStdString(text));
    if (text == "-") {
        // Shown as a divider, as a user knows it from menus, but still a row of its own.
        const int row = box.count() - 1;
        box.setItemText(row, QString());
        box.setItemData(row, "separator", Qt::AccessibleDescriptionRole);
        if (auto* model = qobject_cast<QStandardItemModel*>(box.model())) {
            model->item(row)->setFlags(Qt::NoItemFlags);
        }
    }
}

std::string PopupMenu::Text() const {
    const long long index = ListIndex();
    return index < 0 ? std::string() : rows_[static_cast<size_t>(index)];
}

long long PopupMenu::ListIndex() const {
    return static_cast<const QComboBox&>(LiveWidget()).currentIndex();
}

void PopupMenu::SetListIndex(long long index) {
    if (index < -1 || index >= static_cast<long long>(rows_.size())) {
        throw OutOfBoundsException("Popup row out of bounds");
    }
    static_cast<QComboBox&>(LiveWidget()).setCurrentIndex(static_cast<int>(index));
}

void PopupMenu::RaiseOpen() {
    if (Open) {
        Open(*this);
    }
}

Label::Label() {
    SetWidget(new QLabel);
}

void Label::SetProperty(const std::string& name, const PropertyValue& value) {
    Control::SetProperty(name, value);
    if (name == "Text") {
        SetText(std::get<std::string>(value));
    } else if (name == "TextAlign" || name == "Multiline") {
        ApplyAlignment();
    }
}

void Label::SetText(const std::string& text) {
    text_ = ShownPrefix(text, kShownInCell);
    static_cast<QLabel&>(LiveWidget()).setText(ShownLines(text, kShownInCell));
}

void Label::ApplyAlignment() {
    auto& label = static_cast<QLabel&>(LiveWidget());
    const long long align = PropertyOr<long long>("TextAlign");
    const Qt::Alignment horizontal = align == 1   ? Qt::AlignHCenter
                                     : align == 2 ? Qt::AlignRight
                                                  : Qt::AlignLeft;
    const bool multiline = PropertyOr<bool>("Multiline");
    label.setWordWrap(multiline);
    label.setAlignment(horizontal | (multiline ? Qt::AlignTop : Qt::AlignVCenter));
    label.setTextFormat(Qt::PlainText);
}

TextArea::TextArea() {
    SetWidget(new TextPane);
}

void TextArea::SetProperty(const std::string& name, const PropertyValue& value) {
    Control::SetProperty(name, value);
    if (name == "Text") {
        SetText(std::get<std::string>(value));
    }
}

void TextArea::SetText(std::string text) {
    text_ = std::make_shared<const std::string>(std::move(text));
    ApplyPendingFont();  // the pane wraps the text in the font it is shown in
    static_cast<TextPane&>(LiveWidget()).SetText(text_);
}

TabPanel::TabPanel() {
    auto* tabs = new QTabWidget;
    QObject::connect(tabs, &QTabWidget::currentChanged, Context(), [this] {
        if (auto window = Host()) {
            window->UpdateVisibility();
        }
    });
    SetWidget(tabs);
}

void TabPanel::SetProperty(const std::string& name, const PropertyValue& value) {
    Control::SetProperty(name, value);
    if (name == "TabDefinition") {
        auto& tabs = static_cast<QTabWidget&>(LiveWidget());
        for (const auto& title : SplitRows(std::get<std::string>(value))) {
            tabs.addTab(new QWidget, QString::fromStdString(title));
        }
    } else if (name == "Value") {
        SetValue(std::get<long long>(value));
    }
}

long long TabPanel::Value() const {
    return static_cast<const QTabWidget&>(LiveWidget()).currentIndex();
}

// A value that names no tab leaves the tab bar as it is.
void TabPanel::SetValue(long long value) {
    static_cast<QTabWidget&>(LiveWidget()).setCurrentIndex(static_cast<int>(value));
}
