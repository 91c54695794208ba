// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <cerrno>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

namespace host::system {

/// The reason why a system call failed: its errno, and the name that the call was about. An operation without
/// a value answers one of these, which is empty when nothing failed; the compiler does not let a caller
/// ignore it. systemError() turns it into the platform's Error, which names the item that the user asked for.
/// The name in here may lie far below that item, and is for the log.
class [[nodiscard]] SystemError {
public:
    /// Makes the value that means that nothing failed.
    SystemError() = default;
    explicit SystemError(int number)
        : _number(number)
    {
    }
    /// `about` is a name or a path as the call got it, as bytes.
    SystemError(int number, std::string_view about)
        : _number(number)
        , _about(about)
    {
    }
    /// Answers the error of the last system call. errno is read at once, before anything can change it; for
    /// the same reason `about` must be a text that already exists.
    static SystemError last(std::string_view about = {})
    {
        const int number = errno;
        return SystemError(number, about);
    }
    /// Answers an empty error when the last call succeeded, else last().
    static SystemError unless(bool succeeded, std::string_view about = {})
    {
        return succeeded ? SystemError() : last(about);
    }

    /// Answers whether something failed.
    explicit operator bool() const { return _number != 0; }
    /// Answers whether the item that the caller named met this error. A failure of the drive's own files says
    /// nothing about the item.
    bool is(int number) const { return _number == number && !_concernsDrive; }
    /// Answers the errno, or 0 when nothing failed.
    int number() const { return _number; }
    /// Answers the same error as one of a file that the drive needs for its work, such as a record, and not
    /// of the item that is worked on.
    SystemError ofDrive() const
    {
        auto error = *this;
        error._concernsDrive = true;
        return error;
    }
    bool concernsDrive() const { return _concernsDrive; }
    /// Answers the name that the call was about; empty when that is the item that the caller named.
    const std::string& about() const { return _about; }

private:
    int _number = 0;
    bool _concernsDrive = false;
    std::string _about;
};

/// The result of an operation that answers a value: exactly one of value and error is set. It has the shape
/// of platform::Result.
template <typename T>
struct [[nodiscard]] SystemResult {
    std::optional<T> value;
    SystemError error;

    SystemResult(T v)
        : value(std::move(v))
    {
    }
    SystemResult(SystemError e)
        : error(std::move(e))
    {
    }

    /// Answers whether there is a value.
    explicit operator bool() const { return value.has_value(); }
    /// Answer the value. Calling these without one is a programming error.
    const T& operator*() const { return *value; }
    T& operator*() { return *value; }
    const T* operator->() const { return &*value; }
    T* operator->() { return &*value; }
};

} // namespace host::system

/// Ends the function with the error when an expression answers a SystemError that is not empty, and goes on
/// otherwise. The function may answer a SystemError or a SystemResult.
#define TRW_TRY(expression)                                                                                  \
    do {                                                                                                     \
        if (auto trwFailure = (expression))                                                                  \
            return trwFailure;                                                                               \
    } while (false)
