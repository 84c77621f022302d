// The plain controls of a window: PagePanel, PushButton, PopupMenu, Label, TextArea, TabPanel.
#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "platform/widgets/control.h"

// Pages of controls: setting Value shows that page's controls, hides the others and raises
// Change, also when the value is the one it had, so that a second press on a page's
// segment refreshes it.
class PagePanel : public Control {
  public:
    PagePanel();
    void SetProperty(const std::string& name, const PropertyValue& value) override;
    long long Value() const { return value_; }
    void SetValue(long long value);
    bool IsPageContainer() const override { return true; }
    bool ShowsPage(long long tabPanelIndex) const override { return tabPanelIndex - 1 == value_; }

    std::function<void(PagePanel&)> Change;

  private:
    long long value_ = 0;
};

class PushButton : public Control {
  public:
    PushButton();
    void SetProperty(const std::string& name, const PropertyValue& value) override;
    void Push();  // as a click of the user
    bool PressAsDefault() override;

    std::function<void(PushButton&)> Action;
};

// A popup of text rows. A row "-" is drawn as a dividing line; it can still be chosen by
// ListIndex, and its Text is "-".
class PopupMenu : public Control {
  public:
    PopupMenu();
    void SetProperty(const std::string& name, const PropertyValue& value) override;
    void AddRow(const std::string& text);
    std::string Text() const;
    long long ListIndex() const;
    void SetListIndex(long long index);
    void RaiseOpen() override;

    std::function<void(PopupMenu&)> Open;

  private:
    std::vector<std::string> rows_;
};

// A label, like a text area, holds and shows a text of a sensible length whole, and of a huge
// one only the prefix that it shows: nothing reads a label's text back but tests.
class Label : public Control {
  public:
    Label();
    void SetProperty(const std::string& name, const PropertyValue& value) override;
    std::string Text() const { return text_; }
    void SetText(const std::string& text);

  private:
    void ApplyAlignment();
    std::string text_;
};

// A text area shows its text whole, of any length, to be read, selected and copied: the
// window's text areas are all read-only, and this one takes no typing.
class TextArea : public Control {
  public:
    TextArea();
    void SetProperty(const std::string& name, const PropertyValue& value) override;
    std::string Text() const { return *text_; }
    // Replaces the whole content; carriage returns and line feeds end lines.
    void SetText(std::string text);

  private:
    // Held once, by the control and its pane together.
    std::shared_ptr<const std::string> text_ = std::make_shared<const std::string>();
};

// Tabs whose controls show while their tab is chosen. Without tabs no tab is chosen; the
// first tab made is chosen; a value that names no tab is ignored.
class TabPanel : public Control {
  public:
    TabPanel();
    void SetProperty(const std::string& name, const PropertyValue& value) override;
    long long Value() const;
    void SetValue(long long value);
    bool IsPageContainer() const override { return true; }
    bool ShowsPage(long long tabPanelIndex) const override { return tabPanelIndex - 1 == Value(); }
};
