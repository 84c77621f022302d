// Listbox: a list of rows with a heading, over a model that holds its rows in a RowStore.
// A click on a heading sorts by that column, up or down; the order holds across reloads.
#pragma once

#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "platform/core/variant.h"
#include "platform/widgets/control.h"
#include "platform/widgets/graphics.h"

class ListModel;

class Listbox : public Control {
  public:
    Listbox();
    ~Listbox() override;
    void SetProperty(const std::string& name, const PropertyValue& value) override;
    void PropertiesApplied() override;
    void DetachWidget() override;

    void DeleteAllRows();
    // One row at the end with the given texts in its first cells; empty cells for the rest.
    void AddRow(const std::vector<std::string>& texts = {});
    long long LastIndex() const;
    long long ListCount() const;
    std::string Cell(long long row, long long column) const;
    void SetCell(long long row, long long column, std::string_view text);
    Variant RowTag(long long row) const;
    void SetRowTag(long long row, const Variant& tag);
    // The selected row, or -1.
    long long ListIndex() const;
    void SetListIndex(long long row);

    // As a click of the user on a heading: sorts by it, the other way round on a second click.
    void PressHeading(long long column);

    std::function<void(Listbox&)> Change;
    std::function<void(Listbox&)> DoubleClick;
    std::function<bool(Listbox&, Ref<Graphics>, long long, long long)> CellBackgroundPaint;

    // Platform use.
    ListModel& Model() const { return Rows(); }

  private:
    // The model, or NilObjectException once the window that showed the list is gone.
    ListModel& Rows() const;
    void RaiseDoubleClick();
    void CheckCell(long long row, long long column) const;
    std::unique_ptr<ListModel> model_;
};
