// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/controllers/NavigationItem.h"

namespace kit {

NavigationItem::NavigationItem(std::function<void()> onChange)
    : _onChange(std::move(onChange))
{
}

template <typename T>
void NavigationItem::set(T& field, T value)
{
    if (field == value)
        return;
    field = std::move(value);
    _onChange();
}

void NavigationItem::setTitle(std::string title)
{
    set(_title, std::move(title));
}

void NavigationItem::setSubtitle(std::string subtitle)
{
    set(_subtitle, std::move(subtitle));
}

void NavigationItem::setLeftItems(BarButtonItems items)
{
    set(_leftItems, std::move(items));
}

void NavigationItem::setRightItems(BarButtonItems items)
{
    set(_rightItems, std::move(items));
}

void NavigationItem::setRightItem(std::shared_ptr<BarButtonItem> item)
{
    setRightItems(item ? BarButtonItems{std::move(item)} : BarButtonItems{});
}

void NavigationItem::setHidesBackButton(bool hides)
{
    set(_hidesBackButton, hides);
}

void NavigationItem::setLeftItemsSupplementBackButton(bool supplement)
{
    set(_leftItemsSupplementBackButton, supplement);
}

void NavigationItem::setSearchAction(std::function<void()> action)
{
    _searchAction = std::move(action);
    _onChange();
}

void NavigationItem::setNewAction(std::function<void()> action)
{
    _newAction = std::move(action);
    _onChange();
}

void NavigationItem::setMenu(std::string name, MenuMaker menu)
{
    _menuName = std::move(name);
    _menu = std::move(menu);
    _onChange();
}

} // namespace kit
