// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/PromiseRecord.h"
#include "tests/sweep/support/SweepFixture.h"
#include "tests/sweep/support/Tally.h"

#include <sys/syscall.h>

#include <algorithm>
#include <filesystem>
#include <functional>
#include <utility>
#include <vector>

namespace {

namespace fs = std::filesystem;

using sweep_tests::Drive;
using sweep_tests::Ending;
using sweep_tests::Fault;
using sweep_tests::FileCall;

constexpr const char* saved = "saved meanwhile";

/// Lets another program change the drive between two calls of the operation.
class Meddling : public sweep_tests::SweepFixture {
protected:
    std::string item() const { return GetParam().arguments[1]; }
    /// Answers the document that a program may save meanwhile: the item, the document deepest inside it, or
    /// one in the place of the first folder made.
    std::string document() const
    {
        if (libraryDocument().find('/' + item() + '/') != std::string::npos)
            return libraryDocument();
        const std::pair<std::string, std::string> others[] = {{"folder", "folder/sub/b.txt"},
            {"new/one/two", "new"}, {"inner/here.textbundle", "inner/here.textbundle/assets/here"}};
        for (const auto& [argument, other] : others) {
            if (item() == argument)
                return at(other);
        }
        return at(item());
    }
    std::string target() const { return at(GetParam().arguments.back()); }

    /// Saves as editors do: into a file beside the document, which then replaces it. Answers whether it
    /// could. The file has a short name, because a longer one than the document's may be too long.
    static bool save(const std::string& path, const std::string& content = saved)
    {
        const auto folder = fs::path(path).parent_path();
        if (!fs::exists(folder))
            return false;
        const auto beside = (folder / "saving~").string();
        write(beside, content);
        std::error_code error;
        fs::rename(beside, path, error);
        return !error;
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
        for (const auto& name : {"/a.txt", "/b.txt", "/c.pdf", "/file.txt", "/sub/b.txt"})
            write(_outside + name, "precious");
    }
    Drive outside() const
    {
        Drive found;
        for (const auto& entry : fs::recursive_directory_iterator(_outside))
            found[entry.path()] = entry.is_regular_file() ? read(entry.path().string()) : "folder";
        return found;
    }
    /// Answers the part of the drive that stays after the operation in any case.
    Drive lasting() const
    {
        makeDrive();
        if (isRemoval())
            run();
        return seen();
    }
    /// Performs the deed before each call in turn, some of many in ./test, and checks afterwards, unless the
    /// deed was impossible.
    void meddle(const std::function<bool()>& deed, const std::function<void(const FileCall&)>& check) const
    {
        std::vector<FileCall> done;
        const auto perform = [&](const FileCall& call) {
            if (deed())
                done.push_back(call);
            return Fault{};
        };
        const auto checkDone = [&](const FileCall&, const Ending&) {
            startAgain();
            for (const auto& call : std::exchange(done, {})) {
                ++sweep_tests::tally().deeds;
                check(call);
            }
        };
        atEachCall(
            perform, checkDone, [](const FileCall&) { return true; }, Turns::Some);
    }

private:
    const std::string _outside = _folder.at("outside");
};

class MeddlingWithMoves : public Meddling { };
class MeddlingWithCopies : public Meddling { };

TEST_P(Meddling, WhatIsSavedMeanwhileIsKept)
{
    const auto stays = lasting();
    std::string replaced;
    // A save before the operation's last look at its item is removed with the item; a later save is not.
    bool isSeen = !isRemoval();
    meddle(
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
    meddle([&] { return !fs::exists(target()) && save(target()); },
        [&](const FileCall&) { EXPECT_TRUE(isAllThere(all)); });
}

TEST_P(MeddlingWithCopies, AreAsGoodAsTheOriginalOnceBothWereChanged)
{
    const Drive both{{document(), saved}, {target(), "saved there"}};
    meddle([&] { return fs::is_regular_file(target()) && save(target(), "saved there") && save(document()); },
        [&](const FileCall&) { EXPECT_TRUE(isAllThere(both)); });
}

TEST_P(Meddling, ALinkInPlaceOfAFolderLeadsNowhere)
{
    makeOutside();
    const auto before = outside();
    const auto& arguments = GetParam().arguments;
    for (auto argument = arguments.begin() + 1; argument != arguments.end(); ++argument) {
        const auto folder = *argument == "folder" ? "folder/sub" : fs::path(*argument).parent_path().string();
        SCOPED_TRACE(folder);
        meddle([&] { return swap(at(folder)); }, [&](const FileCall&) { EXPECT_EQ(outside(), before); });
    }
}

/// Answers the operations of this name, or with this argument.
std::vector<sweep_tests::Operation> operationsWith(const std::string& word)
{
    auto all = sweep_tests::operations();
    std::erase_if(all, [&](const auto& operation) {
        return operation.name != word
            && std::ranges::find(operation.arguments, word) == operation.arguments.end();
    });
    return all;
}

constexpr testing::PrintToStringParamName name;

INSTANTIATE_TEST_SUITE_P(Operations, Meddling, testing::ValuesIn(sweep_tests::operations()), name);
INSTANTIATE_TEST_SUITE_P(Operations, MeddlingWithMoves, testing::ValuesIn(operationsWith("move")), name);
INSTANTIATE_TEST_SUITE_P(
    Operations, MeddlingWithCopies, testing::ValuesIn(operationsWith("moveFileAcross")), name);

} // namespace
