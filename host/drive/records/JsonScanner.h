// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>

namespace host::drive {

/// Walks over JSON text without building a tree: reading a promise is part of showing every row. Any failure
/// stays: after it every call answers false or nothing.
class JsonScanner {
public:
    /// Arrays and objects nested deeper than this are refused.
    static constexpr int maximumDepth = 32;

    explicit JsonScanner(std::string_view text)
        : _text(text)
    {
    }

    bool failed() const { return _failed; }
    /// Whether nothing but white space is left.
    bool atEnd();

    /// Enters an object; then nextMember() answers the keys. The value after each must be read or skipped. A
    /// key is valid until the next call.
    bool beginObject();
    std::optional<std::string_view> nextMember();
    /// Enters an array; then nextElement() tells whether a value follows.
    bool beginArray();
    bool nextElement();

    /// A value of this kind; a value of any other kind is skipped and answers nothing.
    std::optional<std::string> text();
    std::optional<std::int64_t> integer();
    std::optional<bool> boolean();
    bool skip();

    /// The first character of the next value, '\0' at the end.
    char peek();

private:
    bool fail();
    bool take(char expected);
    bool takeWord(std::string_view word);
    std::optional<std::string_view> string();
    bool appendEscape();
    std::optional<std::uint32_t> hexUnit();
    std::optional<std::string_view> numberText();
    bool skipNested(int depth);
    bool separate(char end);

    std::string_view _text;
    std::size_t _at = 0;
    bool _failed = false;
    bool _first = false;
    std::string _unescaped;
};

} // namespace host::drive
