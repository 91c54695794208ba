// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/coordination/LocalFileCoordinator.h"
#include "tests/host/system/support/RecordingPresenter.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/TemporaryDirectory.h"
#include "tests/support/VirtualDispatch.h"

#include <gmock/gmock.h>

#include <sys/wait.h>

#include <cerrno>
#include <filesystem>
#include <fstream>
#include <thread>
#include <vector>

namespace {

using host::system::LocalFileCoordinator;
using namespace platform;
using namespace testing;
using testing_support::RecordingPresenter;

class FileCoordinatorTest : public testing::Test {
protected:
    LocalFileCoordinator::Settings settings(platform::Duration patience = std::chrono::seconds(60)) const
    {
        return {.lockFile = _folder.at("locks/all"),
            .patience = patience,
            .lockPatience = std::chrono::minutes(1),
            .beforeWaiting = [this] { _dispatch->runUntilIdle(); }};
    }
    std::shared_ptr<RecordingPresenter> present(LocalFileCoordinator& coordinator, const std::string& path)
    {
        const auto presenter = std::make_shared<RecordingPresenter>(path, _queue);
        coordinator.addFilePresenter(presenter);
        return presenter;
    }
    Url makeFile(const std::string& name) const { return Url::fileURL(_folder.write(name, "0")); }

