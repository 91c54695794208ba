// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/drawing/CairoImageContext.h"
#include "kit/values/Canvas.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace {

using namespace platform;
using host::system::openImageContext;

std::uint32_t pixel(const Image& image, int x, int y)
{
    return image.pixels().at(static_cast<std::size_t>(y * image.pixelWidth() + x));
}

TEST(ImageContext, HasAPixelForEveryPartOfAPoint)
{
    const struct {
        Size size;
        double scale;
        int width, height;
    } rows[] = {{{20, 10}, 1, 20, 10}, {{20, 10}, 3, 60, 30}, {{13.5, 9}, 1, 14, 9},
        {{0.1, 7.0 / 3}, 3, 1, 7}, {{32767, 1}, 1, 32767, 1}, {{32768, 1}, 1, 0, 0},
        {{1e300, 1}, 1e300, 0, 0}, {{0, 1}, 1, 0, 0}, {{1, -1}, 1, 0, 0}, {{1, 1}, 0, 0, 0},
        {{-1, -1}, -1, 0, 0}};
    for (const auto& row : rows) {
        SCOPED_TRACE(testing::Message() << row.size.width << " x " << row.size.height << " at " << row.scale);
        const auto context = openImageContext(row.size, row.scale);
        ASSERT_EQ(context != nullptr, row.width > 0);
        if (context) {
            EXPECT_EQ(context->image().pixelWidth(), row.width);
            EXPECT_EQ(context->image().pixelHeight(), row.height);
            EXPECT_EQ(context->image().scale(), row.scale);
        }
    }
}

TEST(ImageContext, DrawsColoursAsTheyAreOnATransparentSurface)
{
    const auto context = openImageContext({8, 4}, 2);
    context->canvas().setFillColor({1, 0, 0, 0.5F});
    context->canvas().fillRect({1, 1, 2, 2});
    const auto first = context->image();
    context->canvas().setFillColor(Color::black());
    context->canvas().drawImage(first, {4, 0, 4, 2});
    const auto second = context->image();

    EXPECT_EQ(pixel(first, 1, 1), 0U);
    EXPECT_EQ(pixel(first, 2, 2), 0x80800000U);
    EXPECT_EQ(pixel(first, 5, 5), 0x80800000U);
    EXPECT_EQ(pixel(first, 6, 5), 0U);
    EXPECT_EQ(pixel(first, 10, 1), 0U) << "an image keeps what it was";
    EXPECT_NE(pixel(second, 10, 1), 0U);
}

TEST(ImageContext, DrawsTextOnItsBaseline)
{
    const auto context = openImageContext({40, 40}, 1);
    context->canvas().drawText("H", kit::Font::preferred(kit::TextStyle::Body, 20), {2, 30});
    const auto image = context->image();
    const auto isDrawn = [&](int y) {
        const auto* row = image.pixels().data() + static_cast<std::ptrdiff_t>(y) * image.pixelWidth();
        return std::any_of(row, row + image.pixelWidth(), [](auto value) { return value >> 24 > 128; });
    };
    EXPECT_TRUE(isDrawn(28));
    EXPECT_FALSE(isDrawn(32)) << "nothing below the baseline";
    EXPECT_FALSE(isDrawn(12)) << "the letter is smaller than its font";
}

} // namespace
