// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/sample/SamplePictures.h"
#include "host/drive/service/ThumbnailCache.h"
#include "tests/support/DriveFixture.h"

#include <sys/stat.h>

namespace {

using namespace platform;
using testing_support::DriveFixture;

class ThumbnailTests : public testing::Test {
protected:
    std::optional<ThumbnailMap> thumbnails(const Url& url)
    {
        constexpr AttributeKey keys[] = {AttributeKey::ThumbnailMap};
        const auto values = _drive.cloud->promisedItems().promisedItemResourceValues(url, keys);
        return values ? values->optional<ThumbnailMap>(AttributeKey::ThumbnailMap) : std::nullopt;
    }
    std::vector<std::filesystem::path> entries() const
    {
        std::vector<std::filesystem::path> found;
        std::error_code none;
        for (const auto& entry :
            std::filesystem::directory_iterator(_drive.folder().at("thumbnails/xx-large"), none))
            found.push_back(entry.path());
        return found;
    }

    DriveFixture _drive;
};

TEST_F(ThumbnailTests, madeOfAPictureAndAnewForAnotherVersion)
{
    const auto picture =
        _drive.writeDocument("Photos/hill & lake 100%.jpg", host::drive::sample::landscapeJpeg(1));
    const auto made = thumbnails(picture);
    ASSERT_TRUE(made);
    ASSERT_EQ(made->size(), 1U);
    EXPECT_EQ(made->front().pixelSize, 1024);
    EXPECT_EQ(made->front().image.pixelWidth(), 1024);
    EXPECT_EQ(made->front().image.pixelHeight(), 768);

    ASSERT_EQ(entries().size(), 1U);
    struct stat status { };
    ASSERT_EQ(::stat(entries().front().c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 0777, 0600U) << "thumbnails are private";

    // The file has another version now, so the old thumbnail no longer counts.
    const auto earlier = std::filesystem::last_write_time(picture.path()) - std::chrono::hours(1);
    testing_support::writeFile(picture.path(), host::drive::sample::portraitPng(0));
    std::filesystem::last_write_time(picture.path(), earlier);
    const auto anew = thumbnails(picture);
    ASSERT_TRUE(anew);
    EXPECT_EQ(anew->front().image.pixelWidth(), 900) << "a small picture is not made larger";
    EXPECT_EQ(entries().size(), 1U);
}

TEST_F(ThumbnailTests, noneForWhatIsNoPicture)
{
    const Url urls[] = {_drive.writeDocument("notes.txt", "text"),
        _drive.writeDocument("broken.png", "no picture"), _drive.makeFolder("folder.png"),
        _drive.writePromise("promised.png", {}), _drive.writeLink("link.png", "/dev/zero")};
    for (const auto& url : urls)
        EXPECT_FALSE(thumbnails(url)) << url.path();
    EXPECT_TRUE(entries().empty());
}

} // namespace
