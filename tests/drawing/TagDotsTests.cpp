// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "drawing/FileTags.h"
#include "host/system/drawing/CairoImageContext.h"
#include "kit/values/ImageContext.h"
#include "tests/support/DriveFixture.h"

namespace tarrow {
namespace {

using namespace testing;
using platform::Image;

/// The tags have no colour here, because the store is empty.
class TagDotsTest : public testing::Test {
protected:
    TagDotsTest() { kit::ImageContext::install(host::system::openImageContext); }
    ~TagDotsTest() override { kit::ImageContext::install(nullptr); }

    static std::uint32_t pixel(const Image& image, int x, int y)
    {
        return image.pixels().at(static_cast<std::size_t>(y * image.pixelWidth() + x));
    }
    /// Answers the grey of an opaque pixel, from 0 to 255.
    static unsigned grey(const Image& image, int x, int y)
    {
        EXPECT_EQ(pixel(image, x, y) >> 24, 255U) << x << ", " << y;
        return pixel(image, x, y) & 255U;
    }

    testing_support::DriveFixture drive;
};

constexpr unsigned fill = 204, rim = 230; // white levels of 0.8 and 0.9

TEST_F(TagDotsTest, SeveralDotsOverlapAndHaveALighterRim)
{
    const auto drawn = FileTags::blipWithTagsHeightScale({"a", "b", "c"}, 10, 2);
    ASSERT_TRUE(drawn);
    EXPECT_EQ(drawn->size(), (platform::Size{20, 10}));
    EXPECT_EQ(drawn->pixelWidth(), 40);
    EXPECT_EQ(drawn->scale(), 2);
    // Each dot's own left edge is a rim. It lies over the dot before it, whose right edge is covered.
    for (const int left : {0, 10, 20}) {
        EXPECT_NEAR(grey(*drawn, left + 1, 9), rim, 1) << left;
        EXPECT_EQ(grey(*drawn, left + 4, 9), fill) << left;
    }
    EXPECT_EQ(grey(*drawn, 19 + 5, 9), fill) << "the second dot ends below the third";
    EXPECT_NEAR(grey(*drawn, 38, 9), rim, 1);
    EXPECT_EQ(pixel(*drawn, 0, 0), 0U) << "transparent beside the dots";
    EXPECT_EQ(pixel(*drawn, 39, 19), 0U);
}

TEST_F(TagDotsTest, DotsAreAsHighAsWholePoints)
{
    const auto drawn = FileTags::blipWithTagsHeightScale({"a", "b"}, 9.5F, 4);
    ASSERT_TRUE(drawn);
    EXPECT_EQ(drawn->size(), (platform::Size{14.75, 10}));
}

TEST_F(TagDotsTest, OneDotHasNoRimAndLiesAtItsOffset)
{
    const auto drawn = FileTags::blipWithTagImageSizeBlipHeightOffset("a", {20, 16}, 8, {10, 4});
    ASSERT_TRUE(drawn);
    EXPECT_EQ(drawn->size(), (platform::Size{20, 16}));
    EXPECT_EQ(drawn->scale(), 1);
    for (const int x : {10, 14, 17})
        EXPECT_NEAR(static_cast<double>(pixel(*drawn, x, 7) >> 24), 255, 25) << x;
    EXPECT_EQ(grey(*drawn, 14, 4 + 1), fill) << "no rim";
    for (const auto& [x, y] : {std::pair{9, 8}, {18, 8}, {14, 3}, {14, 12}})
        EXPECT_EQ(pixel(*drawn, x, y), 0U) << x << ", " << y;
}

TEST_F(TagDotsTest, NothingIsDrawnOfNothing)
{
    EXPECT_FALSE(FileTags::blipWithTagsHeightScale({}, 10, 1));
    EXPECT_FALSE(FileTags::blipWithTagsHeightScale({"a"}, 0, 1));
    EXPECT_FALSE(FileTags::blipWithTagImageSizeBlipHeightOffset(std::nullopt, {20, 16}, 8, {}));
}

} // namespace
} // namespace tarrow
