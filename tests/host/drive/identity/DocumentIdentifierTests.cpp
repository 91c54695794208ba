// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/identity/LocalDocumentIdentifiers.h"
#include "host/drive/records/ItemFacts.h"
#include "tests/support/DriveFixture.h"

#include <sqlite3.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <random>
#include <set>

namespace {

using namespace host::drive;
using platform::Url;
using testing_support::DriveFixture;
using Kind = DocumentIndex::Answer::Kind;
namespace fs = std::filesystem;

std::optional<Url> find(platform::DocumentIdentifiers& identifiers, std::uint32_t identifier)
{
    const auto file = identifiers.resolve(identifier);
    if (!file)
        return std::nullopt;
    const auto open = identifiers.open(*file);
    if (!open)
        return std::nullopt;
    const auto found = (*open)->attributes();
    return found && found->documentIdentifier == identifier ? std::optional(found->url) : std::nullopt;
}

class DocumentIdentifierTests : public testing::Test {
protected:
    platform::DocumentIdentifiers& identifiers() { return _drive.cloud->documentIdentifiers(); }
    std::uint32_t identify(const Url& url)
    {
        const auto identifier = identifiers().identify(url);
        EXPECT_TRUE(identifier) << url.path();
        return identifier.value.value_or(0);
    }
    std::optional<Url> find(std::uint32_t identifier) { return ::find(identifiers(), identifier); }
    Url document(const std::string& path = "Documents/a.txt") { return _drive.writeDocument(path, path); }
    std::string indexedPath(std::uint32_t identifier) const
    {
        return DocumentIndex(_drive.layout().index()).lookUp(identifier).place.path;
    }
    void move(const std::string& from, const std::string& to)
    {
        ASSERT_EQ(_drive.cloud->fileChanges()->moveItem(at(from), at(to)), std::nullopt);
    }
    void remove(const std::string& path)
    {
        ASSERT_EQ(_drive.cloud->fileChanges()->removeItem(at(path), std::nullopt), std::nullopt);
    }
    void evict(const std::string& path)
    {
        ASSERT_EQ(_drive.cloud->fileChanges()->evictItem(at(path)), std::nullopt);
    }
    void moveByOthers(const std::string& from, const std::string& to) { fs::rename(at(from), at(to)); }
    /// Copies a file with its attributes, as other programs do.
    void copyByOthers(const std::string& from, const std::string& to)
    {
        const auto identifier = host::drive::documentIdentifierAt(at(from));
        fs::copy_file(at(from), at(to));
        _drive.mark(_drive.url(to), host::drive::itemMark::documentIdentifier, std::to_string(identifier));
    }
    std::string at(const std::string& path) const { return _drive.url(path).path(); }

