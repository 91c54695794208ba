// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/desktop/TypeGraph.h"

#include "host/system/desktop/TypeTable.h"

#include <gio/gio.h>

#include <algorithm>
#include <mutex>

namespace host::system {

namespace {

// The MIME database has about a thousand types, so more dynamic types than this are made up and not
// remembered.
constexpr std::size_t maximumDynamicTypes = 2048;

template <typename Map>
const TypeRow* find(const Map& map, std::string_view key)
{
    const auto found = map.find(key);
    return found == map.end() ? nullptr : found->second;
}

/// Answers the type for the first half of a MIME type.
std::string_view broadType(std::string_view mimeType)
{
    static constexpr std::pair<std::string_view, std::string_view> broad[] = {{"text/", "public.plain-text"},
        {"image/", "public.image"}, {"audio/", "public.audio"}, {"video/", "public.video"},
        {"font/", "public.font"}, {"model/", "public.3d-content"}, {"message/", "public.message"},
        {"inode/", "public.item"}};
    const auto* found =
        std::ranges::find_if(broad, [&](const auto& entry) { return mimeType.starts_with(entry.first); });
    return found == std::end(broad) ? "public.data" : found->second;
}

} // namespace

std::vector<std::string_view> words(std::string_view list)
{
    std::vector<std::string_view> parts;
    while (!list.empty()) {
        const auto end = std::min(list.find(' '), list.size());
        parts.push_back(list.substr(0, end));
        list.remove_prefix(std::min(end + 1, list.size()));
    }
    return parts;
}

TypeGraph::TypeGraph()
{
    for (const auto& row : typeTable()) {
        _rows.emplace(row.identifier, &row);
        for (const auto mimeType : words(row.mimeTypes))
            _byMimeType.emplace(mimeType, &row);
        for (const auto extension : words(row.extensions))
            _byExtension.emplace(extension, &row);
        _ancestors.emplace(row.identifier, ancestorsOfRow(row));
    }
}

const TypeRow* TypeGraph::row(std::string_view type) const
{
    return find(_rows, type);
}

const TypeRow* TypeGraph::rowOfMimeType(std::string_view mimeType) const
{
    return find(_byMimeType, mimeType);
}

const TypeRow* TypeGraph::rowOfExtension(std::string_view extension) const
{
    return find(_byExtension, extension);
}

TypeGraph::Ancestors TypeGraph::ancestorsOfRow(const TypeRow& row) const
{
    Ancestors ancestors;
    for (const auto parent : words(row.parents)) {
        ancestors.emplace_back(parent);
        const auto& above = _ancestors.find(parent)->second; // the table lists parents first
        ancestors.insert(ancestors.end(), above.begin(), above.end());
    }
    return ancestors;
}

TypeGraph::Ancestors TypeGraph::ancestorsOfDynamic(std::string_view mimeType) const
{
    Ancestors ancestors;
    const auto add = [&](std::string_view type) {
        ancestors.emplace_back(type);
        const auto& above = _ancestors.find(type)->second;
        ancestors.insert(ancestors.end(), above.begin(), above.end());
    };
    add(broadType(mimeType));
    const std::string mime(mimeType);
    for (const auto& [known, row] : _byMimeType) {
        // In the MIME database everything is a kind of octet stream, also folders.
        if (known != "application/octet-stream" && g_content_type_is_a(mime.c_str(), known.c_str()))
            add(row->identifier);
    }
    return ancestors;
}

std::shared_ptr<const TypeGraph::Ancestors> TypeGraph::dynamicAncestors(std::string_view type) const
{
    {
        const std::shared_lock lock(_mutex);
        if (const auto found = _dynamic.find(type); found != _dynamic.end())
            return found->second;
    }
    auto made = std::make_shared<const Ancestors>(ancestorsOfDynamic(type.substr(dynamicPrefix.size())));
    const std::lock_guard lock(_mutex);
    if (_dynamic.size() < maximumDynamicTypes)
        _dynamic.emplace(type, made);
    return made;
}

bool TypeGraph::conformsTo(std::string_view type, std::string_view other) const
{
    if (type == other)
        return true;
    if (const auto known = _ancestors.find(type); known != _ancestors.end())
        return std::ranges::find(known->second, other) != known->second.end();
    if (!type.starts_with(dynamicPrefix))
        return false;
    if (other.starts_with(dynamicPrefix))
        return g_content_type_is_a(std::string(type.substr(dynamicPrefix.size())).c_str(),
            std::string(other.substr(dynamicPrefix.size())).c_str());
    const auto ancestors = dynamicAncestors(type);
    return std::ranges::find(*ancestors, other) != ancestors->end();
}

} // namespace host::system
