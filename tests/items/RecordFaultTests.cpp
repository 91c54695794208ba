// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/DRItem.h"
#include "tests/items/support/ItemsFixture.h"

#include <gmock/gmock.h>

#include <sys/stat.h>

#include <filesystem>

using namespace tarrow;
using items_tests::ItemsFixture;
using testing::IsEmpty;

namespace {

class RecordFaultTest : public ItemsFixture {
protected:
    void makeUnreachable()
    {
        decorated->decoratedItems.unreachable = Error(platform::errorDomain::system, 5);
    }
};

TEST_F(RecordFaultTest, FallsBackToThePlainFileSystem)
{
    const auto url = writeDocument("Notes/a.txt", "12345");
    makeUnreachable();
    const auto item = DRItem::initWithURL(url);
    ASSERT_TRUE(item);
    EXPECT_EQ(item->localizedName(), "a.txt");
    EXPECT_THAT(item->typeIdentifier(), IsEmpty());
    EXPECT_EQ(item->fileSize(), 5U);
    EXPECT_EQ(item->parentDirectoryURL(), at("Notes"));
    EXPECT_FALSE(item->hasHiddenExtension());
    EXPECT_TRUE(item->contentModificationDate());

    const auto folder = DRItem::initWithURL(at("Notes"));
    ASSERT_TRUE(folder);
    EXPECT_EQ(folder->typeIdentifier(), "public.directory");
    EXPECT_TRUE(folder->isDirectory());
}

TEST_F(RecordFaultTest, FollowsALinkInTheFallback)
{
    makeFolder("Notes");
    makeUnreachable();
    const std::pair<std::string, std::string> rows[] = {
        {"bare name", at("Notes/bare name").path()},
        {"sub/name", at("Notes/sub/name").path()},
        {"/elsewhere/file", "/elsewhere/file"},
    };
    for (const auto& [destination, resolved] : rows) {
        const auto link = at("Notes/link");
        std::filesystem::remove(link.path());
        std::filesystem::create_symlink(destination, link.path());
        const auto item = DRItem::initWithURL(link);
        ASSERT_TRUE(item) << destination;
        EXPECT_TRUE(item->isSymlink());
        EXPECT_EQ(item->typeIdentifier(), "public.symlink");
        EXPECT_EQ(item->symlinkTarget(), destination);
        EXPECT_EQ(item->resolvedURL()->path(), resolved);
    }
}

TEST_F(RecordFaultTest, RefusesWhatIsNeitherFileNorFolderInTheFallback)
{
    const auto url = at("pipe");
    ASSERT_EQ(::mkfifo(url.path().c_str(), 0600), 0);
    makeUnreachable();
    EXPECT_FALSE(DRItem::initWithURL(url));
}

TEST_F(RecordFaultTest, ReadsPlainAttributesWhereTheRecordIsDamaged)
{
    const auto url = writeDocument("a.txt", "12345");
    decorated->decoratedItems.changePromised = [](const Url&, Result<AttributeMap>& values) {
        values = Error(platform::errorDomain::cloud, 1);
    };
    const auto item = DRItem::initWithURL(url);
    ASSERT_TRUE(item);
    EXPECT_EQ(item->fileSize(), 5U);
    EXPECT_FALSE(item->typeIdentifier().empty());
    EXPECT_EQ(log->count("WARNING promisedItemResourceValuesForKeys failed on " + url.absoluteString()), 1U);

    decorated->decoratedItems.changePlain = decorated->decoratedItems.changePromised;
    const auto fallback = DRItem::initWithURL(url);
    ASSERT_TRUE(fallback);
    EXPECT_THAT(fallback->typeIdentifier(), IsEmpty());
}

TEST_F(RecordFaultTest, DoesNotTryPlainAttributesOfAMissingItem)
{
    const auto url = writeDocument("a.txt", "12345");
    decorated->decoratedItems.changePromised = [](const Url&, Result<AttributeMap>& values) {
        values = Error(FileErrorCode::NoSuchItem);
    };
    const auto item = DRItem::initWithURL(url);
    ASSERT_TRUE(item);
    EXPECT_THAT(item->typeIdentifier(), IsEmpty());
    EXPECT_THAT(log->lines(), testing::Not(testing::Contains(testing::HasSubstr("ResourceValues"))));
}

TEST_F(RecordFaultTest, HasNoRecordOfADamagedPromise)
{
    const auto url = at("lost.txt");
    items_tests::writeFile(host::drive::PromiseRecord::pathFor(url.path()), "{ no promise");
    EXPECT_FALSE(DRItem::initWithURL(url));
    EXPECT_EQ(log->count("WARNING promisedItemResourceValuesForKeys failed on " + url.absoluteString()), 1U);
}

TEST_F(RecordFaultTest, StaysClearedWhenAReadingIsRefused)
{
    const auto url = writeDocument("a.txt", "12345");
    coordinator->refusal = Error(platform::errorDomain::system, 11);
    const auto item = DRItem::initWithURL(url);
    ASSERT_TRUE(item);
    EXPECT_THAT(item->localizedName(), IsEmpty());
    EXPECT_EQ(item->fileSize(), std::nullopt);
    EXPECT_TRUE(item->hasHiddenExtension());
    EXPECT_EQ(item->resolvedURL(), url);
    EXPECT_FALSE(item->isPromise());
    EXPECT_FALSE(item->thumbnail());
    EXPECT_TRUE(item->thumbnailFetched());
}

TEST_F(RecordFaultTest, ReadsWhereTheCoordinatorSendsIt)
{
    const auto url = writeDocument("a.txt", "12345"), moved = writeDocument("moved.txt", "1");
    coordinator->elsewhere = moved;
    const auto item = DRItem::initWithURL(url);
    EXPECT_EQ(item->localizedName(), "moved.txt");
    EXPECT_EQ(item->fileSize(), 1U);
    EXPECT_EQ(item->resolvedURL(), url);
    EXPECT_FALSE(item->isPromise());
}

TEST_F(RecordFaultTest, EndsTheAccessesThatItBegan)
{
    const auto url = writeDocument("a.txt", "12345");
    for (const bool isNeeded : {true, false}) {
        decorated->access.isNeeded = isNeeded;
        decorated->access.started = decorated->access.stopped = 0;
        DRItem::initWithURL(url)->thumbnail();
        EXPECT_EQ(decorated->access.started, 2);
        EXPECT_EQ(decorated->access.stopped, isNeeded ? 2 : 0);
    }
    coordinator->refusal = Error(platform::errorDomain::system, 11);
    decorated->access = {};
    DRItem::initWithURL(url);
    EXPECT_EQ(decorated->access.stopped, 1);
}

} // namespace
