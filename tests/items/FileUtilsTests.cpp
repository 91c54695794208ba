// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/FileUtils.h"
#include "platform/TypeRegistry.h"
#include "tests/items/support/ItemsFixture.h"

#include <gmock/gmock.h>

#include <filesystem>

using namespace tarrow;
using items_tests::ItemsFixture;
using testing::ElementsAre;

namespace {

class FileUtilsTest : public ItemsFixture { };

TEST_F(FileUtilsTest, TellsFilesFromFolders)
{
    const auto file = writeDocument("Notes/a.txt", "1");
    std::filesystem::create_symlink("Notes", at("link").path());
    std::filesystem::create_symlink("gone", at("dangling").path());
    struct Row {
        const char* name;
        bool exists, isFile, isDir;
    };
    for (const auto& row : {Row{"Notes/a.txt", true, true, false}, Row{"Notes", true, false, true},
             Row{"link", true, false, true}, Row{"dangling", false, false, false},
             Row{"gone", false, false, false}}) {
        EXPECT_EQ(FileUtils::exists(at(row.name)), row.exists) << row.name;
        EXPECT_EQ(FileUtils::isFile(at(row.name)), row.isFile) << row.name;
        EXPECT_EQ(FileUtils::isDir(at(row.name)), row.isDir) << row.name;
    }
}

TEST_F(FileUtilsTest, PrefersThePromisedValueOfAnAttribute)
{
    host::drive::PromiseRecord promise;
    promise.size = 99;
    const auto url = writePromise("a.txt", promise);
    const auto value = [&](AttributeKey key) { return FileUtils::getResourceValueForURL(key, url); };
    EXPECT_EQ(value(AttributeKey::FileSize), AttributeValue(std::uint64_t{99}));
    EXPECT_EQ(value(AttributeKey::DocumentIdentifier), std::nullopt);
    EXPECT_EQ(FileUtils::getResourceValueForURL(AttributeKey::Name, std::nullopt), std::nullopt);

    const auto local = writeDocument("b.txt", "12");
    changeValues([](const Url&, AttributeMap& values) { values.set(AttributeKey::FileSize, {}); });
    EXPECT_EQ(
        FileUtils::getResourceValueForURL(AttributeKey::FileSize, local), AttributeValue(std::uint64_t{2}));
}

TEST_F(FileUtilsTest, LogsAFilesAttributes)
{
    FileUtils::logFileAttributes(writeDocument("a.txt", "12345").path());
    EXPECT_THAT(log->lines(),
        ElementsAre(testing::MatchesRegex("DEBUG Date Created: .* \\(-?[0-9.]+ seconds ago\\)"),
            testing::MatchesRegex("DEBUG Date Modified: .* \\(-?[0-9.]+ seconds ago\\)"),
            "DEBUG Size: 5 bytes"));
    log->clear();
    const auto path = at("gone").path();
    FileUtils::logFileAttributes(path);
    EXPECT_THAT(
        log->lines(), ElementsAre(testing::StartsWith("ERROR Cannot get attributes of " + path + ": ")));
}

TEST_F(FileUtilsTest, CountsPicturesFilmsSoundsAndPdfAsMedia)
{
    const auto isMedia = [&](const char* name) { return FileUtils::isAudioVideoImageFile(at(name)); };
    for (const char* name : {"a.png", "a.PNG", "a.mp4", "a.mp3", "a.pdf"})
        EXPECT_TRUE(isMedia(name)) << name;
    for (const char* name : {"a.txt", "a", "a.zip"})
        EXPECT_FALSE(isMedia(name)) << name;
    EXPECT_EQ(log->count("DEBUG isAudioVideoImageFile: Extension txt is "
                  + FileUtils::fileUTI(at("a.txt")).value_or("") + " which is not."),
        1U);
    EXPECT_EQ(log->count("DEBUG isAudioVideoImageFile: Extension pdf is public.pdf which conforms to UTI "
                         "public.pdf"),
        1U);
    EXPECT_EQ(FileUtils::fileUTI(at("a")), std::nullopt);
}

TEST_F(FileUtilsTest, AsksTheContainerForTheTypesItTakes)
{
    const auto text = FileUtils::fileUTI(at("a.txt")).value_or("");
    const auto taking = [](const std::string& types) {
        return R"({"documentTypes": [{"name": "x", "contentTypes": [)" + types + "]}]}";
    };
    struct Row {
        std::string description, name;
        bool isValid;
    };
    for (const auto& [description, name, isValid] : {
             Row{"{}", "a.txt", true},
             Row{taking("\"" + text + "\""), "a.txt", true},
             Row{taking("\"public.text\""), "a.txt", true},
             Row{taking("\"public.image\", 7"), "a.txt", false},
             Row{taking("\"public.image\", \"public.data\""), "a.txt", true},
             Row{taking("\"public.content\""), "a.png", true},
             Row{taking("\"public.image\""), "a", true},
             Row{taking("\"public.image\""), "a.no such kind", true},
         }) {
        const auto url = describeContainer("sketches", description).appendingPathComponent(name);
        EXPECT_EQ(FileUtils::isValidExtensionForContainer(url), isValid) << description << name;
    }
    EXPECT_EQ(log->count("ERROR Expected array of strings"), 1U);
    EXPECT_EQ(log->count("INFO Container supports all UTIs"), 2U);
    EXPECT_EQ(log->count("INFO Extension txt conforms to UTI public.text"), 1U);
    EXPECT_TRUE(FileUtils::isValidExtensionForContainer(at("a.txt")));
    EXPECT_FALSE(FileUtils::isValidExtensionForContainer(Url::fileURL("/outside/a.txt")));
}

TEST_F(FileUtilsTest, JudgesNames)
{
    const std::string longName(300, 'x');
    for (const std::string name : {"a", "a b.txt", " a", "a.", "-a", "\\", "na\u00efve", "\u65e5\u672c",
             "\U0001f600", "e\u0301", longName.c_str()})
        EXPECT_TRUE(FileUtils::isValidFilename(name)) << name;
    for (const std::string name : {"", ".", "..", ".a", "a/b", "a:b", "a\nb", "a\tb", "a\u0085b", "a\u2028",
             "a\u2029", "a\u200bb", "a\u202eb", "a\u00adb", "a\ufeffb", "a\ufdd0", "a\uffff", "a\U0003ffff",
             "a\u0378", "a\xff", "a\xc0\xaf"})
        EXPECT_FALSE(FileUtils::isValidFilename(name)) << name;
    EXPECT_FALSE(FileUtils::isValidFilename(std::string_view("a\0b", 3)));
}

} // namespace
