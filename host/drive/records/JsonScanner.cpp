// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/JsonScanner.h"

#include "platform/Url.h"

#include <charconv>
#include <utility>

namespace host::drive {

namespace {

bool isDigit(char c)
{
    return c >= '0' && c <= '9';
}

void appendUtf8(std::string& out, std::uint32_t point)
{
    if (point < 0x80) {
        out.push_back(static_cast<char>(point));
        return;
    }
    const int trailing = point < 0x800 ? 1 : point < 0x10000 ? 2 : 3;
    static constexpr std::uint32_t leads[] = {0, 0xc0, 0xe0, 0xf0};
    out.push_back(static_cast<char>(leads[trailing] | (point >> (6 * trailing))));
    for (int i = trailing - 1; i >= 0; --i)
        out.push_back(static_cast<char>(0x80 | ((point >> (6 * i)) & 0x3f)));
}

} // namespace

bool JsonScanner::fail()
{
    _failed = true;
    _at = _text.size();
    return false;
}

char JsonScanner::peek()
{
    while (_at < _text.size()
        && (_text[_at] == ' ' || _text[_at] == '\n' || _text[_at] == '\t' || _text[_at] == '\r'))
        ++_at;
    return _at < _text.size() ? _text[_at] : '\0';
}

bool JsonScanner::atEnd()
{
    peek();
    return _at == _text.size();
}

bool JsonScanner::take(char expected)
{
    if (_failed || atEnd() || _text[_at] != expected)
        return fail();
    ++_at;
    return true;
}

bool JsonScanner::takeWord(std::string_view word)
{
    if (!_text.substr(_at).starts_with(word))
        return fail();
    _at += word.size();
    return true;
}

bool JsonScanner::beginObject()
{
    _first = take('{');
    return _first;
}

bool JsonScanner::beginArray()
{
    _first = take('[');
    return _first;
}

// Whether another entry follows in the array or object that is being read; takes the comma or the end.
bool JsonScanner::separate(char end)
{
    const bool first = std::exchange(_first, false);
    if (peek() == end) {
        ++_at;
        return false;
    }
    return first ? !atEnd() || fail() : take(',');
}

std::optional<std::string_view> JsonScanner::nextMember()
{
    if (!separate('}'))
        return std::nullopt;
    const auto key = string();
    if (!key || !take(':'))
        return std::nullopt;
    return key;
}

bool JsonScanner::nextElement()
{
    return separate(']');
}

std::optional<std::string_view> JsonScanner::string()
{
    if (!take('"'))
        return std::nullopt;
    const auto begin = _at;
    _unescaped.clear();
    bool escaped = false, ascii = true;
    for (; _at < _text.size() && _text[_at] != '"'; ++_at) {
        ascii = ascii && static_cast<signed char>(_text[_at]) >= 0;
        if (static_cast<unsigned char>(_text[_at]) < 0x20) {
            fail();
            return std::nullopt;
        }
        if (_text[_at] == '\\') {
            if (!std::exchange(escaped, true))
                _unescaped.assign(_text.substr(begin, _at - begin));
            if (!appendEscape())
                return std::nullopt;
        } else if (escaped) {
            _unescaped.push_back(_text[_at]);
        }
    }
    const auto content = escaped ? std::string_view(_unescaped) : _text.substr(begin, _at - begin);
    const bool needsCheck = escaped || !ascii;
    if (!take('"') || (needsCheck && !platform::isValidUtf8(content))) {
        fail();
        return std::nullopt;
    }
    return content;
}

// Leaves the position on the escape's last character.
bool JsonScanner::appendEscape()
{
    static constexpr std::string_view names = "\"\\/bfnrt", values = "\"\\/\b\f\n\r\t";
    if (++_at >= _text.size())
        return fail();
    if (const auto known = names.find(_text[_at]); known != std::string_view::npos) {
        _unescaped.push_back(values[known]);
        return true;
    }
    auto point = hexUnit();
    if (point && *point >= 0xd800 && *point < 0xdc00) {
        if (!_text.substr(_at + 1).starts_with("\\u"))
            return fail();
        _at += 2;
        const auto low = hexUnit();
        if (!low || *low < 0xdc00 || *low > 0xdfff)
            return fail();
        point = 0x10000 + ((*point - 0xd800) << 10) + (*low - 0xdc00);
    }
    // A NUL would cut the text short wherever it is handed to the system.
    if (!point || *point == 0)
        return fail();
    appendUtf8(_unescaped, *point);
    return true;
}

std::optional<std::uint32_t> JsonScanner::hexUnit()
{
    if (_at + 4 >= _text.size() || _text[_at] != 'u')
        return std::nullopt;
    std::uint32_t unit = 0;
    const char* begin = _text.data() + _at + 1;
    if (std::from_chars(begin, begin + 4, unit, 16).ptr != begin + 4)
        return std::nullopt;
    _at += 4;
    return unit;
}

std::optional<std::string> JsonScanner::text()
{
    if (peek() != '"') {
        skip();
        return std::nullopt;
    }
    const auto content = string();
    return content ? std::optional(std::string(*content)) : std::nullopt;
}

std::optional<std::string_view> JsonScanner::numberText()
{
    const auto begin = _at;
    const auto digits = [this] {
        const auto first = _at;
        while (_at < _text.size() && isDigit(_text[_at]))
            ++_at;
        return _at > first;
    };
    const auto is = [this](std::string_view any) {
        return _at < _text.size() && any.find(_text[_at]) != std::string_view::npos;
    };
    if (is("-"))
        ++_at;
    const bool leadingZero = is("0");
    bool valid = digits() && !(leadingZero && _at - begin > (_text[begin] == '-' ? 2u : 1u));
    if (valid && is(".")) {
        ++_at;
        valid = digits();
    }
    if (valid && is("eE")) {
        ++_at;
        if (is("+-"))
            ++_at;
        valid = digits();
    }
    if (!valid) {
        fail();
        return std::nullopt;
    }
    return _text.substr(begin, _at - begin);
}

std::optional<std::int64_t> JsonScanner::integer()
{
    const char first = peek();
    if (first != '-' && !isDigit(first)) {
        skip();
        return std::nullopt;
    }
    const auto digits = numberText();
    std::int64_t value = 0;
    if (!digits)
        return std::nullopt;
    const char* end = digits->data() + digits->size();
    const auto [stop, error] = std::from_chars(digits->data(), end, value);
    return error == std::errc() && stop == end ? std::optional(value) : std::nullopt;
}

std::optional<bool> JsonScanner::boolean()
{
    const char first = peek();
    if (first == 't' || first == 'f')
        return takeWord(first == 't' ? "true" : "false") ? std::optional(first == 't') : std::nullopt;
    skip();
    return std::nullopt;
}

bool JsonScanner::skip()
{
    return skipNested(0);
}

bool JsonScanner::skipNested(int depth)
{
    switch (peek()) {
    case '"':
        return string().has_value();
    case 't':
        return takeWord("true");
    case 'f':
        return takeWord("false");
    case 'n':
        return takeWord("null");
    case '{':
        if (depth == maximumDepth || !beginObject())
            return fail();
        while (nextMember())
            skipNested(depth + 1);
        return !_failed;
    case '[':
        if (depth == maximumDepth || !beginArray())
            return fail();
        while (nextElement())
            skipNested(depth + 1);
        return !_failed;
    default:
        return numberText().has_value();
    }
}

} // namespace host::drive
