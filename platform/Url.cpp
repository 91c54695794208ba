// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/Url.h"

#include <algorithm>
#include <cctype>
#include <cstdint>

namespace platform {

namespace {

constexpr std::string_view pathCharacters = "/!$&'()*+,;=:@";

bool isUnreserved(unsigned char c)
{
    return c < 0x80 && (std::isalnum(c) || c == '-' || c == '.' || c == '_' || c == '~');
}

int hexValue(char c)
{
    if (c >= '0' && c <= '9')
        return c - '0';
    if (c >= 'a' && c <= 'f')
        return c - 'a' + 10;
    return c >= 'A' && c <= 'F' ? c - 'A' + 10 : -1;
}

bool isScheme(std::string_view text)
{
    return !text.empty() && std::isalpha(static_cast<unsigned char>(text[0]))
        && std::ranges::all_of(text, [](unsigned char c) {
               return c < 0x80 && (std::isalnum(c) || c == '+' || c == '-' || c == '.');
           });
}

bool hasForbiddenCharacter(std::string_view text)
{
    return std::ranges::any_of(text, [](unsigned char c) { return c <= 0x20 || c == 0x7f; });
}

bool hasExtraSlashes(std::string_view path)
{
    return path.find("//") != std::string_view::npos || (path.size() > 1 && path.ends_with('/'));
}

std::string withoutExtraSlashes(std::string_view path)
{
    if (!hasExtraSlashes(path))
        return std::string(path);
    std::string out;
    out.reserve(path.size());
    for (const char c : path) {
        if (c != '/' || out.empty() || out.back() != '/')
            out.push_back(c);
    }
    if (out.size() > 1 && out.back() == '/')
        out.pop_back();
    return out;
}

bool hasDotNames(std::string_view path)
{
    for (auto at = path.find("/."); at != std::string_view::npos; at = path.find("/.", at + 1)) {
        auto rest = path.substr(at + 2);
        if (rest.starts_with('.'))
            rest.remove_prefix(1);
        if (rest.empty() || rest.starts_with('/'))
            return true;
    }
    return false;
}

std::string_view takeUntil(std::string_view& text, char separator)
{
    const auto end = text.find(separator);
    const auto head = text.substr(0, end);
    text = end == std::string_view::npos ? std::string_view{} : text.substr(end + 1);
    return head;
}

/// Answers the form of an absolute path in which two paths of one place are equal as texts.
std::string cleanPath(std::string_view path)
{
    // Nearly every path is clean: a plain copy is enough, and this is done for every row of a list.
    if (!hasDotNames(path))
        return withoutExtraSlashes(path);
    std::string out;
    while (!path.empty()) {
        const auto name = takeUntil(path, '/');
        if (name == "..")
            out.resize(std::min(out.size(), out.rfind('/')));
        else if (!name.empty() && name != ".")
            out.append("/").append(name);
    }
    return out.empty() ? "/" : out;
}

std::optional<std::vector<QueryItem>> parseQuery(std::string_view text)
{
    std::vector<QueryItem> items;
    while (!text.empty()) {
        auto pair = takeUntil(text, '&');
        const bool hasValue = pair.find('=') != std::string_view::npos;
        auto name = percentDecoded(takeUntil(pair, '='));
        auto value = percentDecoded(pair);
        if (!name || !value)
            return std::nullopt;
        items.push_back({std::move(*name), hasValue ? std::move(value) : std::nullopt});
    }
    return items;
}

std::string_view lastName(std::string_view path)
{
    const auto slash = path.rfind('/');
    return path == "/" || slash == std::string_view::npos ? path : path.substr(slash + 1);
}

std::string fileText(std::string_view path, PathKind kind)
{
    std::string text = "file://" + percentEncoded(path, pathCharacters);
    if (kind == PathKind::Directory && path != "/")
        text += '/';
    return text;
}

} // namespace

std::optional<Url> Url::parse(std::string_view text)
{
    if (text.size() > maximumLength || hasForbiddenCharacter(text))
        return std::nullopt;
    auto rest = text.substr(0, text.find('#'));
    const auto colon = rest.find(':');
    if (colon == std::string_view::npos || !isScheme(rest.substr(0, colon)))
        return std::nullopt;
    auto data = std::make_shared<Data>();
    data->scheme = takeUntil(rest, ':');
    data->text = text;
    const bool hasQuery = rest.find('?') != std::string_view::npos;
    auto place = takeUntil(rest, '?');
    if (place.starts_with("//")) {
        place.remove_prefix(2);
        const auto slash = std::min(place.find('/'), place.size());
        data->host = std::string(place.substr(0, slash));
        place.remove_prefix(slash);
    }
    auto path = percentDecoded(place);
    auto query = parseQuery(hasQuery ? rest : std::string_view{});
    if (!path || !query)
        return std::nullopt;
    const bool isFile = data->scheme == "file";
    const bool isValid = isFile ? path->starts_with('/') : isValidUtf8(*path);
    if (!isValid)
        return std::nullopt;
    data->kind = path->size() > 1 && path->ends_with('/') ? PathKind::Directory : PathKind::Unknown;
    data->path = isFile ? cleanPath(*path) : withoutExtraSlashes(*path);
    data->query = std::move(*query);
    return Url(std::move(data));
}

Url Url::fileURL(std::string_view path, PathKind kind)
{
    return fromCleanPath(cleanPath(path), kind);
}

Url Url::fromCleanPath(std::string path, PathKind kind)
{
    auto data = std::make_shared<Data>();
    data->scheme = "file";
    data->path = std::move(path);
    data->kind = kind;
    return Url(std::move(data));
}

std::string Url::absoluteString() const
{
    return isFileURL() ? fileText(path(), _data->kind) : _data->text;
}

std::vector<std::string> Url::pathComponents() const
{
    std::vector<std::string> names;
    std::string_view rest = path();
    if (rest.starts_with('/')) {
        names.emplace_back("/");
        rest.remove_prefix(1);
    }
    while (!rest.empty())
        names.emplace_back(takeUntil(rest, '/'));
    return names;
}

std::string Url::lastPathComponent() const
{
    return std::string(lastName(path()));
}

std::string Url::pathExtension() const
{
    const auto name = lastName(path());
    const auto dot = name.rfind('.');
    if (dot == std::string_view::npos || dot == 0 || name.find(' ', dot) != std::string_view::npos)
        return {};
    return std::string(name.substr(dot + 1));
}

Url Url::deletingLastPathComponent() const
{
    const auto slash = path().rfind('/');
    return fromCleanPath(
        slash == 0 || slash == std::string::npos ? "/" : path().substr(0, slash), PathKind::Directory);
}

Url Url::appendingPathComponent(std::string_view name, PathKind kind) const
{
    return fileURL(path() + '/' + std::string(name), kind);
}

bool Url::isWithin(const Url& folder) const
{
    if (!isFileURL() || !folder.isFileURL() || !path().starts_with(folder.path()))
        return false;
    const auto length = folder.path().size();
    return path().size() == length || folder.path() == "/" || path()[length] == '/';
}

bool Url::operator==(const Url& other) const
{
    if (isSameObject(other))
        return true;
    if (isFileURL() && other.isFileURL())
        return path() == other.path();
    return absoluteString() == other.absoluteString();
}

std::optional<std::string> percentDecoded(std::string_view text)
{
    std::string out;
    out.reserve(text.size());
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (text[i] != '%') {
            out.push_back(text[i]);
            continue;
        }
        if (i + 2 >= text.size())
            return std::nullopt;
        const int high = hexValue(text[i + 1]), low = hexValue(text[i + 2]);
        if (high < 0 || low < 0 || high * 16 + low == 0)
            return std::nullopt;
        out.push_back(static_cast<char>(high * 16 + low));
        i += 2;
    }
    return out;
}

