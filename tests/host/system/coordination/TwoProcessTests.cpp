// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// These tests are about two processes on one drive. The other process is a program of these tests.

#include "host/system/coordination/LocalFileCoordinator.h"
#include "host/system/queues/GLibDispatch.h"
#include "tests/host/system/support/RecordingPresenter.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/TemporaryDirectory.h"
#include "tests/support/VirtualDispatch.h"

#include <fcntl.h>
#include <glib.h>
#include <gmock/gmock.h>
#include <sys/resource.h>
#include <sys/wait.h>

#include <atomic>
#include <csignal>
#include <filesystem>
#include <fstream>
#include <thread>

namespace {

using host::system::LocalFileCoordinator;
using namespace platform;
using namespace testing;
using testing_support::RecordingPresenter;
namespace fs = std::filesystem;

/// A process that gets its orders line by line and answers each with one line. It ends with this object.
class PeerProcess {
public:
    explicit PeerProcess(const std::string& argument)
    {
        int input[2], output[2];
        if (::pipe2(input, O_CLOEXEC) != 0 || ::pipe2(output, O_CLOEXEC) != 0)
            std::abort();
        _process = ::fork();
        if (_process == 0) {
            ::dup2(input[0], STDIN_FILENO);
            ::dup2(output[1], STDOUT_FILENO);
            ::execl(TRW_COORDINATION_PEER, TRW_COORDINATION_PEER, argument.c_str(), nullptr);
            ::_exit(127);
        }
        ::close(input[0]);
        ::close(output[1]);
        _toProcess = input[1];
        _fromProcess = output[0];
    }
    ~PeerProcess()
    {
        ::close(_toProcess);
        signal(SIGKILL);
        ::waitpid(_process, nullptr, 0);
        ::close(_fromProcess);
    }
    void send(const std::string& line) const
    {
        const auto text = line + '\n';
        static_cast<void>(::write(_toProcess, text.data(), text.size()) + 1);
    }
    /// Waits for the next line. Answers an empty text when the process has ended.
    std::string receive() const
    {
        std::string line;
        for (char byte = 0; ::read(_fromProcess, &byte, 1) == 1 && byte != '\n';)
            line += byte;
        return line;
    }
    std::string ask(const std::string& line) const
    {
        send(line);
        return receive();
    }
    void signal(int number) const { ::kill(_process, number); }

private:
    pid_t _process = -1;
    int _toProcess = -1, _fromProcess = -1;
};

class TwoProcessTest : public testing::Test {
protected:
    TwoProcessTest()
    {
        for (const auto* name : {"drive/sub/deep/a.txt", "drive/sub/deep/b.txt", "drive/other/c.txt"})
            _folder.write(name, "content");
        fs::create_directory(_folder.at("cloud"));
    }
    LocalFileCoordinator::Settings settings(platform::Duration patience = std::chrono::minutes(1)) const
    {
        return {.lockFile = _locks,
            .lockPatience = patience,
            .root = _folder.at("drive"),
            .dispatch = _dispatch,
            .beforeWaiting = [this] { _dispatch->runUntilIdle(); }};
    }
    /// Presents an item and begins to watch it.
    std::shared_ptr<RecordingPresenter> present(LocalFileCoordinator& coordinator, const std::string& name)
    {
        const auto presenter = std::make_shared<RecordingPresenter>(_folder.at(name), _queue);
        coordinator.addFilePresenter(presenter);
        _dispatch->runUntilIdle();
        return presenter;
    }
    /// Delivers events and lets time pass. A second is enough for every notice.
    void settle(double seconds = 1)
    {
        while (g_main_context_iteration(nullptr, FALSE)) { }
        _dispatch->advance(seconds);
    }
    /// Sends a command, whose words with a slash are names in the test's folder.
    std::string ask(const std::string& command) { return _peer.ask(inFolder(command)); }
    std::string inFolder(const std::string& text) const
    {
        std::istringstream words(text);
        std::string all;
        for (std::string word; words >> word;)
            all += (all.empty() ? "" : " ") + (word.find('/') == word.npos ? word : _folder.at(word));
        return all;
    }

