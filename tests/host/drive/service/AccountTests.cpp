// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/AccountRecord.h"
#include "tests/support/DriveFixture.h"

namespace {

using platform::Notification;
using namespace testing_support;

class AccountTests : public testing::Test {
protected:
    AccountTests()
        : _observation(_drive.notifications->observe(
            Notification::CloudIdentityDidChange, [this](const auto&) { ++_notices; }))
    {
    }

    void writeAccount(std::string_view text) const
    {
        std::ofstream(_drive.layout().account(), std::ios::trunc) << text;
    }
    std::optional<platform::PropertyValue> token() { return _drive.cloud->account().identityToken(); }

    DriveFixture _drive;
    int _notices = 0;
    platform::Observation _observation;
};

TEST_F(AccountTests, tellsOfEveryChangeOfIdentityOnceAndOfNothingElse)
{
    const auto first = token();
    ASSERT_TRUE(first);

    writeAccount(R"({"identity": "account-1", "displayName": "Renamed"})");
    _drive.settle();
    EXPECT_EQ(token(), first);
    EXPECT_EQ(_notices, 0) << "the same identity written again is no change";

    _drive.signIn("Jonas");
    _drive.settle();
    const auto second = token();
    EXPECT_TRUE(second && second != first);
    EXPECT_EQ(_notices, 1);

    // The file is replaced by a rename, as careful programs do.
    const auto prepared = _drive.folder().write("drive/new", R"({"identity": "account-1"})");
    std::filesystem::rename(prepared, _drive.layout().account());
    _drive.settle();
    EXPECT_EQ(token(), first);
    EXPECT_EQ(_notices, 2);

    _drive.signOut();
    _drive.settle();
    EXPECT_FALSE(token());
    EXPECT_EQ(_notices, 3);
    EXPECT_FALSE(_drive.cloud->containers().defaultContainerURL());

    _drive.folder().write("drive/unrelated.json", "{}");
    _drive.settle();
    EXPECT_EQ(_notices, 3);
}

TEST_F(AccountTests, followsAFolderThatGoesAwayAndComesBack)
{
    const auto home = _drive.layout().home();
    std::filesystem::rename(home, home + "-away");
    _drive.settle();
    EXPECT_EQ(_notices, 1);
    EXPECT_FALSE(token());

    std::filesystem::rename(home + "-away", home);
    _drive.dispatch->advance(10);
    EXPECT_EQ(_notices, 2);
    _drive.signIn("Jonas");
    _drive.settle();
    EXPECT_EQ(_notices, 3) << "the folder is watched again";
}

TEST_F(AccountTests, aDamagedAccountIsNobodyAndIsLeftAsItIs)
{
    const std::string whole = R"({"identity": "account-1"})";
    std::vector<std::string> texts{"[]", "null", R"({"identity": 7})", R"({"identity": ""})", whole + "x",
        std::string(host::drive::AccountRecord::maximumFileSize + 1, ' ')};
    for (std::size_t length = 0; length < whole.size(); ++length)
        texts.push_back(whole.substr(0, length));
    for (const auto& text : texts) {
        writeAccount(text);
        _drive.log->clear();
        EXPECT_FALSE(token()) << text.substr(0, 40);
        ASSERT_EQ(_drive.log->lines().size(), 1u) << text.substr(0, 40);
        const auto line = _drive.log->lines().front();
        EXPECT_TRUE(line.starts_with("ERROR Cannot use the account in " + _drive.layout().account())) << line;
        EXPECT_EQ(contentOf(_drive.layout().account()), text);
    }
    _drive.settle();
    EXPECT_EQ(_notices, 1);
}

TEST_F(AccountTests, onlyARegularFileIsAnAccount)
{
    std::filesystem::remove(_drive.layout().account());
    std::filesystem::create_symlink("elsewhere.json", _drive.layout().account());
    _drive.folder().write("drive/elsewhere.json", R"({"identity": "account-1"})");
    EXPECT_FALSE(token());
    std::filesystem::remove(_drive.layout().account());
    std::filesystem::create_directory(_drive.layout().account());
    EXPECT_FALSE(token());
}

TEST_F(AccountTests, quotaIsTheFreeSpaceOrTheSystemsError)
{
    const auto fetch = [this] {
        std::vector<platform::Result<std::int64_t>> answers;
        _drive.cloud->account().makeQuotaFetchOperation(
            [&](platform::Result<std::int64_t> answer) { answers.push_back(std::move(answer)); })();
        EXPECT_EQ(answers.size(), 1u);
        return answers.front();
    };
    const auto space = std::filesystem::space(_drive.layout().home());
    const auto free = fetch();
    ASSERT_TRUE(free);
    EXPECT_NEAR(static_cast<double>(*free), static_cast<double>(space.available), 1e9);

    std::filesystem::remove_all(_drive.layout().home());
    const auto gone = fetch();
    EXPECT_FALSE(gone);
    EXPECT_TRUE(gone.error && gone.error->is(platform::FileErrorCode::NoSuchItem));
}

} // namespace