    DriveFixture _drive;
};

TEST_F(DocumentIdentifierTests, anIdentifierIsGivenOnceAndToOneItem)
{
    host::drive::PromiseRecord promise;
    promise.size = 12;
    promise.tags = {"Red"};
    _drive.writeLink("way", "Documents");
    const Url items[] = {document(), document("Documents/\xff.txt"),
        _drive.makeFolder("Documents/Album.album"), _drive.writePromise("Documents/promised.txt", promise)};
    std::set<std::uint32_t> given;
    for (const auto& item : items) {
        const auto identifier = identify(item);
        EXPECT_TRUE(given.insert(identifier).second);
        EXPECT_EQ(identify(item), identifier) << item.path();
        EXPECT_EQ(find(identifier), item);
    }
    EXPECT_EQ(identify(_drive.url("way/a.txt")), identify(items[0]));
    EXPECT_FALSE(fs::exists(items[3].path()));
    EXPECT_EQ(_drive.cloud->promisedItems().readItem(items[3], {}).tagNames, promise.tags) << "kept";

    _drive.writeLink("link", "Documents/a.txt");
    const auto outside = _drive.folder().write("outside.txt", "");
    for (const auto& url : {_drive.url("link"), _drive.url("missing"), Url::fileURL(outside),
             _drive.layout().documentsURL(), *Url::parse("https://example.org/a")})
        EXPECT_TRUE(identifiers().identify(url).error) << url.path();
    EXPECT_EQ(host::drive::documentIdentifierAt(outside), 0U);
}

TEST_F(DocumentIdentifierTests, aDocumentIsFoundWhereverItWentUnlessItIsGone)
{
    const struct {
        const char* name;
        std::function<void()> happening;
        const char* place; ///< null when it is gone
    } rows[] = {
        {"renamed", [&] { move("F/a.txt", "F/b.txt"); }, "F/b.txt"},
        {"moved with its folder", [&] { move("F", "Desktop/G"); }, "Desktop/G/a.txt"},
        {"evicted", [&] { evict("F/a.txt"); }, "F/a.txt"},
        {"evicted and moved", [&] { evict("F/a.txt"), move("F/a.txt", "b.txt"); }, "b.txt"},
        {"renamed by others", [&] { moveByOthers("F/a.txt", "F/b.txt"); }, "F/b.txt"},
        {"moved by others", [&] { moveByOthers("F/a.txt", "Desktop/b.txt"); }, "Desktop/b.txt"},
        {"moved with its folder by others", [&] { moveByOthers("F", "Desktop/G"); }, "Desktop/G/a.txt"},
        {"moved by others, another one in its place",
            [&] { moveByOthers("F/a.txt", "b.txt"), document("F/a.txt"); }, "b.txt"},
        {"moved by others, a copy in its place",
            [&] { moveByOthers("F/a.txt", "b.txt"), copyByOthers("b.txt", "F/a.txt"); }, "b.txt"},
        {"moved by others out of a folder that is then removed",
            [&] { moveByOthers("F/a.txt", "b.txt"), remove("F"); }, "b.txt"},
        {"saved by replacing it", [&] { copyByOthers("F/a.txt", "F/tmp"), moveByOthers("F/tmp", "F/a.txt"); },
            "F/a.txt"},
        {"moved to another disk and back",
            [&] { copyByOthers("F/a.txt", "b.txt"), fs::remove(at("F/a.txt")); }, "b.txt"},
        {"promise moved by others",
            [&] { evict("F/a.txt"), moveByOthers("F/.a.txt.trwpromise", ".b.txt.trwpromise"); }, "b.txt"},
        {"removed", [&] { remove("F/a.txt"); }, nullptr},
        {"removed with its folder", [&] { remove("F"); }, nullptr},
        {"removed, a copy left", [&] { copyByOthers("F/a.txt", "b.txt"), remove("F/a.txt"); }, nullptr},
        {"removed by others", [&] { fs::remove(at("F/a.txt")); }, nullptr},
        {"saved in the same way, the document itself in the trash",
            [&] {
                fs::create_directories(_drive.layout().trash());
                fs::rename(at("F/a.txt"), _drive.layout().trash() + "/kept");
                document("F/a.txt");
            },
            nullptr},
        {"removed, a new file in its place", [&] { remove("F/a.txt"), document("F/a.txt"); }, nullptr},
        {"moved out of the drive, a link to it in its place",
            [&] {
                fs::rename(at("F/a.txt"), _drive.folder().at("out.txt"));
                _drive.writeLink("F/a.txt", _drive.folder().at("out.txt"));
            },
            nullptr},
        {"another file by its inode",
            [&] { _drive.mark(_drive.url("F/a.txt"), host::drive::itemMark::documentIdentifier, "7"); },
            nullptr},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.name);
        const auto identifier = identify(document("F/a.txt"));
        row.happening();
        const auto place = row.place ? std::optional(_drive.url(row.place)) : std::nullopt;
        EXPECT_EQ(find(identifier), place);
        _drive.settle();
        if (place) {
            EXPECT_EQ(indexedPath(identifier), "documents/BrindleDefault/" + std::string(row.place));
        }
        EXPECT_EQ(find(identifier), place);
        for (const char* rest : {"F", "Desktop/G", "b.txt", ".b.txt.trwpromise", "Desktop/b.txt"})
            fs::remove_all(at(rest));
    }
}

