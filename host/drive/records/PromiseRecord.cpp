// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/PromiseRecord.h"

#include "host/drive/records/ItemMarks.h"
#include "host/system/files/ItemPaths.h"
#include "host/system/files/PromisedNames.h"

#include <nlohmann/json.hpp>

namespace host::drive {

namespace {

using nlohmann::json;
using platform::Date;

std::optional<std::uint64_t> plausibleSize(std::int64_t size)
{
    return size >= 0 ? std::optional(static_cast<std::uint64_t>(size)) : std::nullopt;
}

PromiseRecord::Kind kindNamed(std::string_view name)
{
    return name == "directory" ? PromiseRecord::Kind::Directory
        : name == "package"    ? PromiseRecord::Kind::Package
                               : PromiseRecord::Kind::File;
}

constexpr char shortVersion = 2;
constexpr int hasSize = 1, hasCreated = 2, hasModified = 4; // flags
constexpr std::size_t shortFormHead = 3 + 3 * 8 + 4; // bytes before the content's name

void appendNumber(std::string& form, std::uint64_t number, int bytes = 8)
{
    for (int byte = 0; byte < bytes; ++byte)
        form += static_cast<char>(number >> (8 * byte));
}

std::uint64_t numberAt(std::string_view form, std::size_t position, std::size_t bytes = 8)
{
    std::uint64_t number = 0;
    for (std::size_t byte = 0; byte < bytes; ++byte)
        number |= std::uint64_t{static_cast<unsigned char>(form[position + byte])} << (8 * byte);
    return number;
}

/// Takes a promise's members one by one from the library's parser. No tree of the JSON is built, because
/// reading a promise is part of showing a row and the tree would cost more than all the rest.
class PromiseReader : public nlohmann::json_sax<json> {
public:
    PromiseRecord record;

    bool null() override { return isInside(); }
    bool boolean(bool value) override
    {
        if (isMember("shared"))
            record.shared = value;
        else if (isMember("extensionHidden"))
            record.extensionHidden = value;
        return isInside();
    }
    bool number_integer(std::int64_t value) override
    {
        if (isMember("size"))
            record.size = plausibleSize(value);
        else if (isMember("created"))
            record.created = Date{value};
        else if (isMember("modified"))
            record.modified = Date{value};
        else if (isMember("documentIdentifier") && value > 0 && value <= UINT32_MAX)
            record.documentIdentifier = static_cast<std::uint32_t>(value);
        return isInside();
    }
    bool number_unsigned(std::uint64_t value) override
    {
        return value > INT64_MAX ? isInside() : number_integer(static_cast<std::int64_t>(value));
    }
    /// The parser also calls this for numbers beyond an integer. Nanoseconds in 64 bits reach from 1677 to
    /// 2262, so a year beyond counts as unknown.
    bool number_float(double, const std::string&) override { return isInside(); }
    bool string(std::string& value) override
    {
        // A text with a NUL is refused, because the system would take the part before it for the whole.
        if (!isInside() || value.find('\0') != std::string::npos)
            return false;
        if (isMember("kind"))
            record.kind = kindNamed(value);
        else if (isMember("type"))
            record.type = std::move(value);
        else if (isMember("role"))
            record.role = roleNamed(value);
        else if (isMember("content"))
            record.content = std::move(value);
        else if (_isInTags && _depth == 2 && !value.empty())
            record.tags.push_back(std::move(value));
        return true;
    }
    bool binary(binary_t&) override { return false; }
    bool key(std::string& name) override
    {
        if (_depth == 1)
            _key = std::move(name);
        return true;
    }
    bool start_object(std::size_t) override { return ++_depth <= maximumDepth; }
    bool end_object() override { return --_depth >= 0; }
    bool start_array(std::size_t) override
    {
        _isInTags = _isInTags || isMember("tags");
        return isInside() && ++_depth <= maximumDepth;
    }
    bool end_array() override
    {
        _isInTags = --_depth > 1 && _isInTags;
        return true;
    }
    bool parse_error(std::size_t, const std::string&, const nlohmann::detail::exception&) override
    {
        return false;
    }

private:
    static constexpr int maximumDepth = 32; ///< objects and arrays within each other

