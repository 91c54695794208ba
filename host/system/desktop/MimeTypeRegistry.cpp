// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/desktop/MimeTypeRegistry.h"

#include "host/system/desktop/TypeGraph.h"
#include "host/system/desktop/TypeTable.h"
#include "host/system/texts/Translate.h"

#include <gio/gio.h>

#include <array>
#include <mutex>
#include <shared_mutex>

namespace host::system {

namespace {

// No extension in use is longer, and longer ones need no place in memory.
constexpr std::size_t maximumExtension = 32;
// The number of answers is limited, so that made-up names cannot fill the memory.
constexpr std::size_t maximumCachedAnswers = 4096;
constexpr std::string_view unknownMimeType = "application/octet-stream";

using GlibText = std::unique_ptr<char, decltype(&g_free)>;

/// An extension in lower case, without an allocation; empty when it cannot be one.
class LowerCase {
public:
    explicit LowerCase(std::string_view extension)
        : _length(extension.size() <= maximumExtension ? extension.size() : 0)
    {
        if (extension.find_first_of(std::string_view("/\0", 2)) != std::string_view::npos)
            _length = 0;
        for (std::size_t i = 0; i < _length; ++i)
            _text[i] = g_ascii_tolower(extension[i]);
    }
    operator std::string_view() const { return {_text.data(), _length}; }

private:
    std::array<char, maximumExtension> _text;
    std::size_t _length;
};

} // namespace

/// Keeps the answers for the texts that were asked for, including unknown ones.
class MimeTypeRegistry::AnswerCache {
public:
    using Answer = std::optional<std::string>;

    /// Answers whether the text was asked for before, and sets `answer` then.
    bool find(std::string_view text, Answer& answer) const
    {
        const std::shared_lock lock(_mutex);
        const auto found = _answers.find(text);
        if (found == _answers.end())
            return false;
        answer = found->second;
        return true;
    }
    void add(std::string_view text, const Answer& answer)
    {
        const std::lock_guard lock(_mutex);
        if (_answers.size() < maximumCachedAnswers)
            _answers.emplace(text, answer);
    }

private:
    mutable std::shared_mutex _mutex;
    TextMap<Answer> _answers;
};

MimeTypeRegistry::MimeTypeRegistry()
    : _graph(std::make_unique<TypeGraph>())
    , _extensions(std::make_unique<AnswerCache>())
    , _descriptions(std::make_unique<AnswerCache>())
{
}

MimeTypeRegistry::~MimeTypeRegistry() = default;

std::optional<std::string> MimeTypeRegistry::typeForExtension(std::string_view extension) const
{
    const LowerCase lower(extension);
    if (std::string_view(lower).empty())
        return std::nullopt;
    if (const auto* row = _graph->rowOfExtension(lower))
        return std::string(row->identifier);
    std::optional<std::string> type;
    if (_extensions->find(lower, type))
        return type;
    const auto name = "x." + std::string(std::string_view(lower));
    const GlibText mime(g_content_type_guess(name.c_str(), nullptr, 0, nullptr), g_free);
    if (!g_content_type_is_unknown(mime.get()))
        type = typeForMimeType(mime.get());
    _extensions->add(lower, type);
    return type;
}

std::string MimeTypeRegistry::typeForMimeType(std::string_view mimeType) const
{
    if (const auto* row = _graph->rowOfMimeType(mimeType))
        return std::string(row->identifier);
    return std::string(TypeGraph::dynamicPrefix).append(mimeType);
}

bool MimeTypeRegistry::conformsTo(std::string_view type, std::string_view other) const
{
    return _graph->conformsTo(type, other);
}

bool MimeTypeRegistry::isPackageExtension(std::string_view extension) const
{
    const LowerCase lower(extension);
    const auto* row = _graph->rowOfExtension(lower);
    return row && _graph->conformsTo(row->identifier, platform::typeIdentifier::package);
}

std::optional<std::string> MimeTypeRegistry::mimeType(std::string_view type) const
{
    if (const auto* row = _graph->row(type)) {
        const auto mimeTypes = words(row->mimeTypes);
        return mimeTypes.empty() ? std::nullopt : std::optional<std::string>(mimeTypes.front());
    }
    if (type.starts_with(TypeGraph::dynamicPrefix))
        return std::string(type.substr(TypeGraph::dynamicPrefix.size()));
    return std::nullopt;
}

std::optional<std::string> MimeTypeRegistry::description(std::string_view type) const
{
    std::optional<std::string> description;
    if (_descriptions->find(type, description))
        return description;
    const auto mime = mimeType(type);
    const GlibText text(mime ? g_content_type_get_description(mime->c_str()) : nullptr, g_free);
    // The database describes unknown types as "unknown", which is too short where a kind is named.
    if (mime == unknownMimeType)
        description = translated("Unknown kind");
    else if (text)
        description = text.get();
    else if (_graph->conformsTo(type, platform::typeIdentifier::package))
        description = translated("Package");
    _descriptions->add(type, description);
    return description;
}

std::string MimeTypeRegistry::iconName(std::string_view type) const
{
    if (_graph->conformsTo(type, platform::typeIdentifier::directory)
        && !_graph->conformsTo(type, platform::typeIdentifier::package))
        return "folder";
    const auto mime = mimeType(type);
    // Themes have icons for few single types, but for all general ones.
    const GlibText name(mime ? g_content_type_get_generic_icon_name(mime->c_str()) : nullptr, g_free);
    return name ? name.get() : "text-x-generic";
}

} // namespace host::system
