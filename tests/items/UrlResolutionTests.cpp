#include "items/DocumentIdentifiers.h"
#include "items/UrlResolution.h"
#include "tests/items/support/ItemsFixture.h"

#include <gmock/gmock.h>

#include <filesystem>

using namespace tarrow;
using items_tests::ItemsFixture;

namespace {

class UrlResolutionTest : public ItemsFixture { };

TEST_F(UrlResolutionTest, LeavesAPlainLocationAsItIs)
{
    for (const auto& url :
        {writeDocument("a.txt", "1"), items_tests::writeFile(at("damaged.trwref").path(), "no reference")}) {
        EXPECT_TRUE(trw_URLByResolvingBookmark(url)->isSameObject(url));
        EXPECT_TRUE(trw_URLByResolvingPromise(url).isSameObject(url));
        EXPECT_TRUE(trw_URLByResolvingAlias(url).isSameObject(url));
    }
}

TEST_F(UrlResolutionTest, TurnsAPromisesPlaceIntoTheItemsPlace)
{
    const auto item = writePromise("Notes/a.txt", {});
    const auto physical = Url::fileURL(host::drive::PromiseRecord::pathFor(item.path()));
    EXPECT_EQ(trw_URLByResolvingPromise(physical), item);
    EXPECT_EQ(trw_URLByResolvingPromise(item), item);
}

TEST_F(UrlResolutionTest, FollowsAReferenceToThePlaceWhereItsDocumentShows)
{
    const auto here = writeDocument("Notes/here.txt", "1"), away = writePromise("Notes/away.txt", {});
    const std::pair<Url, Url> rows[] = {
        {writeReference("here.trwref", "BrindleDefault", "Notes/here.txt"), here},
        {writeReference("away.trwref", "BrindleDefault", "Notes/away.txt"), away},
        {writeReference("placeholder.trwref", "BrindleDefault", "Notes/.away.txt.trwpromise"), away},
    };
    for (const auto& [reference, target] : rows) {
        EXPECT_EQ(trw_URLByResolvingBookmark(reference), target);
        EXPECT_EQ(trw_URLByResolvingAlias(reference), target);
    }
}

TEST_F(UrlResolutionTest, KnowsTheTwoSpecialFolders)
{
    makeFolder("Documents/Documents");
    makeFolder("Desktop");
    makeFolder("Notes/Desktop");
    makeFolder("documents");
    const auto sketches = makeContainer("sketches");
    std::filesystem::create_directories(sketches.path() + "/Documents");
    EXPECT_TRUE(trw_isDesktopOrDocumentsFolder(at("Documents")));
    EXPECT_TRUE(trw_isDesktopOrDocumentsFolder(at("Desktop")));
    for (const auto& other : {at("Documents/Documents"), at("Notes/Desktop"), at("documents"), root(),
             sketches, sketches.appendingPathComponent("Documents"), Url::fileURL("/Documents")})
        EXPECT_FALSE(trw_isDesktopOrDocumentsFolder(other)) << other.path();
}

TEST_F(UrlResolutionTest, OffersOtherContainersOnlyWhereTheFirstItemMayGo)
{
    const auto item = writeDocument("a.txt", "1");
    EXPECT_FALSE(trw_canCrossZoneMoveURLs({item})); // there is no other container yet
    makeContainer("sketches");
    EXPECT_TRUE(trw_canCrossZoneMoveURLs({item, Url::fileURL("/outside")}));
    EXPECT_FALSE(trw_canCrossZoneMoveURLs({Url::fileURL("/outside"), item}));
    EXPECT_FALSE(trw_canCrossZoneMoveURLs({}));
}

class DocumentIdentifierTest : public ItemsFixture {
protected:
    /// Gives a document the identifier 4711 and notes that it lies at a path of the drive.
    void identify(const Url& url, const std::string& path) const
    {
        mark(url, host::drive::itemMark::documentIdentifier, "4711");
        host::drive::DocumentIndex(layout().index()).note(4711, "documents/BrindleDefault/" + path);
    }
};

TEST_F(DocumentIdentifierTest, AnswersNothingForWhatIsNoIdentifier)
{
    EXPECT_EQ(trw_URLFromDocumentID(std::nullopt), std::nullopt);
    EXPECT_EQ(log->count("ERROR trw_URLFromDocumentID: missing document ID"), 1U);
    log->clear();
    for (const std::string text : {"", "  ", "x7", "-7", "+7"})
        EXPECT_EQ(trw_URLFromDocumentID(text), std::nullopt) << text;
    EXPECT_THAT(log->lines(), testing::IsEmpty());
}

TEST_F(DocumentIdentifierTest, FollowsADocumentThatMoves)
{
    const auto url = writeDocument("a.txt", "1");
    identify(url, "a.txt");
    EXPECT_EQ(trw_DocumentID(url), 4711);
    EXPECT_EQ(trw_DocumentID(writeDocument("b.txt", "1")), 0);
    EXPECT_EQ(trw_URLFromDocumentID("4711"), url);
    EXPECT_EQ(trw_URLFromDocumentID(" \t4711 and more"), url);

    makeFolder("Notes");
    std::filesystem::rename(url.path(), at("Notes/renamed.txt").path());
    writeDocument("a.txt", "another");
    EXPECT_EQ(trw_URLFromDocumentID("4711"), std::nullopt);
    identify(at("Notes/renamed.txt"), "Notes/renamed.txt");
    EXPECT_EQ(trw_URLFromDocumentID("4711"), at("Notes/renamed.txt"));
}

TEST_F(DocumentIdentifierTest, FindsNothingWhileSignedOut)
{
    identify(writeDocument("a.txt", "1"), "a.txt");
    signOut();
    EXPECT_EQ(trw_URLFromDocumentID("4711"), std::nullopt);
    EXPECT_EQ(log->count("ERROR could not get device ID"), 1U);
}

TEST_F(DocumentIdentifierTest, RefusesADocumentThatSaysItIsAnother)
{
    identify(writeDocument("a.txt", "1"), "a.txt");
    changeValues([](const Url&, AttributeMap& values) {
        values.set(AttributeKey::DocumentIdentifier, std::uint64_t{12});
    });
    EXPECT_EQ(trw_URLFromDocumentID("4711"), std::nullopt);
    EXPECT_EQ(log->count("ERROR document IDs didn't match (12 v/s 4711)"), 1U);
}

TEST_F(DocumentIdentifierTest, NeverCutsANumberToSize)
{
    identify(writeDocument("a.txt", "1"), "a.txt");
    for (const std::string text : {"4294972007", "18446744073709551616004711", "4712", "0"})
        EXPECT_EQ(trw_URLFromDocumentID(text), std::nullopt) << text;
    EXPECT_EQ(log->count("ERROR VXLibraryResolveDocumentId2 failed, errno:2(No such file or directory)"), 4U);
}

} // namespace
