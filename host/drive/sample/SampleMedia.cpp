// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/sample/SampleMedia.h"

#include "host/drive/sample/SamplePictures.h"

#include <algorithm>
#include <cmath>
#include <cstdint>

namespace host::drive::sample {

namespace {

// Both file formats are RIFF: chunks of a four-letter name, a 32-bit length and the content, little-endian.
void append16(std::string& out, std::uint32_t value)
{
    out.push_back(static_cast<char>(value));
    out.push_back(static_cast<char>(value >> 8));
}

void append32(std::string& out, std::uint32_t value)
{
    append16(out, value & 0xffff);
    append16(out, value >> 16);
}

std::string chunk(const char* name, std::string content)
{
    std::string out(name);
    append32(out, static_cast<std::uint32_t>(content.size()));
    if (content.size() % 2 != 0)
        content.push_back('\0');
    return out + content;
}

std::string list(const char* kind, const std::string& content)
{
    return chunk("LIST", kind + content);
}

constexpr int sampleRate = 22'050;

// One note with a soft beginning and a fading end, and two overtones.
void appendNote(std::string& samples, double frequency, double seconds)
{
    const int count = static_cast<int>(seconds * sampleRate);
    for (int i = 0; i < count; ++i) {
        const double t = static_cast<double>(i) / sampleRate, phase = 2 * M_PI * frequency * t;
        const double envelope = std::min(1.0, t * 60) * std::exp(-3.5 * t / seconds);
        const double wave = std::sin(phase) + .35 * std::sin(2 * phase) + .12 * std::sin(3 * phase);
        append16(
            samples, static_cast<std::uint32_t>(static_cast<std::int32_t>(9000 * envelope * wave)) & 0xffff);
    }
}

std::string mainHeader(
    std::uint32_t frames, int width, int height, int framesPerSecond, std::uint32_t largest)
{
    constexpr std::uint32_t hasIndex = 0x10;
    std::string header;
    for (const std::uint32_t value : {1'000'000u / static_cast<std::uint32_t>(framesPerSecond),
             largest * static_cast<std::uint32_t>(framesPerSecond), 0u, hasIndex, frames, 0u, 1u, largest,
             static_cast<std::uint32_t>(width), static_cast<std::uint32_t>(height), 0u, 0u, 0u, 0u})
        append32(header, value);
    return chunk("avih", header);
}

std::string streamHeader(
    std::uint32_t frames, int width, int height, int framesPerSecond, std::uint32_t largest)
{
    std::string header = "vidsMJPG";
    for (const std::uint32_t value :
        {0u, 0u, 0u, 1u, static_cast<std::uint32_t>(framesPerSecond), 0u, frames, largest, 0xffffffffu, 0u})
        append32(header, value);
    for (const int value : {0, 0, width, height})
        append16(header, static_cast<std::uint32_t>(value));
    return chunk("strh", header);
}

std::string streamFormat(int width, int height)
{
    std::string format;
    append32(format, 40);
    append32(format, static_cast<std::uint32_t>(width));
    append32(format, static_cast<std::uint32_t>(height));
    append16(format, 1);
    append16(format, 24);
    format += "MJPG";
    append32(format, static_cast<std::uint32_t>(width * height * 3));
    for (int i = 0; i < 4; ++i)
        append32(format, 0);
    return chunk("strf", format);
}

} // namespace

std::string tuneWav(int variant)
{
    static constexpr int tunes[2][12] = {
        {0, 4, 7, 12, 7, 4, 5, 9, 12, 9, 7, 0}, {0, 3, 7, 8, 7, 3, 5, 8, 12, 10, 7, 0}};
    std::string samples;
    for (const int step : tunes[variant % 2])
        appendNote(samples, 261.63 * std::pow(2, step / 12.0), .4);
    std::string format;
    append16(format, 1); // uncompressed
    append16(format, 1); // channels
    append32(format, sampleRate);
    append32(format, sampleRate * 2);
    append16(format, 2);
    append16(format, 16);
    return chunk("RIFF", "WAVE" + chunk("fmt ", format) + chunk("data", samples));
}

std::string motionJpegAvi(const std::vector<std::string>& frames, int width, int height, int framesPerSecond)
{
    std::string movie, index;
    std::size_t largest = 0;
    for (const auto& frame : frames) {
        constexpr std::uint32_t keyFrame = 0x10;
        index += "00dc";
        append32(index, keyFrame);
        append32(index, static_cast<std::uint32_t>(4 + movie.size())); // from the list's kind on
        append32(index, static_cast<std::uint32_t>(frame.size()));
        movie += chunk("00dc", frame);
        largest = std::max(largest, frame.size());
    }
    const auto count = static_cast<std::uint32_t>(frames.size()), most = static_cast<std::uint32_t>(largest);
    const auto stream =
        list("strl", streamHeader(count, width, height, framesPerSecond, most) + streamFormat(width, height));
    const auto headers = list("hdrl", mainHeader(count, width, height, framesPerSecond, most) + stream);
    return chunk("RIFF", "AVI " + headers + list("movi", movie) + chunk("idx1", index));
}

std::string sunriseAvi()
{
    constexpr int width = 480, height = 270, count = 60;
    std::vector<std::string> frames;
    for (int i = 0; i < count; ++i)
        frames.push_back(sunriseFrameJpeg(width, height, static_cast<double>(i) / (count - 1)));
    return motionJpegAvi(frames, width, height, 15);
}

} // namespace host::drive::sample
