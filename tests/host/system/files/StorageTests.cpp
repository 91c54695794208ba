// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/files/JsonKeyedArchiver.h"
#include "host/system/files/JsonUserDefaults.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/TemporaryDirectory.h"
#include "tests/support/VirtualDispatch.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <fstream>
#include <sstream>

using namespace platform;
using namespace host::system;
using namespace testing_support;

namespace {

Data bytes(std::string_view text)
{
    const auto* begin = reinterpret_cast<const std::byte*>(text.data());
    return Data(begin, begin + text.size());
}

std::string content(const std::string& path)
{
    std::stringstream text;
    text << std::ifstream(path).rdbuf();
    return text.str();
}

class UserDefaultsTest : public testing::Test {
protected:
    void TearDown() override { installLogSink(nullptr); }
    std::unique_ptr<JsonUserDefaults> open() { return std::make_unique<JsonUserDefaults>(path, *dispatch); }

    TemporaryDirectory directory;
    std::string path = directory.at("defaults.json");
    std::shared_ptr<VirtualDispatch> dispatch = VirtualDispatch::create();
    std::shared_ptr<RecordingLog> log = RecordingLog::install();
};

TEST_F(UserDefaultsTest, KeepsValuesBetweenRunsAndWritesManyChangesAtOnce)
{
    const auto token = bytes(std::string("\0\xff token", 8));
    {
        const auto defaults = open();
        EXPECT_EQ(defaults->data("token"), std::nullopt);
        defaults->setData("token", bytes("old"));
        defaults->setData("token", token);
        defaults->setData("gone", {});
        EXPECT_EQ(defaults->data("gone"), Data());
        EXPECT_FALSE(std::filesystem::exists(path)); // nothing is written on the caller's thread
        EXPECT_EQ(dispatch->pendingCount(), 1U);
        dispatch->runUntilIdle();
        defaults->remove("gone"); // still pending when the object is destroyed
    }
    const auto again = open();
    EXPECT_EQ(again->data("token"), token);
    EXPECT_EQ(again->data("gone"), std::nullopt);
    const auto files = std::distance(std::filesystem::directory_iterator(directory.path()), {});
    EXPECT_EQ(files, 1); // no temporary file is left
}

TEST_F(UserDefaultsTest, DamagedFileIsKeptAsideAndNamedInTheLog)
{
    for (const std::string damaged : {"", "{\"version\":1", "[]", R"({"version":1,"values":[]})"}) {
        directory.write("defaults.json", damaged);
        log->clear();
        const auto defaults = open();
        EXPECT_EQ(defaults->data("token"), std::nullopt);
        ASSERT_EQ(log->lines().size(), 1U) << damaged;
        EXPECT_THAT(log->lines()[0], testing::StartsWith("ERROR " + path + " is damaged: "));
        defaults->setData("token", bytes("new"));
    }
    EXPECT_EQ(content(directory.at("defaults.json.damaged-2")), "{\"version\":1");
    EXPECT_EQ(open()->data("token"), bytes("new"));
}

TEST_F(UserDefaultsTest, FileThatMustNotBeTouchedIsNotOverwritten)
{
    const std::string newer = R"({"version":2,"values":{},"more":1})";
    directory.write("defaults.json", newer);
    open()->setData("token", bytes("x"));
    EXPECT_EQ(content(path), newer);
    std::filesystem::remove(path);
    std::filesystem::create_directory(path); // nobody can read it as a file, not even root
    open()->setData("token", bytes("x"));
    EXPECT_TRUE(std::filesystem::is_directory(path));
    EXPECT_EQ(log->lines().size(), 2U);
}

TEST_F(UserDefaultsTest, FailedWriteIsReportedAndTriedAgain)
{
    path = directory.at("new/folder/defaults.json");
    const auto defaults = open();
    const auto obstacle = directory.write("new", "");
    defaults->setData("token", bytes("x"));
    dispatch->runUntilIdle();
    EXPECT_EQ(log->lines().size(), 1U);
    std::filesystem::remove(obstacle);
    defaults->setData("other", bytes("y"));
    dispatch->runUntilIdle();
    EXPECT_EQ(open()->data("token"), bytes("x"));
}

const PropertyValue& everyKind()
{
    static const PropertyValue value = PropertyDictionary{
        {"null", {}},
        {"bool", true},
        {"signed", std::numeric_limits<std::int64_t>::min()},
        {"positive", std::int64_t{5}},
        {"unsigned", std::numeric_limits<std::uint64_t>::max()},
        {"real", 1.0},
        {"infinite", -HUGE_VAL},
        {"text", "Zoë \n\"quoted\" \x01"},
        {"noUtf8", std::string("a\xff\0b", 4)},
        {"data", bytes("\x01\x02\xff")},
        {"date", Date{-1'234'567'890'123'456'789}},
        {"file", Url::fileURL("/a b/\xff%41", PathKind::Directory)},
        {"web", *Url::parse("https://host/p?q=1")},
        {"array", PropertyArray{1, PropertyArray{}, "x"}},
        {"$", PropertyDictionary{{"v", "not a tag"}}},
        {"\xfe", "key that is no UTF-8"},
        {"plain", PropertyDictionary{{"k", 2}}},
    };
    return value;
}

TEST(JsonKeyedArchiver, GivesBackEveryKindOfValue)
{
    const JsonKeyedArchiver archiver;
    const auto back = archiver.unarchive(archiver.archive(everyKind()));
    ASSERT_TRUE(back);
    EXPECT_EQ(*back, everyKind());
    const auto* url = find(*back->get<PropertyDictionary>(), "file")->get<Url>();
    EXPECT_TRUE(url->hasDirectoryPath());
    EXPECT_TRUE(std::isnan(*archiver.unarchive(archiver.archive(std::nan("")))->get<double>()));
}

TEST(JsonKeyedArchiver, RefusesWhatIsTooLargeTooDeepNewerOrMalformed)
{
    const JsonKeyedArchiver archiver;
    const auto nested = [](int levels) {
        PropertyValue value = PropertyArray{};
        for (int i = 1; i < levels; ++i)
            value = PropertyDictionary{{"\xff", std::move(value)}};
        return value;
    };
    EXPECT_TRUE(archiver.unarchive(archiver.archive(nested(32))));
    EXPECT_FALSE(archiver.unarchive(archiver.archive(nested(33))));
    EXPECT_TRUE(archiver.unarchive(archiver.archive(std::string(65'000, 'x'))));
    EXPECT_FALSE(archiver.unarchive(archiver.archive(std::string(66'000, 'x'))));
    const std::string open(30'000, '[');
    for (const std::string& text : {std::string(), open, std::string("{}"), std::string("{\"root\":1}"),
             std::string(R"({"version":2,"root":1})"), std::string(R"({"version":1,"root":1} x)"),
             std::string(R"({"version":1,"root":{"$":"thing","v":""}})"),
             std::string(R"({"version":1,"root":{"$":"data","v":"A*=="}})"),
             std::string(R"({"version":1,"root":{"$":"url","v":"nowhere"}})"),
             std::string(R"({"version":1,"root":{"$":1,"v":1}})")})
        EXPECT_FALSE(archiver.unarchive(bytes(text))) << text.substr(0, 60);
}

TEST(JsonKeyedArchiver, SurvivesEveryCutAndEveryFlippedBit)
{
    const JsonKeyedArchiver archiver;
    const auto whole = archiver.archive(everyKind());
    for (std::size_t length = 0; length < whole.size(); ++length)
        EXPECT_FALSE(archiver.unarchive(Data(whole.begin(), whole.begin() + static_cast<long>(length))));
    std::size_t refused = 0;
    for (std::size_t bit = 0; bit < whole.size() * 8; ++bit) {
        auto damaged = whole;
        damaged[bit / 8] ^= std::byte(1 << (bit % 8));
        refused += !archiver.unarchive(damaged);
    }
    EXPECT_GT(refused, 0U); // a flipped letter of a text cannot be noticed, but broken syntax must be
}

} // namespace
