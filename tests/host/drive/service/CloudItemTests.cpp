// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/identity/Bookmark.h"
#include "host/drive/records/ItemFacts.h"
#include "tests/support/DriveFixture.h"

namespace {

using host::drive::Bookmark;
using platform::Url;
using testing_support::DriveFixture;

class CloudItemTests : public testing::Test {
protected:
    platform::CloudItems& items() { return _drive.cloud->items(); }
    /// Asks for an answer that comes in the background.
    template <typename T>
    platform::Result<T> answer(const std::function<void(std::function<void(platform::Result<T>)>)>& ask)
    {
        std::vector<platform::Result<T>> answers;
        ask([&](platform::Result<T> answer) { answers.push_back(std::move(answer)); });
        EXPECT_TRUE(answers.empty()) << "the caller is not made to wait for the disk";
        _drive.settle();
        EXPECT_EQ(answers.size(), 1U);
        return answers.empty() ? platform::Result<T>() : answers.front();
    }
    platform::Result<Url> decode(const std::string& text)
    {
        return answer<Url>([&](auto answered) { items().decodeBookmark(text, answered); });
    }
    platform::Result<std::string> make(const Url& url)
    {
        return answer<std::string>(
            [&](auto answered) { items().RZBookmarkableStringFromDocumentURL(url, answered); });
    }
    Url identified(std::string_view name, const char* identifier)
    {
        const auto url = _drive.writeDocument(name);
        _drive.mark(url, host::drive::itemMark::documentIdentifier, identifier);
        return url;
    }

