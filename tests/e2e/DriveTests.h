// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "Program.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <optional>
#include <string>

namespace e2e {

/// Runs the real program on a sample drive of its own.
class DriveTests : public ::testing::Test {
protected:
    void SetUp() override
    {
        auto place = std::string(getenv("HOME")) + "/XXXXXX";
        ASSERT_TRUE(mkdtemp(place.data()));
        home = place;
        // The drive lies in the default place of the data folder, so that two programs with separate states
        // can share it.
        environment = {{"XDG_DATA_HOME", home / "data"}, {"XDG_STATE_HOME", home / "state"}};
        ASSERT_EQ(Program::run({getenv("TRW_ACCOUNT"), "make-sample"}, environment), 0);
        documents = home / "data/tarrow-drive/local/documents";
        top = documents / "BrindleDefault";
    }

    void TearDown() override
    {
        program.reset();
        // The sample drive has a folder that cannot be read, and so could not be removed.
        std::filesystem::permissions(top / "Documents/Locked drawer", std::filesystem::perms::owner_all);
        std::filesystem::remove_all(home);
    }

    void start(const std::vector<std::string>& arguments = {}) { program.emplace(environment, arguments); }
    /// Ends the program and starts it again.
    void startAgain(const std::vector<std::string>& arguments = {})
    {
        program.reset();
        start(arguments);
    }

    /// Runs a command of another program on the drive.
    int files(const std::vector<std::string>& arguments) const
    {
        std::vector<std::string> command{getenv("TRW_FILES")};
        command.insert(command.end(), arguments.begin(), arguments.end());
        return Program::run(command, environment);
    }

    /// Waits for a condition. On failure it reports what is on the screen.
    ::testing::AssertionResult eventually(const std::function<bool()>& condition) const
    {
        if (Accessible::waitFor(condition))
            return ::testing::AssertionSuccess();
        return ::testing::AssertionFailure() << (program ? program->state() : "nothing runs");
    }

    void expectShown(const std::string& beginning) const
    {
        EXPECT_TRUE(eventually([&] { return program->shows(beginning); })) << beginning;
    }
    void expectGone(const std::string& beginning) const
    {
        EXPECT_TRUE(eventually([&] { return !program->shows(beginning); })) << beginning;
    }

    std::filesystem::path home, documents, top;
    Program::Environment environment;
    std::optional<Program> program;
};

} // namespace e2e
