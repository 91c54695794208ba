// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/desktop/JpegEnd.h"

namespace host::system {

namespace {

constexpr std::string_view startMark = "\xFF\xD8", endMark = "\xFF\xD9";
constexpr unsigned char scanMark = 0xDA;

unsigned char byteAt(const std::string& bytes, std::size_t index)
{
    return static_cast<unsigned char>(bytes[index]);
}

} // namespace

void JpegEnd::feed(std::string_view piece)
{
    if (_place == Place::Ended || _place == Place::Elsewhere)
        return;
    _bytes += piece;
    if (_place == Place::Start && _bytes.size() >= startMark.size()) {
        _place = _bytes.starts_with(startMark) ? Place::Segments : Place::Elsewhere;
        _bytes.erase(0, startMark.size());
    }
    if (_place == Place::Segments)
        skipSegments();
    if (_place == Place::Picture)
        lookForEnd();
}

/// Skips the segments before the picture by their lengths, because one may contain a small picture with an
/// end of its own.
void JpegEnd::skipSegments()
{
    std::size_t at = 0;
    while (_place == Place::Segments && at + 4 <= _bytes.size()) {
        const std::size_t length = std::size_t{byteAt(_bytes, at + 2)} << 8 | byteAt(_bytes, at + 3);
        if (byteAt(_bytes, at) != 0xFF)
            _place = Place::Elsewhere;
        else if (byteAt(_bytes, at + 1) == 0xFF)
            ++at;
        else if (byteAt(_bytes, at + 1) == scanMark)
            _place = Place::Picture;
        else if (at + 2 + length <= _bytes.size())
            at += 2 + length;
        else
            break;
    }
    _bytes.erase(0, at);
}

void JpegEnd::lookForEnd()
{
    if (_bytes.find(endMark) != std::string::npos)
        _place = Place::Ended;
    else if (!_bytes.empty())
        _bytes.erase(0, _bytes.size() - 1);
}

} // namespace host::system