TEST_F(DocumentIdentifierTests, aNewFileInItsPlaceInheritsTheIdentifier)
{
    const auto identifier = identify(document("F/a.txt"));
    const auto save = [&] { document("F/tmp"), moveByOthers("F/tmp", "F/a.txt"); };
    save();
    EXPECT_EQ(find(identifier), std::nullopt) << "the main thread does not look at everything";
    _drive.settle();
    EXPECT_EQ(find(identifier), _drive.url("F/a.txt"));
    save();
    EXPECT_EQ(identify(_drive.url("F/a.txt")), identifier);
    evict("F/a.txt");
    document("F/b.txt");
    moveByOthers("F/b.txt", "F/a.txt");
    EXPECT_NE(identify(_drive.url("F/a.txt")), identifier) << "the promise carries it";
}

TEST_F(DocumentIdentifierTests, aCopyGetsAnIdentifierOfItsOwn)
{
    const struct {
        const char* name;
        std::function<void()> happening;
        const char *original, *copy;
    } rows[] = {
        {"beside it", [&] { copyByOthers("F/a.txt", "F/b.txt"); }, "F/a.txt", "F/b.txt"},
        {"the original moved by others",
            [&] { copyByOthers("F/a.txt", "F/b.txt"), moveByOthers("F/a.txt", "c.txt"); }, "c.txt",
            "F/b.txt"},
        {"in its place", [&] { moveByOthers("F/a.txt", "c.txt"), copyByOthers("c.txt", "F/a.txt"); }, "c.txt",
            "F/a.txt"},
        {"the original evicted", [&] { copyByOthers("F/a.txt", "F/b.txt"), evict("F/a.txt"); }, "F/a.txt",
            "F/b.txt"},
        {"the index lost",
            [&] {
                copyByOthers("F/a.txt", "F/b.txt");
                for (const char* suffix : {"", "-wal", "-shm"})
                    fs::remove(_drive.layout().index() + suffix);
            },
            "F/a.txt", "F/b.txt"},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.name);
        const auto identifier = identify(document("F/a.txt"));
        row.happening();
        const auto copys = identify(_drive.url(row.copy));
        EXPECT_NE(copys, identifier);
        EXPECT_EQ(find(identifier), _drive.url(row.original));
        EXPECT_EQ(find(copys), _drive.url(row.copy));
        EXPECT_EQ(identify(_drive.url(row.original)), identifier);
        fs::remove_all(at("F"));
        fs::remove(at("c.txt"));
    }
    const auto identifier = identify(document("F/a.txt"));
    copyByOthers("F/a.txt", "F/b.txt");
    remove("F/a.txt");
    EXPECT_NE(identify(_drive.url("F/b.txt")), identifier)
        << "the number of a removed document stays its own";
}

TEST_F(DocumentIdentifierTests, anItemThatIsReadCorrectsTheIndex)
{
    const auto identifier = identify(document());
    moveByOthers("Documents/a.txt", "Desktop/b.txt");
    const auto read = [&](const char* path) {
        _drive.cloud->promisedItems().readItem(_drive.url(path), {});
        _drive.settle();
    };
    read("Desktop/b.txt");
    EXPECT_EQ(indexedPath(identifier), "documents/BrindleDefault/Desktop/b.txt");
    copyByOthers("Desktop/b.txt", "Desktop/copy.txt");
    read("Desktop/copy.txt");
    EXPECT_EQ(indexedPath(identifier), "documents/BrindleDefault/Desktop/b.txt")
        << "a copy is not the document";
    remove("Desktop/b.txt");
    read("Desktop/copy.txt");
    EXPECT_EQ(find(identifier), std::nullopt);
}