std::string percentEncoded(std::string_view text, std::string_view alsoAllowed)
{
    static constexpr char digits[] = "0123456789ABCDEF";
    std::string out;
    for (const char c : text) {
        const auto byte = static_cast<unsigned char>(c);
        if (isUnreserved(byte) || alsoAllowed.find(c) != std::string_view::npos)
            out.push_back(c);
        else
            out.append({'%', digits[byte >> 4], digits[byte & 15]});
    }
    return out;
}

bool isValidUtf8(std::string_view text)
{
    for (std::size_t i = 0; i < text.size();) {
        const auto lead = static_cast<unsigned char>(text[i]);
        const std::size_t length = lead < 0x80 ? 1
            : lead >= 0xf0 && lead < 0xf5      ? 4
            : lead >= 0xe0 && lead < 0xf0      ? 3
            : lead >= 0xc2 && lead < 0xe0      ? 2
                                               : 0;
        if (length == 0 || i + length > text.size())
            return false;
        std::uint32_t point = length == 1 ? lead : lead & (0x7fU >> length);
        for (std::size_t k = 1; k < length; ++k) {
            const auto next = static_cast<unsigned char>(text[i + k]);
            if ((next & 0xc0) != 0x80)
                return false;
            point = (point << 6) | (next & 0x3f);
        }
        const bool overlong = (length == 3 && point < 0x800) || (length == 4 && point < 0x10000);
        if (overlong || point > 0x10ffff || (point >= 0xd800 && point < 0xe000))
            return false;
        i += length;
    }
    return true;
}

} // namespace platform
