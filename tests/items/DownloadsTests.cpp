// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/Downloads.h"
#include "items/ItemContents.h"
#include "tests/support/DriveFixture.h"

#include <gmock/gmock.h>

namespace tarrow {
namespace {

using namespace testing_support;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::UnorderedElementsAre;

class DownloadsTest : public testing::Test {
protected:
    /// Writes the promise of a document whose content is in the cloud.
    Url promise(const std::string& path, const std::string& content = "content")
    {
        host::drive::PromiseRecord record;
        record.size = content.size();
        record.content = "content-" + std::to_string(++contents);
        writeFile(drive.layout().cloud() + '/' + record.content, content);
        return drive.writePromise(path, record);
    }
    bool isHere(const Url& url) const { return FileUtils::exists(url); }
    std::vector<std::string> waitingOrRunning() const
    {
        std::vector<std::string> names;
        for (const auto& entry : downloads->entries())
            names.push_back((entry.progress ? "" : "waiting ") + entry.url.lastPathComponent());
        return names;
    }

    DriveFixture drive;
    int contents = 0;
    std::vector<std::string> outcomes;
    std::shared_ptr<Downloads> downloads = Downloads::create({.changed = [] {},
        .ended =
            [this](std::size_t arrived, const std::vector<Error>& errors) {
                outcomes.push_back(std::to_string(arrived));
                for (const auto& error : errors)
                    outcomes.push_back(error.text(platform::errorKey::localizedDescription).value_or("?"));
            }});
};

TEST_F(DownloadsTest, FindsTheDocumentsOfFoldersByThePlaceOfTheirContents)
{
    const auto trip = drive.makeFolder("Trip");
    const auto here = drive.writeDocument("Trip/here.txt"), deep = drive.writeDocument("Trip/a/b/deep.txt");
    const auto far = promise("Trip/far.txt"), deepFar = promise("Trip/a/far.txt"),
               other = promise("other.txt"), part = promise("Trip/Book.pages/part.txt");
    drive.writeDocument("Trip/.hidden");
    drive.writeDocument("Trip/.git/config");
    drive.writeDocument("Trip/Book.pages/inside.txt");
    drive.writeLink("Trip/link", here.path());
    drive.writeReference("Trip/note.trwref", "BrindleDefault", "Trip/here.txt");
    promise("Trip/twin.txt");
    const auto twin = drive.writeDocument("Trip/twin.txt");
    const auto find = [&](ContentPlace place) {
        return findDocuments({trip, other, drive.url("gone.txt")}, place, [] { return true; });
    };
    const auto isHereAlready = find(ContentPlace::Here);
    EXPECT_THAT(
        isHereAlready.documents, UnorderedElementsAre(here, deep, twin, drive.url("Trip/Book.pages")));
    EXPECT_EQ(isHereAlready.errors.size(), 1U) << "the one that is gone";
    EXPECT_THAT(find(ContentPlace::Cloud).documents, UnorderedElementsAre(far, deepFar, other, part));
    const auto unwanted = findDocuments({trip}, ContentPlace::Here, [] { return false; });
    EXPECT_THAT(unwanted.documents, IsEmpty());
}

TEST_F(DownloadsTest, AFewRunAtATimeAndTheEndSaysWhatFailed)
{
    std::vector<Url> wanted;
    for (const char* name : {"1", "2", "3", "4", "5"})
        wanted.push_back(promise(name));
    host::drive::PromiseRecord folder;
    folder.kind = host::drive::PromiseRecord::Kind::Directory;
    wanted.push_back(drive.writePromise("Folder", folder));
    downloads->add(wanted);
    downloads->add({wanted[0], wanted[4]});
    EXPECT_THAT(waitingOrRunning(), ElementsAre("1", "2", "3", "waiting 4", "waiting 5", "waiting Folder"));
    EXPECT_EQ(downloads->count().all, 6U) << "none is downloaded twice";
    drive.settle();
    EXPECT_THAT(outcomes, ElementsAre("5", "The content of the document isn’t in the cloud."));
    for (std::size_t i = 0; i < 5; ++i)
        EXPECT_EQ(contentOf(wanted[i]), "content");
    EXPECT_THAT(waitingOrRunning(), IsEmpty());
    EXPECT_EQ(downloads->count().all, 0U);
}

TEST_F(DownloadsTest, CancelledOnesStayInTheCloudWithoutAWord)
{
    std::vector<Url> wanted;
    for (const char* name : {"1", "2", "3", "4", "5"})
        wanted.push_back(promise(name));
    downloads->add(wanted);
    downloads->cancel(wanted[1]);
    downloads->cancel(wanted[4]);
    drive.settle();
    EXPECT_THAT(outcomes, ElementsAre("3"));
    EXPECT_FALSE(isHere(wanted[1]) || isHere(wanted[4]));
    EXPECT_TRUE(isHere(wanted[0]) && isHere(wanted[3]));

    downloads->add({wanted[1], wanted[4], promise("6"), promise("7")});
    downloads->cancelAll();
    drive.settle();
    EXPECT_THAT(outcomes, ElementsAre("3", "0"));
    EXPECT_FALSE(isHere(wanted[1]) || isHere(drive.url("7")));

    downloads->add(wanted);
    downloads->forget();
    drive.settle();
    EXPECT_EQ(outcomes.size(), 2U) << "nobody is there to be told";
    EXPECT_FALSE(isHere(wanted[1]) || isHere(wanted[4]));
}

TEST_F(DownloadsTest, ListsTheDownloadsOfScreensToo)
{
    const auto far = promise("far.txt");
    const auto handle = platform::services().cloudDocumentService().items().startDownload(far, {});
    std::vector<std::string> seen;
    const auto watch =
        drive.notifications->observe(platform::Notification::DownloadsDidChange, [&](const auto&) {
            for (const auto& name : waitingOrRunning())
                seen.push_back(name);
        });
    drive.settle();
    EXPECT_THAT(seen, testing::Contains("far.txt"));
    EXPECT_THAT(waitingOrRunning(), IsEmpty());
    EXPECT_THAT(outcomes, IsEmpty()) << "its screen tells of it";
}

} // namespace
} // namespace tarrow
