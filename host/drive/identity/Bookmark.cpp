// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/identity/Bookmark.h"

#include "host/drive/records/JsonObject.h"
#include "host/drive/records/LinkRecords.h"

namespace host::drive {

namespace {

using nlohmann::json;

// The alphabet that is safe in URLs, without padding (RFC 4648, section 5).
constexpr std::string_view alphabet = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789-_";

std::string base64Encoded(std::string_view bytes)
{
    std::string text;
    std::uint32_t bits = 0;
    int waiting = 0;
    for (const char byte : bytes) {
        bits = (bits << 8) | static_cast<unsigned char>(byte);
        for (waiting += 8; waiting >= 6; waiting -= 6)
            text.push_back(alphabet[(bits >> (waiting - 6)) & 63]);
    }
    if (waiting > 0)
        text.push_back(alphabet[(bits << (6 - waiting)) & 63]);
    return text;
}

std::optional<std::string> base64Decoded(std::string_view text)
{
    std::string bytes;
    std::uint32_t bits = 0;
    int waiting = 0;
    for (const char c : text) {
        const auto value = alphabet.find(c);
        if (value == std::string_view::npos)
            return std::nullopt;
        bits = (bits << 6) | static_cast<std::uint32_t>(value);
        waiting += 6;
        if (waiting >= 8) {
            waiting -= 8;
            bytes.push_back(static_cast<char>((bits >> waiting) & 255));
        }
    }
    // One text for one content: what is left over must be less than a byte, and zero.
    if (waiting >= 6 || (bits & ((1U << waiting) - 1)) != 0)
        return std::nullopt;
    return bytes;
}

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
    return base64Encoded(object.dump(-1, ' ', false, json::error_handler_t::replace));
}

std::optional<Bookmark> Bookmark::decode(std::string_view encodedText)
{
    if (encodedText.size() > maximumLength)
        return std::nullopt;
    const auto bytes = base64Decoded(encodedText);
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
