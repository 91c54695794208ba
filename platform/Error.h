// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PropertyValue.h"

#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace platform {

/// Codes of the domain errorDomain::file. An error with one of them concerns an item and has a meaning that
/// callers act on; everything else that the system refuses is in errorDomain::system.
enum class FileErrorCode : int {
    NoSuchItem = 4, ///< an operation (also a promised-attribute read) found no such item
    NoSuchFile = 260, ///< a document that was to be shown is not there
    InvalidName = 514, ///< the file system does not take the name: it is too long, or not in its encoding
    ItemExists = 516, ///< something has the name already, and nothing is ever replaced
    Formatting = 2048, ///< a location cannot be split into container and path
    /// The operation was given up and nothing was changed: the item changed meanwhile, or somebody ended it.
    Cancelled = 3072,
    Unsupported = 3328, ///< the operation has no meaning for what it was asked to work on
};

/// The domains that errors of the platform come from. ImageLoader.h and PagedDocument.h add one each.
namespace errorDomain {
inline constexpr std::string_view file = "app.tarrow.Drive.file"; ///< codes: FileErrorCode
inline constexpr std::string_view system = "app.tarrow.Drive.system"; ///< codes: the system's errno values
inline constexpr std::string_view cloud = "app.tarrow.Drive.cloud"; ///< the cloud document service's own
} // namespace errorDomain

/// Keys of an error's user information. All four values are texts, and each may be missing.
namespace errorKey {
/// A sentence for the user, in the user's language, that names the item and says what is wrong.
inline constexpr std::string_view localizedDescription = "LocalizedDescription";
/// What the log says of the reason; it is not translated.
inline constexpr std::string_view localizedFailureReason = "LocalizedFailureReason";
/// The path of the item, as bytes.
inline constexpr std::string_view filePath = "FilePath";
/// Where the item was to go, for a move that failed.
inline constexpr std::string_view destinationFilePath = "DestinationFilePath";
} // namespace errorKey

/// Why an operation failed: a domain, a code of that domain, and a map of further information. An error is
/// immutable and cheap to copy, because copies share their content; any thread may use it.
class Error {
public:
    Error(std::string_view domain, int code, PropertyDictionary userInfo = {});
    explicit Error(FileErrorCode code, PropertyDictionary userInfo = {})
        : Error(errorDomain::file, static_cast<int>(code), std::move(userInfo))
    {
    }

    /// One of `errorDomain`.
    const std::string& domain() const { return _data->domain; }
    /// The number within the domain: a FileErrorCode, an errno, or the domain's own.
    int code() const { return _data->code; }
    /// Further information, under the keys of `errorKey`.
    const PropertyDictionary& userInfo() const { return _data->userInfo; }

    /// The text under a key of the user information; nothing when there is no value or it is no text.
    std::optional<std::string> text(std::string_view key) const;

    /// Whether the error is of the file domain and has this code.
    bool is(FileErrorCode code) const;

    /// The error as a log line has it: domain, code and the description for the user. It is not for people.
    std::string debugDescription() const;

    /// Two errors are equal when domain, code and user information are.
    bool operator==(const Error& other) const;

private:
    struct Data {
        std::string domain;
        int code;
        PropertyDictionary userInfo;
    };
    std::shared_ptr<const Data> _data;
};

/// What an operation that can fail answers. Nearly always exactly one of the two is there. An operation whose
/// header says so may answer both (a value that is incomplete, and why) or neither (nothing was found, and
/// that is no failure).
template <typename T>
struct Result {
    std::optional<T> value;
    std::optional<Error> error;

    Result() = default;
    Result(T v)
        : value(std::move(v))
    {
    }
    Result(Error e)
        : error(std::move(e))
    {
    }

    /// Whether there is a value; an error may be there all the same.
    explicit operator bool() const { return value.has_value(); }
    /// The value. Calling these two without one is a programming error.
    const T& operator*() const { return *value; }
    const T* operator->() const { return &*value; }
};

} // namespace platform
