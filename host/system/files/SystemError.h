// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <cerrno>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

namespace host::system {

/// Why the system refused something: its errno and what the call was about. An operation that has nothing
/// else to answer answers one of these, which is empty when nothing failed; the compiler does not let a
/// caller overlook it. systemError() turns it into the platform's Error, which names what the user asked for;
/// the name in here may lie far below that, and is for the log.
class [[nodiscard]] SystemError {
public:
    /// Nothing failed.
    SystemError() = default;
    explicit SystemError(int number)
        : _number(number)
    {
    }
    /// `about` is a name or a path as the call had it, as bytes.
    SystemError(int number, std::string_view about)
        : _number(number)
        , _about(about)
    {
    }
    /// The call that was made last failed: errno is taken before anything else can change it. `about` has to
    /// lie at hand for the same reason.
    static SystemError last(std::string_view about = {})
    {
        const int number = errno;
        return SystemError(number, about);
    }
    /// Nothing when the last call succeeded, else last().
    static SystemError unless(bool succeeded, std::string_view about = {})
    {
        return succeeded ? SystemError() : last(about);
    }

    /// Whether something failed.
    explicit operator bool() const { return _number != 0; }
    bool is(int number) const { return _number == number; }
    /// The errno; 0 when nothing failed.
    int number() const { return _number; }
    /// What the call was about; empty when that is what the caller named.
    const std::string& about() const { return _about; }

private:
    int _number = 0;
    std::string _about;
};

/// What an operation answers that has a value to give or was refused: exactly one of the two. It has the
/// shape of platform::Result.
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

    /// Whether there is a value.
    explicit operator bool() const { return value.has_value(); }
    /// The value. Calling these without one is a programming error.
    const T& operator*() const { return *value; }
    T& operator*() { return *value; }
    const T* operator->() const { return &*value; }
    T* operator->() { return &*value; }
};

} // namespace host::system

/// Ends the function with the failure of an expression that answers a SystemError; goes on where it answers
/// none. The function may answer a SystemError or a SystemResult.
#define TRW_TRY(expression)                                                                                  \
    do {                                                                                                     \
        if (auto trwFailure = (expression))                                                                  \
            return trwFailure;                                                                               \
    } while (false)