TEST_F(DocumentIdentifierTests, aDeepSearchEndsInTheBackground)
{
    const auto identifier = identify(document());
    for (int i = 0; i < 11'000; ++i)
        std::ofstream(at("Documents/" + std::to_string(i)));
    _drive.makeFolder("Documents/z");
    moveByOthers("Documents/a.txt", "Documents/z/a.txt");
    EXPECT_EQ(find(identifier), std::nullopt) << "the main thread does not look at everything";
    _drive.settle();
    EXPECT_EQ(find(identifier), _drive.url("Documents/z/a.txt"));
}

TEST_F(DocumentIdentifierTests, aLinkInPlaceOfTheFolderIsNotFollowed)
{
    const auto identifier = identify(document("F/a.txt"));
    moveByOthers("F", "G");
    _drive.writeLink("F", "G");
    EXPECT_EQ(find(identifier), std::nullopt);
    _drive.settle();
    EXPECT_EQ(find(identifier), _drive.url("G/a.txt"));
}

class DamagedIndexTests : public DocumentIdentifierTests {
protected:
    void SetUp() override
    {
        // The drive's own service is not used here, because its connection would stay open beside the damage.
        auto identifiers = LocalDocumentIdentifiers::create(_drive.layout(), _drive.dispatch);
        for (int i = 0; i < 40; ++i)
            _identifier = *identifiers->identify(document("F/" + std::to_string(i)));
        _place = document("F/39");
        identifiers.reset();
        std::ifstream file(_drive.layout().index(), std::ios::binary);
        _whole.assign(std::istreambuf_iterator<char>(file), {});
        ASSERT_FALSE(fs::exists(_drive.layout().index() + "-wal")) << "all of it is in the file";
        ASSERT_GT(_whole.size(), 8192U);
    }
    void writeIndex(const std::string& content)
    {
        for (const char* suffix : {"-wal", "-shm"})
            fs::remove(_drive.layout().index() + suffix);
        std::ofstream(_drive.layout().index(), std::ios::binary | std::ios::trunc) << content;
    }
    std::shared_ptr<LocalDocumentIdentifiers> begin() const
    {
        return LocalDocumentIdentifiers::create(_drive.layout(), _drive.dispatch);
    }
    /// Answers what a user is told when a new document cannot be identified.
    std::string reasonAgainst(LocalDocumentIdentifiers& identifiers)
    {
        const auto result = identifiers.identify(document("new.txt"));
        return result ? "none" : result.error->text(platform::errorKey::localizedDescription).value_or("");
    }

    std::uint32_t _identifier = 0;
    Url _place = Url::fileURL("/");
    std::string _whole;
};

TEST_F(DamagedIndexTests, cutOffAtAnyByte)
{
    for (std::size_t length = 0; length < _whole.size(); length += length < 4200 ? 1 : 61) {
        writeIndex(_whole.substr(0, length));
        const auto identifiers = begin();
        ASSERT_EQ(::find(*identifiers, _identifier), _place) << length;
        if (length % 256 != 0)
            continue;
        _drive.settle();
        const DocumentIndex index(_drive.layout().index());
        ASSERT_EQ(index.state(), DocumentIndex::State::Complete) << length;
        ASSERT_EQ(index.lookUp(_identifier).kind, Kind::Known) << length;
    }
}

TEST_F(DamagedIndexTests, overwrittenWithGarbage)
{
    std::mt19937 random(20'021);
    for (int round = 0; round < 400; ++round) {
        auto content = _whole;
        const auto begins = random() % content.size();
        for (auto at = begins; at < std::min<std::size_t>(begins + 1 + random() % 600, content.size()); ++at)
            content[at] = static_cast<char>(random());
        writeIndex(content);
        const auto identifiers = begin();
        const auto found = ::find(*identifiers, _identifier);
        EXPECT_TRUE(!found || *found == _place) << round << ' ' << found->path();
        const auto identifier = identifiers->identify(_place);
        EXPECT_TRUE(!identifier || ::find(*identifiers, *identifier) == _place) << round;
        _drive.mark(_place, host::drive::itemMark::documentIdentifier, std::to_string(_identifier));
        _drive.settle();
    }
    writeIndex(std::string(20'000, '\x5a'));
    EXPECT_EQ(::find(*begin(), _identifier), _place);
}

TEST_F(DamagedIndexTests, replacedWhileItIsOpen)
{
    const auto identifiers = begin();
    EXPECT_EQ(::find(*identifiers, _identifier), _place);
    fs::remove(_drive.layout().index());
    moveByOthers("F/39", "b.txt");
    EXPECT_EQ(::find(*identifiers, _identifier), _drive.url("b.txt"));
    _drive.settle();
    EXPECT_EQ(::find(*begin(), _identifier), _drive.url("b.txt"));
}

TEST_F(DamagedIndexTests, lockedByAnotherProcess)
{
    sqlite3* other = nullptr;
    ASSERT_EQ(sqlite3_open(_drive.layout().index().c_str(), &other), SQLITE_OK);
    ASSERT_EQ(
        sqlite3_exec(other, "PRAGMA locking_mode = EXCLUSIVE; BEGIN EXCLUSIVE", nullptr, nullptr, nullptr),
        SQLITE_OK);
    const auto identifiers = begin();
    EXPECT_EQ(::find(*identifiers, _identifier), _place);
    EXPECT_EQ(reasonAgainst(*identifiers),
        "The drive’s own files, which are needed for “new.txt”, are being used by another program.");
    sqlite3_close(other);
    EXPECT_TRUE(identifiers->identify(document("new.txt")));
    EXPECT_EQ(::find(*identifiers, _identifier), _place);
}

TEST_F(DamagedIndexTests, replacedBySomethingElse)
{
    for (const bool isPipe : {true, false}) {
        fs::remove_all(_drive.layout().index());
        if (isPipe)
            ASSERT_EQ(::mkfifo(_drive.layout().index().c_str(), 0600), 0);
        else
            fs::create_directory(_drive.layout().index());
        EXPECT_EQ(
            reasonAgainst(*begin()), "The drive’s own files, which are needed for “new.txt”, can’t be used.");
    }
}

TEST_F(DocumentIdentifierTests, processesThatIdentifyOneCopyAgree)
{
    // The connection is closed before the process forks.
    const auto original = LocalDocumentIdentifiers::create(_drive.layout(), _drive.dispatch)
                              ->identify(document("a.txt"))
                              .value.value_or(0);
    for (int round = 0; round < 10; ++round) {
        copyByOthers("a.txt", "copy.txt");
        int ends[2];
        ASSERT_EQ(::pipe(ends), 0);
        constexpr int count = 4;
        for (int i = 0; i < count; ++i) {
            if (::fork() != 0)
                continue;
            const auto mine = LocalDocumentIdentifiers::create(_drive.layout(), _drive.dispatch);
            const auto identifier = mine->identify(_drive.url("copy.txt")).value.value_or(0);
            ::_exit(::write(ends[1], &identifier, sizeof identifier) < 0);
        }
        std::set<std::uint32_t> answers;
        for (int i = 0; i < count; ++i) {
            std::uint32_t answer = 0;
            ASSERT_EQ(::read(ends[0], &answer, sizeof answer), static_cast<ssize_t>(sizeof answer));
            answers.insert(answer);
            ::wait(nullptr);
        }
        ::close(ends[0]), ::close(ends[1]);
        EXPECT_EQ(answers.size(), 1U);
        EXPECT_FALSE(answers.contains(original) || answers.contains(0));
        fs::remove(at("copy.txt"));
    }
}

} // namespace
