// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/desktop/GdkPixbufImageLoader.h"
#include "host/system/desktop/JpegEnd.h"
#include "tests/support/TemporaryDirectory.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

using namespace platform;
using host::system::GdkPixbufImageLoader;
using testing_support::TemporaryDirectory;

namespace {

/// Answers a picture whose left half is red and whose right half is blue.
std::string twoColors(int width, int height)
{
    std::string file = "P6 " + std::to_string(width) + ' ' + std::to_string(height) + " 255\n";
    for (int i = 0; i < width * height; ++i)
        file += i % width < width / 2 ? std::string("\xFF\0\0", 3) : std::string("\0\0\xFF", 3);
    return file;
}

struct ErrorRow {
    const char* name;
    std::string content;
    ImageErrorCode code;
};

TEST(ImageLoader, KeepsColorsAndMakesLargePicturesSmaller)
{
    const TemporaryDirectory folder;
    const auto path = folder.write("wide.ppm", twoColors(400, 100));
    const GdkPixbufImageLoader loader;

    const auto whole = loader.load(path, {.maxWidth = 400, .maxHeight = 400, .scale = 2});
    ASSERT_TRUE(whole);
    EXPECT_EQ(whole->pixelWidth(), 400);
    EXPECT_EQ(whole->size(), (Size{200, 50}));
    EXPECT_EQ(whole->pixels().front(), 0xFFFF0000);
    EXPECT_EQ(whole->pixels().back(), 0xFF0000FF);

    const auto small = loader.load(path, {.maxWidth = 100, .maxHeight = 10});
    ASSERT_TRUE(small);
    EXPECT_EQ(small->pixelWidth(), 40);
    EXPECT_EQ(small->pixelHeight(), 10);
}

TEST(ImageLoader, SaysWhyAPictureCannotBeShown)
{
    const TemporaryDirectory folder;
    const GdkPixbufImageLoader loader;
    const ImageLimits limits{.maxFileBytes = 100'000, .maxSourcePixels = 10'000};
    const ErrorRow rows[] = {
        {"no picture", "just words", ImageErrorCode::Damaged},
        {"empty", "", ImageErrorCode::Damaged},
        {"header names too many pixels", "P6 30000 30000 255\n", ImageErrorCode::TooLarge},
        {"too many bytes", std::string(100'001, ' '), ImageErrorCode::TooLarge},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.name);
        const auto loaded = loader.load(folder.write("picture.ppm", row.content), limits);
        ASSERT_TRUE(loaded.error);
        EXPECT_EQ(loaded.error->domain(), errorDomain::image);
        EXPECT_EQ(loaded.error->code(), static_cast<int>(row.code));
    }
    const auto missing = loader.load(folder.at("missing.png"), limits);
    ASSERT_TRUE(missing.error);
    EXPECT_TRUE(missing.error->is(FileErrorCode::NoSuchFile));
}

TEST(ImageLoader, ReadsTheFramesOfAnAnimation)
{
    using namespace std::string_literals;
    // The animation shows one pixel, black for 200 milliseconds and white for 10.
    const auto frame = [](char delay, char color) {
        return "\x21\xF9\4\0"s + delay + "\0\0\0"s + "\x2C\0\0\0\0\1\0\1\0\0\2\2"s + color + "\1\0"s;
    };
    const auto gif = "GIF89a\1\0\1\0\x80\0\0\0\0\0\xFF\xFF\xFF"s + frame(20, '\x44') + frame(1, '\x4C') + ";";
    const TemporaryDirectory folder;
    const auto path = folder.write("moving.gif", gif);
    const auto never = [] { return false; };
    const GdkPixbufImageLoader loader;
    const auto picture = loader.loadPicture(path, {}, never);
    ASSERT_TRUE(picture);
    ASSERT_EQ(picture->frames.size(), 2U);
    EXPECT_EQ(picture->frames[0].image.pixels()[0], 0xFF000000);
    EXPECT_EQ(picture->frames[1].image.pixels()[0], 0xFFFFFFFF);
    EXPECT_EQ(picture->frames[0].milliseconds, 200);
    EXPECT_FALSE(picture->breaksOff);

    EXPECT_EQ(loader.loadPicture(path, {.maxAnimationBytes = 7}, never)->frames.size(), 1U);
    const auto cancelled = loader.loadPicture(path, {}, [] { return true; });
    EXPECT_EQ(cancelled.error->code(), static_cast<int>(ImageErrorCode::Cancelled));

    // The file is truncated within its second frame.
    const auto half = loader.loadPicture(folder.write("half.gif", gif.substr(0, gif.size() - 6)), {}, never);
    ASSERT_TRUE(half);
    EXPECT_TRUE(half->breaksOff);
}

/// Answers a grey JPEG picture of one colour whose frame has this mark.
std::string greyJpeg(unsigned width, unsigned height, char frame)
{
    using namespace std::string_literals;
    const auto number = [](unsigned value) {
        return std::string{static_cast<char>(value >> 8), static_cast<char>(value & 0xFF)};
    };
    // Each table has one code of one bit, "no difference" and "end of block", so two bits are a block.
    const auto table = [](char kind) { return "\xFF\xC4\0\x14"s + kind + "\1"s + std::string(16, '\0'); };
    const std::size_t blocks = std::size_t{(width + 7) / 8} * ((height + 7) / 8);
    return "\xFF\xD8\xFF\xDB\0\x43\0"s + std::string(64, '\1') + "\xFF"s + frame + "\0\x0B\x08"s
        + number(height) + number(width) + "\1\1\x11\0"s + table('\0') + table('\x10')
        + "\xFF\xDA\0\x08\1\1\0\0\x3F\0"s + std::string(blocks / 4 + 1, '\0') + "\xFF\xD9"s;
}

TEST(ImageLoader, ShowsLargePhotosThatAreMadeSmallerWhileTheyAreRead)
{
    const TemporaryDirectory folder;
    const GdkPixbufImageLoader loader;
    const ImageLimits limits{.maxWidth = 400, .maxHeight = 400};
    constexpr char rows = '\xC0', progressive = '\xC2';
    const auto photo = loader.loadPicture(
        folder.write("photo.jpg", greyJpeg(12000, 9000, rows)), limits, [] { return false; });
    ASSERT_TRUE(photo);
    EXPECT_EQ(photo->sourceWidth, 12000);
    EXPECT_EQ(photo->frames.front().image.pixelWidth(), 400);
    EXPECT_EQ(photo->frames.front().image.pixels()[50'000], 0xFF808080);
    EXPECT_FALSE(photo->breaksOff);

    auto whole = limits;
    whole.maxWidth = whole.maxHeight = 12000;
    const std::pair<std::string, ImageLimits> refused[] = {{greyJpeg(12000, 9000, progressive), limits},
        {greyJpeg(12000, 9000, rows), whole}, {greyJpeg(60000, 60000, rows), limits}};
    for (const auto& [content, allowed] : refused) {
        const auto loaded = loader.load(folder.write("large.jpg", content), allowed);
        ASSERT_TRUE(loaded.error);
        EXPECT_EQ(loaded.error->code(), static_cast<int>(ImageErrorCode::TooLarge));
    }
}

struct EndRow {
    const char* name;
    std::string_view bytes;
    bool isMissing;
};

TEST(JpegEnd, IsFoundBehindThePictureOnly)
{
    using namespace std::string_view_literals;
    const EndRow rows[] = {
        {"whole", "\xFF\xD8\xFF\xE0\0\4ab\xFF\xDA\0\2pixels\xFF\xD9"sv, false},
        {"whole, with more behind it", "\xFF\xD8\xFF\xDA\0\2\xFF\xD9 and a film"sv, false},
        {"fill bytes before a mark", "\xFF\xD8\xFF\xFF\xFF\xDA\0\2\xFF\xD9"sv, false},
        {"broken off", "\xFF\xD8\xFF\xE0\0\4ab\xFF\xDA\0\2pixels\xFF"sv, true},
        {"with an end in its small picture alone", "\xFF\xD8\xFF\xE1\0\4\xFF\xD9\xFF\xDA\0\2pixels"sv, true},
        {"broken off within a segment", "\xFF\xD8\xFF\xE1\1\0short"sv, true},
        {"another format", "GIF89a"sv, false},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.name);
        host::system::JpegEnd whole, pieces;
        whole.feed(row.bytes);
        for (const char byte : row.bytes)
            pieces.feed({&byte, 1});
        EXPECT_EQ(whole.isMissing(), row.isMissing);
        EXPECT_EQ(pieces.isMissing(), row.isMissing);
    }
}

TEST(ImageLoader, DoesNotWaitForAPipe)
{
    const TemporaryDirectory folder;
    ASSERT_EQ(::mkfifo(folder.at("pipe.png").c_str(), 0600), 0);
    EXPECT_TRUE(GdkPixbufImageLoader().load(folder.at("pipe.png"), {}).error);
}

} // namespace