    testing_support::TemporaryDirectory _folder;
    std::shared_ptr<testing_support::RecordingLog> _log = testing_support::RecordingLog::install();
    std::shared_ptr<testing_support::VirtualDispatch> _dispatch = testing_support::VirtualDispatch::create();
    std::shared_ptr<platform::OperationQueue> _queue =
        _dispatch->makeOperationQueue("presenters", platform::QualityOfService::Utility);
};

TEST_F(FileCoordinatorTest, writersOfThreadsAndProcessesHaveTheirItemToThemselves)
{
    constexpr int rounds = 50;
    const auto url = makeFile("number"), other = Url::fileURL(_folder.at("other"));
    const auto numberInFile = [&] {
        int number = -1;
        std::ifstream(url.path()) >> number;
        return number;
    };
    // Adding one to the number in the file is correct only with exclusive access.
    const auto addOne = [&] {
        const int number = numberInFile();
        std::this_thread::yield();
        std::ofstream(url.path()) << number + 1;
    };
    const auto countAll = [&](LocalFileCoordinator& coordinator) {
        const auto move = [&](const Url& from, const Url& to) {
            return coordinator.coordinateWriting(from, WritingOptions::ForMoving, to,
                WritingOptions::ForReplacing, [&](const Url&, const Url&) { addOne(); });
        };
        for (int round = 0; round < rounds; ++round) {
            EXPECT_FALSE(
                coordinator.coordinateWriting(url, WritingOptions::None, [&](const Url&) { addOne(); }));
            EXPECT_FALSE(move(url, other));
            EXPECT_FALSE(move(other, url)) << "they wait for each other";
        }
    };
    const auto child = ::fork();
    LocalFileCoordinator shared(settings()), own(settings());
    if (child == 0) {
        countAll(own);
        ::_exit(0);
    }
    std::vector<std::jthread> threads;
    for (auto* coordinator : {&shared, &shared, &own})
        threads.emplace_back([&, coordinator] { countAll(*coordinator); });
    threads.clear();
    int status = -1;
    ::waitpid(child, &status, 0);
    EXPECT_EQ(status, 0);
    EXPECT_EQ(numberInFile(), 4 * 3 * rounds);
}

TEST_F(FileCoordinatorTest, anUnusableLockFileIsNoFaultOfTheItem)
{
    const auto item = makeFile("a.txt");
    std::filesystem::create_directories(_folder.at("locks/all"));
    std::filesystem::create_symlink(_folder.at("locks/all"), _folder.at("locks/link"));
    for (const auto& place : {"locks/all", "locks/link"}) {
        LocalFileCoordinator coordinator({.lockFile = _folder.at(place)});
        const auto error =
            coordinator.coordinateWriting(item, WritingOptions::None, [](const Url&) { FAIL(); });
        ASSERT_TRUE(error);
        EXPECT_EQ(error->text(errorKey::localizedDescription),
            "The drive’s own files, which are needed for “a.txt”, can’t be used.");
    }
}

TEST_F(FileCoordinatorTest, anAccessorMayCoordinateAgainForItemsThatItsThreadHolds)
{
    LocalFileCoordinator coordinator(settings());
    const auto folder = Url::fileURL("/f"), item = Url::fileURL("/f/i");
    int runs = 0;
    const auto nested = [&](const Url& url) {
        return [&, url](const Url&) {
            for (const auto options :
                {ReadingOptions::None, ReadingOptions::ImmediatelyAvailableMetadataOnly})
                EXPECT_FALSE(coordinator.coordinateReading(url, options, [&](const Url&) { ++runs; }));
        };
    };
    EXPECT_FALSE(coordinator.coordinateWriting(folder, WritingOptions::None, nested(item)));
    EXPECT_FALSE(coordinator.coordinateReading(item, ReadingOptions::None, nested(item)));
    EXPECT_FALSE(coordinator.coordinateWriting(item, WritingOptions::None, nested(folder)));
    EXPECT_EQ(runs, 6);

    coordinator.coordinateReading(item, ReadingOptions::None, [&](const Url&) {
        for (const auto& url : {item, folder}) {
            const auto refused = coordinator.coordinateWriting(
                url, WritingOptions::None, [](const Url&) { ADD_FAILURE() << "waits for itself"; });
            ASSERT_TRUE(refused);
            EXPECT_EQ(refused->code(), EDEADLK);
        }
    });
}

TEST_F(FileCoordinatorTest, presentersAreAskedBeforeADeletionAndToldAfterwards)
{
    LocalFileCoordinator coordinator(settings());
    const auto file = makeFile("a.txt");
    const auto item = present(coordinator, file.path());
    const auto folder = present(coordinator, _folder.path().string());
    const auto sibling = present(coordinator, _folder.at("a.txt2"));
    const auto gone = present(coordinator, file.path());
    coordinator.removeFilePresenter(*gone);

    coordinator.coordinateWriting(file, WritingOptions::ForDeleting, [&](const Url&) {
        EXPECT_THAT(item->heard, ElementsAre("deletes"));
        EXPECT_THAT(folder->heard, ElementsAre("deletes a.txt"));
    });
    _dispatch->runUntilIdle();
    EXPECT_THAT(item->heard, ElementsAre("deletes", "changed")) << "it was kept";

    coordinator.coordinateWriting(
        file, WritingOptions::ForDeleting, [](const Url& url) { std::filesystem::remove(url.path()); });
    _dispatch->runUntilIdle();
    EXPECT_THAT(item->heard, ElementsAre("deletes", "changed", "deletes"));
    EXPECT_THAT(folder->heard, ElementsAre("deletes a.txt", "changed", "deletes a.txt", "changed"));
    EXPECT_THAT(sibling->heard, IsEmpty());
    EXPECT_THAT(gone->heard, IsEmpty());
}

TEST_F(FileCoordinatorTest, aPresentersErrorKeepsTheItem)
{
    LocalFileCoordinator coordinator(settings());
    const auto file = makeFile("a.txt");
    const Error reason(platform::errorDomain::system, EBUSY);
    const auto keeper = present(coordinator, file.path());
    keeper->answer = reason;
    EXPECT_EQ(coordinator.coordinateWriting(
                  file, WritingOptions::ForDeleting, [](const Url&) { ADD_FAILURE() << "ran all the same"; }),
        reason);
}

TEST_F(FileCoordinatorTest, aPresenterThatNeverAnswersIsNotWaitedForForever)
{
    LocalFileCoordinator coordinator(settings(std::chrono::milliseconds(5)));
    const auto file = makeFile("a.txt");
    const auto silent = present(coordinator, file.path());
    silent->isSilent = true;
    int runs = 0;
    coordinator.coordinateWriting(file, WritingOptions::ForDeleting, [&](const Url&) { ++runs; });
    EXPECT_EQ(runs, 1);
    const auto line = "WARNING A presenter did not answer in time, going on: " + file.absoluteString();
    EXPECT_EQ(_log->count(line), 1U);
    silent->kept.front()(Error(platform::errorDomain::system, EIO)); // too late to matter
}

TEST_F(FileCoordinatorTest, aPresenterThatGoesAwayHasAnswered)
{
    std::shared_ptr<RecordingPresenter> leaving;
    auto chosen = settings();
    chosen.beforeWaiting = [&] {
        leaving.reset();
        _dispatch->runUntilIdle();
    };
    LocalFileCoordinator coordinator(chosen);
    const auto file = makeFile("a.txt");
    leaving = present(coordinator, file.path());
    int runs = 0;
    coordinator.coordinateWriting(file, WritingOptions::ForDeleting, [&](const Url&) { ++runs; });
    EXPECT_EQ(runs, 1);
    EXPECT_FALSE(leaving);
    EXPECT_THAT(_log->lines(), IsEmpty());
}

TEST_F(FileCoordinatorTest, presentersHearOfAMoveBeforeAndAfterIt)
{
    LocalFileCoordinator coordinator(settings());
    const auto folder = present(coordinator, "/d/from");
    const auto inside = present(coordinator, "/d/from/sub/a.txt");
    const auto above = present(coordinator, "/d");
    const auto source = Url::fileURL("/d/from"), target = Url::fileURL("/e/to");
    const auto move = [&](bool succeeds) {
        coordinator.coordinateWriting(source, WritingOptions::ForMoving, target, WritingOptions::ForReplacing,
            [&](const Url& from, const Url& to) {
                coordinator.itemWillMove(from, to);
                EXPECT_EQ(folder->heard.back(), "moves to /e/to");
                if (succeeds)
                    coordinator.itemDidMove(from, to);
            });
        _dispatch->runUntilIdle();
    };
    move(false);
    EXPECT_THAT(folder->heard, ElementsAre("moves to /e/to", "changed"));
    EXPECT_THAT(above->heard, ElementsAre("changed"));
    for (const auto& presenter : {folder, inside, above})
        presenter->heard.clear();
    move(true);
    EXPECT_THAT(folder->heard, ElementsAre("moves to /e/to", "moved to /e/to"));
    EXPECT_THAT(inside->heard, ElementsAre("moves to /e/to/sub/a.txt", "moved to /e/to/sub/a.txt"));
    EXPECT_THAT(above->heard, ElementsAre("changed"));
}

} // namespace
