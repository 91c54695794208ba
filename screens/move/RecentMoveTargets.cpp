// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/move/RecentMoveTargets.h"

#include "platform/Services.h"
#include "platform/UserDefaults.h"

#include <algorithm>
#include <string>

namespace screens {

namespace {

const std::string key = "RecentMoveTargets";

} // namespace

std::vector<Url> RecentMoveTargets::folders()
{
    std::vector<Url> folders;
    const auto data = services().userDefaults().data(key);
    const auto value = data ? services().keyedArchiver().unarchive(*data) : std::nullopt;
    const auto* paths = value ? value->get<PropertyArray>() : nullptr;
    if (!paths)
        return folders;
    for (const auto& path : *paths) {
        const auto* text = path.get<std::string>();
        if (text && text->starts_with('/') && folders.size() < kept)
            folders.push_back(Url::fileURL(*text, PathKind::Directory));
    }
    return folders;
}

void RecentMoveTargets::remember(const Url& folder)
{
    auto remembered = folders();
    std::erase(remembered, folder);
    remembered.insert(remembered.begin(), folder);
    PropertyArray paths;
    for (std::size_t i = 0; i < std::min(remembered.size(), kept); ++i)
        paths.emplace_back(remembered[i].path());
    services().userDefaults().setData(
        key, services().keyedArchiver().archive(PropertyValue(std::move(paths))));
}

} // namespace screens
