// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/BarButtonItem.h"
#include "kit/values/Menu.h"

#include <functional>

namespace kit {

/// The title, the buttons and the menu that the navigation bar shows while a screen is on top.
class NavigationItem {
public:
    /// `onChange` is called after every change.
    explicit NavigationItem(std::function<void()> onChange);

    const std::string& title() const { return _title; }
    void setTitle(std::string title);
    const std::string& subtitle() const { return _subtitle; } ///< empty: none
    void setSubtitle(std::string subtitle);

    const BarButtonItems& leftItems() const { return _leftItems; }
    void setLeftItems(BarButtonItems items);
    /// The first item stands at the right edge, and each further one stands to the left of the one before.
    const BarButtonItems& rightItems() const { return _rightItems; }
    void setRightItems(BarButtonItems items);
    void setRightItem(std::shared_ptr<BarButtonItem> item); ///< null: none

    bool hidesBackButton() const { return _hidesBackButton; }
    void setHidesBackButton(bool hides);
    /// Answers whether left items stand beside the back button instead of replacing it.
    bool leftItemsSupplementBackButton() const { return _leftItemsSupplementBackButton; }
    void setLeftItemsSupplementBackButton(bool supplement);

    /// The bar's search button calls this function; without one the bar has no such button.
    const std::function<void()>& searchAction() const { return _searchAction; }
    void setSearchAction(std::function<void()> action);

    /// The key for a new item (Ctrl+Shift+N) calls this function; without one the key does nothing.
    const std::function<void()>& newAction() const { return _newAction; }
    void setNewAction(std::function<void()> action);

    /// The bar's menu button calls this function at each press and shows its menu; without one the bar has no
    /// such button.
    using MenuMaker = std::function<Menu()>;
    const MenuMaker& menu() const { return _menu; }
    const std::string& menuName() const { return _menuName; }
    void setMenu(std::string name, MenuMaker menu);

private:
    template <typename T>
    void set(T& field, T value);

    std::function<void()> _onChange;
    std::string _title, _subtitle;
    BarButtonItems _leftItems, _rightItems;
    bool _hidesBackButton = false, _leftItemsSupplementBackButton = false;
    std::function<void()> _searchAction, _newAction;
    std::string _menuName;
    MenuMaker _menu;
};

} // namespace kit
