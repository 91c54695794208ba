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

/// The real program on a sample drive of its own.
class DriveTests : public ::testing::Test {
protected:
    void SetUp() override
    {
        auto place = std::string(getenv("HOME")) + "/XXXXXX";
        ASSERT_TRUE(mkdtemp(place.data()));
        home = place;
        // The default place of a home, so that two programs with their own states can share it.
        environment = {{"XDG_DATA_HOME", home / "data"}, {"XDG_STATE_HOME", home / "state"}};
        ASSERT_EQ(Program::run({getenv("TRW_ACCOUNT"), "make-sample"}, environment), 0);
        documents = home / "data/tarrow-drive/local/documents";
        top = documents / "BrindleDefault";
    }

    void TearDown() override
    {
        program.reset();
        // The sample has a folder that cannot be read.
        std::filesystem::permissions(top / "Documents/Locked drawer", std::filesystem::perms::owner_all);
        std::filesystem::remove_all(home);
    }

    void start() { program.emplace(environment); }

    /// What another program does to the drive.
    int files(const std::vector<std::string>& arguments) const
    {
        std::vector<std::string> command{getenv("TRW_FILES")};
        command.insert(command.end(), arguments.begin(), arguments.end());
        return Program::run(command, environment);
    }

    /// Waits for a condition; says what is on the screen when it does not come to hold.
    ::testing::AssertionResult eventually(const std::function<bool()>& condition) const
    {
        if (Accessible::waitFor(condition))
            return ::testing::AssertionSuccess();
        return ::testing::AssertionFailure() << (program ? program->state() : "nothing runs");
    }

    std::filesystem::path home, documents, top;
    Program::Environment environment;
    std::optional<Program> program;
};

} // namespace e2e
