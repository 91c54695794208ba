// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/DocumentID.h"
#include "items/UrlResolution.h"
#include "tests/items/support/ItemsFixture.h"

using namespace tarrow;
using items_tests::ItemsFixture;

namespace {

class UrlResolutionTest : public ItemsFixture { };

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
    for (const std::string way :
        {"/./Desktop", "/Desktop/.", "/Notes/../Desktop", "/../BrindleDefault/Desktop/"})
        EXPECT_TRUE(trw_isDesktopOrDocumentsFolder(Url::fileURL(root().path() + way))) << way;
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
    /// Answers the identifier of a document as text.
    std::string identify(const Url& url) const
    {
        return std::to_string(DriveFixture::cloud->documentIdentifiers().identify(url).value.value_or(0));
    }
};

TEST_F(DocumentIdentifierTest, IsTheNumberAtTheStartOfAText)
{
    const auto url = writeDocument("a.txt", "1");
    EXPECT_EQ(trw_DocumentID(url), 0) << "it is read, not given";
    const auto identifier = identify(url);
    EXPECT_EQ(std::to_string(trw_DocumentID(url)), identifier);
    EXPECT_EQ(trw_URLFromDocumentID(" \t" + identifier + " and more"), url);
}

TEST_F(DocumentIdentifierTest, FindsNothingWhileSignedOut)
{
    const auto identifier = identify(writeDocument("a.txt", "1"));
    signOut();
    EXPECT_EQ(trw_URLFromDocumentID(identifier), std::nullopt);
    EXPECT_EQ(log->count("ERROR could not get device ID"), 1U);
    signIn("Mira");
    EXPECT_EQ(trw_URLFromDocumentID(identifier), at("a.txt")) << "the look at the device is taken again";
}

TEST_F(DocumentIdentifierTest, SaysWhichStepFailed)
{
    auto& hooks = decorated->decoratedIdentifiers;
    const auto remove = [&] { std::filesystem::remove(at("a.txt").path()); };
    const struct {
        std::function<void()> beforeLooking, beforeOpening, beforeReading;
        std::string message;
    } rows[] = {
        {remove, {}, {}, "VXLibraryResolveDocumentId2 failed, errno:2(No such file or directory)"},
        {{}, remove, {}, "openDocument failed, errno:2(No such file or directory)"},
        {{}, [&] { remove(), writeLink("a.txt", "/etc/hostname"); }, {},
            "openDocument failed, errno:40(Too many levels of symbolic links)"},
        {{}, {}, remove, "readAttributes failed, error:2(No such file or directory)"},
        {{}, {}, [&] { std::filesystem::rename(at("a.txt").path(), layout().home() + "/out"); },
            "readAttributes failed, error:18(Invalid cross-device link)"},
        {{}, {}, [&] { mark(at("a.txt"), host::drive::itemMark::documentIdentifier, "12"); },
            "document IDs didn't match (12 v/s "},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.message);
        hooks.beforeOpening = hooks.beforeReading = nullptr;
        const auto identifier = identify(writeDocument("a.txt", "1"));
        log->clear();
        if (row.beforeLooking)
            row.beforeLooking();
        hooks.beforeOpening = row.beforeOpening;
        hooks.beforeReading = row.beforeReading;
        EXPECT_EQ(trw_URLFromDocumentID(identifier), std::nullopt);
        EXPECT_THAT(log->lines(), testing::ElementsAre(testing::StartsWith("ERROR " + row.message)));
        std::filesystem::remove(at("a.txt").path());
    }
}

TEST_F(DocumentIdentifierTest, FindsNothingByWhatIsNoIdentifierAndCutsNoNumberToSize)
{
    const auto identifier = std::stoull(identify(writeDocument("a.txt", "1")));
    EXPECT_EQ(trw_URLFromDocumentID(std::nullopt), std::nullopt);
    EXPECT_EQ(log->count("ERROR trw_URLFromDocumentID: missing document ID"), 1U);
    log->clear();
    for (const std::string text : {"", "  ", "x7", "-7", "+7"})
        EXPECT_EQ(trw_URLFromDocumentID(text), std::nullopt) << text;
    EXPECT_THAT(log->lines(), testing::IsEmpty());
    for (const std::string& text : {std::to_string((std::uint64_t{1} << 32) + identifier),
             "18446744073709551616" + std::to_string(identifier), std::to_string(identifier ^ 1),
             std::string("0")})
        EXPECT_EQ(trw_URLFromDocumentID(text), std::nullopt) << text;
    EXPECT_EQ(log->count("ERROR VXLibraryResolveDocumentId2 failed, errno:2(No such file or directory)"), 4U);
}

} // namespace
