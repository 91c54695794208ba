// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/DRItem.h"
#include "items/FileUtils.h"
#include "tests/items/support/ItemsFixture.h"

using namespace tarrow;
using items_tests::ItemsFixture;
using testing::ElementsAre;

namespace {

class FileUtilsTest : public ItemsFixture { };

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

TEST_F(FileUtilsTest, ChangesTagsInACoordinatedWriteThatCanBeUndone)
{
    using Tags = std::vector<std::string>;
    const auto document = writeDocument("a.txt", "1");
    mark(document, host::drive::itemMark::tags, "Old,Work");
    const auto tags = [](const Url& url) { return DRItem::initWithURL(url)->tags(); };
    const auto before = FileUtils::changeTags(document, {"Red", "Work"}, {"Old", "Blue"});
    EXPECT_EQ(before.value, (Tags{"Old", "Work"}));
    EXPECT_THAT(tags(document), ElementsAre("Work", "Red"));
    const auto reference = writeReference("pointer.trwref", "BrindleDefault", "a.txt");
    EXPECT_TRUE(FileUtils::changeTagsBack(reference, *before, {"Red", "Work"}, {"Old", "Blue"}));
    EXPECT_THAT(tags(document), ElementsAre("Old", "Work")) << "those of what the reference stands for";

    const auto unwanted = FileUtils::changeTags(document, {"Red"}, {}, [] { return false; });
    EXPECT_TRUE(unwanted.error->is(FileErrorCode::Cancelled));
    const auto reading =
        fileCoordinator->coordinateReading(document, platform::ReadingOptions::None, [&](const Url&) {
            EXPECT_EQ(FileUtils::changeTags(document, {"Red"}, {}).error->code(), EDEADLK)
                << "somebody reads it";
        });
    EXPECT_FALSE(reading);
    EXPECT_THAT(tags(document), ElementsAre("Old", "Work"));
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
             Row{taking(R"("public.image", "public.data")"), "a.txt", true},
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
    // NOLINTNEXTLINE(misc-misleading-bidirectional): the escape misleads no reader
    const std::string overridden = "a\u202eb";
    for (const std::string name : {"a", "a b.txt", " a", "a.", "-a", "\\", "na\u00efve", "\u65e5\u672c",
             "\U0001f600", "e\u0301", longName.c_str()})
        EXPECT_TRUE(FileUtils::isValidFilename(name)) << name;
    for (const std::string name : {"", ".", "..", ".a", "a/b", "a:b", "a\nb", "a\tb", "a\u0085b", "a\u2028",
             "a\u2029", "a\u200bb", overridden.c_str(), "a\u00adb", "a\ufeffb", "a\ufdd0", "a\uffff",
             "a\U0003ffff", "a\u0378", "a\xff", "a\xc0\xaf"})
        EXPECT_FALSE(FileUtils::isValidFilename(name)) << name;
    EXPECT_FALSE(FileUtils::isValidFilename(std::string_view("a\0b", 3)));
}

std::string isolated(const std::string& name)
{
    // NOLINTNEXTLINE(misc-misleading-bidirectional): the closing sign is in another literal
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
    testing_support::writeFile(sketch("a.txt").path(), "1");
    EXPECT_TRUE(split(sketch("a.txt")));
    ASSERT_TRUE(container);
    EXPECT_THAT(*components, ElementsAre("a.txt"));
    EXPECT_EQ(FileUtils::displayableLocationForURL(sketch("a.txt")), std::nullopt);
}

TEST_F(LocationTest, WritesTheLocationLineInBothDirections)
{
    testing_support::writeFile(at("Notes/Old/a.txt").path(), "1");
    testing_support::writeFile(sketch("Pens/b.txt").path(), "1");
    const auto drive = isolated("My Drive"), library = isolated("Sketchbook");
    for (const bool isRightToLeft : {false, true}) {
        texts->rightToLeft = isRightToLeft;
        const std::string mark = isRightToLeft ? "\u200f" : "", arrow = isRightToLeft ? " ◂ " : " ▸ ";
        EXPECT_EQ(FileUtils::displayableLocationForURL(root()), mark + drive);
        EXPECT_EQ(FileUtils::displayableLocationForURL(at("Notes")), mark + drive);
        EXPECT_EQ(FileUtils::displayableLocationForURL(at("Notes/Old/a.txt")),
            mark + drive + arrow + isolated("Notes") + arrow + isolated("Old"));
        EXPECT_EQ(
            FileUtils::displayableLocationForURL(at("Gone/a.txt")), mark + drive + arrow + isolated("Gone"))
            << "a missing item has the names of its path";
        EXPECT_EQ(FileUtils::displayableLocationForURL(sketch("Pens/b.txt")),
            mark + drive + arrow + library + arrow + isolated("Pens"));
    }
    EXPECT_EQ(FileUtils::displayableLocationForURL(Url::fileURL("/outside")), std::nullopt);
}

} // namespace
