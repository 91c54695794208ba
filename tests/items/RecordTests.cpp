// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/DRItem.h"
#include "platform/TypeRegistry.h"
#include "tests/items/support/ItemsFixture.h"

#include <gmock/gmock.h>

#include <filesystem>

using namespace tarrow;
using host::drive::PromiseRecord;
using items_tests::ItemsFixture;
using testing::ElementsAre;
using testing::IsEmpty;

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

TEST_F(RecordTest, ReadsALocalFile)
{
    const auto url = writeDocument("a file.txt", "12345");
    const auto item = DRItem::initWithURL(url);
    ASSERT_TRUE(item);
    EXPECT_EQ(item->fileSize(), 5U);
    EXPECT_FALSE(item->localizedTypeDescription().empty());
    EXPECT_TRUE(item->renameable());
    EXPECT_FALSE(item->isDirectory());
    EXPECT_FALSE(item->isPackage());
    EXPECT_FALSE(item->isContainer());
    EXPECT_FALSE(item->isSymlink());
    EXPECT_FALSE(item->isBookmark());
    EXPECT_FALSE(item->isPromise());
    EXPECT_TRUE(item->promiseURL()->isSameObject(*item->resolvedURL()));
    EXPECT_EQ(item->description(),
        "Name=a file.txt, Size=5, URL=" + url.absoluteString()
            + ", ResURL=<same>, PromiseURL=<same>, Local,");
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

TEST_F(RecordTest, LogsWhatItCannotSum)
{
    EXPECT_EQ(DRItem::sizeOfPackage(std::nullopt), 0U);
    EXPECT_EQ(log->count("ERROR sizeOfPackage: null URL"), 1U);
    EXPECT_EQ(DRItem::sizeOfPackage(at("missing")), 0U);
    EXPECT_THAT(log->lines(),
        testing::Contains(testing::StartsWith("INFO Error enumerating " + at("missing").absoluteString())));
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

TEST_F(RecordTest, FollowsALinkToItsEnd)
{
    const auto target = writeDocument("Notes/target.txt", "1");
    for (const auto& destination : {std::string("target.txt"), target.path()}) {
        const auto link = at("Notes/link");
        std::filesystem::remove(link.path());
        std::filesystem::create_symlink(destination, link.path());
        const auto item = DRItem::initWithURL(link);
        ASSERT_TRUE(item) << destination;
        EXPECT_TRUE(item->isSymlink());
        EXPECT_EQ(item->localizedName(), "link");
        EXPECT_EQ(item->resolvedURL(), target);
        EXPECT_THAT(item->description(), testing::EndsWith("Symlink, "));
    }
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

TEST_F(RecordTest, WarnsThatAPromisedAliasIsNotFollowed)
{
    const auto url = writePromise("pointer.trwalias", promise(100));
    EXPECT_TRUE(DRItem::initWithURL(url)->isSymlink());
    EXPECT_EQ(log->count("WARNING Pathwell Alias is promised -- unable to determine target without "
                         "downloading: "
                  + url.absoluteString()),
        1U);
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

TEST_F(RecordTest, IsNotBuiltForWhatIsNotThere)
{
    const auto url = at("gone.txt");
    EXPECT_FALSE(DRItem::initWithURL(url));
    EXPECT_EQ(log->count("ERROR Failed to cache values for URL " + url.absoluteString()), 1U);
}

TEST_F(RecordTest, IsNotBuiltWithoutAUrl)
{
    try {
        DRItem::init();
        FAIL() << "a record without a URL was built";
    } catch (const std::invalid_argument& error) {
        EXPECT_STREQ(error.what(), "Don't call -[DRItem init].");
    }
}

TEST_F(RecordTest, FormatsDatesWithTheShortTime)
{
    const auto item = DRItem::initWithURL(writePromise("a.txt", promise(1)));
    EXPECT_EQ(item->friendlyCreationDate(DateStyle::Long),
        services().formatters().date(*item->creationDate(), DateStyle::Long, DateStyle::Short));
    item->setContentModificationDate(std::nullopt);
    EXPECT_EQ(item->friendlyContentModificationDate(DateStyle::Long), std::nullopt);
}

} // namespace
