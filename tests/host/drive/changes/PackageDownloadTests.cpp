// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/ContentCollection.h"
#include "host/drive/changes/DownloadWork.h"
#include "host/drive/changes/LocalCloudStore.h"
#include "host/drive/records/ItemFacts.h"
#include "tests/support/DownloadFixture.h"

#include <cerrno>
#include <cstring>

namespace {

namespace fs = std::filesystem;

using namespace host::drive;
using namespace platform;
using testing_support::alone;
using testing_support::contentOf;
using testing_support::DownloadTest;
using testing_support::goOn;

/// A package of two levels with a link, a picture that may not be written, and a part that is in the cloud.
class PackageTest : public DownloadTest {
protected:
    Url writePackage(const std::string& name)
    {
        promise("part.txt", "a part");
        fs::create_directories(url(name + "/assets/empty").path());
        fs::rename(PromiseRecord::pathFor(url("part.txt").path()),
            PromiseRecord::pathFor(url(name + "/assets/part.txt").path()));
        writeDocument(name + "/text.md", "a text");
        writeDocument(name + "/assets/picture", std::string(3'000'000, 'x'));
        writeLink(name + "/assets/link", "../text.md");
        fs::permissions(url(name + "/assets/picture").path(), fs::perms::owner_read);
        return url(name);
    }
    std::optional<Error> evict(const Url& item) { return cloud->fileChanges()->evictItem(item.path()); }
    std::optional<Error> fetch(const Url& item, const KeepingOthersOut& keeping = alone)
    {
        LocalCloudStore store(layout());
        return host::drive::bringHere(layout(), store, item.path(), goOn, keeping);
    }
    static bool isPromise(const Url& item)
    {
        return !fs::exists(item.path()) && fs::exists(PromiseRecord::pathFor(item.path()));
    }
    std::size_t contents() const
    {
        return static_cast<std::size_t>(std::distance(fs::directory_iterator(layout().cloud()), {}));
    }
};

TEST_F(PackageTest, EvictedAndFetchedIsTheSame)
{
    const auto item = writePackage("a.textbundle");
    const auto copy = folder().at("copy");
    const auto size =
        3'000'006 + fs::file_size(PromiseRecord::pathFor(url("a.textbundle/assets/part.txt").path()));
    ASSERT_EQ(std::system(("cp -a '" + item.path() + "' '" + copy + "'").c_str()), 0);
    ASSERT_EQ(::chmod(item.path().c_str(), 0750), 0);
    mark(item, "user.foreign", "kept");
    mark(item, itemMark::tags, "Red");
    mark(item, itemMark::documentIdentifier, "77");
    const auto before = host::drive::lookAtFile(item.path());
    ASSERT_FALSE(evict(item));
    EXPECT_TRUE(isPromise(item));
    const auto promised = host::drive::lookAtItem(item.path()).promise;
    EXPECT_EQ(promised.kind, PromiseRecord::Kind::Package);
    EXPECT_EQ(promised.size, size);
    EXPECT_EQ(promised.documentIdentifier, 77U);
    // Its attributes are the promise's meanwhile, also those that go.
    EXPECT_TRUE(
        cloud->fileChanges()->editTags(item.path(), [](const auto&) { return std::vector<std::string>(); }));
    const auto download = start(item);
    dispatch->runUntilIdle();
    ASSERT_EQ(ended, std::vector<std::optional<Error>>(1));
    EXPECT_EQ(heard.back(), (DownloadProgress{size, size}));
    EXPECT_GE(heard.size(), 3U);
    EXPECT_EQ(std::system(("diff -r --no-dereference '" + item.path() + "' '" + copy + "'").c_str()), 0);
    struct stat picture;
    ASSERT_EQ(::stat(url("a.textbundle/assets/picture").path().c_str(), &picture), 0);
    EXPECT_EQ(picture.st_mode & 07777, 0400U);
    const auto after = host::drive::lookAtFile(item.path());
    EXPECT_EQ(after.status.stx_mode, before.status.stx_mode);
    EXPECT_EQ(after.modified(), before.modified());
    EXPECT_EQ(after.created(), before.created());
    EXPECT_EQ(after.marks.documentIdentifier, 77U);
    EXPECT_TRUE(after.marks.tags.empty());
    EXPECT_EQ(*AttributeReader(item.path()).value("user.foreign"), "kept");
    EXPECT_FALSE(hasTraces());
    // The part is still in the cloud, and everything else is not.
    ASSERT_EQ(collect(), ContentCollection::Outcome::Done);
    EXPECT_TRUE(fs::is_empty(layout().released()));
    EXPECT_EQ(contents(), 1U);
    EXPECT_FALSE(fetch(url("a.textbundle/assets/part.txt")));
    EXPECT_EQ(contentOf(url("a.textbundle/assets/part.txt")), "a part");
}

TEST_F(PackageTest, GoesWithItsPartsOnceNothingNamesIt)
{
    const auto item = writePackage("a.textbundle");
    writeDocument("outside/precious", "precious");
    fs::create_directory_symlink(url("outside").path(), url("a.textbundle/assets/outside").path());
    ASSERT_FALSE(evict(item));
    EXPECT_TRUE(ContentCollection(layout()).orphans().value->empty()) << "the package names its part";
    ASSERT_FALSE(cloud->fileChanges()->removeItem(item.path(), std::nullopt));
    ASSERT_EQ(collect(), ContentCollection::Outcome::Done);
    EXPECT_TRUE(fs::is_empty(layout().released()));
    EXPECT_EQ(contents(), 0U);
    EXPECT_EQ(contentOf(url("outside/precious")), "precious");
}

TEST_F(PackageTest, OnlyWhatCanComeBackIsEvicted)
{
    const auto item = writePackage("a.textbundle");
    const std::pair<int, std::function<std::string()>> rows[] = {
        {EOPNOTSUPP,
            [&] {
                ::mkfifo((item.path() + "/pipe").c_str(), 0600);
                return "pipe";
            }},
        {EBUSY,
            [&] {
                writeDocument("a.textbundle/assets/.trwtmp-1");
                return "assets/.trwtmp-1";
            }},
        {ELOOP,
            [&] {
                std::string path = item.path() + "/deep";
                for (int level = 0; level < 130; ++level)
                    path += "/d";
                fs::create_directories(path);
                return "deep";
            }},
    };
    for (const auto& [error, hinder] : rows) {
        const auto hindrance = hinder();
        const auto refused = evict(item);
        ASSERT_TRUE(refused) << hindrance;
        EXPECT_EQ(refused->code(), error);
        fs::remove_all(item.path() + '/' + hindrance);
        EXPECT_TRUE(fs::exists(item.path()) && !fs::exists(PromiseRecord::pathFor(item.path())));
        EXPECT_EQ(contents(), 1U);
    }
    EXPECT_TRUE(evict(makeFolder("folder"))->is(FileErrorCode::Unsupported));
    EXPECT_FALSE(evict(item));
}

TEST_F(PackageTest, WhatOthersDoMeanwhileCounts)
{
    const auto item = writePackage("a.textbundle");
    ASSERT_FALSE(evict(item));
    // Another process fetches it as well.
    EXPECT_FALSE(fetch(item, [&](const auto& steps) {
        EXPECT_FALSE(fetch(item));
        return alone(steps);
    }));
    EXPECT_EQ(contentOf(url("a.textbundle/text.md")), "a text");
    EXPECT_FALSE(hasTraces());
    // Another program puts a package, or a file, in its place.
    ASSERT_FALSE(evict(item));
    for (const auto& put : {std::function<void()>([&] { fs::create_directory(item.path()); }),
             std::function<void()>([&] { writeDocument("a.textbundle"); })}) {
        const auto error = fetch(item, [&](const auto& steps) {
            put();
            return alone(steps);
        });
        ASSERT_TRUE(error);
        EXPECT_TRUE(error->is(FileErrorCode::ItemExists));
        EXPECT_EQ(contents(), 2U);
        EXPECT_FALSE(hasTraces());
        fs::remove(item.path());
    }
    // It is cancelled, and its promise is moved away.
    LocalCloudStore store(layout());
    const auto error = host::drive::bringHere(
        layout(), store, item.path(),
        [](auto done, auto) {
            return done > 1'000'000 ? CloudStore::Continue::No : CloudStore::Continue::Yes;
        },
        alone);
    EXPECT_EQ(error->code(), ECANCELED);
    EXPECT_TRUE(isPromise(item));
    EXPECT_FALSE(hasTraces());
    EXPECT_TRUE(fetch(item, [&](const auto& steps) {
        EXPECT_FALSE(cloud->fileChanges()->moveItem(item.path(), url("moved").path()));
        return alone(steps);
    }));
    EXPECT_FALSE(fs::exists(item.path()));
    EXPECT_FALSE(fetch(url("moved")));
    EXPECT_EQ(contentOf(url("moved/text.md")), "a text");
    EXPECT_FALSE(hasTraces());
}

TEST_F(PackageTest, CanBeEnteredAlsoWhenItsPromiseIsOfAnotherProgram)
{
    fs::create_directories(content("far") + "/inner");
    std::ofstream(content("far") + "/inner/a.txt") << "a";
    fs::permissions(content("far") + "/inner", fs::perms::owner_read | fs::perms::owner_exec);
    std::ofstream(PromiseRecord::pathFor(url("far").path()))
        << R"({"version": 1, "kind": "directory", "content": "far"})";
    fs::permissions(PromiseRecord::pathFor(url("far").path()), fs::perms(0644));
    EXPECT_FALSE(fetch(url("far")));
    EXPECT_EQ(fs::status(url("far").path()).permissions(), fs::perms(0755));
    EXPECT_EQ(contentOf(url("far/inner/a.txt")), "a");
}

} // namespace
