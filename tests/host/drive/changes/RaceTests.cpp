// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/LocalCloudStore.h"
#include "host/drive/changes/LocalItemChanges.h"
#include "host/drive/changes/Recovery.h"
#include "tests/support/DriveFixture.h"

#include <fcntl.h>

#include <atomic>
#include <cstdio>
#include <cstdlib>
#include <set>
#include <thread>

namespace {

namespace fs = std::filesystem;

using namespace host::drive;
using host::system::FileDescriptor;
using testing_support::contentOf;

/// Is called between the check of a document and its removal or move, because the document has a promise
/// beside it. At that moment it lets other programs work for as long as they like.
class WindowStore : public LocalCloudStore {
public:
    using LocalCloudStore::LocalCloudStore;
    bool holdsOtherThan(const std::string&, const FileDescriptor&) override
    {
        inTheWindow();
        return true;
    }
    std::function<void()> inTheWindow = [] {};
};

/// Saves numbered versions of a document by replacing it, and records which versions it replaced itself.
class Saver {
public:
    Saver(std::string path, std::string temporary)
        : _path(std::move(path))
        , _temporary(std::move(temporary))
    {
    }
    void save()
    {
        std::ofstream(_temporary) << ++_last;
        const auto rename = [&](unsigned how) {
            return ::renameat2(AT_FDCWD, _temporary.c_str(), AT_FDCWD, _path.c_str(), how) == 0;
        };
        while (!rename(RENAME_NOREPLACE)) {
            if (!rename(RENAME_EXCHANGE))
                continue;
            int replaced = 0;
            std::ifstream(_temporary) >> replaced;
            accounted.insert(replaced);
            fs::remove(_temporary);
            break;
        }
        saved = _last;
    }
    /// Saves on a thread of its own until it is stopped.
    void start()
    {
        save();
        _thread = std::thread([this] {
            while (!_isOver) {
                if (isResting)
                    std::this_thread::yield();
                else
                    save();
            }
        });
    }
    void stop()
    {
        _isOver = true;
        _thread.join();
    }
    std::atomic<int> saved = 0;
    std::atomic<bool> isResting = false;
    std::set<int> accounted; ///< used on the saver's thread only

private:
    std::string _path, _temporary;
    int _last = 0;
    std::atomic<bool> _isOver = false;
    std::thread _thread;
};

/// The long run takes so many rounds in each test.
int roundsOf(int few)
{
    constexpr int many = 50'000;
    return ::getenv("TARROW_LONG_SWEEP") ? many : few;
}

class RaceTest : public testing::Test, public testing_support::DriveFixture {
protected:
    /// Checks that every saved version exists somewhere, was replaced by its saver, or is one of these.
    void expectNoneLost(const Saver& saver, std::set<int> accounted)
    {
        accounted.insert(saver.accounted.begin(), saver.accounted.end());
        host::drive::Recovery(layout(), *store).run();
        for (const auto& entry : fs::recursive_directory_iterator(layout().home())) {
            if (entry.is_regular_file())
                accounted.insert(std::atoi(contentOf(entry.path().string()).c_str()));
        }
        for (int version = 1; version <= saver.saved; ++version)
            EXPECT_TRUE(accounted.contains(version)) << version << " of " << saver.saved << " is lost";
    }
    const std::shared_ptr<WindowStore> store = std::make_shared<WindowStore>(layout());
    LocalItemChanges changes{layout(), store};
};

TEST_F(RaceTest, NoVersionIsDeletedThatTheDeleterHadNotSeen)
{
    const int rounds = roundsOf(200);
    const auto item = url("a.txt");
    writeDocument(".a.txt.trwpromise", R"({"content": "other"})");
    Saver saver(item.path(), folder().at("temporary"));
    saver.start();
    std::set<int> deleted;
    for (int round = 0; round < rounds;) {
        // In every other round a save certainly comes between the check and the operation.
        const int before = saver.saved;
        const bool isSaveAwaited = round % 2 == 0;
        store->inTheWindow = [&] {
            while (isSaveAwaited && saver.saved == before)
                std::this_thread::yield();
        };
        const auto version = changes.versionOfItem(item.path());
        const FileDescriptor seen(::open(item.path().c_str(), O_RDONLY | O_CLOEXEC));
        struct stat status { };
        if (!version || ::fstat(seen.get(), &status) != 0 || host::drive::versionOf(status) != *version)
            continue;
        ++round;
        if (!changes.removeItem(item.path(), version)) {
            char text[16] = {};
            ASSERT_GT(::pread(seen.get(), text, sizeof text - 1, 0), 0);
            deleted.insert(std::atoi(text));
        }
    }
    saver.stop();
    expectNoneLost(saver, deleted);
    std::printf("Tried: %d races\n", rounds);
    EXPECT_GT(saver.saved, rounds / 2);
}

TEST_F(RaceTest, NoVersionIsReplacedThatWasNotRead)
{
    const int rounds = roundsOf(300);
    const auto item = url("a.txt");
    Saver saver(item.path(), folder().at("temporary"));
    saver.start();
    std::set<int> accounted;
    int replaced = 0;
    for (int round = 0; round < rounds; ++round) {
        // A saver that never rests is always quicker than a program that reads first.
        saver.isResting = round % 2 == 0;
        const auto before = changes.contentToReplace(item.path(), 100);
        if (before && changes.replaceContent(item.path(), *before, "0")) {
            accounted.insert(std::atoi(before->bytes->c_str()));
            ++replaced;
        }
    }
    saver.stop();
    EXPECT_THAT(contentOf(item.path()), testing::AnyOf(std::to_string(saver.saved), "0"))
        << "the newest version has the name";
    expectNoneLost(saver, accounted);
    std::printf("Tried: %d races\n", rounds);
    EXPECT_GT(replaced, 0);
    EXPECT_GT(saver.saved, 1);
}

} // namespace
