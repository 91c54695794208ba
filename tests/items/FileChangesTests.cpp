// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/PromiseFile.h"
#include "items/FileUtils.h"
#include "platform/FilePresenter.h"
#include "tests/items/support/ItemsFixture.h"

#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>
#include <map>

using namespace tarrow;
using items_tests::ItemsFixture;
using namespace testing;
using testing_support::contentOf;
using testing_support::writeFile;

namespace {

namespace fs = std::filesystem;

/// Acts at the moment when a presenter of the item is asked to prepare for its deletion.
class ActingPresenter : public platform::FilePresenter {
public:
    ActingPresenter(Url url, std::shared_ptr<platform::OperationQueue> queue, std::function<void()> act)
        : _url(std::move(url))
        , _queue(std::move(queue))
        , _act(std::move(act))
    {
    }
    std::optional<Url> presentedItemURL() override { return _url; }
    std::shared_ptr<platform::OperationQueue> presentedItemOperationQueue() override { return _queue; }
    void accommodatePresentedItemDeletionWithCompletionHandler(CompletionHandler completion) override
    {
        _act();
        completion(std::nullopt);
    }

private:
    Url _url;
    std::shared_ptr<platform::OperationQueue> _queue;
    std::function<void()> _act;
};

class FileChangesTest : public ItemsFixture {
protected:
    std::shared_ptr<ActingPresenter> whenAsked(const Url& url, std::function<void()> act)
    {
        const auto presenter = std::make_shared<ActingPresenter>(url, _queue, std::move(act));
        coordinator->addFilePresenter(presenter);
        return presenter;
    }
    static bool isThere(const Url& url)
    {
        return fs::symlink_status(url.path()).type() != fs::file_type::not_found;
    }
    static Url promiseOf(const Url& url)
    {
        return Url::fileURL(host::drive::PromiseRecord::pathFor(url.path()));
    }
    Url outside(const std::string& name) { return writeFile(folder().at("outside/" + name), "precious"); }