    bool isInside() const { return _depth > 0; }
    bool isMember(std::string_view name) const { return _depth == 1 && _key == name; }

    std::string _key;
    int _depth = 0;
    bool _isInTags = false;
};

} // namespace

std::optional<PromiseRecord> PromiseRecord::parse(std::string_view text)
{
    PromiseReader reader;
    // The parser would take a NUL for the end of the text, so such a text is refused.
    const bool isWhole =
        text.find('\0') == std::string_view::npos && json::sax_parse(text.begin(), text.end(), &reader);
    return isWhole ? std::optional(std::move(reader.record)) : std::nullopt;
}

std::string PromiseRecord::toJson() const
{
    static constexpr const char* kinds[] = {"file", "directory", "package"};
    json promise{{"version", 1}, {"kind", kinds[static_cast<int>(kind)]}};
    if (size)
        promise["size"] = *size;
    if (created)
        promise["created"] = created->nanoseconds;
    if (modified)
        promise["modified"] = modified->nanoseconds;
    if (!type.empty())
        promise["type"] = type;
    if (shared)
        promise["shared"] = true;
    if (role)
        promise["role"] = nameOf(*role);
    if (extensionHidden)
        promise["extensionHidden"] = true;
    if (documentIdentifier != 0)
        promise["documentIdentifier"] = documentIdentifier;
    if (!tags.empty())
        promise["tags"] = tags;
    if (!content.empty())
        promise["content"] = content;
    if (!longName.empty())
        promise["name"] = longName;
    return promise.dump(-1, ' ', false, json::error_handler_t::replace) + '\n';
}

std::string PromiseRecord::shortForm() const
{
    std::string form{static_cast<char>(shortVersion), static_cast<char>(kind),
        static_cast<char>((size ? hasSize : 0) | (created ? hasCreated : 0) | (modified ? hasModified : 0))};
    appendNumber(form, size.value_or(0));
    appendNumber(form, static_cast<std::uint64_t>(created.value_or(Date{}).nanoseconds));
    appendNumber(form, static_cast<std::uint64_t>(modified.value_or(Date{}).nanoseconds));
    appendNumber(form, documentIdentifier, 4);
    return form + content;
}

std::optional<PromiseRecord> PromiseRecord::parseShortForm(std::string_view form)
{
    if (form.size() < shortFormHead || form[0] != shortVersion
        || static_cast<unsigned char>(form[1]) > static_cast<unsigned>(Kind::Package))
        return std::nullopt;
    PromiseRecord promise;
    promise.kind = static_cast<Kind>(form[1]);
    const int flags = static_cast<unsigned char>(form[2]);
    const auto number = [&](std::size_t index) { return numberAt(form, 3 + 8 * index); };
    if (flags & hasSize)
        promise.size = plausibleSize(static_cast<std::int64_t>(number(0)));
    if (flags & hasCreated)
        promise.created = Date{static_cast<std::int64_t>(number(1))};
    if (flags & hasModified)
        promise.modified = Date{static_cast<std::int64_t>(number(2))};
    promise.documentIdentifier = static_cast<std::uint32_t>(numberAt(form, 3 + 3 * 8, 4));
    promise.content = form.substr(shortFormHead);
    const bool isName = promise.content.find('\0') == std::string::npos;
    return isName ? std::optional(std::move(promise)) : std::nullopt;
}

std::string PromiseRecord::pathFor(std::string_view itemPath)
{
    return system::promisePath(itemPath);
}

bool PromiseRecord::isPromiseName(std::string_view name)
{
    return system::isLongPromiseName(name) || system::itemName(name) != name;
}

std::optional<std::string> PromiseRecord::itemPathFor(std::string_view promisePath)
{
    const auto name = system::promisedName(std::string(promisePath));
    return name ? std::optional(system::siblingPath(promisePath, *name)) : std::nullopt;
}

} // namespace host::drive
