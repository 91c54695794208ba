// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PropertyValue.h"

#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace platform {

/// Codes of the domain errorDomain::file.
enum class FileErrorCode : int {
    NoSuchItem = 4, ///< an operation (also a promised-attribute read) found no such item
    NoSuchFile = 260, ///< a document that was to be shown is not there
    InvalidName = 514,
    ItemExists = 516,
    Formatting = 2048, ///< a location cannot be split into container and path
    Cancelled = 3072, ///< the document changed while it was being deleted, and was kept
    Unsupported = 3328,
};

namespace errorDomain {
inline constexpr std::string_view file = "app.tarrow.Drive.file"; ///< codes: FileErrorCode
inline constexpr std::string_view system = "app.tarrow.Drive.system"; ///< codes: the system's errno values
inline constexpr std::string_view cloud = "app.tarrow.Drive.cloud"; ///< the cloud document service's own
} // namespace errorDomain

/// Entries of an error's user information.
namespace errorKey {
inline constexpr std::string_view localizedDescription = "LocalizedDescription";
inline constexpr std::string_view localizedFailureReason = "LocalizedFailureReason";
inline constexpr std::string_view filePath = "FilePath";
inline constexpr std::string_view destinationFilePath = "DestinationFilePath";
} // namespace errorKey

/// Why an operation failed: a domain, a code of that domain, and a map of further information.
class Error {
public:
    Error(std::string_view domain, int code, PropertyDictionary userInfo = {});
    explicit Error(FileErrorCode code, PropertyDictionary userInfo = {})
        : Error(errorDomain::file, static_cast<int>(code), std::move(userInfo))
    {
    }

    const std::string& domain() const { return _data->domain; }
    int code() const { return _data->code; }
    const PropertyDictionary& userInfo() const { return _data->userInfo; }

    /// The text under a key of the user information; nothing when there is none or it is not text.
    std::optional<std::string> text(std::string_view key) const;

    bool is(FileErrorCode code) const;

    /// For logs: domain, code and description.
    std::string debugDescription() const;

    bool operator==(const Error& other) const;

private:
    struct Data {
        std::string domain;
        int code;
        PropertyDictionary userInfo;
    };
    std::shared_ptr<const Data> _data;
};

/// What an operation that can fail answers. Several operations of the platform may answer both parts, or
/// neither.
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

    explicit operator bool() const { return value.has_value(); }
    const T& operator*() const { return *value; }
    const T* operator->() const { return &*value; }
};

} // namespace platform
