// SegmentedControl: a row of segments of which one at a time is selected.
#pragma once

#include <functional>
#include <string>
#include <vector>

#include "platform/widgets/control.h"

class SegmentedControl;

class SegmentedControlItem {
  public:
    void SetTitle(const std::string& title);
    void SetWidth(long long width);
    bool Selected() const { return selected_; }
    // Marks the segment as chosen or not, as the user sees it.
    void SetSelected(bool selected);

  private:
    friend class SegmentedControl;
    std::string title_;
    long long width_ = 0;
    bool selected_ = false;
    SegmentedControl* owner_ = nullptr;
};

class SegmentedControl : public Control {
  public:
    // The list of segments: Append, and subscript access from 0.
    class ItemList {
      public:
        explicit ItemList(SegmentedControl& owner) : owner_(owner) {}
        void Append(const Ref<SegmentedControlItem>& item);
        Ref<SegmentedControlItem> operator[](long long index) const;

      private:
        SegmentedControl& owner_;
    };

    SegmentedControl();
    ItemList Items() { return ItemList(*this); }
    void SizeToFit();
    // As a click of the user on that segment.
    void Press(long long segmentIndex);

    std::function<void(SegmentedControl&, long long)> Action;

  private:
    friend class SegmentedControlItem;
    void Rebuild();
    void ShowSelection();
    void Step(int index);
    void Clicked(int index);

    std::vector<Ref<SegmentedControlItem>> items_;
};
