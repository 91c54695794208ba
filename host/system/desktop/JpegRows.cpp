// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/desktop/JpegRows.h"

#include <fstream>

namespace host::system {

namespace {

constexpr int startMark = 0xD8, scanMark = 0xDA;
/// The frames whose rows follow each other: baseline, and the same with more exact colours.
constexpr int baselineFrame = 0xC0, extendedFrame = 0xC1;
/// Pictures from other people may have any number of segments.
constexpr int mostSegments = 10'000;

/// Answers the code of the next mark, or -1.
int nextMark(std::istream& file)
{
    if (file.get() != 0xFF)
        return -1;
    int code = 0xFF;
    while (code == 0xFF)
        code = file.get();
    return file ? code : -1;
}

int nextNumber(std::istream& file)
{
    const int high = file.get(), low = file.get();
    return file ? high << 8 | low : -1;
}

} // namespace

bool isJpegInRows(const std::string& path)
{
    std::ifstream file(path, std::ios::binary);
    if (nextMark(file) != startMark)
        return false;
    int components = 0; // of a frame with rows; 0 before it
    for (int segment = 0; segment < mostSegments; ++segment) {
        const int mark = nextMark(file), length = nextNumber(file);
        if (mark < 0 || length < 2)
            return false;
        const auto end = file.tellg() + std::streamoff{length - 2};
        if (mark == scanMark)
            return components > 0 && file.get() == components;
        if (mark == baselineFrame || mark == extendedFrame) {
            constexpr int beforeComponents = 5; // the depth and the two sides
            file.ignore(beforeComponents);
            components = file.get();
        }
        file.seekg(end);
    }
    return false;
}

} // namespace host::system