    DriveFixture _drive;
    const Bookmark _bookmark{"account-1", "BrindleDefault", "Documents/a.txt", 0};
};

TEST_F(CloudItemTests, whatLiesInTheDriveAndInItsTrash)
{
    const auto home = _drive.layout().home();
    const auto document = _drive.writeDocument("Documents/a.txt");
    _drive.folder().write("drive/documents-evil/a.txt", "");
    _drive.folder().write("outside/a.txt", "");
    _drive.folder().write("drive/trash/a.txt", "");
    _drive.writeLink("inner", "second");
    _drive.writeLink("second", "Documents/../Documents");
    _drive.writeLink("dangling", "Documents/gone/deeper");
    _drive.writeLink("outer", _drive.folder().at("outside"));
    _drive.writeLink("loop", "loop");
    _drive.writeLink("toTrash", home + "/trash");
    std::filesystem::create_directory_symlink(
        home + "/documents/BrindleDefault", _drive.folder().at("entrance"));
    const auto drive = home + "/documents/BrindleDefault";
    const struct {
        std::string path;
        bool isInDrive, isInTrash;
    } rows[] = {
        {home + "/documents", true, false},
        {drive + "/Documents/a.txt", true, false},
        {drive + "/Documents/not there/at all", true, false},
        {drive + "/inner/a.txt", true, false},
        {drive + "/inner", true, false},
        {drive + "/outer", true, false}, // the link itself lies in the drive
        {drive + "/outer/a.txt", false, false},
        {drive + "/loop/a.txt", false, false},
        {drive + "/Documents/../../../outside", false, false},
        {drive + "/Documents/../Documents/a.txt", true, false},
        {drive + "/not there/../../../../outside/a.txt", false, false},
        {drive + "/toTrash/a.txt", false, true},
        {home + "/documents-evil/a.txt", false, false},
        {home + "/trash/a.txt", false, true},
        {home + "/trash", false, true},
        {home + "/account.json", false, false},
        {_drive.folder().at("entrance/Documents/a.txt"), true, false},
        {"/", false, false},
    };
    for (const auto& row : rows) {
        const auto url = Url::fileURL(row.path);
        EXPECT_EQ(items().isInDocumentsArea(url), row.isInDrive) << row.path;
        EXPECT_EQ(items().isInTrash(url), row.isInTrash) << row.path;
    }
    const auto page = Url::parse("https://example.org" + drive);
    EXPECT_FALSE(items().isInDocumentsArea(*page));
    EXPECT_EQ(items().realURL(_drive.url("inner/a.txt")), document);
    EXPECT_EQ(items().realURL(_drive.url("dangling/x")), _drive.url("Documents/gone/deeper/x"));
    EXPECT_EQ(items().realURL(_drive.url("loop/x")), _drive.url("loop/x"));
    EXPECT_EQ(items().realURL(Url::fileURL("/")), Url::fileURL("/"));
    EXPECT_TRUE(items().realURL(document).isSameObject(document));
}

TEST_F(CloudItemTests, aPathFromOutsideIsReadAsTheSystemReadsIt)
{
    _drive.writeDocument("Notes/Trips/a.txt");
    _drive.makeFolder("Desktop");
    _drive.writeLink("Desktop/link", "../Notes/Trips");
    const auto drive = _drive.layout().defaultContainer();
    const struct {
        const char* path;
        const char* location; // empty: there is none
    } rows[] = {
        {"/Desktop/link/../a.txt", "/Notes/a.txt"}, // not /Desktop/a.txt
        {"/Desktop/link/..", "/Notes"},
        {"/Notes/../Desktop/link", "/Desktop/link"},
        {"/Desktop/link/a.txt", "/Desktop/link/a.txt"},
        {"/Desktop/./link/./a.txt", "/Desktop/link/a.txt"},
        {"/gone/../Desktop", ""},
        {"/Notes/Trips/a.txt/..", ""},
    };
    for (const auto& row : rows) {
        const auto url = items().urlOfPath(drive + row.path);
        EXPECT_EQ(url ? url->path() : "", *row.location ? drive + row.location : "") << row.path;
    }
    EXPECT_EQ(items().urlOfPath("/../.."), Url::fileURL("/"));
}

TEST_F(CloudItemTests, bookmarksLeadToTheirDocument)
{
    const auto document = identified("Documents/a.txt", "7");
    EXPECT_EQ(Bookmark::decode(_bookmark.encoded()), _bookmark);
    EXPECT_EQ(decode(_bookmark.encoded()).value, document);

    auto withIdentifier = _bookmark;
    withIdentifier.documentIdentifier = 7;
    EXPECT_EQ(decode(withIdentifier.encoded()).value, document) << "found by its place: nothing is indexed";
    identified("Documents/a.txt", "8");
    EXPECT_TRUE(decode(withIdentifier.encoded()).error) << "the place holds another document now";

    auto promised = _bookmark;
    promised.path = "Documents/مهم.txt";
    EXPECT_EQ(decode(promised.encoded()).error.has_value(), true);
    EXPECT_EQ(decode(promised.encoded()).value, std::nullopt);
    const auto url = _drive.writePromise(promised.path, {});
    EXPECT_EQ(decode(promised.encoded()).value, url);
}

TEST_F(CloudItemTests, anyOtherTextIsNoBookmark)
{
    _drive.writeDocument("Documents/a.txt");
    const auto whole = _bookmark.encoded();
    for (std::size_t length = 0; length < whole.size(); ++length)
        EXPECT_TRUE(decode(whole.substr(0, length)).error) << length;
    for (const auto& text : {whole + "=", whole + "A", " " + whole, whole + "\n", whole + "/",
             std::string("+/+/"), std::string(Bookmark::maximumLength + 1, 'A'), std::string(4'000'000, 'e')})
        EXPECT_TRUE(decode(text).error) << text.substr(0, 60);

    for (std::size_t at = 0; at < whole.size(); ++at) {
        auto changed = whole;
        changed[at] = changed[at] == 'A' ? 'B' : 'A';
        const auto bookmark = Bookmark::decode(changed);
        EXPECT_NE(bookmark, _bookmark) << at;
        if (bookmark) {
            EXPECT_EQ(Bookmark::decode(bookmark->encoded()), bookmark) << at;
        }
    }

    auto damaged = _bookmark;
    for (const char* path : {"", "..", "../a", "a/../b", "/etc/passwd", "a//b", "."}) {
        damaged.path = path;
        EXPECT_FALSE(Bookmark::decode(damaged.encoded())) << path;
    }
    for (const char* container : {"", "..", "a/b"}) {
        damaged = _bookmark;
        damaged.container = container;
        EXPECT_FALSE(Bookmark::decode(damaged.encoded())) << container;
    }
}

TEST_F(CloudItemTests, bookmarksOfOthersAndOfPlacesOutsideAreRefused)
{
    _drive.writeDocument("Documents/a.txt");
    auto foreign = _bookmark;
    foreign.account = "account-2";
    EXPECT_TRUE(decode(foreign.encoded()).error);
    _drive.folder().write("outside/a.txt", "");
    _drive.writeLink("outer", _drive.folder().at("outside"));
    auto outside = _bookmark;
    outside.path = "outer/a.txt";
    auto missing = _bookmark;
    missing.path = "gone.txt";
    const auto outsideError = decode(outside.encoded()).error, missingError = decode(missing.encoded()).error;
    ASSERT_TRUE(outsideError && missingError);
    EXPECT_EQ(*outsideError, *missingError) << "nothing is told of what lies outside";
    _drive.signOut();
    EXPECT_TRUE(decode(_bookmark.encoded()).error);
}

TEST_F(CloudItemTests, bookmarksNameADocumentForOtherDevices)
{
    _drive.makeContainer("app.example.Notes");
    host::drive::PromiseRecord promise;
    promise.documentIdentifier = 9;
    const Url rows[] = {
        _drive.writeDocument("Documents/a.txt"),
        identified("Documents/Süß & salzig.txt", "7"),
        _drive.writePromise("Documents/promised.txt", promise),
        Url::fileURL(_drive.layout().containerDocuments("app.example.Notes") + "/note.txt"),
        _drive.writeDocument("Documents/\xff.txt"),
    };
    std::ofstream(rows[3].path()) << "note";
    for (const auto& document : rows) {
        const auto text = make(document);
        ASSERT_TRUE(text) << document.path();
        EXPECT_EQ(decode(*text).value, document);
    }
    _drive.writeLink("way", "Documents");
    EXPECT_EQ(decode(*make(_drive.url("way/a.txt"))).value, rows[0]) << "the place without the link";
}

TEST_F(CloudItemTests, bookmarksOutliveMovesAndNewNames)
{
    const auto document = _drive.writeDocument("Documents/a.txt");
    const auto text = make(document);
    ASSERT_TRUE(text);
    const auto here = _drive.url("Desktop/b.txt"), elsewhere = _drive.url("Desktop/Folder/c.txt");
    EXPECT_FALSE(_drive.cloud->fileChanges()->moveItem(document.path(), here.path()));
    EXPECT_EQ(decode(*text).value, here);
    _drive.makeFolder("Desktop/Folder");
    std::filesystem::rename(here.path(), elsewhere.path());
    _drive.writeDocument("Documents/a.txt", "another document in the old place");
    EXPECT_EQ(decode(*text).value, elsewhere) << "moved by another program";
    EXPECT_EQ(make(elsewhere).value.has_value(), true);
}

TEST_F(CloudItemTests, bookmarksAreNotMadeOfWhatNoOtherDeviceCanOpen)
{
    const auto outside = _drive.folder().write("outside/a.txt", "");
    _drive.writeLink("outer", _drive.folder().at("outside"));
    _drive.makeContainer("app.example.Notes");
    const auto container = _drive.layout().container("app.example.Notes");
    std::ofstream(container + "/settings.json") << "{}";
    const std::string name(200, 'n');
    auto deep = std::string("Documents");
    for (int i = 0; i < 16; ++i)
        deep += '/' + name;
    const Url rows[] = {
        Url::fileURL(outside),
        _drive.url("outer/a.txt"),
        _drive.url("Documents/not there.txt"),
        Url::fileURL(_drive.layout().trash() + "/a.txt"),
        Url::fileURL(_drive.layout().account()),
        _drive.layout().documentsURL(),
        _drive.layout().defaultContainerURL(),
        Url::fileURL(container + "/settings.json"),
        _drive.writeDocument(deep + "/a.txt"),
        *Url::parse("https://example.org/a.txt"),
    };
    for (const auto& url : rows) {
        const auto text = make(url);
        ASSERT_TRUE(text.error) << url.path();
        EXPECT_EQ(text.error->domain(), platform::errorDomain::cloud);
        EXPECT_EQ(text.error->code(), platform::notBookmarkableCode) << url.path();
    }
    const auto document = _drive.writeDocument("Documents/a.txt");
    _drive.signOut();
    EXPECT_EQ(make(document).error->code(), platform::notBookmarkableCode);
}

} // namespace
