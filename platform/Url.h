// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace platform {

/// Whether a path is known to name a folder. It decides about the trailing slash of the URL's text and about
/// nothing else.
enum class PathKind { Unknown, Directory };

/// One item of a URL's query, "name=value".
struct QueryItem {
    std::string name;
    std::optional<std::string> value; ///< nothing without an equals sign, empty with nothing behind it
};

/// An immutable location, such as "file:///home/mira/Notes.txt". It is parsed once and cheap to copy, because
/// copies share one object (see isSameObject()); any thread may use it. There is no empty URL: what may be
/// missing is an optional.
///
/// A file URL holds the path's bytes as they are on disk, valid UTF-8 or not, so every file of the disk has
/// one. Its path is clean, because what is decided about a path must hold for the file that the system finds
/// there: it has no empty name, no "." and no "..". A ".." takes away the name before it, as in every URL;
/// the disk is not asked, so behind a symbolic link that is another folder than the one the system would
/// find. What comes from outside or out of a link is therefore read by CloudItems::urlOfPath().
class Url {
public:
    /// The longest text that parse() takes; anything longer is refused unread.
    static constexpr std::size_t maximumLength = 64 * 1024;

    /// Parses an absolute URL. It answers nothing for a text without a scheme, with a broken percent escape,
    /// with an encoded NUL, with control characters or blanks, and with escapes that are not UTF-8 (a file
    /// URL may have those), and for a file URL without an absolute path. A fragment ("#...") is dropped from
    /// the parts and stays in the text. The path of another URL than a file's keeps its dots.
    static std::optional<Url> parse(std::string_view text);

    /// Answers the URL of an absolute path, given as the bytes that the file system uses, cleaned as said
    /// above.
    static Url fileURL(std::string_view path, PathKind kind = PathKind::Unknown);

    /// The scheme, as it was written: "file", "tarrowdriveapp".
    const std::string& scheme() const { return _data->scheme; }
    /// What stands between "//" and the path, undecoded; nothing without "//" and for URLs that were made
    /// from a path.
    const std::optional<std::string>& host() const { return _data->host; }
    /// Whether the URL names a place in the file system of this machine.
    bool isFileURL() const { return _data->scheme == "file"; }

    /// The path, percent-decoded once, without a trailing slash (the root is "/").
    const std::string& path() const { return _data->path; }
    /// Whether the path is known to name a folder.
    bool hasDirectoryPath() const { return _data->kind == PathKind::Directory; }

    /// The items of the query in order, names and values percent-decoded once.
    const std::vector<QueryItem>& queryItems() const { return _data->query; }

    /// The whole URL as text, percent-encoded where it must be.
    std::string absoluteString() const;

    /// The names of the path from the root on; the root itself is the first of them, "/".
    std::vector<std::string> pathComponents() const;
    /// The last name of the path; "/" for the root.
    std::string lastPathComponent() const;
    /// What follows the last dot of the last name. It is empty without a dot, for a name whose only dot is
    /// its first character, and where it would hold a blank ("Mr. Smith").
    std::string pathExtension() const;
    /// The file URL of the folder that the last name lies in; the root's folder is the root.
    Url deletingLastPathComponent() const;
    /// The file URL of a name in this folder. The name is taken as it is, as bytes; it may hold slashes and
    /// then is a path.
    Url appendingPathComponent(std::string_view name, PathKind kind = PathKind::Unknown) const;

    /// Whether this location is `folder` itself or lies below it. Names are compared as they stand, and links
    /// are not resolved; for other than file URLs the answer is false.
    bool isWithin(const Url& folder) const;

    /// Whether both are copies of the very same object, and not merely equal. Some services answer the object
    /// that they were given to say that nothing was to be done.
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

/// Undoes percent-encoding once. It answers nothing when an escape is broken or yields a NUL. A '+' stays as
/// it is.
std::optional<std::string> percentDecoded(std::string_view text);

/// Percent-encodes every byte but letters and digits of ASCII, "-._~" and the characters in `alsoAllowed`.
std::string percentEncoded(std::string_view text, std::string_view alsoAllowed = {});

/// Whether a text is well-formed UTF-8 (no overlong forms, no surrogates).
bool isValidUtf8(std::string_view text);

} // namespace platform
