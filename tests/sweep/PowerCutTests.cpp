// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/LocalCloudStore.h"
#include "host/drive/changes/Recovery.h"
#include "tests/sweep/support/DiskImage.h"
#include "tests/sweep/support/SweepFixture.h"
#include "tests/sweep/support/Tally.h"

#include <gmock/gmock.h>

#include <sys/syscall.h>

#include <cstdlib>
#include <filesystem>

namespace {

namespace fs = std::filesystem;

using sweep_tests::Fault;
using sweep_tests::FileCall;
using sweep_tests::FileSystems;
using sweep_tests::MountedDisk;

/// Says what other programs do with the disk while the operation runs.
enum class Others { AreQuiet, SyncTheirFiles };

/// Runs an operation on a disk of its own, copies the disk at each moment at which something reaches it, and
/// starts again on each copy, as after a power cut at that moment.
class PowerCut : public sweep_tests::SweepFixture {
protected:
    /// Settles what has a private name without a record: nothing keeps the order of two disks.
    void settleStrays() const
    {
        host::drive::LocalCloudStore store(_layout);
        EXPECT_FALSE(
            host::drive::Recovery(_layout, store, std::chrono::nanoseconds(0)).settleStraysAmongItems());
    }
    void TearDown() override { unmount(); }
    static bool isLong() { return ::getenv("TARROW_LONG_SWEEP") != nullptr; }

    /// Makes the drive on new disks. Answers whether disks can be mounted here.
    bool mountNewDrive()
    {
        for (const auto& disk : _disks)
            sweep_tests::makeDiskImage(image(disk, "now"));
        return mount("now", [this] { makeDrive(); });
    }
    /// Mounts the copies of a moment, which replays their journals.
    bool mountCopy(const std::string& moment)
    {
        return mount(moment, [] {});
    }
    /// Mounts a disk of another program on the device that was the drive's.
    std::shared_ptr<MountedDisk> mountOther() const
    {
        sweep_tests::makeDiskImage(_images.at("other"));
        return MountedDisk::mount(_images.at("other"), _elsewhere.path());
    }
    void unmount()
    {
        while (!_mounted.empty())
            _mounted.pop_back();
    }
    /// Runs the operation and copies the disks at its moments. Answers the moments, the end of the run as the
    /// last.
    std::vector<std::string> runToTheEnd(Others others)
    {
        for (const auto& disk : _mounted)
            disk->sync();
        std::vector<std::string> moments;
        const auto copy = [&](const std::string& moment) {
            for (const auto& disk : others == Others::SyncTheirFiles ? _mounted : Mounted())
                disk->syncOtherFile();
            moments.push_back(moment);
            for (const auto& disk : _disks)
                fs::copy_file(image(disk, "now"), image(disk, moment));
        };
        const auto ending = run([&](const FileCall& call) {
            if (isMoment(call))
                copy("before call " + std::to_string(call.index) + ", " + std::to_string(call.number));
            return Fault{};
        });
        EXPECT_EQ(ending.status, 0);
        copy("after the end");
        return moments;
    }
    void removeCopy(const std::string& moment) const
    {
        for (const auto& disk : _disks)
            fs::remove(image(disk, moment));
    }

private:
    using Mounted = std::vector<std::shared_ptr<MountedDisk>>;

    template <typename Between>
    bool mount(const std::string& moment, const Between& between)
    {
        _mounted.push_back(MountedDisk::mount(image(_disks[0], moment), _folder.path()));
        if (!_mounted.back())
            return false;
        between();
        if (_disks.size() > 1)
            _mounted.push_back(MountedDisk::mount(image(_disks[1], moment), at("target")));
        return _mounted.back() != nullptr;
    }
    /// The long run also stops before what is not synced by then.
    static bool isMoment(const FileCall& call)
    {
        return call.changesNames() || call.number == SYS_fsync || (isLong() && call.mayNeedSpace());
    }
    std::string image(const std::string& disk, const std::string& moment) const
    {
        return _images.at(disk + ' ' + moment);
    }
    /// Images in memory need not wait for a real disk.
    static fs::path placeOfImages()
    {
        return fs::is_directory("/dev/shm") ? fs::path("/dev/shm") : fs::temp_directory_path();
    }

    const testing_support::TemporaryDirectory _images{placeOfImages()};
    const testing_support::TemporaryDirectory _elsewhere;
    const std::vector<std::string> _disks = GetParam().fileSystems == FileSystems::One
        ? std::vector<std::string>{"drive"}
        : std::vector<std::string>{"drive", "target"};
    Mounted _mounted; ///< the second one lies in the first
};

TEST_P(PowerCut, LosesNothingAtAnyMoment)
{
    int images = 0;
    for (const auto others : {Others::SyncTheirFiles, Others::AreQuiet}) {
        // Less of an operation is on the disk by itself, so a cut without others seldom finds more.
        if (others == Others::AreQuiet && !isLong())
            continue;
        SCOPED_TRACE(others == Others::AreQuiet ? "alone" : "while others sync their files");
        if (!mountNewDrive())
            GTEST_SKIP() << "No disk can be mounted here, so no power cut was tried.";
        const auto before = seen();
        const auto moments = runToTheEnd(others);
        const auto after = seen();
        unmount();
        // The disks have other device numbers after the restart.
        const auto other = mountOther();
        for (const auto& moment : moments) {
            SCOPED_TRACE(moment);
            ASSERT_TRUE(mountCopy(moment));
            EXPECT_TRUE(isNothingHalf(seen(), before)) << differences(seen(), before);
            EXPECT_TRUE(isAllThere(isRemoval() ? after : before));
            startAgain();
            settleStrays();
            const auto now = noticed();
            // A download may have to be made again: its content is in the cloud until a sync of everything.
            const bool isCertain = moment == moments.back() && GetParam().arguments[0] != "fetch";
            EXPECT_TRUE(isCertain ? now == after : isBeforeAfterOrBoth(now, before, after))
                << differences(now, before);
            EXPECT_THAT(leftovers(), testing::IsEmpty());
            unmount();
            removeCopy(moment);
            ++images;
            ++sweep_tests::tally().powerCuts;
        }
    }
    RecordProperty("images", images);
}

INSTANTIATE_TEST_SUITE_P(
    Operations, PowerCut, testing::ValuesIn(sweep_tests::operations()), testing::PrintToStringParamName());

} // namespace
