// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/sample/SamplePictures.h"
#include "host/drive/service/ThumbnailCache.h"
#include "host/system/desktop/PixbufImage.h"
#include "platform/PagedDocument.h"
#include "tests/support/DriveFixture.h"
#include "tests/support/SimplePdf.h"

#include <sys/stat.h>

#include <atomic>
#include <chrono>
#include <stdexcept>
#include <thread>

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
        _drive.writeDocument("broken.png", "no picture"), _drive.writeDocument("broken.pdf", "no pages"),
        _drive.makeFolder("folder.png"), _drive.writePromise("promised.png", {}),
        _drive.writePromise("promised.pdf", {}), _drive.writeLink("link.png", "/dev/zero")};
    for (const auto& url : urls)
        EXPECT_FALSE(thumbnails(url)) << url.path();
    EXPECT_TRUE(entries().empty());
}

/// Makes thumbnails of one colour, or fails as the test says, and counts.
class CountingMaker : public ThumbnailMaker {
public:
    Result<Image> makeThumbnail(const std::string&, ThumbnailContent, int) const override
    {
        ++calls;
        if (isKilled)
            throw std::runtime_error("the process ends");
        std::this_thread::sleep_for(std::chrono::milliseconds(20));
        return error ? Result<Image>(*error) : Image::fromPixels(1, 1, 1, {0xff00ff00});
    }
    mutable std::atomic<int> calls = 0;
    std::optional<Error> error;
    bool isKilled = false;
};

class ThumbnailCacheTests : public testing::Test {
protected:
    /// Asks as often as the program may, in a process of its own each time.
    int callsFor(int processes, Date version = {})
    {
        maker->calls = 0;
        for (int i = 0; i < processes; ++i) {
            host::drive::ThumbnailCache process(folder.at("thumbnails"), maker);
            for (int j = 0; j < 2; ++j) {
                try {
                    process.thumbnails(document, version, ThumbnailContent::Pages);
                } catch (const std::runtime_error&) {
                    break;
                }
            }
        }
        return maker->calls;
    }

    testing_support::TemporaryDirectory folder;
    std::shared_ptr<CountingMaker> maker = std::make_shared<CountingMaker>();
    Url document = Url::fileURL("/drive/a.pdf");
};

TEST_F(ThumbnailCacheTests, doesNotTryADamagedDocumentAgainBeforeItChanges)
{
    maker->error = Error(errorDomain::pages, static_cast<int>(PagesErrorCode::Damaged));
    EXPECT_EQ(callsFor(3), 1);
    EXPECT_EQ(callsFor(3, Date::fromSeconds(5)), 1);
    maker->error.reset();
    EXPECT_EQ(callsFor(3, Date::fromSeconds(9)), 1) << "made once and kept";
}

TEST_F(ThumbnailCacheTests, triesWhatTheMachineLacksOnceInEachProcess)
{
    maker->error = Error(errorDomain::system, ENOSYS);
    EXPECT_EQ(callsFor(3), 3);
}

TEST_F(ThumbnailCacheTests, triesADocumentThatEndsTheProcessAFewTimesOnly)
{
    maker->isKilled = true;
    EXPECT_EQ(callsFor(9), host::drive::ThumbnailCache::mostAttempts);
    maker->isKilled = false;
    EXPECT_EQ(callsFor(1, Date::fromSeconds(5)), 1);
}

TEST_F(ThumbnailCacheTests, makesAThumbnailOnceForThreadsThatAskTogether)
{
    host::drive::ThumbnailCache cache(folder.at("thumbnails"), maker);
    {
        std::vector<std::jthread> threads;
        for (int i = 0; i < 4; ++i)
            threads.emplace_back(
                [&] { EXPECT_EQ(cache.thumbnails(document, {}, ThumbnailContent::Pages).size(), 1U); });
    }
    EXPECT_EQ(maker->calls, 1);
}

TEST_F(ThumbnailTests, madeOfTheFirstPage)
{
    const auto pages = thumbnails(_drive.writeDocument("a.pdf", testing_support::simplePdf({"one", "two"})));
    ASSERT_TRUE(pages);
    EXPECT_EQ(pages->front().image.pixelWidth(), 683);
    EXPECT_EQ(pages->front().image.pixelHeight(), 1024);
    EXPECT_EQ(pages->front().image.pixels().front(), 0xffffffffU) << "white paper";
    EXPECT_EQ(entries().size(), 1U);
}

TEST_F(ThumbnailTests, takenFromOtherProgramsWhereTheProgramCanMakeNone)
{
    const auto document = _drive.writeDocument("notes.txt", "text");
    const auto modified = std::to_string(std::chrono::duration_cast<std::chrono::seconds>(
        std::chrono::file_clock::to_sys(std::filesystem::last_write_time(document.path())).time_since_epoch())
                                             .count());
    const auto path = _drive.folder().at("thumbnails/large/")
        + std::unique_ptr<char, decltype(&g_free)>(
            g_compute_checksum_for_string(G_CHECKSUM_MD5, document.absoluteString().c_str(), -1), g_free)
              .get()
        + ".png";
    std::filesystem::create_directories(std::filesystem::path(path).parent_path());
    const auto picture = host::system::pixbufOf(Image::fromPixels(1, 1, 1, {0x80402000}));
    ASSERT_TRUE(gdk_pixbuf_save(picture.get(), path.c_str(), "png", nullptr, "tEXt::Thumb::URI",
        document.absoluteString().c_str(), "tEXt::Thumb::MTime", modified.c_str(), nullptr));
    const auto found = thumbnails(document);
    ASSERT_TRUE(found);
    EXPECT_EQ(found->front().pixelSize, 256);
    EXPECT_EQ(found->front().image.pixels().front(), 0x80402000U);
}

} // namespace
