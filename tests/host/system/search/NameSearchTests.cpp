// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/desktop/MimeTypeRegistry.h"
#include "host/system/files/ItemPaths.h"
#include "host/system/search/IndexedNameSearch.h"
#include "host/system/search/NameIndex.h"
#include "host/system/texts/NameFolding.h"
#include "tests/support/TemporaryDirectory.h"
#include "tests/support/VirtualDispatch.h"

#include <gmock/gmock.h>

#include <filesystem>
#include <fstream>
#include <map>

namespace {

using namespace host::system;
using namespace platform;
using namespace testing;
using Names = std::vector<std::string>;

std::string folded(std::string_view name)
{
    std::string text;
    NameFolding().append(name, text);
    return text;
}

TEST(NameFoldingTests, LeavesCaseAccentsAndFormsOut)
{
    const struct {
        std::string name, folded;
    } rows[] = {{"Report 2.TXT", "report 2.txt"}, {"Café", "cafe"}, {"Cafe\u0301", "cafe"}, {"ﬁle", "file"},
        {"STRASSE", "strasse"}, {"Straße", "strasse"}, {"ΣΊΣΥΦΟΣ", "σισυφοσ"}, {"ملَف", "ملف"},
        {"bad\xff", "bad\uFFFD"}, {"", ""}};
    for (const auto& row : rows)
        EXPECT_EQ(folded(row.name), row.folded) << row.name;
}

NameIndex indexOf(const Names& names)
{
    NameIndex::Builder builder;
    builder.beginFolder("/drive", 1);
    builder.beginFolder("/drive/folder", 1);
    for (const auto& name : names)
        builder.append({name, folded(name), FolderEntryKind::Document, false});
    builder.beginFolder("/drive/empty", 1);
    return builder.finish();
}

Names found(const NameIndex& index, const std::string& query, std::size_t limit = 10)
{
    Names names;
    for (const auto number : index.find(folded(query), limit, {}).items)
        names.push_back(index.found(number).url.lastPathComponent());
    return names;
}

TEST(NameIndexTests, FindsEveryWordAndTheBestNamesFirst)
{
    const auto index = indexOf({"old report.txt", "Unreported", "Report 17.pdf", "report", "r",
        "port of call", "my-report", "17 reports"});
    EXPECT_THAT(found(index, "report"),
        ElementsAre("Report 17.pdf", "report", "old report.txt", "my-report", "17 reports", "Unreported"));
    EXPECT_THAT(found(index, "  17   REPORT "), UnorderedElementsAre("Report 17.pdf", "17 reports"));
    EXPECT_THAT(found(index, "report 17"), ElementsAre("Report 17.pdf", "17 reports"));
    EXPECT_THAT(found(index, "report", 2), ElementsAre("Report 17.pdf", "report"));
    EXPECT_EQ(index.find("report", 2, {}).total, 6U);
    for (const auto* nothing : {"", "   ", "reportx", "txtun", "call my"})
        EXPECT_THAT(found(index, nothing), IsEmpty()) << nothing;
    EXPECT_EQ(index.found(0).url.path(), "/drive/folder/old report.txt");
    EXPECT_THAT(indexOf({}).find("a", 1, {}).items, IsEmpty());
}

TEST(NameIndexTests, AnswersNothingWhenItIsCancelled)
{
    const auto index = indexOf(Names(10'000, "same"));
    EXPECT_EQ(index.find("same", 5, {}).total, 10'000U);
    EXPECT_EQ(index.find("same", 5, [] { return true; }).total, 0U);
}

class NameSearchTests : public testing::Test {
protected:
    void begin(std::vector<std::string> roots)
    {
        std::vector<Url> urls;
        for (const auto& root : roots)
            urls.push_back(Url::fileURL(folder.at(root)));
        session = search.begin(std::move(urls), [this](NameSearchResults news) {
            ++updates;
            results = std::move(news);
        });
    }
    /// Answers the items found, by their paths below the temporary folder; a promise has an asterisk.
    Names search_(const std::string& query)
    {
        session->setQuery(query);
        dispatch->runUntilIdle();
        return shown();
    }
    Names shown() const
    {
        Names paths;
        for (const auto& item : results.items)
            paths.push_back(
                item.url.path().substr(folder.at("").size()) + std::string(item.isPromise ? "*" : ""));
        return paths;
    }

    testing_support::TemporaryDirectory folder;
    std::shared_ptr<testing_support::VirtualDispatch> dispatch = testing_support::VirtualDispatch::create();
    /// The tags of items, by their paths; a promise has an asterisk.
    std::map<std::string, Names> tags;
    int looks = 0; ///< how many items were asked for their tags
    IndexedNameSearch search{dispatch, std::make_shared<host::system::MimeTypeRegistry>(),
        {[this](const std::string& path, bool isPromise) {
             ++looks;
             const auto found = tags.find(path.substr(folder.at("").size()) + (isPromise ? "*" : ""));
             return found == tags.end() ? Names() : found->second;
         },
            {"tag:", "Etikett:"}}};
    std::shared_ptr<platform::NameSearchSession> session;
    NameSearchResults results;
    int updates = 0;
};

TEST_F(NameSearchTests, KnowsWhatTheListsShowAndNothingElse)
{
    folder.write("a/Plan.txt", "");
    folder.write("a/deep/er/Planet.txt", "");
    folder.write("a/.hidden plan/plan.txt", "");
    folder.write("a/.plan", "");
    folder.write("a/.Plan B.pdf.trwpromise", "{}");
    folder.write("a/.Plan.txt.trwpromise", "{}");
    folder.write("outside/plan.txt", "");
    folder.write("b/plans/x.txt", "");
    std::filesystem::create_directory_symlink(folder.at("outside"), folder.at("a/plan link"));
    const auto longPlan = "plan " + std::string(250, 'x');
    std::ofstream(host::system::promisePath(folder.at("b/" + longPlan)))
        << R"({"name": ")" + longPlan + R"("})";
    begin({"a", "b", "missing"});
    EXPECT_THAT(search_("plan"),
        UnorderedElementsAre("a/Plan.txt", "a/deep/er/Planet.txt", "a/Plan B.pdf*", "a/plan link", "b/plans",
            "b/" + longPlan + "*"));
    EXPECT_TRUE(results.isComplete);
    EXPECT_EQ(results.query, "plan");
    EXPECT_THAT(search_(""), IsEmpty());
}

TEST_F(NameSearchTests, FollowsChangesWhileItGoesOn)
{
    folder.write("a/one/plan 1.txt", "");
    folder.write("a/two/other.txt", "");
    begin({"a"});
    EXPECT_THAT(search_("plan"), ElementsAre("a/one/plan 1.txt"));
    // A folder that was not modified lately is not read again.
    for (const auto* each : {"a", "a/one", "a/two"})
        std::filesystem::last_write_time(
            folder.at(each), std::filesystem::file_time_type::clock::now() - std::chrono::hours(1));
    dispatch->advance(2.1);
    const int before = updates;
    dispatch->advance(2.1);
    EXPECT_EQ(updates, before);

    folder.write("a/two/plan 2.txt", "");
    dispatch->advance(2.1);
    EXPECT_THAT(shown(), UnorderedElementsAre("a/one/plan 1.txt", "a/two/plan 2.txt"));
    std::filesystem::remove_all(folder.at("a/one"));
    dispatch->advance(2.1);
    EXPECT_THAT(shown(), ElementsAre("a/two/plan 2.txt"));

    session.reset();
    const int ended = updates;
    folder.write("a/plan 3.txt", "");
    dispatch->advance(10);
    EXPECT_EQ(updates, ended);
}

TEST_F(NameSearchTests, FindsItemsByTheirTags)
{
    for (const auto* name : {"a/one.txt", "a/deep/two.txt", "a/red.txt", "a/.away.txt.trwpromise"})
        folder.write(name, "");
    tags = {{"a/one.txt", {"Work", "Reddish"}}, {"a/deep/two.txt", {"Red"}}, {"a/deep", {"Café two"}},
        {"a/away.txt*", {"Réd"}}};
    begin({"a"});
    EXPECT_THAT(search_("red"), ElementsAre("a/red.txt"));
    EXPECT_EQ(looks, 0) << "a search for names looks at no tags";
    struct Row {
        const char* query;
        Names found;
    };
    for (const auto& [query, found] : {Row{"tag:red", {"a/deep/two.txt", "a/away.txt*", "a/one.txt"}},
             {"TAG: Work", {"a/one.txt"}}, {"etikett:CAFE T", {"a/deep"}}, {"tag:ed", {}}, {"tag:two", {}},
             {"tag:", {"a/one.txt", "a/deep/two.txt", "a/deep", "a/away.txt*"}}}) {
        SCOPED_TRACE(query);
        EXPECT_THAT(search_(query), UnorderedElementsAreArray(found));
        EXPECT_TRUE(results.isComplete && results.isForTag);
        EXPECT_EQ(results.total, found.size());
        EXPECT_EQ(results.query, query);
    }
    search_("tag:red");
    EXPECT_EQ(shown().back(), "a/one.txt") << "a tag of just this name counts more";

    // New tags do not show in the folder.
    tags["a/red.txt"] = {"Red"};
    dispatch->advance(2.1);
    EXPECT_THAT(shown(), Contains("a/red.txt"));
    folder.write("a/new.txt", "");
    tags["a/new.txt"] = {"Red"};
    dispatch->advance(2.1);
    EXPECT_THAT(shown(), Contains("a/new.txt"));
    search_("red");
    dispatch->advance(10);
    const int before = looks;
    dispatch->advance(10);
    EXPECT_EQ(looks, before) << "nobody asks for tags any more";
}

TEST_F(NameSearchTests, AnswersTheLatestQueryAlone)
{
    folder.write("a/first", "");
    folder.write("a/second", "");
    begin({"a"});
    session->setQuery("first");
    session->setQuery("second");
    dispatch->runUntilIdle();
    EXPECT_THAT(shown(), ElementsAre("a/second"));
    EXPECT_EQ(updates, 1);
}

} // namespace