    std::shared_ptr<platform::OperationQueue> _queue =
        dispatch->makeOperationQueue("presenters", platform::QualityOfService::Utility);
};

MATCHER_P(HasCode, code, "")
{
    return arg && arg->code() == static_cast<int>(code);
}

TEST_F(FileChangesTest, RemovesWhatItWasAskedToAndNothingElse)
{
    const auto kept = outside("kept.txt");
    const auto file = writeDocument("a.txt"), tree = makeFolder("tree");
    writeDocument("tree/sub/deep/b.txt");
    writeDocument("tree/.hidden");
    writeLink("tree/sub/link", folder().at("outside"));
    const auto link = writeLink("link", folder().at("outside"));
    host::drive::PromiseRecord promise;
    promise.modified = Date{1'600'000'000'000'000'000};
    promise.content = "content-1";
    const auto promised = writePromise("p.pdf", promise);
    const auto content = writeFile(layout().cloud() + "/content-1", "cloud");
    const auto twin = writePromise("a.txt", {});

    for (const auto& url : {file, tree, link, promised}) {
        log->clear();
        EXPECT_FALSE(FileUtils::remove(url)) << url.path();
        EXPECT_THAT(log->lines(),
            ElementsAre("DEBUG Removing item: '" + url.absoluteString() + "'",
                "INFO Deleted item: '" + url.absoluteString() + "'",
                StartsWith("INFO Coordinated Write returned ")));
        EXPECT_FALSE(isThere(url) || isThere(promiseOf(url))) << url.path();
    }
    EXPECT_FALSE(isThere(content)); // nobody can fetch it but through a copied promise
    EXPECT_EQ(contentOf(kept), "precious");
    EXPECT_FALSE(hasTraces());
    // A missing file has no date, so nothing shows that it is unchanged.
    EXPECT_THAT(FileUtils::remove(file), HasCode(FileErrorCode::Cancelled));
}

TEST_F(FileChangesTest, KeepsADocumentThatChangedWhileItWasBeingDeleted)
{
    const auto url = writeDocument("a.txt", "old");
    const auto rewrite = [&] { writeFile(url.path(), "new"); };
    const auto replaceWithItsDate = [&] {
        const auto date = fs::last_write_time(url.path());
        writeFile(url.path() + "~", "two");
        fs::last_write_time(url.path() + "~", date);
        fs::rename(url.path() + "~", url.path());
    };
    for (const auto& [change, content] :
        {std::pair<std::function<void()>, std::string>{rewrite, "new"}, {replaceWithItsDate, "two"}}) {
        const auto writer = whenAsked(url, change);
        log->clear();
        EXPECT_THAT(FileUtils::remove(url), HasCode(FileErrorCode::Cancelled));
        EXPECT_EQ(log->count("INFO Date changed during delete (user chose Keep?) -- preserving document: '"
                      + url.absoluteString() + "'"),
            1U);
        EXPECT_EQ(contentOf(url), content);
    }
    EXPECT_FALSE(FileUtils::remove(url));
}

/// Answers everything below a folder by its path, with its content or target.
std::map<std::string, std::string> everything(const std::string& folder)
{
    std::map<std::string, std::string> found;
    for (const auto& entry : fs::recursive_directory_iterator(folder))
        found[entry.path()] = entry.is_symlink() ? fs::read_symlink(entry.path()).string()
            : entry.is_directory()               ? "folder"
                                                 : contentOf(entry.path().string());
    return found;
}

TEST_F(FileChangesTest, WhatCannotBeDoneIsToldAndChangesNothing)
{
    const auto file = writeDocument("a.txt", "a"), other = writeDocument("b.txt", "b");
    const auto dir = makeFolder("folder"), otherDir = makeFolder("folder2");
    writeDocument("folder/b.txt", "b");
    writeLink("link", dir.path());
    const auto dangling = writeLink("dangling", "nowhere"), promised = writePromise("p.txt", {});
    const auto elsewhere = Url::fileURL(folder().at("elsewhere"));
    fs::create_directory_symlink(folder().path(), at("out").path());
    std::string composed, decomposed; // 128 letters: 256 and 384 bytes
    for (int i = 0; i < 128; ++i) {
        composed += "\u00e9";
        decomposed += "e\u0301";
    }
    struct Row {
        const char* name;
        std::optional<Error> error;
        int code;
    };
    const auto before = everything(layout().documents());
    EXPECT_FALSE(FileUtils::moveTo(file, file));
    EXPECT_EQ(log->count("DEBUG Move: src and dest are the same"), 1U);
    EXPECT_FALSE(FileUtils::mkdir(dir)) << "a folder that is there is made";
    const Row rows[] = {
        {"256 bytes", FileUtils::mkdir(at(composed)), 514},
        {"384 bytes of as many letters", FileUtils::moveTo(file, at(decomposed)), 514},
        {"256 bytes on the way", FileUtils::mkdir(at("new/" + composed + "/x")), 514},
        {"a promise to 256 bytes", FileUtils::moveTo(promised, at(std::string(256, 'p'))), 514},
        {"a folder into itself", FileUtils::moveTo(dir, at("folder/in")), EINVAL},
        {"a folder into itself by a link", FileUtils::moveTo(dir, at("link/in")), ENOTDIR},
        {"a file into a link", FileUtils::moveTo(file, at("link/a.txt")), ENOTDIR},
        {"a folder in place of a file", FileUtils::mkdir(file), 516},
        {"a folder below a file", FileUtils::mkdir(at("a.txt/x")), 516},
        {"a folder below a link", FileUtils::mkdir(at("out/x")), 516},
        {"upwards", FileUtils::mkdir(at("../../../a")), EXDEV},
        {"a folder elsewhere", FileUtils::mkdir(elsewhere), EXDEV},
        {"a file elsewhere", FileUtils::moveTo(file, elsewhere), EXDEV},
        {"the drive itself", FileUtils::moveTo(Url::fileURL(layout().documents()), at("x")), EXDEV},
        {"a NUL", FileUtils::mkdir(Url::fileURL(at("a").path() + std::string(1, '\0') + "b")), 514},
        {"a file onto a folder", FileUtils::moveTo(file, dir), 3328},
        {"a folder onto a file", FileUtils::moveTo(dir, file), 3328},
        {"a file onto a file", FileUtils::moveTo(file, other), 516},
        {"a folder onto a folder", FileUtils::moveTo(dir, otherDir), 516},
        {"a file onto a promise", FileUtils::moveTo(file, promised), 516},
        {"a promise onto a file", FileUtils::moveTo(promised, file), 516},
        {"a file onto a link to nowhere", FileUtils::moveTo(file, dangling), 516},
        {"nothing", FileUtils::moveTo(at("gone"), at("new")), 4},
        {"a file into no folder", FileUtils::moveTo(file, at("gone/a.txt")), 4},
    };
    for (const auto& [name, error, code] : rows) {
        EXPECT_THAT(error, HasCode(code)) << name;
        const bool isExplained =
            error && !error->text(platform::errorKey::localizedDescription).value_or("").empty();
        EXPECT_EQ(isExplained, code != 3328)
            << name << ": the change of an item's kind has no words of its own";
    }
    EXPECT_THAT(log->lines(), testing::Contains(StartsWith("ERROR failed to create directory:'")));
    EXPECT_EQ(everything(layout().documents()), before);
    EXPECT_FALSE(isThere(elsewhere));
    EXPECT_FALSE(hasTraces());
}

TEST_F(FileChangesTest, NamesThatDifferByAnyByteAreItemsOfTheirOwn)
{
    struct Row {
        const char* name;
        std::string from, to;
    };
    const Row rows[] = {{"case", "a.txt", "A.txt"}, {"normalisation", "\u00e9.txt", "e\u0301.txt"},
        {"invalid bytes", "bad\xff.txt", "bad\xfe.txt"},
        {"255 bytes", std::string(255, 'n'), std::string(254, 'n') + 'N'}};
    for (const auto& [name, from, to] : rows) {
        // A name that is not UTF-8 can exist on the disk, however it came there.
        const auto source = at(from), target = at(to);
        writeFile(source.path(), "first");
        EXPECT_FALSE(FileUtils::moveTo(source, target)) << name;
        EXPECT_EQ(contentOf(target), "first") << name;
        EXPECT_FALSE(isThere(source)) << name;
        writeFile(source.path(), "second");
        EXPECT_THAT(FileUtils::moveTo(source, target), HasCode(516)) << name;
        EXPECT_FALSE(FileUtils::remove(target)) << name;
        EXPECT_EQ(contentOf(source), "second") << name;
    }
    EXPECT_FALSE(hasTraces());
}

TEST_F(FileChangesTest, WithoutPermissionAllStaysAsItIs)
{
    makeFolder("closed/sub");
    const auto file = writeDocument("closed/sub/a.txt", "a"), folder = at("closed");
    // The folder is read in any order, so nothing may be deleted before it is known that everything can be.
    for (const auto& name : {"b", "c", "d", "e", "f", "g"})
        writeDocument(std::string("closed/") + name, name);
    const auto before = everything(layout().documents());
    const auto sub = file.deletingLastPathComponent();
    const auto child = ::fork();
    if (child == 0) {
        // Root may do anything, so another user owns the drive and runs the operation.
        constexpr unsigned nobody = 65534;
        if (::geteuid() == 0) {
            for (const auto& entry : fs::recursive_directory_iterator(DriveFixture::folder().path()))
                static_cast<void>(::lchown(entry.path().c_str(), nobody, nobody));
            if (::chown(DriveFixture::folder().path().c_str(), nobody, nobody) != 0
                || ::setresuid(nobody, nobody, nobody) != 0)
                ::_exit(99);
        }
        ::chmod(sub.path().c_str(), 0500);
        const std::optional<Error> errors[] = {FileUtils::remove(file), FileUtils::remove(folder),
            FileUtils::moveTo(file, at("a.txt")), FileUtils::mkdir(sub.appendingPathComponent("new")),
            DriveFixture::cloud->fileChanges()->evictItem(file.path())};
        int wrong = 1;
        for (const auto& error : errors) {
            if (!error || error->code() != EACCES)
                ::_exit(wrong);
            ++wrong;
        }
        ::chmod(sub.path().c_str(), 0700);
        ::_exit(0);
    }
    int status = 0;
    ::waitpid(child, &status, 0);
    if (WEXITSTATUS(status) == 99)
        GTEST_SKIP() << "no other user can be taken here";
    EXPECT_EQ(status, 0);
    EXPECT_EQ(everything(layout().documents()), before);
    EXPECT_FALSE(hasTraces());
}

TEST_F(FileChangesTest, EvictsADocumentAndKeepsWhatIsKnownOfIt)
{
    const auto url = writeDocument("a.txt", "12345");
    mark(url, host::drive::itemMark::tags, "Red,Blue");
    const auto date = FileUtils::getResourceValueForURL(AttributeKey::ContentModificationDate, url);
    EXPECT_TRUE(FileUtils::evictDocument(url));
    EXPECT_FALSE(isThere(url));
    EXPECT_EQ(
        FileUtils::getResourceValueForURL(AttributeKey::FileSize, url), AttributeValue(std::uint64_t{5}));
    EXPECT_EQ(FileUtils::getResourceValueForURL(AttributeKey::ContentModificationDate, url), date);
    EXPECT_THAT(DriveFixture::cloud->promisedItems().readItem(url, {}).tagNames, ElementsAre("Red", "Blue"));
    const auto promise = host::drive::readPromise(promiseOf(url).path()).value;
    ASSERT_TRUE(promise);
    EXPECT_EQ(contentOf(Url::fileURL(layout().cloud() + '/' + promise->content)), "12345");
    EXPECT_TRUE(FileUtils::evictDocument(url)) << "there is no copy any more";

    log->clear();
    EXPECT_FALSE(FileUtils::evictDocument(makeFolder("dir")));
    EXPECT_FALSE(FileUtils::evictDocument(at("gone")));
    EXPECT_THAT(
        log->lines(), ElementsAre(StartsWith("WARNING Evict error: "), StartsWith("WARNING Evict error: ")));
    EXPECT_FALSE(FileUtils::remove(url)) << "a promise with its date";
    EXPECT_TRUE(fs::is_empty(layout().cloud()));
}

} // namespace
