// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/files/PosixFileSystem.h"

#include "tests/support/TemporaryDirectory.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <filesystem>

using namespace platform;
using host::system::PosixFileSystem;
using testing_support::TemporaryDirectory;

namespace {

using Continue = FileSystem::Continue;

class FileSystemTest : public testing::Test {
protected:
    /// Answers what an enumeration finds below the folder, as "path:type" relative to it, and keeps the
    /// errors.
    std::vector<std::string> enumerate(const std::string& path,
        decltype(&FileSystem::enumerateDeeply) enumeration = &FileSystem::enumerateDeeply)
    {
        std::vector<std::string> found;
        (files.*enumeration)(
            Url::fileURL(path),
            [&](const Url& url, FileType type) {
                found.push_back(url.path().substr(path.size() + 1) + ':' + "rdlo"[static_cast<int>(type)]);
                return Continue::Yes;
            },
            [&](const Url&, const Error& error) {
                errors.push_back(error);
                return Continue::Yes;
            });
        std::ranges::sort(found);
        return found;
    }

    TemporaryDirectory directory;
    PosixFileSystem files;
    std::vector<Error> errors;
};

TEST_F(FileSystemTest, TellsAttributesOfTheItemItself)
{
    const auto path = directory.write("a.txt", "12345");
    std::filesystem::create_symlink("a.txt", directory.at("link"));
    std::filesystem::create_symlink("nowhere", directory.at("dangling"));
    mkfifo(directory.at("fifo").c_str(), 0600);

    const auto file = files.attributesOfItem(path);
    ASSERT_TRUE(file);
    EXPECT_EQ(file->type, FileType::Regular);
    EXPECT_EQ(file->size, 5U);
    EXPECT_FALSE(file->extensionHidden);
    struct stat found;
    ASSERT_EQ(::stat(path.c_str(), &found), 0);
    EXPECT_EQ(
        file->modificationDate.nanoseconds, found.st_mtim.tv_sec * 1'000'000'000 + found.st_mtim.tv_nsec);
    EXPECT_EQ(files.attributesOfItem(directory.at("link"))->type, FileType::SymbolicLink);
    EXPECT_EQ(files.attributesOfItem(directory.at("fifo"))->type, FileType::Other);
    EXPECT_EQ(files.typeOfItem(directory.at("link")), FileType::Regular);
    EXPECT_EQ(files.typeOfItem(directory.at("dangling")), std::nullopt);
    EXPECT_EQ(files.destinationOfSymbolicLink(directory.at("dangling")).value, "nowhere");
}

TEST_F(FileSystemTest, ErrorsSayWhatFailedInTermsOfTheInterface)
{
    const auto file = directory.write("file", "");
    const auto tooLong = directory.at(std::string(256, 'n'));
    const auto missing = files.attributesOfItem(directory.at("missing"));
    ASSERT_TRUE(missing.error);
    EXPECT_TRUE(missing.error->is(FileErrorCode::NoSuchItem));
    EXPECT_EQ(missing.error->text(errorKey::filePath), directory.at("missing"));
    EXPECT_EQ(missing.error->text(errorKey::localizedDescription), "“missing” is no longer there.");
    EXPECT_TRUE(files.attributesOfItem(tooLong).error->is(FileErrorCode::InvalidName));
    EXPECT_TRUE(files.attributesOfItem(file + '\0' + "x").error->is(FileErrorCode::InvalidName));
    EXPECT_EQ(files.destinationOfSymbolicLink(file).error->code(), EINVAL);
}

TEST_F(FileSystemTest, EnumeratesEverythingBelowWithoutFollowingLinks)
{
    directory.write("top/.hidden", "");
    directory.write("top/Pack.pages/inside/\xff", "");
    directory.write("outside/secret", "");
    std::filesystem::create_directory_symlink(directory.at("outside"), directory.at("top/link"));
    mkfifo(directory.at("top/fifo").c_str(), 0600);
    EXPECT_EQ(enumerate(directory.at("top")),
        (std::vector<std::string>{".hidden:r", "Pack.pages/inside/\xff:r", "Pack.pages/inside:d",
            "Pack.pages:d", "fifo:o", "link:l"}));
    EXPECT_TRUE(errors.empty());
}

TEST_F(FileSystemTest, AShallowEnumerationStaysInTheFolder)
{
    directory.write("top/.hidden", "");
    directory.write("top/Folder/inside", "");
    std::filesystem::create_directory_symlink("Folder", directory.at("top/link"));
    const auto shallowly = &FileSystem::enumerateShallowly;
    EXPECT_EQ(enumerate(directory.at("top"), shallowly),
        (std::vector<std::string>{".hidden:r", "Folder:d", "link:l"}));
    EXPECT_TRUE(errors.empty());
    enumerate(directory.at("gone"), shallowly);
    ASSERT_EQ(errors.size(), 1U);
    EXPECT_TRUE(errors[0].is(FileErrorCode::NoSuchItem));
}

TEST_F(FileSystemTest, EnumerationStopsWhenAskedAndReportsFoldersThatCannotBeRead)
{
    directory.write("top/a/1", "");
    directory.write("top/b/2", "");
    for (const auto enumeration : {&FileSystem::enumerateDeeply, &FileSystem::enumerateShallowly}) {
        int entries = 0;
        (files.*enumeration)(
            Url::fileURL(directory.at("top")), [&](auto&&...) { return ++entries, Continue::No; },
            [&](auto&&...) { return Continue::Yes; });
        EXPECT_EQ(entries, 1);
    }
    // A folder that is replaced by a link during the walk is not entered.
    bool swapped = false;
    files.enumerateDeeply(
        Url::fileURL(directory.at("top")),
        [&](const Url& url, FileType) {
            if (!std::exchange(swapped, true)) {
                std::filesystem::remove_all(directory.at("top/a"));
                std::filesystem::create_directory_symlink("/usr", directory.at("top/a"));
            }
            EXPECT_NE(url.lastPathComponent(), "bin");
            return Continue::Yes;
        },
        [&](const Url& url, const Error&) {
            EXPECT_EQ(url.lastPathComponent(), "a");
            errors.emplace_back(FileErrorCode::NoSuchItem);
            return Continue::Yes;
        });
    EXPECT_EQ(errors.size(), 1U);
    EXPECT_TRUE(enumerate(directory.at("missing")).empty());
    EXPECT_TRUE(errors.back().is(FileErrorCode::NoSuchItem));
}

TEST_F(FileSystemTest, WalksThousandsOfLevelsWithFewDescriptors)
{
    constexpr int depth = 1200;
    int folder = ::open(directory.path().c_str(), O_RDONLY | O_DIRECTORY);
    for (int i = 0; i < depth; ++i) {
        // Each level has two folders, so that the walk returns to every level.
        ASSERT_EQ(::mkdirat(folder, "level", 0700) | ::mkdirat(folder, "other", 0700), 0);
        const int next = ::openat(folder, "level", O_RDONLY | O_DIRECTORY);
        ::close(folder);
        folder = next;
    }
    ::close(folder);
    rlimit before;
    getrlimit(RLIMIT_NOFILE, &before);
    const rlimit few{256, before.rlim_max};
    setrlimit(RLIMIT_NOFILE, &few);
    EXPECT_EQ(enumerate(directory.path()).size(), 2U * depth);
    setrlimit(RLIMIT_NOFILE, &before);
    EXPECT_TRUE(errors.empty());
}

} // namespace
