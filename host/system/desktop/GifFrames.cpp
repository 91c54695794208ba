// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/desktop/GifFrames.h"

namespace host::system {

namespace {

constexpr std::size_t headerSize = 13; ///< signature and screen descriptor
constexpr std::size_t descriptorSize = 9; ///< of a frame, after its mark
constexpr unsigned char extensionMark = 0x21, frameMark = 0x2C;

class Reader {
public:
    explicit Reader(std::string_view bytes)
        : _bytes(bytes)
    {
    }
    unsigned char at(std::size_t offset) const
    {
        return _at + offset < _bytes.size() ? static_cast<unsigned char>(_bytes[_at + offset]) : 0;
    }
    void skip(std::size_t count) { _at += count; }
    bool isAtEnd() const { return _at >= _bytes.size(); }
    /// Skips data, which comes in blocks behind their lengths, up to an empty one.
    void skipBlocks()
    {
        while (!isAtEnd() && at(0) != 0)
            skip(1U + at(0));
        skip(1);
    }

private:
    std::string_view _bytes;
    std::size_t _at = 0;
};

std::size_t colorTableSize(unsigned char flags)
{
    return (flags & 0x80) != 0 ? 3U << ((flags & 0x07) + 1) : 0;
}

} // namespace

std::size_t gifFrameCount(std::string_view bytes)
{
    if (!bytes.starts_with("GIF8") || bytes.size() < headerSize)
        return 0;
    Reader reader(bytes);
    reader.skip(headerSize + colorTableSize(reader.at(10)));
    std::size_t frames = 0;
    for (; !reader.isAtEnd(); reader.skipBlocks()) {
        const auto mark = reader.at(0);
        if (mark == extensionMark) {
            reader.skip(2);
        } else if (mark == frameMark) {
            ++frames;
            // A frame begins with its own colours and the width of its codes.
            reader.skip(1 + descriptorSize + colorTableSize(reader.at(descriptorSize)) + 1);
        } else {
            return frames;
        }
    }
    return frames;
}

} // namespace host::system
