#include "host/drive/LocalCloudStore.h"
#include "host/drive/PromiseRecord.h"
#include "host/drive/Recovery.h"
#include "tests/support/TemporaryDirectory.h"
#include "tests/sweep/support/FaultyRun.h"

#include <gmock/gmock.h>

#include <sys/syscall.h>

#include <cerrno>
#include <filesystem>
#include <fstream>
#include <map>
#include <ostream>

namespace {

namespace fs = std::filesystem;

using host::drive::DriveLayout;
using host::drive::PromiseRecord;
using sweep_tests::Ending;
using sweep_tests::Fault;
using sweep_tests::FileCall;

/// Whether documents can be renamed from folder to folder.
enum class FileSystems { One, Several };

struct Operation {
    const char* name;
    std::vector<std::string> arguments;
    FileSystems fileSystems = FileSystems::One;
};

void PrintTo(const Operation& operation, std::ostream* stream)
{
    *stream << operation.name;
}

/// What a user sees: every item by its path, a document with its content, a promise with the content behind
/// it.
using Drive = std::map<std::string, std::string>;

class Sweep : public testing::TestWithParam<Operation> {
protected:
    Sweep() { ::setenv("TARROW_DRIVE_HOME", _layout.home().c_str(), 1); }
    ~Sweep() override { ::unsetenv("TARROW_DRIVE_HOME"); }

