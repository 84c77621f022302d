// Menus: MenuBar, MenuItem and QuitMenuItem as a tree of named items; each window shows the
// tree in a native menu bar of its own.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include "platform/core/ref.h"

class QMenuBar;

class MenuItem {
  public:
    virtual ~MenuItem() = default;

    std::string Name;
    bool AutoEnable = false;
    // "&" marks the mnemonic; "-" makes a separator.
    std::string Text;
    bool Visible = true;
    // "Cmd+Q" style; Cmd is the platform's command key (Ctrl off macOS).
    std::string KeyboardShortcut;

    void Append(const Ref<MenuItem>& item) { children_.push_back(item); }
    long long Count() const { return static_cast<long long>(children_.size()); }
    Ref<MenuItem> Item(long long index) const;
    // The item of that name directly below this one, or Nil.
    Ref<MenuItem> Child(const std::string& name) const;
    // The item of that name anywhere below this one, or Nil.
    Ref<MenuItem> _Lookup(const std::string& name) const;

    // What a choice of the item does; the platform's text editing stands behind the Edit items.
    virtual void Action();

  private:
    std::vector<Ref<MenuItem>> children_;
};

class QuitMenuItem : public MenuItem {
  public:
    void Action() override;
};

class MenuBar : public MenuItem {};

// Platform use: a native menu bar that shows the tree and acts through it.
QMenuBar* BuildNativeMenuBar(const MenuBar& bar);
