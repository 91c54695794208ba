// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace tarrow {

/// The tags that are given to items and the tags that are taken from them.
struct TagEdit {
    std::vector<std::string> added, removed;
    bool isEmpty() const { return added.empty() && removed.empty(); }
    bool operator==(const TagEdit&) const = default;
};

/// The tags from which a person chooses those of some items: those of the shared table first, in its order,
/// then those that the items have besides, in the order of the alphabet. It knows no screen.
class TagChoices {
public:
    /// `known` are the names of the shared table; `tagsOfItems` has the tags of each item.
    TagChoices(const std::vector<std::string>& known, std::vector<std::vector<std::string>> tagsOfItems);

    std::size_t count() const { return _choices.size(); }
    const std::string& name(std::size_t index) const { return _choices[index].name; }
    /// Answers how many of the items had the tag at first.
    std::size_t itemsWith(std::size_t index) const { return _choices[index].items; }
    std::size_t itemCount() const { return _itemCount; }
    /// Answers whether all items shall have the tag.
    bool isOn(std::size_t index) const { return _choices[index].isOn; }
    /// The tag shall be on all items, or on none.
    void set(std::size_t index, bool on);
    /// Switches on the tags that were typed, with commas between them, and adds those that are not among the
    /// choices at the end. Names are compared regardless of the case of ASCII letters. Answers the index of
    /// the last one, or `count()` when nothing but spaces was typed.
    std::size_t add(std::string_view typed);

    /// Answers what was chosen. A tag that only some items have stays as it is until it is set.
    TagEdit edit() const;

private:
    struct Choice {
        std::string name;
        std::size_t items = 0;
        bool isOn = false, isSet = false;
    };
    std::size_t indexOf(std::string_view name) const;
    std::size_t addOne(std::string_view name);

    std::vector<Choice> _choices;
    std::size_t _itemCount;
};

} // namespace tarrow
