// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/previews/FilmFrame.h"
#include "platform/ImageLoader.h"
#include "tests/support/DriveFixture.h"

namespace {

using namespace platform;

const std::string& film()
{
    static const auto content = testing_support::contentOf(TRW_SAMPLE_FOLDER "/sunrise.avi");
    return content;
}

TEST(FilmFrame, IsTheThumbnailOfAFilm)
{
    const testing_support::DriveFixture drive;
    constexpr AttributeKey keys[] = {AttributeKey::ThumbnailMap};
    const auto values = drive.cloud->promisedItems().promisedItemResourceValues(
        drive.writeDocument("Sunrise.avi", film()), keys);
    ASSERT_TRUE(values && values->has(AttributeKey::ThumbnailMap));
    const auto image = values->get<ThumbnailMap>(AttributeKey::ThumbnailMap)->front().image;
    EXPECT_EQ(image.pixelWidth(), 480) << "a small film is not made larger";
    EXPECT_EQ(image.pixelHeight(), 270);
}

TEST(FilmFrame, FitsItsSizeAndIsNotTheFirstOne)
{
    const testing_support::TemporaryDirectory folder;
    const auto whole = host::previews::frameOfFilm(folder.write("a.avi", film()), 120);
    const auto cut = host::previews::frameOfFilm(folder.write("b.avi", film().substr(0, 40'000)), 120);
    ASSERT_TRUE(whole && cut);
    EXPECT_EQ(whole->pixelWidth(), 120);
    EXPECT_NEAR(whole->pixelHeight(), 68, 1);
    EXPECT_THAT(whole->pixels(), testing::Each(testing::Ge(0xff000000U))) << "opaque";
    EXPECT_NE(whole->pixels(), cut->pixels());
}

TEST(FilmFrame, IsMissingWhereThereIsNone)
{
    const testing_support::TemporaryDirectory folder;
    const struct {
        const char *name, *content;
        bool isLasting;
    } rows[] = {{"empty.avi", "", true}, {"text.avi", "no film", true}, {"start.avi", "RIFF", true},
        {"list.mp4", "#EXTM3U\n#EXT-X-TARGETDURATION:9\n#EXTINF:9,\nhttp://127.0.0.1:1/a.ts\n", false}};
    for (const auto& row : rows) {
        const auto frame = host::previews::frameOfFilm(folder.write(row.name, row.content), 64);
        ASSERT_FALSE(frame) << row.name;
        EXPECT_EQ(frame.error->domain() == errorDomain::image, row.isLasting) << row.name;
    }
    EXPECT_FALSE(host::previews::frameOfFilm(folder.at("missing.avi"), 64));
}

} // namespace
