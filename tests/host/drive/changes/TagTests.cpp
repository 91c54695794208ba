// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/DownloadWork.h"
#include "host/drive/changes/LocalCloudStore.h"
#include "host/drive/changes/LocalItemChanges.h"
#include "host/drive/records/ItemFacts.h"
#include "host/drive/records/PromiseFile.h"
#include "host/drive/records/SmallFile.h"
#include "tests/support/DriveFixture.h"

#include <sys/xattr.h>

#include <cerrno>

namespace {

namespace fs = std::filesystem;

using namespace host::drive;
using namespace platform;
using testing::ElementsAre;
using testing::IsEmpty;
using testing_support::contentOf;
using Tags = std::vector<std::string>;

class TagTest : public testing::Test, public testing_support::DriveFixture {
protected:
    Result<Tags> edit(const Url& item, const FileChanges::TagEdit& edit)
    {
        return LocalItemChanges(layout(), std::make_shared<LocalCloudStore>(layout()))
            .editTags(item.path(), edit);
    }
    Result<Tags> set(const Url& item, const Tags& tags)
    {
        return edit(item, [&](const Tags&) { return tags; });
    }
    Tags tagsOf(const Url& item) const { return cloud->promisedItems().readItem(item, {}).tagNames; }
    PromiseRecord promiseOf(const Url& item) const
    {
        return readPromise(PromiseRecord::pathFor(item.path())).value.value_or(PromiseRecord());
    }
    /// Puts another document in the place of one, as a program that saves does.
    void replace(const std::string& path, std::string_view content) const
    {
        testing_support::writeFile(path + ".new", content);
        fs::rename(path + ".new", path);
    }
    PromiseRecord known() const
    {
        PromiseRecord promise;
        promise.size = 12;
        promise.documentIdentifier = 42;
        promise.tags = {"Old"};
        promise.content = "content-1";
        return promise;
    }
};

TEST_F(TagTest, AreChangedWhereverTheItemIsAndAnsweredAsTheyWere)
{
    const auto document = writeDocument("a.txt", "text"), folder = makeFolder("Folder");
    const auto promised = writePromise("b.txt", known());
    mark(document, itemMark::tags, "Old");
    mark(folder, itemMark::tags, "Old");
    for (const auto& item : {document, folder, promised}) {
        SCOPED_TRACE(item.lastPathComponent());
        const auto before = set(item, {"Red", "Two words", "Red", "مهم"});
        EXPECT_EQ(before.value, Tags{"Old"});
        EXPECT_THAT(tagsOf(item), ElementsAre("Red", "Two words", "مهم"));
        EXPECT_TRUE(set(item, *before));
        EXPECT_THAT(tagsOf(item), ElementsAre("Old")) << "undone";
        EXPECT_TRUE(set(item, {}));
        EXPECT_THAT(tagsOf(item), IsEmpty());
    }
    EXPECT_EQ(::lgetxattr(document.path().c_str(), itemMark::tags, nullptr, 0), -1);
    EXPECT_EQ(contentOf(document), "text");
    auto expected = known();
    expected.tags.clear();
    EXPECT_EQ(promiseOf(promised), expected);
    EXPECT_FALSE(fs::exists(promised.path())) << "nothing was fetched";
    EXPECT_FALSE(hasTraces());
}

TEST_F(TagTest, ThatCannotBeAreRefusedAndNothingIsChanged)
{
    const auto document = writeDocument("a.txt"), promised = writePromise("b.txt", known());
    mark(document, itemMark::tags, "Old");
    for (const auto& item : {document, promised}) {
        for (const std::string tag : {"", "a,b", " a", "a ", "a\nb", "\xff"}) {
            const auto answer = set(item, {"Red", tag});
            ASSERT_TRUE(answer.error) << tag;
            EXPECT_TRUE(answer.error->is(FileErrorCode::InvalidName)) << tag;
        }
        EXPECT_TRUE(set(item, {std::string(256, 'a')}).error);
        Tags many;
        for (int i = 0; i < 5000; ++i)
            many.push_back("a long name of a tag " + std::to_string(i));
        EXPECT_TRUE(set(item, many).error) << "more than an item can have";
        EXPECT_THAT(tagsOf(item), ElementsAre("Old"));
    }
    EXPECT_TRUE(set(writeLink("link", "a.txt"), {"Red"}).error->is(FileErrorCode::Unsupported));
    EXPECT_TRUE(set(url("gone"), {"Red"}).error->is(FileErrorCode::NoSuchItem));
    EXPECT_EQ(set(Url::fileURL("/etc/hostname"), {"Red"}).error->code(), EXDEV);
    writeLink("way", "/etc");
    EXPECT_TRUE(set(url("way/hostname"), {"Red"}).error);
    EXPECT_FALSE(hasTraces());
}

TEST_F(TagTest, ReachTheItemThatOthersRenameOrReplaceMeanwhile)
{
    const auto document = writeDocument("a.txt", "1");
    int asked = 0;
    EXPECT_TRUE(edit(document, [&](const Tags&) {
        fs::rename(document.path(), url("renamed.txt").path());
        writeDocument("a.txt", "another one");
        return Tags{"Red"};
    }));
    EXPECT_THAT(tagsOf(url("renamed.txt")), ElementsAre("Red"));
    EXPECT_THAT(tagsOf(document), IsEmpty());

    EXPECT_TRUE(edit(document, [&](const Tags& before) {
        if (++asked == 1) {
            replace(document.path(), "saved");
            mark(document, itemMark::tags, "Theirs");
        }
        auto tags = before;
        tags.emplace_back("Red");
        return tags;
    }));
    EXPECT_EQ(asked, 2);
    EXPECT_THAT(tagsOf(document), ElementsAre("Theirs", "Red"));

    const auto outside = folder().write("outside.txt", "secret");
    EXPECT_TRUE(edit(document, [&](const Tags&) {
        fs::remove(document.path());
        fs::create_symlink(outside, document.path());
        return Tags{"Blue"};
    }).error->is(FileErrorCode::Unsupported));
    EXPECT_EQ(::lgetxattr(outside.c_str(), itemMark::tags, nullptr, 0), -1);
}

TEST_F(TagTest, NeverTakeBackWhatOthersWriteIntoAPromise)
{
    const auto item = writePromise("b.txt", known());
    const auto path = PromiseRecord::pathFor(item.path());
    auto theirs = known();
    theirs.content = "content-2";
    int asked = 0;
    EXPECT_TRUE(edit(item, [&](const Tags&) {
        if (++asked == 1)
            replace(path, theirs.toJson());
        return Tags{"Red"};
    }));
    EXPECT_EQ(asked, 2);
    theirs.tags = {"Red"};
    EXPECT_EQ(promiseOf(item), theirs);

    const auto always = edit(item, [&](const Tags&) {
        replace(path, theirs.toJson());
        return Tags{"Blue"};
    });
    EXPECT_EQ(always.error->code(), EBUSY);
    EXPECT_EQ(promiseOf(item), theirs);
    testing_support::writeFile(path, "{ no promise");
    EXPECT_TRUE(set(item, {"Blue"}).error);
    EXPECT_EQ(contentOf(path), "{ no promise");
    EXPECT_FALSE(hasTraces());
}

/// The local store, which lets something happen before a fetch.
class WindowStore : public LocalCloudStore {
public:
    using LocalCloudStore::LocalCloudStore;
    host::system::SystemError fetch(const std::string& content, const host::system::FileDescriptor& into,
        const Progress& progress) override
    {
        beforeFetch();
        return LocalCloudStore::fetch(content, into, progress);
    }
    std::function<void()> beforeFetch;
};

TEST_F(TagTest, ThatAreGivenDuringADownloadStay)
{
    auto promise = known();
    promise.size.reset();
    testing_support::writeFile(layout().cloud() + "/content-1", "text");
    const auto item = writePromise("b.txt", promise);
    WindowStore store(layout());
    for (const Tags& tags : {Tags{"Red", "Blue"}, Tags{}}) {
        store.beforeFetch = [&] { EXPECT_TRUE(set(item, tags)); };
        EXPECT_FALSE(bringHere(
            layout(), store, item.path(),
            [](std::uint64_t, std::optional<std::uint64_t>) { return CloudStore::Continue::Yes; },
            [](const auto& steps) {
                steps();
                return std::optional<platform::Error>();
            }));
        EXPECT_EQ(contentOf(item), "text");
        EXPECT_EQ(tagsOf(item), tags);
        fs::remove(item.path());
        testing_support::writeFile(layout().cloud() + "/content-1", "text");
        writePromise("b.txt", promise);
    }
}

} // namespace
