// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/support/DriveFixture.h"

#include <sys/stat.h>

namespace {

namespace fs = std::filesystem;

using namespace testing;
using host::drive::PromiseRecord;

class DriveRecordTests : public Test, public testing_support::DriveFixture { };

TEST_F(DriveRecordTests, whatIsNoRecordIsAnErrorAndOneLineAndIsLeftAsItIs)
{
    const auto library = makeContainer("app.notes");
    const auto promised = writePromise("Plan.pdf", {});
    const struct {
        std::string path, whole;
        std::function<bool()> canBeUsed;
    } rows[] = {
        {layout().account(), R"({"identity": "account-1"})",
            [&] { return cloud->account().identityToken().has_value(); }},
        {layout().containerDescription("app.notes"), R"({"names": {"en": "Notes"}})",
            [&] { return cloud->containers().containerForItem(library).error == std::nullopt; }},
        {PromiseRecord::pathFor(promised.path()), R"({"size": 12, "tags": ["Red"]})",
            [&] {
                const auto error = cloud->promisedItems().readItem(promised, {}).values.error;
                return !error || error->is(platform::FileErrorCode::NoSuchItem);
            }},
    };
    for (const auto& [path, whole, canBeUsed] : rows) {
        std::vector<std::string> texts{"[]", "null", "\"text\"", whole + "x", whole + whole,
            "{\"a\": \"\xff\"}", std::string(300, '\0'), "{\"a\": " + std::string(30'000, '['),
            std::string(300'000, ' ')};
        for (std::size_t length = 0; length + 1 < whole.size(); ++length)
            texts.push_back(whole.substr(0, length));
        for (const auto& text : texts) {
            SCOPED_TRACE(path + ": " + text.substr(0, 40));
            std::ofstream(path, std::ios::trunc) << text;
            log->clear();
            EXPECT_FALSE(canBeUsed());
            EXPECT_THAT(
                log->lines(), ElementsAre(AllOf(StartsWith("ERROR Cannot use the "), HasSubstr(path))));
            EXPECT_EQ(testing_support::contentOf(path), text);
        }
        std::ofstream(path, std::ios::trunc) << whole;
        EXPECT_TRUE(canBeUsed());
        fs::rename(path, path + ".real");
        fs::create_symlink(path + ".real", path);
        EXPECT_FALSE(canBeUsed()) << "a link";
        fs::remove(path);
        fs::create_directory(path);
        EXPECT_FALSE(canBeUsed()) << "a folder";
        fs::remove(path);
        ASSERT_EQ(::mkfifo(path.c_str(), 0600), 0);
        EXPECT_FALSE(canBeUsed()) << "a pipe";
    }
}

TEST(PromiseRecordTests, aFieldThatCannotBeRightIsUnknown)
{
    for (const char* size : {"-1", "2.5", "99999999999999999999", "\"12\"", "null", "[1,[2]]"}) {
        const auto record =
            PromiseRecord::parse(std::string("{\"size\":") + size + ",\"modified\":" + size + "}");
        ASSERT_TRUE(record) << size;
        EXPECT_FALSE(record->size) << size;
    }
    EXPECT_FALSE(PromiseRecord::parse(R"({"type": "a\u0000b"})"));
    const auto record = PromiseRecord::parse(
        R"({"modified": -11644473600000000000, "role": "king", "documentIdentifier": 4294967296, "tags": [1, "", "a"],
            "unknown": {"deep": [true, false, null, -1.5e3]}, "kind": 3, "shared": "yes"})");
    ASSERT_TRUE(record);
    EXPECT_FALSE(record->modified);
    EXPECT_FALSE(record->role);
    EXPECT_EQ(record->documentIdentifier, 0U);
    EXPECT_THAT(record->tags, ElementsAre("a"));
    EXPECT_EQ(record->kind, PromiseRecord::Kind::File);
    EXPECT_FALSE(record->shared);
}

} // namespace
