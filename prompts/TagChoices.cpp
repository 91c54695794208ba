// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "prompts/TagChoices.h"

#include <algorithm>

namespace tarrow {

namespace {

std::string_view trimmed(std::string_view text)
{
    constexpr std::string_view spaces = " \t";
    const auto first = text.find_first_not_of(spaces);
    if (first == std::string_view::npos)
        return {};
    return text.substr(first, text.find_last_not_of(spaces) - first + 1);
}

char lower(char letter)
{
    return letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter - 'A' + 'a') : letter;
}

bool isSameName(std::string_view one, std::string_view other)
{
    return std::ranges::equal(one, other, {}, lower, lower);
}

bool contains(const std::vector<std::string>& names, const std::string& name)
{
    return std::ranges::find(names, name) != names.end();
}

} // namespace

TagChoices::TagChoices(
    const std::vector<std::string>& known, std::vector<std::vector<std::string>> tagsOfItems)
    : _itemCount(tagsOfItems.size())
{
    std::vector<std::string> names, others;
    for (const auto& name : known) {
        if (!contains(names, name))
            names.push_back(name);
    }
    for (const auto& tags : tagsOfItems)
        std::ranges::copy_if(
            tags, std::back_inserter(others), [&](const auto& name) { return !contains(names, name); });
    std::ranges::sort(others);
    const auto repeated = std::ranges::unique(others);
    others.erase(repeated.begin(), repeated.end());
    names.insert(names.end(), others.begin(), others.end());
    for (auto& name : names) {
        const auto items = static_cast<std::size_t>(
            std::ranges::count_if(tagsOfItems, [&](const auto& tags) { return contains(tags, name); }));
        _choices.push_back({std::move(name), items, items > 0 && items == _itemCount, false});
    }
}

void TagChoices::set(std::size_t index, bool on)
{
    auto& choice = _choices[index];
    choice.isSet = choice.isSet || choice.isOn != on;
    choice.isOn = on;
}

std::size_t TagChoices::indexOf(std::string_view name) const
{
    // The very name goes before one that differs in the case of its letters.
    auto found = std::ranges::find(_choices, name, &Choice::name);
    if (found == _choices.end())
        found = std::ranges::find_if(
            _choices, [&](const Choice& choice) { return isSameName(choice.name, name); });
    return static_cast<std::size_t>(found - _choices.begin());
}

std::size_t TagChoices::addOne(std::string_view name)
{
    const auto index = indexOf(name);
    if (index == count())
        _choices.push_back({std::string(name), 0, false, false});
    set(index, true);
    return index;
}

std::size_t TagChoices::add(std::string_view typed)
{
    std::size_t last = count();
    while (!typed.empty()) {
        // A comma stands between the names in the attribute of a file, so that no name may contain one.
        const auto end = std::min(typed.find(','), typed.size());
        if (const auto name = trimmed(typed.substr(0, end)); !name.empty())
            last = addOne(name);
        typed.remove_prefix(std::min(end + 1, typed.size()));
    }
    return last;
}

TagEdit TagChoices::edit() const
{
    TagEdit edit;
    for (const auto& choice : _choices) {
        if (!choice.isSet)
            continue;
        if (choice.isOn && choice.items < _itemCount)
            edit.added.push_back(choice.name);
        else if (!choice.isOn && choice.items > 0)
            edit.removed.push_back(choice.name);
    }
    return edit;
}

} // namespace tarrow