    void makeDrive() const
    {
        fs::remove_all(_layout.home());
        for (const auto& folder : {"folder/sub", "folder/empty", "target"})
            fs::create_directories(at(folder));
        fs::create_directories(_layout.cloud());
        write(at("file.txt"), std::string(100'000, 'f'));
        write(at("folder/a.txt"), "a");
        write(at("folder/sub/b.txt"), "bb");
        fs::create_symlink("../a.txt", at("folder/sub/link"));
        promise("folder/sub/c.pdf", "ccc");
        promise("p.txt", "pppp");
        write(at("twin.txt"), "of the document");
        promise("twin.txt", "that nobody has seen");
        promise("bystander.pdf", "kept");
    }
    std::string at(const std::string& path) const { return _layout.defaultContainer() + '/' + path; }

    /// Runs the operation and lets one of its calls meet a fault; none for call 0.
    Ending run(const std::function<Fault(const FileCall&)>& faultFor) const
    {
        std::vector<std::string> command{TARROW_FILES_COMMAND};
        command.insert(command.end(), GetParam().arguments.begin(), GetParam().arguments.end());
        return sweep_tests::runWithFaults(command, _layout.home() + '/', [&](const FileCall& call) {
            const auto fault = faultFor(call);
            return fault.kind == Fault::Kind::None && isForOtherFileSystem(call)
                ? Fault{Fault::Kind::Error, EXDEV}
                : fault;
        });
    }
    /// What any program does when it starts on the drive.
    void startAgain() const
    {
        host::drive::LocalCloudStore store(_layout);
        host::drive::Recovery(_layout, store).run();
    }

    Drive seen() const
    {
        Drive drive;
        for (auto each = fs::recursive_directory_iterator(_layout.documents());
             each != fs::recursive_directory_iterator(); ++each) {
            const auto path = each->path().string();
            if (const auto item = PromiseRecord::itemPathFor(path))
                drive["promise of " + *item] = behind(path);
            else if (each->path().filename().string().starts_with(".trw"))
                each.disable_recursion_pending();
            else
                drive[path] = each->is_symlink() ? "link to " + fs::read_symlink(path).string()
                    : each->is_directory()       ? "folder"
                                                 : read(path);
        }
        return drive;
    }
    /// What should not be there once nobody works on the drive.
    std::vector<std::string> leftovers() const
    {
        std::vector<std::string> found;
        std::size_t contents = 0;
        for (const auto& entry : fs::recursive_directory_iterator(_layout.home())) {
            const auto path = entry.path().string();
            const auto name = entry.path().filename().string();
            if (path.starts_with(_layout.cloud() + '/'))
                ++contents;
            else if (name.starts_with(".trw") || path.starts_with(_layout.held() + '/')
                || path.starts_with(_layout.trash() + '/'))
                found.push_back(path);
        }
        for (const auto& [path, content] : seen()) {
            if (path.starts_with("promise of ") && content != "nothing")
                --contents;
        }
        if (contents != 0)
            found.push_back("contents without a promise: " + std::to_string(contents));
        return found;
    }
    /// Every content of a drive lies somewhere, under whatever name.
    bool isAllThere(const Drive& drive) const
    {
        std::vector<std::string> contents;
        for (const auto& entry : fs::recursive_directory_iterator(_layout.home())) {
            if (entry.is_regular_file() && !entry.is_symlink())
                contents.push_back(read(entry.path().string()));
        }
        return std::ranges::all_of(drive, [&](const auto& item) {
            return item.second == "folder" || item.second.starts_with("link to ")
                || std::ranges::find(contents, item.second) != contents.end();
        });
    }
    static bool isPart(const Drive& part, const Drive& whole) { return std::ranges::includes(whole, part); }
    static std::string differences(const Drive& now, const Drive& before)
    {
        std::string text;
        const auto add = [&](const char* what, const Drive& some, const Drive& others) {
            for (const auto& item : some) {
                if (const auto other = others.find(item.first); other == others.end() || *other != item)
                    text += what + item.first + ": " + item.second.substr(0, 20);
            }
        };
        add("\n  is now ", now, before);
        add("\n  was ", before, now);
        return text;
    }
    /// No name shows anything but what was under some name before.
    static bool isNothingHalf(const Drive& now, const Drive& before)
    {
        return std::ranges::all_of(now, [&](const auto& item) {
            return item.second == "folder" || item.second == "nothing"
                || std::ranges::any_of(before, [&](const auto& old) { return old.second == item.second; });
        });
    }

    const testing_support::TemporaryDirectory _folder;
    const DriveLayout _layout = DriveLayout::at(_folder.at("drive")).prepare();

private:
    bool isForOtherFileSystem(const FileCall& call) const
    {
        const auto folderOf = [](const std::string& path) { return path.substr(0, path.rfind('/')); };
        const auto isPrivate = [](const std::string& path) {
            return path.substr(path.rfind('/') + 1).starts_with(".trw");
        };
        return GetParam().fileSystems == FileSystems::Several && call.number == SYS_renameat2
            && folderOf(call.subject) != folderOf(call.newName) && !isPrivate(call.subject)
            && !isPrivate(call.newName);
    }
    static void write(const std::string& path, const std::string& content)
    {
        std::ofstream(path, std::ios::binary) << content;
    }
    static std::string read(const std::string& path)
    {
        std::ifstream file(path, std::ios::binary);
        return {std::istreambuf_iterator<char>(file), {}};
    }
    void promise(const std::string& path, const std::string& content) const
    {
        PromiseRecord record;
        record.content = "content of " + fs::path(path).filename().string();
        record.size = content.size();
        record.modified = platform::Date{1'600'000'000'000'000'000};
        write(_layout.cloud() + '/' + record.content, content);
        write(PromiseRecord::pathFor(at(path)), record.toJson());
    }
    std::string behind(const std::string& promisePath) const
    {
        const auto record = PromiseRecord::parse(read(promisePath));
        const auto content = _layout.cloud() + '/' + (record ? record->content : std::string("damaged"));
        return fs::exists(content) ? read(content) : "nothing";
    }
};

TEST_P(Sweep, AKillAtAnyCallLosesNothingAndTheNextStartPutsItRight)
{
    makeDrive();
    const auto before = seen();
    const auto whole = run([](const FileCall&) { return Fault{}; });
    ASSERT_EQ(whole.status, 0);
    const auto after = seen();
    ASSERT_NE(before, after);
    ASSERT_THAT(leftovers(), testing::IsEmpty());
    ASSERT_GE(whole.calls, 10);
    RecordProperty("calls", whole.calls);
    const bool isRemoval = GetParam().arguments[0] == "remove";

    for (int point = 1; point <= whole.calls; ++point) {
        makeDrive();
        std::string what;
        const auto ending = run([&](const FileCall& call) {
            if (call.index != point)
                return Fault{};
            what = std::to_string(call.number) + " on " + call.subject;
            return Fault{Fault::Kind::Kill};
        });
        SCOPED_TRACE("killed at call " + std::to_string(point) + ", " + what);
        ASSERT_TRUE(ending.wasKilled);
        EXPECT_TRUE(isNothingHalf(seen(), before));
        EXPECT_TRUE(isAllThere(isRemoval ? after : before));
        startAgain();
        const auto now = seen();
        const bool isOnTheWay =
            GetParam().arguments[0] == "mkdir" && isPart(before, now) && isPart(now, after);
        EXPECT_TRUE(now == before || now == after || isOnTheWay) << differences(now, before);
        EXPECT_THAT(leftovers(), testing::IsEmpty());
    }
}

TEST_P(Sweep, AFailureOfAnyCallLeavesAllAsItWasOrAllDone)
{
    makeDrive();
    const auto before = seen();
    const auto whole = run([](const FileCall&) { return Fault{}; });
    const auto after = seen();
    for (const int error : {ENOSPC, EIO, EACCES}) {
        for (int point = 1; point <= whole.calls; ++point) {
            makeDrive();
            FileCall met;
            const auto ending = run([&](const FileCall& call) {
                const bool isMet = call.index == point && (error != ENOSPC || call.mayNeedSpace())
                    && (error != EACCES || call.takesPath());
                if (isMet)
                    met = call;
                return isMet ? Fault{Fault::Kind::Error, error} : Fault{};
            });
            if (met.index == 0)
                continue;
            SCOPED_TRACE(std::string(::strerrorname_np(error)) + " at call " + std::to_string(point) + ", "
                + std::to_string(met.number) + " on " + met.subject);
            const auto now = seen();
            // Only that the change reached the disk can fail once it is made.
            EXPECT_TRUE((now == before && ending.status != 0)
                || (now == after && (ending.status == 0 || met.number == SYS_fsync)))
                << "status " << ending.status << differences(now, before);
            if (!leftovers().empty())
                startAgain();
            EXPECT_THAT(leftovers(), testing::IsEmpty());
            EXPECT_TRUE(seen() == now) << differences(seen(), now);
        }
    }
}

INSTANTIATE_TEST_SUITE_P(Operations, Sweep,
    testing::Values(Operation{"mkdir", {"mkdir", "new/one/two"}},
        Operation{"removeFile", {"remove", "file.txt"}}, Operation{"removeFolder", {"remove", "folder"}},
        Operation{"removePromise", {"remove", "p.txt"}}, Operation{"removeTwin", {"remove", "twin.txt"}},
        Operation{"moveFile", {"move", "file.txt", "target/new.txt"}},
        Operation{"moveFolder", {"move", "folder", "target/new"}},
        Operation{"movePromise", {"move", "p.txt", "target/new.txt"}},
        Operation{"moveFileAcross", {"move", "file.txt", "target/new.txt"}, FileSystems::Several},
        Operation{"moveFolderAcross", {"move", "folder", "target/new"}, FileSystems::Several},
        Operation{"movePromiseAcross", {"move", "p.txt", "target/new.txt"}, FileSystems::Several},
        Operation{"evict", {"evict", "file.txt"}}),
    [](const auto& row) { return std::string(row.param.name); });

} // namespace
