// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/FileUtils.h"
#include "platform/Localization.h"
#include "tests/items/support/ItemsFixture.h"

#include <gmock/gmock.h>

using namespace tarrow;
using items_tests::ItemsFixture;
using testing::ElementsAre;

namespace {

std::string isolated(const std::string& name)
{
    return "\u2068" + name + "\u2069";
}

class LocationTest : public ItemsFixture {
protected:
    LocationTest()
    {
        describeContainer("BrindleDefault", R"({"names": {"en": "My Drive"}})");
        sketches = describeContainer("sketches", R"({"names": {"en": "Sketchbook"}})");
    }

    std::optional<Error> split(const Url& url)
    {
        container = nullptr;
        components.reset();
        return FileUtils::containerAndRelativePathforURLContainerRelativePathComponents(
            url, &container, &components);
    }

    Url sketch(std::string_view path) const { return sketches.appendingPathComponent(path); }

    Url sketches = root();
    std::shared_ptr<const DocumentContainer> container;
    std::optional<std::vector<std::string>> components;
};

TEST_F(LocationTest, SplitsALocationIntoContainerAndNames)
{
    writePromise("Notes/Old/a.txt", {});
    EXPECT_FALSE(split(at("Notes/Old/a.txt")));
    EXPECT_EQ(container->identifier, "BrindleDefault");
    EXPECT_THAT(*components, ElementsAre("Notes", "Old", "a.txt"));

    items_tests::writeFile(sketch("a.txt").path(), "1");
    EXPECT_FALSE(split(sketch("a.txt")));
    EXPECT_EQ(container->identifier, "sketches");
    EXPECT_THAT(*components, ElementsAre("a.txt"));

    EXPECT_FALSE(split(root()));
    EXPECT_EQ(components, std::nullopt);
    EXPECT_FALSE(FileUtils::containerAndRelativePathforURLContainerRelativePathComponents(
        sketch("a.txt"), nullptr, nullptr));
}

TEST_F(LocationTest, TakesThePathsNameOfWhatIsNotThere)
{
    EXPECT_FALSE(split(at("gone.txt")));
    EXPECT_THAT(*components, ElementsAre("gone.txt"));
    EXPECT_THAT(log->lines(),
        testing::Contains(testing::StartsWith(
            "DEBUG Can't get localizedName for URL " + at("gone.txt").absoluteString() + ": err ")));
}

TEST_F(LocationTest, SaysWhyALocationCannotBeSplit)
{
    EXPECT_TRUE(split(Url::fileURL("/outside/a.txt")));
    EXPECT_FALSE(container);
    EXPECT_THAT(log->lines(), testing::Contains(testing::StartsWith("WARNING Split URL: ")));

    // This location lies above the container's documents folder.
    const auto error = split(sketches.deletingLastPathComponent());
    ASSERT_TRUE(error);
    EXPECT_TRUE(error->is(FileErrorCode::Formatting));
    EXPECT_EQ(components, std::nullopt);
}

TEST_F(LocationTest, SplitsBesideTheErrorOfADamagedContainer)
{
    describeContainer("sketches", "damaged");
    items_tests::writeFile(sketch("a.txt").path(), "1");
    EXPECT_TRUE(split(sketch("a.txt")));
    ASSERT_TRUE(container);
    EXPECT_THAT(*components, ElementsAre("a.txt"));
    EXPECT_EQ(FileUtils::displayableLocationForURL(sketch("a.txt")), std::nullopt);
}

TEST_F(LocationTest, WritesTheLocationLineInBothDirections)
{
    items_tests::writeFile(at("Notes/Old/a.txt").path(), "1");
    items_tests::writeFile(sketch("Pens/b.txt").path(), "1");
    const auto drive = isolated("My Drive"), library = isolated("Sketchbook");
    for (const bool isRightToLeft : {false, true}) {
        texts->rightToLeft = isRightToLeft;
        const std::string mark = isRightToLeft ? "\u200f" : "", arrow = isRightToLeft ? " ◂ " : " ▸ ";
        EXPECT_EQ(FileUtils::displayableLocationForURL(root()), mark + drive);
        EXPECT_EQ(FileUtils::displayableLocationForURL(at("Notes")), mark + drive);
        EXPECT_EQ(FileUtils::displayableLocationForURL(at("Notes/Old/a.txt")),
            mark + drive + arrow + isolated("Notes") + arrow + isolated("Old"));
        EXPECT_EQ(FileUtils::displayableLocationForURL(sketch("Pens/b.txt")),
            mark + drive + arrow + library + arrow + isolated("Pens"));
    }
    EXPECT_EQ(FileUtils::displayableLocationForURL(Url::fileURL("/outside")), std::nullopt);
}

} // namespace
