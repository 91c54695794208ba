// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/AccountRecord.h"
#include "host/drive/records/SmallFile.h"
#include "host/drive/sample/SampleDrive.h"
#include "host/system/files/AtomicWrite.h"
#include "host/system/files/SystemErrors.h"

#include <sys/stat.h>

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <filesystem>
#include <optional>
#include <string>
#include <vector>

// This program signs people in to the drive on this machine and out again. Its exit status is 0 when done (or
// signed in), 1 when nobody is signed in, 2 after wrong use, 3 after a failure.

namespace {

using host::drive::AccountRecord;
using host::drive::DriveLayout;

constexpr int done = 0, nobody = 1, wrongUse = 2, failed = 3;
constexpr std::size_t longestName = 255;

int usage()
{
    std::fputs("Use: tarrow-account sign-in NAME | sign-out | status | make-sample\n"
               "The drive lies in $TARROW_DRIVE_HOME, else below $XDG_DATA_HOME/tarrow-drive.\n",
        stderr);
    return wrongUse;
}

int fail(const std::string& what, const platform::Error& error)
{
    std::fprintf(stderr, "%s: %s\n", what.c_str(), host::drive::reasonOf(error).c_str());
    return failed;
}

/// Creates the drive's home, and prints the reason when that fails.
bool prepareHome(const DriveLayout& layout)
{
    layout.prepare();
    std::error_code error;
    if (std::filesystem::is_directory(layout.home(), error))
        return true;
    std::fprintf(stderr, "The folder %s cannot be made.\n", layout.home().c_str());
    return false;
}

std::string shownName(const AccountRecord& record)
{
    return record.displayName.empty() ? record.identity : record.displayName;
}

bool isUsableName(const std::string& name)
{
    const auto isControl = [](unsigned char c) { return c < 0x20 || c == 0x7f; };
    return !name.empty() && name.size() <= longestName && platform::isValidUtf8(name)
        && std::ranges::none_of(name, isControl);
}

/// Creates the folders with which a drive begins; those that are there already stay as they are.
std::optional<platform::Error> makeFolders(const DriveLayout& layout)
{
    const auto top = layout.defaultContainer();
    for (const auto& folder : {layout.documents(), top, top + "/Desktop", top + "/Documents"}) {
        if (::mkdir(folder.c_str(), 0700) != 0 && errno != EEXIST)
            return host::system::systemError(errno, folder);
    }
    return std::nullopt;
}

int signIn(const DriveLayout& wanted, const std::string& name)
{
    if (!isUsableName(name)) {
        std::fputs("A name is a short text without control characters.\n", stderr);
        return wrongUse;
    }
    if (!prepareHome(wanted))
        return failed;
    const auto layout = wanted.prepare();
    const auto present = AccountRecord::read(layout);
    const auto identity = host::drive::localIdentity(name);
    if (present && present->identity == identity) {
        std::printf("%s is signed in already.\n", name.c_str());
        return done;
    }
    if (const auto error = makeFolders(layout))
        return fail("Cannot sign in", *error);
    // A program that waits for the account lists the folders as soon as the account is there.
    if (const auto error =
            host::system::writeFileAtomically(layout.account(), AccountRecord{identity, name, {}}.toJson()))
        return fail("Cannot sign in", *error);
    std::printf("%s is signed in. The drive lies in %s.\n", name.c_str(), layout.home().c_str());
    return done;
}

int signOut(const DriveLayout& layout)
{
    if (std::remove(layout.account().c_str()) == 0) {
        std::printf("Signed out. The documents stay in %s.\n", layout.documents().c_str());
        return done;
    }
    if (errno == ENOENT || errno == ENOTDIR) {
        std::puts("Nobody is signed in.");
        return done;
    }
    std::perror("Cannot sign out");
    return failed;
}

int status(const DriveLayout& layout)
{
    const auto record = AccountRecord::read(layout);
    if (record.error)
        return fail("Cannot use " + layout.account(), *record.error);
    if (!record) {
        std::puts("Nobody is signed in.");
        return nobody;
    }
    std::printf(
        "%s is signed in. The drive lies in %s.\n", shownName(*record).c_str(), layout.home().c_str());
    return done;
}

int makeSample(const DriveLayout& layout)
{
    if (!prepareHome(layout))
        return failed;
    const auto outcome = host::drive::sample::makeSampleDrive(layout);
    if (outcome.error)
        return fail("Cannot make the sample drive", *outcome.error);
    std::printf("The sample drive lies in %s (%d new items).\n", layout.home().c_str(), outcome.written);
    return done;
}

} // namespace

int main(int count, char** values)
{
    const std::vector<std::string> arguments(values + 1, values + count);
    const auto layout = DriveLayout::fromEnvironment();
    if (arguments.size() == 2 && arguments[0] == "sign-in")
        return signIn(layout, arguments[1]);
    if (arguments.size() != 1)
        return usage();
    if (arguments[0] == "sign-out")
        return signOut(layout);
    if (arguments[0] == "status")
        return status(layout);
    return arguments[0] == "make-sample" ? makeSample(layout) : usage();
}
