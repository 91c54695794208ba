// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/LocalCloudStore.h"
#include "host/drive/changes/LocalItemChanges.h"
#include "host/drive/records/ItemFacts.h"
#include "tests/support/DriveFixture.h"

#include <sys/stat.h>

#include <fstream>

namespace {

namespace fs = std::filesystem;

using namespace host::drive;
using namespace platform;
using testing_support::contentOf;
using testing_support::writeFile;

class AddingTest : public testing::Test, public testing_support::DriveFixture {
protected:
    std::optional<Error> add(
        const std::string& from, const Url& to,
        const std::function<bool()>& goesOn = [] { return true; }) const
    {
        return LocalItemChanges(layout(), std::make_shared<LocalCloudStore>(layout()))
            .addCopy(from, to.path(), goesOn);
    }
    std::string outside(const std::string& name) const { return folder().at("outside/" + name); }
    std::string writeOutside(const std::string& name, std::string_view content = "content") const
    {
        return writeFile(outside(name), content).path();
    }
};

TEST_F(AddingTest, CopiesAreItemsOfTheirOwn)
{
    const auto plan = writeOutside("tree/sub/plan.txt", std::string(100'000, 'p'));
    fs::create_symlink("sub/plan.txt", outside("tree/link"));
    fs::permissions(plan, fs::perms(0440));
    mark(Url::fileURL(plan), itemMark::tags, "Work");
    const auto date = fs::last_write_time(plan);
    EXPECT_FALSE(add(outside("tree"), url("tree")));
    const auto copy = url("tree/sub/plan.txt");
    EXPECT_EQ(contentOf(copy.path()), contentOf(plan));
    EXPECT_EQ(fs::read_symlink(url("tree/link").path()), "sub/plan.txt");
    EXPECT_EQ(fs::last_write_time(copy.path()), date);
    EXPECT_EQ(fs::status(copy.path()).permissions(), fs::perms(0640)) << "its user may change it";
    EXPECT_THAT(lookAtFile(copy.path()).marks.tags, testing::ElementsAre("Work"));

    EXPECT_FALSE(add(outside("tree/link"), url("link")));
    EXPECT_EQ(fs::read_symlink(url("link").path()), "sub/plan.txt") << "it is not followed";

    mark(copy, itemMark::documentIdentifier, "77");
    EXPECT_FALSE(add(copy.path(), url("copy.txt")));
    EXPECT_EQ(documentIdentifierAt(url("copy.txt").path()), 0U) << "that is the original's";
    EXPECT_FALSE(hasTraces());
}

TEST_F(AddingTest, NothingIsReplacedAndNothingForeignComesIn)
{
    const auto taken = writeDocument("taken.txt", "here"), promised = writePromise("promised.txt", {});
    const auto inCloud = writePromise("holds/far.pdf", {});
    const auto file = writeOutside("a.txt");
    writeOutside("tree/.b.pdf.trwpromise");
    makeFolder("folder/below");
    ::mkfifo(outside("pipe").c_str(), 0600);
    fs::create_directories(outside("pipes/deep"));
    ::mkfifo(outside("pipes/deep/pipe").c_str(), 0600);
    const struct {
        std::string from;
        Url to;
        FileErrorCode code;
        const char* words;
    } rows[] = {
        {file, taken, FileErrorCode::ItemExists, "“taken.txt”"},
        {file, promised, FileErrorCode::ItemExists, "“promised.txt”"},
        {file, url(".trwtmp-1"), FileErrorCode::InvalidName, "“.trwtmp-1”"},
        {outside("gone.txt"), url("new"), FileErrorCode::NoSuchItem, "“gone.txt” is no longer there."},
        {outside("pipe"), url("new"), FileErrorCode::Unsupported, "“pipe” can’t be added"},
        {outside("pipes"), url("new"), FileErrorCode::Unsupported, "“pipe” can’t be added"},
        {url("folder").path(), url("folder/new"), FileErrorCode::Unsupported,
            "“folder” can’t be added to itself."},
        {url("folder").path(), url("folder/below/new"), FileErrorCode::Unsupported, "“folder” can’t"},
        {promised.path(), url("new"), FileErrorCode::Unsupported, "“promised.txt” is still in the cloud"},
        {url("holds").path(), url("new"), FileErrorCode::Unsupported, "“far.pdf” is still in the cloud"},
        {outside("tree"), url("new"), FileErrorCode::Unsupported, "“b.pdf” is still in the cloud"},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.from + " to " + row.to.path());
        const auto refused = add(row.from, row.to);
        ASSERT_TRUE(refused && refused->is(row.code)) << refused->debugDescription();
        EXPECT_THAT(
            refused->text(errorKey::localizedDescription).value_or(""), testing::HasSubstr(row.words));
        EXPECT_FALSE(fs::exists(url("new").path()) || hasTraces());
    }
    EXPECT_EQ(contentOf(taken.path()), "here");
}

TEST_F(AddingTest, WhatChangesOrIsNotWantedAnyMoreLeavesNothing)
{
    const auto file = writeOutside("tree/a.bin", std::string(300'000, 'a'));
    const std::pair<const char*, std::function<bool(int asked)>> rows[] = {
        {"cancelled at once", [](int) { return false; }},
        {"cancelled on the way", [](int asked) { return asked < 5; }},
        {"written on the way",
            [&](int asked) {
                if (asked == 5)
                    std::ofstream(file, std::ios::in) << "b";
                return true;
            }},
        {"grown on the way",
            [&](int asked) {
                if (asked == 5)
                    writeOutside("tree/b.txt");
                return true;
            }},
    };
    for (const auto& [name, goesOn] : rows) {
        for (const auto& from : {outside("tree"), file}) {
            SCOPED_TRACE(std::string(name) + " " + from);
            int asked = 0;
            const auto error = add(from, url("new"), [&] { return goesOn(++asked); });
            const bool concernsFolder = std::string_view(name).starts_with("grown");
            if (concernsFolder && from == file)
                continue;
            EXPECT_TRUE(error && error->is(FileErrorCode::Cancelled));
            EXPECT_FALSE(fs::exists(url("new").path()) || hasTraces());
            fs::remove(outside("tree/b.txt"));
        }
    }
}

TEST_F(AddingTest, AFileThatVanishesOnTheWayIsCopiedWholeOrNotAtAll)
{
    writeOutside("tree/a.txt");
    writeOutside("tree/b.txt");
    int asked = 0;
    const auto error = add(outside("tree"), url("new"), [&] {
        if (++asked == 4)
            fs::remove_all(outside("tree"));
        return true;
    });
    EXPECT_TRUE(error);
    EXPECT_FALSE(fs::exists(url("new").path()) || hasTraces());
}

} // namespace
