// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// A list that follows its folder by the kernel's notices must always end in the state that a fresh reading
// gives.

#include "screens/list/FolderContents.h"
#include "tests/support/DriveFixture.h"

#include <algorithm>
#include <chrono>
#include <functional>
#include <random>

using namespace platform;
using namespace screens;

namespace {

using Lines = std::vector<std::string>;

Lines linesOf(const DocumentRows& rows)
{
    Lines lines;
    for (std::size_t row = 0; row < rows.count(); ++row) {
        const auto entry = rows.entry(row);
        lines.push_back(std::string(entry.name) + (entry.isPromise ? " promised " : " here ")
            + std::to_string(static_cast<int>(entry.kind)));
    }
    return lines;
}

struct NamedOrder {
    const char* name;
    ListOrder order;
};

void PrintTo(const NamedOrder& row, std::ostream* stream)
{
    *stream << row.name;
}

class LiveList : public testing::TestWithParam<NamedOrder> {
protected:
    /// A list, and the rows that a view would have after its changes.
    struct Followed {
        std::shared_ptr<FolderContents> contents;
        std::vector<kit::RowId> ids;
        Lines lines;
        std::size_t wholeLists = 0, revisions = 0;
    };

    std::shared_ptr<Followed> follow(const ListOrder& order)
    {
        const auto followed = std::make_shared<Followed>();
        followed->contents = FolderContents::create(drive.url("Stuff"),
            [weak = std::weak_ptr(followed)](const auto& update) { replay(*weak.lock(), update); });
        followed->contents->start(
            {{Url::fileURL("/elsewhere"), "Mail", FolderEntryKind::Library, {}}}, order);
        return followed;
    }
    static void replay(Followed& followed, const FolderContentsUpdate& update)
    {
        const auto after = linesOf(*update.rows);
        const auto& ids = update.rows->ids();
        (update.rows->snapshot()->revision() ? followed.revisions : followed.wholeLists) += 1;
        const auto splice = [](auto& values, const kit::ListSplice& change, const auto& news) {
            const auto at = static_cast<std::ptrdiff_t>(change.position);
            const auto place = values.erase(
                values.begin() + at, values.begin() + at + static_cast<std::ptrdiff_t>(change.removed));
            values.insert(
                place, news.begin() + at, news.begin() + at + static_cast<std::ptrdiff_t>(change.inserted));
        };
        for (const auto& change : update.changes.splices) {
            splice(followed.ids, change, ids);
            splice(followed.lines, change, after);
        }
        for (const auto& range : update.changes.changed)
            for (auto row = range.first; row < range.end(); ++row)
                followed.lines[row] = after[row];
        EXPECT_TRUE(std::ranges::equal(followed.ids, ids));
        EXPECT_EQ(followed.lines, after) << "a row shows what it was";
    }

    /// Runs the kernel's notices and the virtual clock until the condition holds. Answers false when it never
    /// does.
    bool waitUntil(const std::function<bool()>& condition) const
    {
        const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(60);
        while (!condition()) {
            if (std::chrono::steady_clock::now() > deadline)
                return false;
            drive.settle();
            drive.dispatch->advance(0.01);
        }
        return true;
    }

    std::string path(const std::string& name) const { return drive.url("Stuff/" + name).path(); }
    /// Makes one change of any kind to one of a few names, so that changes affect the same names.
    void changeAnything()
    {
        static const std::vector<std::string> names{"a", "B 2.txt", "b 10.txt", "b 9.pdf", "Über.txt",
            "uber.TXT", "z.trwalias", "Letter.pages", "mail", "x.png", "\xff.bin"};
        const auto& name = names[_random() % names.size()];
        const auto& other = names[_random() % names.size()];
        const auto promise = "." + name + ".trwpromise";
        std::error_code ignored;
        switch (_random() % 8) {
        case 0:
            std::ofstream(path(name)) << std::string(_random() % 5000, 'x');
            break;
        case 1:
            std::filesystem::remove_all(path(name), ignored);
            break;
        case 2:
            std::filesystem::rename(path(name), path(other), ignored);
            break;
        case 3: // to a promise and back
            drive.writePromise("Stuff/" + name, {});
            break;
        case 4:
            std::filesystem::remove(path(promise), ignored);
            break;
        case 5:
            std::filesystem::create_directory(path(name), ignored);
            break;
        case 6: // an atomic save
            std::ofstream(path(".trw-new")) << "saved";
            std::filesystem::rename(path(".trw-new"), path(name), ignored);
            break;
        default:
            std::filesystem::last_write_time(
                path(name), std::filesystem::file_time_type{std::chrono::hours(_random() % 1000)}, ignored);
        }
    }
    Lines whatIsThere()
    {
        const auto fresh = follow(GetParam().order);
        waitUntil([&] { return fresh->contents->rows()->count() > 0; });
        return fresh->lines;
    }

    testing_support::DriveFixture drive;
    std::mt19937 _random{7};
};

TEST_P(LiveList, EndsInTheStateThatAFreshReadingGives)
{
    drive.makeFolder("Stuff");
    for (int i = 0; i < 50; ++i)
        drive.writeDocument("Stuff/file " + std::to_string(i) + ".txt", std::string(i * 10U, 'x'));
    const auto list = follow(GetParam().order);
    ASSERT_TRUE(waitUntil([&] { return list->contents->rows()->count() == 51; }));
    for (int storm = 0; storm < 40; ++storm) {
        for (auto left = _random() % 30; left > 0; --left) {
            changeAnything();
            if (_random() % 10 == 0)
                waitUntil([turns = 0]() mutable { return ++turns > 3; });
        }
        const bool isRight = waitUntil([&] { return list->lines == whatIsThere(); });
        ASSERT_TRUE(isRight) << "storm " << storm;
    }
    EXPECT_EQ(list->wholeLists, 1U) << "single changes are no reason to read the folder again";
    EXPECT_GT(list->revisions, 40U);
}

TEST_P(LiveList, GoesOnWithAnotherFolderAtItsPlace)
{
    drive.writeDocument("Stuff/old.txt");
    const auto list = follow(GetParam().order);
    ASSERT_TRUE(waitUntil([&] { return list->contents->rows()->count() == 2; }));
    std::filesystem::rename(drive.url("Stuff").path(), drive.url("Elsewhere").path());
    drive.writeDocument("Stuff/new.txt");
    drive.writeDocument("Elsewhere/other.txt");
    ASSERT_TRUE(waitUntil([&] { return list->lines == Lines{"Mail here 3", "new.txt here 0"}; }));
    drive.writeDocument("Stuff/new too.txt");
    ASSERT_TRUE(waitUntil([&] { return list->lines.size() == 3; }));
}

INSTANTIATE_TEST_SUITE_P(InEveryOrder, LiveList,
    testing::Values(NamedOrder{"Name", {}},
        NamedOrder{"NameDescending", {OrderKey::Name, OrderDirection::Descending}},
        NamedOrder{"NameMixed", {OrderKey::Name, OrderDirection::Ascending, FolderGrouping::Mixed}},
        NamedOrder{"DateDescending", {OrderKey::Date, OrderDirection::Descending}},
        NamedOrder{"SizeMixed", {OrderKey::Size, OrderDirection::Ascending, FolderGrouping::Mixed}},
        NamedOrder{"KindDescending", {OrderKey::Kind, OrderDirection::Descending}}),
    [](const auto& row) { return std::string(row.param.name); });

} // namespace
