// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/DriveEntry.h"
#include "host/drive/changes/LocalCloudStore.h"
#include "host/drive/changes/Recovery.h"
#include "host/drive/records/ItemMarks.h"
#include "host/drive/records/PromiseFile.h"
#include "host/system/files/DriveNames.h"
#include "host/system/files/PromisedNames.h"
#include "platform/FolderLister.h"
#include "tests/support/DriveFixture.h"

#include <sys/xattr.h>

#include <fcntl.h>

namespace {

namespace fs = std::filesystem;

using namespace host::drive;
using namespace platform;
using host::system::promisedName;
using testing::ElementsAre;
using testing::IsEmpty;
using testing_support::contentOf;

std::string nameOf(std::size_t bytes, char letter = 'n')
{
    return std::string(bytes - 4, letter) + ".txt";
}

/// Names of so many bytes, around the last one that a promise's own name can say.
class LongNames : public testing::TestWithParam<std::size_t>, public testing_support::DriveFixture {
protected:
    static FileChanges& changes() { return services().fileChanges(); }
    static std::string promiseOf(const Url& item) { return PromiseRecord::pathFor(item.path()); }
    bool isPromised(const Url& item) const
    {
        return !fs::exists(item.path()) && promisedName(promiseOf(item)).value == item.lastPathComponent()
            && !cloud->promisedItems().checkPromisedItemIsReachable(item);
    }
    static bool saysItsName(const std::string& path)
    {
        return ::getxattr(path.c_str(), host::system::promisedNameAttribute, nullptr, 0) >= 0;
    }
    std::optional<Error> fetch(const Url& item) const
    {
        std::optional<std::optional<Error>> ended;
        const auto download = cloud->items().startDownload(
            item, {nullptr, [&](const std::optional<Error>& error) { ended = error; }});
        settle();
        return ended.value_or(Error(FileErrorCode::Cancelled));
    }
    /// The names of what is in the cloud at the drive's top level, as a list of it shows them.
    std::vector<std::string> listed() const
    {
        std::vector<std::string> names;
        const auto listing = services().folderLister().list(url(""), {}, platform::FolderGrouping::Mixed,
            [&](const std::shared_ptr<const FolderSnapshot>& list) {
                names.clear();
                for (std::size_t index = 0; index < list->count(); ++index) {
                    if (list->entry(index).isPromise)
                        names.emplace_back(list->entry(index).name);
                }
            });
        settle();
        return names;
    }
};

TEST_P(LongNames, AreKeptWhileTheContentIsInTheCloud)
{
    const auto item = writeDocument(nameOf(GetParam()), "text");
    mark(item, "user.note", "kept");
    const auto number = cloud->documentIdentifiers().identify(item);
    ASSERT_TRUE(number);

    ASSERT_FALSE(changes().evictItem(item.path()));
    EXPECT_TRUE(isPromised(item));
    EXPECT_THAT(listed(), ElementsAre(item.lastPathComponent()));
    EXPECT_EQ(cloud->promisedItems().logicalURLForPromise(Url::fileURL(promiseOf(item))), item);
    EXPECT_EQ(cloud->documentIdentifiers().identify(item).value, *number);
    EXPECT_TRUE(changes().editTags(item.path(), [](const auto&) { return std::vector<std::string>{"Red"}; }));
    EXPECT_TRUE(changes().createFolder(item.path())->is(FileErrorCode::ItemExists));
    EXPECT_TRUE(changes().createFolder(promiseOf(item))->is(FileErrorCode::InvalidName));

    ASSERT_FALSE(fetch(item));
    EXPECT_EQ(contentOf(item), "text");
    EXPECT_FALSE(fs::exists(promiseOf(item)));
    EXPECT_FALSE(saysItsName(item.path())) << "only a promise needs it";
    EXPECT_EQ(*AttributeReader(item.path()).value("user.note"), "kept");
    EXPECT_EQ(documentIdentifierAt(item.path()), *number);
    EXPECT_THAT(tagsAt(item.path(), false), ElementsAre("Red"));
    EXPECT_FALSE(hasTraces());
}

TEST_P(LongNames, AreTrashedRestoredAndDeleted)
{
    const auto item = writeDocument("folder/" + nameOf(GetParam()), "text");
    ASSERT_FALSE(changes().evictItem(item.path()));
    auto& trash = services().trash();
    for (const auto& moved : {item, url("folder")}) {
        const auto trashed = trash.moveToTrash(moved.path(), std::nullopt);
        ASSERT_TRUE(trashed);
        const auto items = trash.items();
        ASSERT_TRUE(items && items->size() == 1);
        EXPECT_EQ(items->front().name, moved.lastPathComponent());
        EXPECT_EQ(items->front().origin, moved.path());
        EXPECT_EQ(trash.restore(trashed->identifier, std::nullopt).value, moved.path());
        EXPECT_TRUE(isPromised(item));
    }
    EXPECT_FALSE(changes().removeItem(item.path(), std::nullopt));
    EXPECT_FALSE(fs::exists(promiseOf(item)));
    EXPECT_TRUE(fs::is_empty(layout().cloud()));
    EXPECT_FALSE(hasTraces());
}

TEST_P(LongNames, ChangeIntoOneAnother)
{
    auto item = writeDocument("a.txt", "text");
    ASSERT_FALSE(changes().evictItem(item.path()));
    for (const auto& next :
        {nameOf(GetParam()), nameOf(255, 'x'), std::string("b.txt"), nameOf(244, 'y'), nameOf(GetParam())}) {
        const auto before = std::exchange(item, url(next));
        ASSERT_FALSE(changes().moveItem(before.path(), item.path()));
        EXPECT_TRUE(isPromised(item));
        EXPECT_FALSE(fs::exists(promiseOf(before)));
        EXPECT_EQ(saysItsName(promiseOf(item)), next.size() > 243);
        EXPECT_THAT(listed(), ElementsAre(next));
    }
    EXPECT_TRUE(changes().moveItem(item.path(), url(std::string(256, 'z')).path()));
    ASSERT_FALSE(fetch(item));
    EXPECT_EQ(contentOf(item), "text");
}

TEST_P(LongNames, AreWhatTheyWereOrShallBeWhileAPromiseIsRenamed)
{
    const auto from = writeDocument(nameOf(255, 'a')), to = url(nameOf(GetParam(), 'b'));
    ASSERT_FALSE(changes().evictItem(from.path()));
    const auto entry = DriveEntry::open(layout(), from.path());
    ASSERT_FALSE(host::system::addPromisedName(entry->folder, entry->promiseName(), to.lastPathComponent()));
    EXPECT_TRUE(isPromised(from));
    fs::rename(promiseOf(from), promiseOf(to));
    EXPECT_TRUE(isPromised(to));
    if (GetParam() > 243) {
        fs::rename(promiseOf(to), promiseOf(url(nameOf(250, 'c'))));
        EXPECT_THAT(listed(), IsEmpty()) << "a promise says no name that is not its own";
    }
}

INSTANTIATE_TEST_SUITE_P(Bytes, LongNames, testing::Values(243, 244, 255));

TEST_F(LongNames, StandInTheTextOfAPromiseWithoutAttributes)
{
    PromiseRecord record;
    record.longName = nameOf(255);
    EXPECT_TRUE(isPromised(writePromise(record.longName, record)));
    EXPECT_FALSE(isPromised(writePromise(nameOf(255, 'x'), record)));
    EXPECT_THAT(listed(), ElementsAre(record.longName));
}

TEST_F(LongNames, ComeBackAfterAProcessWasKilled)
{
    // Both were held by it. The place of the second one is taken by now.
    LocalCloudStore store(layout());
    for (const char letter : {'a', 'b'}) {
        const auto item = writeDocument(nameOf(255, letter), "text");
        ASSERT_FALSE(changes().evictItem(item.path()));
        const auto held = layout().held() + "/.trwheld-fffffff-" + letter + ".trwpromise";
        testing_support::writeFile(held + ".place", promiseOf(item) + '\0' + held + '\0' + '\0');
        fs::rename(promiseOf(item), held);
    }
    const auto free = url(nameOf(255, 'a')), taken = writeDocument(nameOf(255, 'b'), "other");
    ASSERT_FALSE(changes().evictItem(taken.path()));
    Recovery(layout(), store).run();
    EXPECT_TRUE(isPromised(free) && isPromised(taken));
    const auto items = services().trash().items();
    ASSERT_TRUE(items && items->size() == 1);
    EXPECT_EQ(items->front().name, taken.lastPathComponent());
    EXPECT_EQ(items->front().origin, taken.path());
    EXPECT_TRUE(items->front().isPromise);
    EXPECT_TRUE(services().trash().restore(items->front().identifier, url("c.txt").path()));
    EXPECT_FALSE(fetch(url("c.txt")));
    EXPECT_EQ(contentOf(url("c.txt")), "text");
}

TEST_F(LongNames, AreFoundAgainWhenAPromiseHasLostThem)
{
    const auto item = writeDocument(nameOf(255), "text");
    ASSERT_FALSE(changes().evictItem(item.path()));
    ASSERT_EQ(::removexattr(promiseOf(item).c_str(), host::system::promisedNameAttribute), 0);
    LocalCloudStore store(layout());
    Recovery recovery(layout(), store, std::chrono::nanoseconds(0));
    EXPECT_FALSE(recovery.settleStraysAmongItems());
    const auto items = services().trash().items();
    ASSERT_TRUE(items && items->size() == 1);
    EXPECT_TRUE(services().trash().restore(items->front().identifier, url("found.txt").path()));
    EXPECT_FALSE(fetch(url("found.txt")));
    EXPECT_EQ(contentOf(url("found.txt")), "text");
}

} // namespace
