// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/identity/Bookmark.h"

#include "host/drive/records/JsonObject.h"
#include "host/drive/records/LinkRecords.h"
#include "host/system/files/Base64.h"

namespace host::drive {

namespace {

using nlohmann::json;

std::optional<std::uint32_t> identifier(const json& object)
{
    const auto found = object.find("document");
    if (found == object.end())
        return 0;
    if (!found->is_number_unsigned() || found->get<std::uint64_t>() > UINT32_MAX)
        return std::nullopt;
    return found->get<std::uint32_t>();
}

} // namespace

std::string Bookmark::encoded() const
{
    json object{{"v", 1}, {"account", account}, {"container", container}, {"path", path}};
    if (documentIdentifier != 0)
        object["document"] = documentIdentifier;
    return host::system::base64UrlEncoded(object.dump(-1, ' ', false, json::error_handler_t::replace));
}

std::optional<Bookmark> Bookmark::decode(std::string_view encodedText)
{
    if (encodedText.size() > maximumLength)
        return std::nullopt;
    const auto bytes = host::system::base64UrlDecoded(encodedText);
    const auto object = bytes ? parseJsonObject(*bytes) : std::nullopt;
    if (!object || member(*object, "v") != 1)
        return std::nullopt;
    const auto document = identifier(*object);
    Bookmark bookmark{textMember(*object, "account"), textMember(*object, "container"),
        textMember(*object, "path"), document.value_or(0)};
    if (!document || bookmark.account.empty() || !isPlainRelativePath(bookmark.container)
        || bookmark.container.find('/') != std::string::npos || !isPlainRelativePath(bookmark.path))
        return std::nullopt;
    return bookmark;
}

} // namespace host::drive
