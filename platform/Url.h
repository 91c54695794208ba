// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace platform {

/// Whether a path is known to name a folder. It only decides about the trailing slash of the URL's text.
enum class PathKind { Unknown, Directory };

struct QueryItem {
    std::string name;
    std::optional<std::string> value;
};

/// An immutable location, parsed once and cheap to copy (copies share one object, see isSameObject()).
///
/// A file URL holds the path's bytes as they are on disk, valid UTF-8 or not. Any thread may use it.
class Url {
public:
    /// The longest text that parse() takes; anything longer is refused unread.
    static constexpr std::size_t maximumLength = 64 * 1024;

    /// Parses an absolute URL. Nothing for a text without a scheme, with a broken percent escape, an encoded
    /// NUL or slash in its path, control characters or blanks, or (but for file URLs) escapes that are not
    /// UTF-8.
    static std::optional<Url> parse(std::string_view text);

    /// The URL of an absolute path, given as the bytes that the file system uses. Repeated and trailing
    /// slashes go;
    /// "." and ".." stay as they are.
    static Url fileURL(std::string_view path, PathKind kind = PathKind::Unknown);

    const std::string& scheme() const { return _data->scheme; }
    const std::optional<std::string>& host() const { return _data->host; }
    bool isFileURL() const { return _data->scheme == "file"; }

    /// The path, percent-decoded once, without a trailing slash (the root is "/").
    const std::string& path() const { return _data->path; }
    bool hasDirectoryPath() const { return _data->kind == PathKind::Directory; }

    /// The items of the query in order, names and values percent-decoded once.
    const std::vector<QueryItem>& queryItems() const { return _data->query; }

    /// The whole URL as text, percent-encoded where it must be.
    std::string absoluteString() const;

    /// The names of the path from the root on, the root itself as "/".
    std::vector<std::string> pathComponents() const;
    /// The last name of the path; "/" for the root.
    std::string lastPathComponent() const;
    /// What follows the last dot of the last name; empty without one, for a name that begins with its only
    /// dot, and where it would hold a blank.
    std::string pathExtension() const;
    Url deletingLastPathComponent() const;
    Url appendingPathComponent(std::string_view name, PathKind kind = PathKind::Unknown) const;

    /// Whether this location is `folder` itself or lies below it, compared name by name.
    bool isWithin(const Url& folder) const;

    /// Whether both are copies of the very same object, not merely equal.
    bool isSameObject(const Url& other) const { return _data == other._data; }

    /// File URLs are equal when their paths are, whatever is known of their kinds; others when their texts
    /// are.
    bool operator==(const Url& other) const;

private:
    struct Data {
        std::string scheme;
        std::optional<std::string> host;
        std::string path;
        PathKind kind = PathKind::Unknown;
        std::vector<QueryItem> query;
        std::string text;
    };
    static Url fromCleanPath(std::string path, PathKind kind);
    explicit Url(std::shared_ptr<const Data> data)
        : _data(std::move(data))
    {
    }

    std::shared_ptr<const Data> _data;
};

/// Undoes percent-encoding once. Nothing when an escape is broken or yields a NUL.
std::optional<std::string> percentDecoded(std::string_view text);

/// Percent-encodes every byte but unreserved characters and those in `alsoAllowed`.
std::string percentEncoded(std::string_view text, std::string_view alsoAllowed = {});

/// Whether a text is well-formed UTF-8 (no overlong forms, no surrogates).
bool isValidUtf8(std::string_view text);

} // namespace platform
