// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/KeyValueStore.h"
#include "tests/support/DriveFixture.h"

namespace {

using namespace platform;

class KeyValueStoreTests : public testing::Test {
protected:
    KeyValueStoreTests()
        : _observation(_drive.notifications->observe(
            platform::Notification::KeyValueStoreDidChangeExternally, [this](const auto&) { ++_notices; }))
    {
    }
    std::optional<PropertyValue> value(const std::string& key) const
    {
        return platform::services().keyValueStore().objectForKey(key);
    }
    void write(const std::string& text) const
    {
        std::ofstream(_drive.layout().keyValueStore(), std::ios::trunc) << text;
    }

    testing_support::DriveFixture _drive;
    int _notices = 0;
    platform::Observation _observation;
};

TEST_F(KeyValueStoreTests, ValuesKeepTheirKinds)
{
    write(
        R"({"text": "x", "yes": true, "less": -3, "more": 18446744073709551615, "half": 0.5, "nothing": null,
        "list": [1, {"in": ["deep"]}]})");
    EXPECT_EQ(value("text"), PropertyValue("x"));
    EXPECT_EQ(value("yes"), PropertyValue(true));
    EXPECT_EQ(value("less"), PropertyValue(-3));
    EXPECT_EQ(value("more"), PropertyValue(std::uint64_t(18446744073709551615U)));
    EXPECT_EQ(value("half"), PropertyValue(0.5));
    EXPECT_EQ(value("nothing"), PropertyValue());
    EXPECT_EQ(value("list"),
        PropertyValue(PropertyArray{
            std::uint64_t(1), PropertyDictionary{{"in", PropertyArray{PropertyValue("deep")}}}}));
    EXPECT_EQ(value("absent"), std::nullopt);
}

TEST_F(KeyValueStoreTests, OnlyWhatChangedIsTold)
{
    EXPECT_EQ(value("a"), std::nullopt);
    write(R"({"a": 1})");
    _drive.settle();
    EXPECT_EQ(_notices, 1);
    EXPECT_EQ(value("a")->asInteger(), 1);
    write(R"({ "a" : 1 })");
    _drive.settle();
    EXPECT_EQ(_notices, 1) << "the same values are no change";
    std::filesystem::remove(_drive.layout().keyValueStore());
    _drive.settle();
    EXPECT_EQ(_notices, 2);
    EXPECT_EQ(value("a"), std::nullopt);
}

TEST_F(KeyValueStoreTests, AFileThatCannotBeUsedIsNamedOnceAndHoldsNothing)
{
    const std::string huge(host::drive::LocalKeyValueStore::maximumFileSize + 1, ' ');
    for (const auto& text : {std::string("{\"a\": 1"), std::string("[1]"), huge, std::string()}) {
        write(R"({"a": 1})");
        EXPECT_TRUE(value("a"));
        _drive.settle();
        _drive.log->clear();
        write(text);
        _drive.settle();
        EXPECT_EQ(value("a"), std::nullopt) << text.substr(0, 20);
        EXPECT_EQ(value("b"), std::nullopt);
        EXPECT_EQ(_drive.log->lines().size(), 1U) << text.substr(0, 20);
        write(R"({"a": 1})");
        _drive.settle();
    }
}

} // namespace