    testing_support::TemporaryDirectory _folder;
    const std::string _locks = _folder.at("locks/all");
    std::shared_ptr<testing_support::RecordingLog> _log = testing_support::RecordingLog::install();
    std::shared_ptr<testing_support::VirtualDispatch> _dispatch = testing_support::VirtualDispatch::create();
    std::shared_ptr<platform::OperationQueue> _queue =
        _dispatch->makeOperationQueue("presenters", platform::QualityOfService::Utility);
    PeerProcess _peer{_locks};
};

TEST_F(TwoProcessTest, aWriterWaitsForAReaderAndAReaderDoesNot)
{
    const auto item = Url::fileURL(_folder.at("drive/sub/deep/a.txt"));
    ASSERT_EQ(ask("reads drive/sub/deep/a.txt"), "holding");
    LocalFileCoordinator coordinator(settings());
    int runs = 0;
    EXPECT_FALSE(coordinator.coordinateReading(item, ReadingOptions::None, [&](auto&) { ++runs; }));
    EXPECT_EQ(runs, 1);

    std::atomic<bool> isReleased = false;
    std::thread writer([&] {
        const auto failed = coordinator.coordinateWriting(Url::fileURL(_folder.at("drive/sub")),
            WritingOptions::None, [&](auto&) { EXPECT_TRUE(isReleased); });
        EXPECT_FALSE(failed);
    });
    isReleased = true;
    EXPECT_EQ(_peer.ask("release"), "done");
    writer.join();
}

TEST_F(TwoProcessTest, aHolderThatHangsIsNotWaitedForForever)
{
    const auto item = Url::fileURL(_folder.at("drive/sub/deep/a.txt"));
    ASSERT_EQ(ask("writes drive/sub"), "holding");
    _peer.signal(SIGSTOP);
    LocalFileCoordinator coordinator(settings(std::chrono::milliseconds(5)));
    const auto ran = [](auto&) { ADD_FAILURE() << "ran all the same"; };
    for (const auto& refused : {coordinator.coordinateReading(item, ReadingOptions::None, ran),
             coordinator.coordinateWriting(item, WritingOptions::ForDeleting, ran)}) {
        ASSERT_TRUE(refused);
        EXPECT_EQ(refused->code(), EBUSY);
        EXPECT_EQ(refused->text(platform::errorKey::localizedDescription),
            "“a.txt” is being used by another program.");
    }
    EXPECT_EQ(_log->count("WARNING Cannot lock " + item.path() + ": Device or resource busy"), 2U);

    // A killed process holds no lock any more.
    _peer.signal(SIGKILL);
    EXPECT_EQ(_peer.receive(), "");
    EXPECT_FALSE(coordinator.coordinateWriting(item, WritingOptions::None, [](auto&) {}));
}

struct Told {
    const char* presented;
    std::vector<std::string> commands;
    std::vector<std::string> heard;
};

void PrintTo(const Told& row, std::ostream* stream)
{
    for (const auto& command : row.commands)
        *stream << (&command == row.commands.data() ? "" : ", ") << command;
}

class PresenterOfAnotherProcess : public TwoProcessTest, public testing::WithParamInterface<Told> { };

TEST_P(PresenterOfAnotherProcess, isToldOnceAndFollowsItsItem)
{
    LocalFileCoordinator coordinator(settings());
    const auto presenter = present(coordinator, GetParam().presented);
    for (const auto& command : GetParam().commands) {
        if (command == "settle" || command == "pause")
            settle(command == "pause" ? 0.1 : 1);
        else
            EXPECT_EQ(ask(command), "done");
    }
    settle();
    std::vector<std::string> expected;
    for (const auto& heard : GetParam().heard)
        expected.push_back(inFolder(heard));
    EXPECT_THAT(presenter->heard, ElementsAreArray(expected));
    // The item is watched in its new place as well.
    presenter->heard.clear();
    const auto last = expected.empty() ? std::string() : expected.back();
    const auto place = last.starts_with("moved to ") ? last.substr(9) : presenter->url.path();
    if (!fs::is_regular_file(place))
        return;
    EXPECT_EQ(_peer.ask("append " + place), "done");
    settle();
    EXPECT_THAT(presenter->heard, ElementsAre("changed"));
}

const char* const presentedFile = "drive/sub/deep/a.txt";
const char* const presentedFolder = "drive/sub/deep";

INSTANTIATE_TEST_SUITE_P(Changes, PresenterOfAnotherProcess,
    testing::ValuesIn(std::vector<Told>{
        {presentedFile, {"append drive/sub/deep/a.txt"}, {"changed"}},
        {presentedFile, {"write drive/sub/deep/a.txt", "write drive/sub/deep/a.txt"}, {"changed"}},
        {presentedFile, {"save drive/sub/deep/a.txt"}, {"changed"}},
        {presentedFile, {"rename drive/sub/deep/a.txt drive/sub/deep/a.txt~", "write drive/sub/deep/a.txt"},
            {"changed"}},
        {presentedFile,
            {"rename drive/sub/deep/a.txt drive/sub/deep/a.txt~", "pause", "write drive/sub/deep/a.txt"},
            {"changed"}},
        {presentedFile, {"delete drive/sub/deep/a.txt", "pause", "write drive/sub/deep/a.txt"}, {"changed"}},
        {presentedFile, {"rename drive/other/c.txt drive/sub/deep/a.txt"}, {"changed"}},
        {presentedFile,
            {"rename drive/sub/deep/a.txt cloud/content", "write drive/sub/deep/.a.txt.trwpromise"},
            {"changed"}},
        {presentedFile, {"move drive/sub/deep/a.txt drive/sub/deep/z.txt"},
            {"moved to drive/sub/deep/z.txt"}},
        {presentedFile, {"rename drive/sub/deep/a.txt drive/other/z.txt"}, {"moved to drive/other/z.txt"}},
        {presentedFile, {"rename drive/sub/deep/a.txt cloud/z.txt"}, {"moved to cloud/z.txt"}},
        {presentedFile, {"rename drive/sub drive/other/sub"}, {"moved to drive/other/sub/deep/a.txt"}},
        {presentedFile, {"remove drive/sub/deep/a.txt"}, {"deletes"}},
        {presentedFile, {"delete drive/sub"}, {"deletes"}},
        {presentedFile, {"rename ./drive cloud/drive"}, {}}, // a drive that was taken off deletes nothing
        {presentedFile, {"write drive/sub/deep/b.txt", "delete drive/sub/deep/b.txt"}, {}},
        {presentedFile, {"flood drive/sub/deep/x 20000", "write drive/sub/deep/a.txt"}, {"changed"}},
        {"drive/other/c.txt",
            {"rename drive/other/c.txt cloud/content", "write drive/other/.c.txt.trwpromise", "settle",
                "rename drive/other/.c.txt.trwpromise drive/sub/.d.txt.trwpromise", "settle",
                "delete drive/sub/.d.txt.trwpromise"},
            {"changed", "moved to drive/sub/d.txt", "deletes"}},
        {presentedFolder, {"append drive/sub/deep/new.txt"}, {"changed"}},
        {presentedFolder, {"append drive/sub/deep/a.txt"}, {"changed"}},
        {presentedFolder, {"remove drive/sub/deep/a.txt"}, {"deletes a.txt", "changed"}},
        {presentedFolder, {"write drive/sub/deep/new.txt", "delete drive/sub/deep/new.txt"}, {"changed"}},
        {presentedFolder, {"move drive/sub/deep drive/other/deep"}, {"moved to drive/other/deep"}},
        {presentedFolder, {"delete drive/sub"}, {"deletes"}},
        {presentedFolder, {"flood drive/sub/deep/x 20000"}, {"changed"}},
    }));

TEST_F(TwoProcessTest, whatThisProcessWritesIsNotToldTwice)
{
    LocalFileCoordinator coordinator(settings());
    const auto item = present(coordinator, presentedFile);
    const auto folder = present(coordinator, presentedFolder);
    const auto url = Url::fileURL(_folder.at(presentedFile)),
               moved = Url::fileURL(_folder.at("drive/other/m"));
    coordinator.coordinateWriting(url, WritingOptions::None, [&](const Url& at) {
        std::ofstream(at.path()) << "first part";
        settle();
        std::ofstream(at.path()) << "second part";
    });
    settle();
    EXPECT_THAT(item->heard, ElementsAre("changed"));
    EXPECT_THAT(folder->heard, ElementsAre("changed"));

    coordinator.coordinateWriting(url, WritingOptions::ForMoving, moved, WritingOptions::ForReplacing,
        [&](const Url& from, const Url& to) {
            coordinator.itemWillMove(from, to);
            fs::rename(from.path(), to.path());
            coordinator.itemDidMove(from, to);
        });
    settle();
    EXPECT_THAT(item->heard, ElementsAre("changed", "moves to " + moved.path(), "moved to " + moved.path()));
    EXPECT_THAT(folder->heard, ElementsAre("changed", "changed"));
    // The presenter still answers the old place, but the new one is watched.
    item->heard.clear();
    EXPECT_EQ(ask("write drive/other/m"), "done");
    settle();
    EXPECT_THAT(item->heard, ElementsAre("changed"));

    item->heard.clear();
    item->url = moved;
    coordinator.coordinateWriting(
        moved, WritingOptions::ForDeleting, [](const Url& at) { fs::remove(at.path()); });
    settle();
    EXPECT_THAT(item->heard, ElementsAre("deletes"));
}

TEST_F(TwoProcessTest, changesByOthersDuringAWriteAreReported)
{
    LocalFileCoordinator coordinator(settings());
    const auto item = present(coordinator, presentedFile);
    const auto folder = present(coordinator, presentedFolder);
    coordinator.coordinateWriting(
        Url::fileURL(_folder.at("drive/sub/deep/b.txt")), WritingOptions::ForDeleting, [&](const Url& at) {
            fs::remove(at.path());
            EXPECT_EQ(ask("delete drive/sub/deep/a.txt"), "done");
        });
    settle();
    EXPECT_THAT(item->heard, ElementsAre("deletes"));
    EXPECT_THAT(folder->heard, ElementsAre("deletes b.txt", "changed", "deletes a.txt", "changed"));
}

TEST_F(TwoProcessTest, aRemovedPresenterIsToldNothing)
{
    auto coordinator = std::make_unique<LocalFileCoordinator>(settings());
    const auto removed = present(*coordinator, presentedFile), kept = present(*coordinator, presentedFile);
    auto destroyed = present(*coordinator, presentedFile);
    coordinator->removeFilePresenter(*removed);
    destroyed.reset();
    EXPECT_EQ(ask("write drive/sub/deep/a.txt"), "done");
    settle();
    EXPECT_THAT(removed->heard, IsEmpty());
    EXPECT_THAT(kept->heard, ElementsAre("changed"));

    // The coordinator is destroyed while events and a look are pending.
    EXPECT_EQ(ask("write drive/sub/deep/a.txt"), "done");
    while (g_main_context_iteration(nullptr, FALSE)) { }
    _dispatch->runUntilIdle();
    EXPECT_EQ(ask("write drive/sub/deep/a.txt"), "done");
    coordinator.reset();
    settle();
    EXPECT_THAT(kept->heard, ElementsAre("changed"));
    EXPECT_EQ(_dispatch->pendingCount(), 0U);
}

/// Counts its notices on any thread, and wakes the main loop.
class CountingPresenter : public RecordingPresenter {
public:
    using RecordingPresenter::RecordingPresenter;
    std::atomic<int> changes = 0;
    void presentedItemDidChange() override
    {
        ++changes;
        g_main_context_wakeup(nullptr);
    }
};

TEST_F(TwoProcessTest, noChangeIsMissedOnRealThreads)
{
    constexpr int rounds = 50;
    const auto dispatch = std::make_shared<host::system::GLibDispatch>();
    const auto queue = dispatch->makeOperationQueue("presenters", platform::QualityOfService::Utility);
    auto chosen = settings();
    chosen.dispatch = dispatch;
    chosen.beforeWaiting = nullptr;
    LocalFileCoordinator coordinator(chosen);
    const auto url = Url::fileURL(_folder.at(presentedFile));
    const auto presenter = std::make_shared<CountingPresenter>(url.path(), queue);
    coordinator.addFilePresenter(presenter);

    std::thread writer([&] {
        for (int round = 0; round < rounds; ++round)
            EXPECT_FALSE(coordinator.coordinateWriting(
                url, WritingOptions::None, [](const Url& at) { std::ofstream(at.path()) << "own"; }));
    });
    std::thread visitor([&] {
        for (int round = 0; round < rounds; ++round)
            coordinator.addFilePresenter(std::make_shared<CountingPresenter>(url.path(), queue));
    });
    for (int round = 0; round < rounds; ++round)
        EXPECT_EQ(ask("append drive/sub/deep/a.txt"), "done");
    writer.join();
    visitor.join();
    // Each write of this process is reported, and sooner or later so is the write of the other process.
    while (presenter->changes < rounds)
        g_main_context_iteration(nullptr, TRUE);
    for (const int before = presenter->changes; presenter->changes == before;) {
        EXPECT_EQ(ask("append drive/sub/deep/a.txt"), "done");
        while (g_main_context_iteration(nullptr, FALSE)) { }
    }
    coordinator.removeFilePresenter(*presenter);
}

TEST_F(TwoProcessTest, withoutWatchesTheItemIsLookedAtNowAndThen)
{
#ifdef __SANITIZE_ADDRESS__
    GTEST_SKIP() << "the sanitizer's look at an object's type opens a pipe, which the limit below forbids";
#endif
    rlimit before{};
    ::getrlimit(RLIMIT_NOFILE, &before);
    LocalFileCoordinator coordinator(settings());
    const rlimit none{0, before.rlim_max};
    ::setrlimit(RLIMIT_NOFILE, &none);
    const auto presenter = present(coordinator, presentedFile);
    ::setrlimit(RLIMIT_NOFILE, &before);
    EXPECT_EQ(_log->count("WARNING Cannot watch the folders of " + _folder.at(presentedFile)
                  + ", looking now and then instead"),
        1U);
    _dispatch->advance(6);
    EXPECT_EQ(ask("write drive/sub/deep/a.txt"), "done");
    _dispatch->advance(6);
    EXPECT_THAT(presenter->heard, ElementsAre("changed"));
}

} // namespace
