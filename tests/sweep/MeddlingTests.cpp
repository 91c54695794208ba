// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/PromiseRecord.h"
#include "tests/sweep/support/SweepFixture.h"

#include <gmock/gmock.h>

#include <sys/syscall.h>

#include <algorithm>
#include <filesystem>
#include <functional>

namespace {

namespace fs = std::filesystem;

using sweep_tests::Drive;
using sweep_tests::Fault;
using sweep_tests::FileCall;

constexpr const char* saved = "saved meanwhile";

/// Lets another program change the drive between two calls of the operation.
class Meddling : public sweep_tests::SweepFixture {
protected:
    std::string item() const { return GetParam().arguments[1]; }
    /// Answers the document that a program may save meanwhile: the item, the document deepest inside it, or
    /// one in its place.
    std::string document() const
    {
        return at(item() == "folder" ? "folder/sub/b.txt" : item().substr(0, item().find('/')));
    }
    std::string target() const { return at(GetParam().arguments.back()); }

    /// Saves as editors do: into a file beside the document, which then replaces it. Answers whether it
    /// could.
    static bool save(const std::string& path, const std::string& content = saved)
    {
        if (!fs::exists(fs::path(path).parent_path()))
            return false;
        write(path + '~', content);
        std::error_code error;
        fs::rename(path + '~', path, error);
        return true;
    }
    /// Moves a folder aside and puts a link to a place outside the drive in its place.
    bool swap(const std::string& path) const
    {
        std::error_code error;
        fs::rename(path, path + ".away", error);
        if (!error)
            fs::create_directory_symlink(_outside, path, error);
        return !error;
    }
    void makeOutside() const
    {
        fs::remove_all(_outside);
        fs::create_directories(_outside + "/sub");
        for (const auto& name : {"/a.txt", "/b.txt", "/c.pdf", "/sub/b.txt"})
            write(_outside + name, "precious");
    }
    std::size_t itemsOutside() const
    {
        return static_cast<std::size_t>(
            std::distance(fs::recursive_directory_iterator(_outside), fs::recursive_directory_iterator()));
    }
    /// Answers the part of the drive that stays after the operation in any case.
    Drive lasting() const
    {
        makeDrive();
        if (isRemoval())
            run([](const FileCall&) { return Fault{}; });
        return seen();
    }
    /// Performs the deed before each call in turn and checks afterwards, unless the deed was impossible.
    void atEachCall(
        const std::function<bool()>& deed, const std::function<void(const FileCall&)>& check) const
    {
        makeDrive();
        const int calls = run([](const FileCall&) { return Fault{}; }).calls;
        for (int point = 1; point <= calls; ++point) {
            makeDrive();
            bool isDone = false;
            FileCall met;
            run([&](const FileCall& call) {
                if (call.index == point) {
                    met = call;
                    isDone = deed();
                }
                return Fault{};
            });
            startAgain();
            SCOPED_TRACE("at call " + std::to_string(point) + ", " + std::to_string(met.number) + " on "
                + met.subject);
            if (isDone)
                check(met);
        }
    }

private:
    const std::string _outside = _folder.at("outside");
};

class MeddlingWithMoves : public Meddling { };
class MeddlingWithCopies : public Meddling { };
class MeddlingWithFolders : public Meddling { };

TEST_P(Meddling, WhatIsSavedMeanwhileIsKept)
{
    const auto stays = lasting();
    std::string replaced;
    // A save before the operation's last look at its item is removed with the item; a later save is not.
    bool isSeen = !isRemoval();
    atEachCall(
        [&] {
            replaced = fs::is_regular_file(document()) ? read(document()) : std::string();
            // The other program deletes the document that is being downloaded, and makes another one of the
            // same name.
            if (GetParam().arguments[0] == "fetch")
                fs::remove(host::drive::PromiseRecord::pathFor(document()));
            return save(document());
        },
        [&](const FileCall& call) {
            auto expected = stays;
            std::erase_if(expected, [&](const auto& item) { return item.second == replaced; });
            isSeen = isSeen || call.number == SYS_renameat2;
            if (isSeen)
                expected[document()] = saved;
            EXPECT_TRUE(isAllThere(expected));
        });
    EXPECT_TRUE(isSeen);
}

TEST_P(MeddlingWithMoves, ADocumentUnderTheNewNameIsNeverReplaced)
{
    makeDrive();
    auto all = seen();
    all[target()] = saved;
    atEachCall([&] { return !fs::exists(target()) && save(target()); },
        [&](const FileCall&) { EXPECT_TRUE(isAllThere(all)); });
}

TEST_P(MeddlingWithCopies, AreAsGoodAsTheOriginalOnceBothWereChanged)
{
    const Drive both{{document(), saved}, {target(), "saved there"}};
    atEachCall(
        [&] { return fs::is_regular_file(target()) && save(target(), "saved there") && save(document()); },
        [&](const FileCall&) { EXPECT_TRUE(isAllThere(both)); });
}

TEST_P(MeddlingWithFolders, ALinkInPlaceOfAFolderLeadsNowhere)
{
    makeOutside();
    const auto items = itemsOutside();
    const auto& folder = item() == "folder" ? "folder/sub" : "target";
    atEachCall([&] { return swap(at(folder)); }, [&](const FileCall&) { EXPECT_EQ(itemsOutside(), items); });
}

std::string nameOf(const testing::TestParamInfo<sweep_tests::Operation>& row)
{
    return row.param.name;
}

using Wanted = std::function<bool(const sweep_tests::Operation&)>;

std::vector<sweep_tests::Operation> operationsThat(const Wanted& wanted)
{
    auto all = sweep_tests::operations();
    std::erase_if(all, std::not_fn(wanted));
    return all;
}

Wanted have(const std::string& argument)
{
    return [argument](const auto& operation) {
        return std::ranges::find(operation.arguments, argument) != operation.arguments.end();
    };
}

/// Answers whether the operation copies documents that exist already.
bool copies(const sweep_tests::Operation& operation)
{
    return operation.fileSystems == sweep_tests::FileSystems::Several && have("file.txt")(operation);
}

INSTANTIATE_TEST_SUITE_P(Operations, Meddling, testing::ValuesIn(sweep_tests::operations()), nameOf);
INSTANTIATE_TEST_SUITE_P(
    Operations, MeddlingWithMoves, testing::ValuesIn(operationsThat(have("move"))), nameOf);
INSTANTIATE_TEST_SUITE_P(Operations, MeddlingWithCopies, testing::ValuesIn(operationsThat(copies)), nameOf);
INSTANTIATE_TEST_SUITE_P(
    IntoFolders, MeddlingWithFolders, testing::ValuesIn(operationsThat(have("target/new.txt"))), nameOf);
INSTANTIATE_TEST_SUITE_P(
    OfFolders, MeddlingWithFolders, testing::ValuesIn(operationsThat(have("folder"))), nameOf);

} // namespace
