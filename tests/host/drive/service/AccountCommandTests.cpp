// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/AccountRecord.h"
#include "tests/support/TemporaryDirectory.h"

#include <gmock/gmock.h>

#include <sys/wait.h>

#include <array>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>

namespace {

using namespace host::drive;
using testing::HasSubstr;

struct Outcome {
    int status;
    std::string text; ///< standard output and standard error
};

class AccountCommandTests : public testing::Test {
protected:
    /// Runs the command on a drive; `arguments` are written as for the shell.
    Outcome run(const std::string& arguments) const
    {
        const auto line =
            "TARROW_DRIVE_HOME='" + home() + "' '" TARROW_ACCOUNT_COMMAND "' " + arguments + " 2>&1";
        FILE* pipe = ::popen(line.c_str(), "r");
        Outcome outcome{-1, {}};
        std::array<char, 512> buffer;
        while (const auto count = std::fread(buffer.data(), 1, buffer.size(), pipe))
            outcome.text.append(buffer.data(), count);
        outcome.status = WEXITSTATUS(::pclose(pipe));
        return outcome;
    }
    std::string home() const { return _folder.at("new/drive"); }

    testing_support::TemporaryDirectory _folder;
};

TEST_F(AccountCommandTests, signsInAndOut)
{
    const auto layout = DriveLayout::at(home());
    EXPECT_EQ(run("status").status, 1);
    EXPECT_EQ(run("sign-in 'Noor Ägir'").status, 0);
    const auto account = AccountRecord::read(layout);
    ASSERT_TRUE(account);
    EXPECT_EQ(account->displayName, "Noor Ägir");
    EXPECT_TRUE(std::filesystem::is_directory(layout.defaultContainer() + "/Documents"));
    const auto permissions = std::filesystem::status(home()).permissions();
    EXPECT_EQ(permissions, std::filesystem::perms::owner_all) << "a drive is its owner's alone";

    const auto status = run("status");
    EXPECT_EQ(status.status, 0);
    EXPECT_THAT(status.text, HasSubstr("Noor Ägir"));
    EXPECT_EQ(run("sign-in 'Noor Ägir'").status, 0);
    EXPECT_EQ(AccountRecord::read(layout)->identity, account->identity);
    EXPECT_EQ(run("sign-in Jonas").status, 0);
    EXPECT_NE(AccountRecord::read(layout)->identity, account->identity);

    EXPECT_EQ(run("sign-out").status, 0);
    EXPECT_EQ(run("sign-out").status, 0);
    EXPECT_EQ(run("status").status, 1);
    EXPECT_TRUE(std::filesystem::is_directory(layout.defaultContainer())) << "documents stay";
}

TEST_F(AccountCommandTests, wrongUseAndFailuresAreTold)
{
    for (const char* arguments :
        {"", "sign-in", "sign-in ''", "sign-in 'a\tb'", "sign-in a b", "bogus", "status x"}) {
        EXPECT_EQ(run(arguments).status, 2) << arguments;
        EXPECT_FALSE(std::filesystem::exists(home() + "/account.json")) << arguments;
    }
    std::filesystem::create_directories(home());
    std::ofstream(home() + "/account.json") << "{";
    const auto damaged = run("status");
    EXPECT_EQ(damaged.status, 3);
    EXPECT_THAT(damaged.text, HasSubstr(home() + "/account.json"));

    std::filesystem::remove_all(home());
    std::ofstream(home()) << "no folder";
    for (const char* arguments : {"sign-in Noor", "make-sample"}) {
        const auto outcome = run(arguments);
        EXPECT_EQ(outcome.status, 3) << arguments;
        EXPECT_THAT(outcome.text, HasSubstr(home())) << arguments;
    }
}

} // namespace
