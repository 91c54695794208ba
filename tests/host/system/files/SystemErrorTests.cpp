// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/files/SystemErrors.h"

#include <gtest/gtest.h>

#include <cerrno>

using host::system::SystemError;
using host::system::SystemResult;

TEST(SystemErrorTest, IsWhatErrnoWasOnlyWhenTheCallFailed)
{
    errno = EXDEV;
    const auto failure = SystemError::unless(false, "name");
    EXPECT_FALSE(SystemError::unless(true, "name"));
    errno = ENOENT;
    EXPECT_TRUE(failure.is(EXDEV));
    EXPECT_EQ(logText(failure), "EXDEV (name)");
    EXPECT_EQ(logText(SystemError(ENOENT)), "ENOENT");
}

TEST(SystemErrorTest, TheFirstFailureEndsTheSteps)
{
    int steps = 0;
    const auto run = [&](int failingStep) -> SystemResult<int> {
        for (const int step : {1, 2, 3}) {
            TRW_TRY(step == failingStep ? SystemError(EIO) : SystemError());
            ++steps;
        }
        return steps;
    };
    EXPECT_TRUE(run(2).error.is(EIO));
    EXPECT_EQ(steps, 1);
    EXPECT_EQ(*run(0), 4);
}
