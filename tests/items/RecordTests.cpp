// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/DRItem.h"
#include "platform/TypeRegistry.h"
#include "tests/items/support/ItemsFixture.h"

#include <sys/stat.h>

using namespace tarrow;
using host::drive::PromiseRecord;
using items_tests::ItemsFixture;
using namespace testing;

namespace {

class RecordTest : public ItemsFixture {
protected:
    PromiseRecord promise(std::uint64_t size)
    {
        PromiseRecord record;
        record.size = size;
        record.created = Date::fromSeconds(1'000'000'000);
        record.modified = Date::fromSeconds(1'100'000'000);
        return record;
    }
};

TEST_F(RecordTest, ReadsAPromiseFromWhatIsPromised)
{
    auto record = promise(1'234'567);
    record.tags = {"Red", "Work"};
    const auto url = writePromise("Notes/Plan.pdf", record);

    const auto item = DRItem::initWithURL(url);
    ASSERT_TRUE(item);
    EXPECT_EQ(item->localizedName(), "Plan.pdf");
    EXPECT_EQ(item->typeIdentifier(), services().typeRegistry().typeForExtension("pdf"));
    EXPECT_EQ(item->fileSize(), 1'234'567U);
    EXPECT_EQ(item->friendlyFileSize(),
        services().formatters().byteCount(
            1'234'567, platform::ByteCountStyle::File, platform::ByteCountUnit::Included));
    EXPECT_EQ(item->creationDate(), record.created);
    EXPECT_EQ(item->contentModificationDate(), record.modified);
    EXPECT_EQ(item->parentDirectoryURL(), at("Notes"));
    EXPECT_THAT(item->tags(), ElementsAre("Red", "Work"));
    EXPECT_TRUE(item->isPromise());
    EXPECT_FALSE(item->isDownloaded());
    EXPECT_TRUE(item->canPreview());
    EXPECT_EQ(item->resolvedURL(), url);
    EXPECT_EQ(item->promiseURL()->path(), PromiseRecord::pathFor(url.path()));
    EXPECT_EQ(item->description(),
        "Name=Plan.pdf, Size=1234567, URL=" + url.absoluteString()
            + ", ResURL=<same>, PromiseURL=" + item->promiseURL()->absoluteString() + ", Promise, ");
}

TEST_F(RecordTest, BelievesOnlyAKnownDownloadingStatus)
{
    const auto url = writeDocument("a.txt", "1");
    EXPECT_FALSE(DRItem::initWithURL(url)->isDownloaded());
    for (const std::string status : {"downloaded", "current"}) {
        mark(url, host::drive::itemMark::status, status);
        EXPECT_TRUE(DRItem::initWithURL(url)->isDownloaded()) << status;
    }
}

TEST_F(RecordTest, LetsOnlyTheOwnerOfASharedItemRename)
{
    struct Row {
        const char *shared, *role;
        bool renameable;
    };
    for (const auto& row : {Row{"1", "participant", false}, Row{"1", "owner", true}, Row{"1", "", true},
             Row{"", "participant", true}}) {
        const auto url = writeDocument("shared.txt", "1");
        mark(url, host::drive::itemMark::shared, row.shared);
        mark(url, host::drive::itemMark::role, row.role);
        EXPECT_EQ(DRItem::initWithURL(url)->renameable(), row.renameable) << row.shared << row.role;
    }
}

TEST_F(RecordTest, SumsAPackageThatHasNoSizeOfItsOwn)
{
    writeDocument("Slides.pages/Contents/a.txt", "123");
    writeDocument("Slides.pages/.hidden", "12345");
    writePromise("Slides.pages/Contents/b.txt", promise(1000));

    const auto item = DRItem::initWithURL(at("Slides.pages"));
    ASSERT_TRUE(item);
    EXPECT_TRUE(item->isPackage());
    EXPECT_FALSE(item->isDirectory());
    EXPECT_EQ(item->fileSize(), 1008U);
    EXPECT_FALSE(item->friendlyFileSize().empty());

    makeFolder("Empty.pages/Contents");
    const auto empty = DRItem::initWithURL(at("Empty.pages"));
    EXPECT_EQ(empty->fileSize(), std::nullopt);
    EXPECT_THAT(empty->friendlyFileSize(), IsEmpty());
    EXPECT_FALSE(empty->isDirectory());
}

TEST_F(RecordTest, ShowsAContainerUnderItsOwnName)
{
    const auto item =
        DRItem::initWithURL(describeContainer("sketches", R"({"names": {"en": "Sketchbook"}})"));
    ASSERT_TRUE(item);
    EXPECT_TRUE(item->isContainer());
    EXPECT_TRUE(item->isDirectory());
    EXPECT_FALSE(item->renameable());
    EXPECT_EQ(item->localizedName(), "Sketchbook");

    const auto damaged = DRItem::initWithURL(describeContainer("damaged", "no description"));
    ASSERT_TRUE(damaged);
    EXPECT_TRUE(damaged->isContainer());
    EXPECT_THAT(damaged->localizedName(), testing::Not(IsEmpty()));
}

TEST_F(RecordTest, FollowsAnAliasWhateverTheCaseOfItsKind)
{
    const auto target = writeDocument("Notes/target.txt", "1");
    const auto alias = writeAlias("pointer.trwalias", target.path());
    for (const std::string kind : {"", "aLiAs", "ALIAS"}) {
        changeValues([&](const Url&, AttributeMap& values) {
            if (!kind.empty())
                values.set(AttributeKey::LocalizedTypeDescription, kind);
        });
        const auto item = DRItem::initWithURL(alias);
        EXPECT_TRUE(item->isSymlink()) << kind;
        EXPECT_EQ(item->resolvedURL(), target) << kind;
    }
    EXPECT_THAT(log->lines(), testing::Not(testing::Contains(testing::StartsWith("WARNING"))));
}

TEST_F(RecordTest, KeepsAnAliasToNowhereWithoutATarget)
{
    const auto item = DRItem::initWithURL(writeAlias("pointer.trwalias", at("gone.txt").path()));
    ASSERT_TRUE(item);
    EXPECT_TRUE(item->isSymlink());
    EXPECT_EQ(item->resolvedURL(), std::nullopt);
    EXPECT_FALSE(item->canPreview());
    EXPECT_FALSE(item->thumbnail());
    EXPECT_THAT(log->lines(), testing::Contains(testing::StartsWith("WARNING Error resolving Alias: ")));
}

TEST_F(RecordTest, ReadsTheDocumentThatAReferenceStandsFor)
{
    const auto here = writeDocument("Notes/here.txt", "123");
    const auto item =
        DRItem::initWithURL(writeReference("here.txt.trwref", "BrindleDefault", "Notes/here.txt"));
    ASSERT_TRUE(item);
    EXPECT_TRUE(item->isBookmark());
    EXPECT_EQ(item->resolvedURL(), here);
    EXPECT_EQ(item->fileSize(), 3U);
    EXPECT_FALSE(item->isPromise());

    const auto promised = writePromise("Notes/away.txt", promise(77));
    const auto away =
        DRItem::initWithURL(writeReference("away.txt.trwref", "BrindleDefault", "Notes/away.txt"));
    ASSERT_TRUE(away);
    EXPECT_EQ(away->resolvedURL(), promised);
    EXPECT_EQ(away->fileSize(), 77U);
    EXPECT_TRUE(away->isPromise());
}

TEST_F(RecordTest, ReadsAnewOnlyForAnotherUrl)
{
    const auto first = writeDocument("first.txt", "1"), second = writeDocument("second.txt", "22");
    const auto item = DRItem::initWithURL(first);
    item->setThumbnail(Image::named("a"));
    item->setThumbnailFetched(true);
    const int reads = coordinator->reads;

    item->setUrl(Url::fileURL(first.path()));
    EXPECT_EQ(coordinator->reads, reads);
    EXPECT_TRUE(item->thumbnail());

    item->setUrl(second);
    EXPECT_EQ(item->fileSize(), 2U);
    EXPECT_FALSE(item->thumbnailFetched());

    EXPECT_TRUE(item->canPreview());
    item->setUrl(at("gone.txt"));
    EXPECT_THAT(item->localizedName(), IsEmpty());
    EXPECT_EQ(item->fileSize(), std::nullopt);
    EXPECT_TRUE(item->hasHiddenExtension());
    EXPECT_TRUE(item->canPreview());
}

TEST_F(RecordTest, IsNotBuiltForWhatIsNotThereOrWithoutAUrl)
{
    EXPECT_FALSE(DRItem::initWithURL(at("gone.txt")));
    EXPECT_EQ(log->count("ERROR Failed to cache values for URL " + at("gone.txt").absoluteString()), 1U);
    EXPECT_THAT(
        [] { DRItem::init(); }, testing::ThrowsMessage<std::invalid_argument>("Don't call -[DRItem init]."));
}

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

TEST_F(RecordFaultTest, HasNoRecordOfADamagedPromise)
{
    const auto url = at("lost.txt");
    testing_support::writeFile(host::drive::PromiseRecord::pathFor(url.path()), "{ no promise");
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
        const auto item = DRItem::initWithURL(url);
        item->thumbnail();
        settle();
        EXPECT_EQ(decorated->access.started, 2);
        EXPECT_EQ(decorated->access.stopped, isNeeded ? 2 : 0);
    }
    coordinator->refusal = Error(platform::errorDomain::system, 11);
    decorated->access = {};
    DRItem::initWithURL(url);
    EXPECT_EQ(decorated->access.stopped, 1);
}

class ThumbnailTest : public ItemsFixture {
protected:
    /// Gives every item these thumbnails, and counts the requests for them.
    void provide(ThumbnailMap map)
    {
        decorated->decoratedItems.changePromised = [this, map = std::move(map)](
                                                       const Url&, Result<AttributeMap>& values) {
            values.value.emplace();
            values.value->set(AttributeKey::ThumbnailMap, map);
            ++fetches;
        };
    }
    int fetches = 0;
};

TEST_F(ThumbnailTest, IsFetchedOnceOffTheMainThreadWhetherThereIsOneOrNot)
{
    const auto large = Image::fromPixels(2, 1, 1, {0, 0});
    const auto first = DRItem::initWithURL(writeDocument("a.png", "1"));
    const auto second = DRItem::initWithURL(writeDocument("b.png", "1"));
    std::vector<std::string> arrived;
    const auto ask = [&](const std::shared_ptr<DRItem>& item) {
        EXPECT_FALSE(item->thumbnail());
        item->whenThumbnailArrives([&arrived, item] {
            EXPECT_TRUE(item->thumbnail());
            arrived.push_back(item->localizedName());
        });
    };

    provide({{256, Image::named("small")}, {1024, large}});
    ask(first);
    ask(first);
    EXPECT_EQ(fetches, 0);
    settle();
    EXPECT_EQ(first->thumbnail(), large);
    EXPECT_THAT(arrived, testing::ElementsAre("a.png", "a.png"));
    EXPECT_EQ(log->count("DEBUG URL Thumbs: (256: 0x0, 1024: 2x1)"), 1U);

    provide({{256, Image::named("small")}});
    ask(second);
    settle();
    EXPECT_FALSE(second->thumbnail());
    EXPECT_EQ(arrived.size(), 2U) << "nobody is told of a thumbnail that there is not";
    settle();
    EXPECT_EQ(fetches, 2);
}

TEST_F(ThumbnailTest, IsNotFetchedForARecordThatEndsOrIsReadAgain)
{
    const auto other = writeDocument("b.png", "1");
    auto ended = DRItem::initWithURL(writeDocument("a.png", "1")), again = DRItem::initWithURL(other);
    provide({{1024, Image::named("large")}});
    for (const auto& item : {ended, again}) {
        EXPECT_FALSE(item->thumbnail());
        item->whenThumbnailArrives([] { FAIL() << "nobody asked for this version"; });
    }
    ended.reset();
    again->cacheValues();
    settle();
    EXPECT_EQ(fetches, 1) << "the record itself was read";
    EXPECT_FALSE(again->thumbnailFetched());
}

TEST_F(ThumbnailTest, IsInMemoryForARecordOfTheSameVersion)
{
    const auto large = Image::fromPixels(2, 1, 1, {0, 0});
    const auto url = writeDocument("a.png", "1");
    const auto first = DRItem::initWithURL(url), second = DRItem::initWithURL(url);
    std::filesystem::last_write_time(url.path(), std::filesystem::file_time_type());
    const auto changed = DRItem::initWithURL(url);
    provide({{1024, large}});
    first->thumbnail();
    settle();
    EXPECT_EQ(second->thumbnail(), large);
    EXPECT_FALSE(changed->thumbnail());
}

} // namespace
