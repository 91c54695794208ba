// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/DownloadWork.h"
#include "host/drive/changes/LocalCloudStore.h"
#include "host/drive/changes/LocalItemChanges.h"
#include "host/drive/records/PromiseFile.h"
#include "tests/sweep/support/SweepFixture.h"
#include "tests/sweep/support/Tally.h"

#include <cstdlib>
#include <filesystem>
#include <functional>

namespace {

namespace fs = std::filesystem;

using host::drive::LocalCloudStore;
using host::drive::PromiseRecord;
using sweep_tests::Drive;
using sweep_tests::Fault;
using sweep_tests::FileCall;

/// Lets another program do something to the very item that an operation works on, between two of its calls.
/// Programs of ours among them do not wait for the operation's locks, as if these were lost.
class OtherPrograms : public sweep_tests::SweepFixture {
protected:
    struct Deed {
        const char* name;
        std::function<bool()> perform; ///< answers whether it was possible
        bool deletes = false;
    };
    std::string item() const { return at(GetParam().arguments[1]); }
    std::string promise() const { return PromiseRecord::pathFor(item()); }
    std::string away(const std::string& path) const { return at("target" + path.substr(path.rfind('/'))); }
    static bool rename(const std::string& from, const std::string& to)
    {
        std::error_code error;
        fs::rename(from, to, error);
        return !error;
    }
    bool evict() const
    {
        return fs::exists(item())
            && !host::drive::LocalItemChanges(
                _layout, std::make_shared<LocalCloudStore>(_layout), [](const auto&) {
                    return true;
                }).evictItem(item());
    }
    bool fetch() const
    {
        LocalCloudStore store(_layout);
        return fs::is_regular_file(promise())
            && !host::drive::bringHere(
                _layout, store, item(), [](auto, auto) { return host::drive::CloudStore::Continue::Yes; },
                [](const auto& steps) {
                    steps();
                    return std::optional<platform::Error>();
                });
    }
    bool copyPromise() const
    {
        const auto copied = "cp -a '" + promise() + "' '" + at("target/.copy.trwpromise") + "'";
        return fs::is_regular_file(promise()) && std::system(copied.c_str()) == 0;
    }
    std::vector<Deed> deeds() const
    {
        return {{"moves the document", [this] { return rename(item(), away(item())); }},
            {"moves the promise", [this] { return rename(promise(), away(promise())); }},
            {"deletes the document", [this] { return fs::remove_all(item()) > 0; }, true},
            {"deletes the promise", [this] { return fs::remove(promise()); }, true},
            {"copies the promise", [this] { return copyPromise(); }},
            {"evicts the document", [this] { return evict(); }},
            {"fetches the document", [this] { return fetch(); }}};
    }
    /// Performs a deed before every so many calls, and checks afterwards, if the deed was possible.
    void meddle(const Deed& deed, const std::function<void(const FileCall&)>& check) const
    {
        const int step = ::getenv("TARROW_LONG_SWEEP") ? 1 : 12;
        for (int at = 1, ended = at; at <= ended; at += step) {
            makeDrive();
            bool isDone = false;
            FileCall met;
            const auto ending = run([&](const FileCall& call) {
                if (call.index == at) {
                    met = call;
                    isDone = deed.perform();
                }
                return Fault{};
            });
            ended = ending.calls;
            startAgain();
            if (isDone) {
                ++sweep_tests::tally().deeds;
                check(met);
            }
        }
    }
    /// Answers the promises whose content is nowhere.
    static std::vector<std::string> empty(const Drive& drive)
    {
        std::vector<std::string> found;
        for (const auto& [name, content] : drive) {
            if (name.starts_with("promise of ") && content == "nothing")
                found.push_back(name);
        }
        return found;
    }
};

TEST_P(OtherPrograms, LoseNothingAndLeaveNoPromiseOfNothing)
{
    makeDrive();
    if (isRemoval())
        run();
    const auto lasting = seen();
    for (const auto& deed : deeds()) {
        SCOPED_TRACE(deed.name);
        meddle(deed, [&](const FileCall& call) {
            SCOPED_TRACE("before call " + std::to_string(call.index) + " on " + call.subject);
            auto expected = lasting;
            if (deed.deletes)
                std::erase_if(
                    expected, [&](const auto& each) { return each.first.find(item()) != std::string::npos; });
            EXPECT_TRUE(isAllThere(expected)) << differences(seen(), lasting);
            EXPECT_EQ(empty(seen()), std::vector<std::string>());
        });
    }
}

std::vector<sweep_tests::Operation> onDocuments()
{
    auto all = sweep_tests::operations();
    std::erase_if(all, [](const auto& operation) {
        const auto& item = operation.arguments[1];
        return !item.ends_with("file.txt") && !item.ends_with("/p.txt") && !item.ends_with(".textbundle");
    });
    return all;
}

INSTANTIATE_TEST_SUITE_P(
    Operations, OtherPrograms, testing::ValuesIn(onDocuments()), testing::PrintToStringParamName());

} // namespace
