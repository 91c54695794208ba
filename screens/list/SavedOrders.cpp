// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file keeps the orders that the user chose for folders in the user defaults.

#include "platform/Services.h"
#include "platform/UserDefaults.h"
#include "screens/PlatformNames.h"
#include "screens/list/ListOrder.h"

#include <algorithm>
#include <charconv>
#include <optional>
#include <string>
#include <string_view>

namespace screens {

namespace {

constexpr auto defaultsKey = "FolderOrders";
/// A person does not remember more folders than this. Beyond it, the order that was not used for longest is
/// dropped.
constexpr std::size_t mostFolders = 500;

/// Answers the key of a folder: a hash of its path (64-bit FNV-1a), which stays the same from run to run.
std::string nameOf(const Url& folder)
{
    std::uint64_t hash = 0xcbf29ce484222325ULL;
    for (const char c : folder.path())
        hash = (hash ^ static_cast<unsigned char>(c)) * 0x100000001b3ULL;
    char digits[16];
    auto* const end = std::to_chars(std::begin(digits), std::end(digits), hash, 16).ptr;
    return {digits, end};
}

char codeOf(const ListOrder& order)
{
    return static_cast<char>('A' + static_cast<int>(order.key) * 4 + static_cast<int>(order.direction) * 2
        + static_cast<int>(order.grouping));
}

std::optional<ListOrder> orderOf(char code)
{
    const int number = code - 'A';
    if (number < 0 || number > static_cast<int>(OrderKey::Kind) * 4 + 3)
        return std::nullopt;
    return ListOrder{static_cast<OrderKey>(number / 4), static_cast<OrderDirection>(number / 2 % 2),
        static_cast<FolderGrouping>(number % 2)};
}

/// Answers one text for each folder, the one used last at the end. A text is the code of the order and then
/// the folder's key.
PropertyArray savedOrders()
{
    const auto data = services().userDefaults().data(defaultsKey);
    const auto value = data ? services().keyedArchiver().unarchive(*data) : std::nullopt;
    const auto* entries = value ? value->get<PropertyArray>() : nullptr;
    return entries ? *entries : PropertyArray();
}

bool isFor(const PropertyValue& entry, std::string_view name)
{
    const auto* text = entry.get<std::string>();
    return text && !text->empty() && std::string_view(*text).substr(1) == name;
}

} // namespace

ListOrder savedOrder(const Url& folder)
{
    const auto orders = savedOrders();
    const auto found = std::ranges::find_if(
        orders, [name = nameOf(folder)](const auto& entry) { return isFor(entry, name); });
    const auto order = found == orders.end() ? std::nullopt : orderOf(found->get<std::string>()->front());
    return order.value_or(ListOrder());
}

void saveOrder(const Url& folder, const ListOrder& order)
{
    auto orders = savedOrders();
    const auto name = nameOf(folder);
    std::erase_if(orders, [&](const PropertyValue& entry) { return isFor(entry, name); });
    if (order != ListOrder())
        orders.emplace_back(codeOf(order) + name);
    if (orders.size() > mostFolders)
        orders.erase(orders.begin(), orders.end() - static_cast<std::ptrdiff_t>(mostFolders));
    services().userDefaults().setData(defaultsKey, services().keyedArchiver().archive(orders));
}

} // namespace screens
