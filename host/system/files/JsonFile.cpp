// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/files/JsonFile.h"

#include "host/system/files/AtomicWrite.h"
#include "host/system/files/ItemPaths.h"
#include "platform/Log.h"

#include <nlohmann/json.hpp>

#include <fcntl.h>
#include <glib/gstdio.h>
#include <stdio.h>

#include <algorithm>
#include <cerrno>
#include <cstring>

namespace host::system {

using nlohmann::json;
using platform::FileErrorCode;

namespace {

constexpr int maximumDamagedFiles = 1000;

/// Counts how deeply a text nests without parsing it, because the parser would recurse that deeply.
int nesting(std::string_view text)
{
    int depth = 0, deepest = 0;
    bool isInString = false;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const char c = text[i];
        if (isInString && c == '\\')
            ++i;
        else if (c == '"')
            isInString = !isInString;
        else if (!isInString && (c == '[' || c == '{'))
            deepest = std::max(deepest, ++depth);
        else if (!isInString && (c == ']' || c == '}'))
            --depth;
    }
    return deepest;
}

} // namespace

std::unique_ptr<json> parseJson(std::string_view text, JsonLimits limits)
{
    // The parser would take a NUL for the end of the text, so such a text is refused.
    if (text.size() > limits.bytes || nesting(text) > limits.depth
        || text.find('\0') != std::string_view::npos)
        return nullptr;
    auto value = std::make_unique<json>(json::parse(text, nullptr, false));
    return value->is_discarded() ? nullptr : std::move(value);
}

std::string jsonText(const json& value)
{
    return value.dump(-1, ' ', false, json::error_handler_t::replace);
}

JsonFile::Content JsonFile::read() const
{
    static constexpr platform::Operation op{"-[JsonFile read]"};
    const auto text = readWholeFile(_path, _limits.bytes);
    if (text) {
        auto value = parseJson(*text, _limits);
        return value ? Content{State::Read, std::move(value)}
                     : Content{setAside(text->empty() ? "it is empty" : "it is no JSON"), nullptr};
    }
    if (text.error->is(FileErrorCode::NoSuchItem))
        return {State::Absent, nullptr};
    if (text.error->domain() == platform::errorDomain::system && text.error->code() == EFBIG)
        return {setAside("it is too large"), nullptr};
    op.error("Cannot read %@: %{public}@", _path, *text.error);
    return {State::Unreadable, nullptr};
}

JsonFile::State JsonFile::setAside(std::string_view reason) const
{
    static constexpr platform::Operation op{"-[JsonFile setAside:]"};
    const std::string why(reason);
    for (int number = 1; number <= maximumDamagedFiles; ++number) {
        const auto aside = _path + (number == 1 ? ".damaged" : ".damaged-" + std::to_string(number));
        if (renameat2(AT_FDCWD, _path.c_str(), AT_FDCWD, aside.c_str(), RENAME_NOREPLACE) == 0) {
            op.error("%@ is damaged: %{public}@. It was kept as %@", _path, why, aside);
            return State::Absent;
        }
        if (errno != EEXIST)
            break;
    }
    op.error("%@ is damaged: %{public}@. It cannot be set aside: %s", _path, why, std::strerror(errno));
    return State::Unreadable;
}

std::optional<platform::Error> JsonFile::write(const json& value) const
{
    g_mkdir_with_parents(parentPath(_path).c_str(), 0700); // the write below reports a failure
    return writeFileAtomically(_path, jsonText(value));
}

} // namespace host::system
