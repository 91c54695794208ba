// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/support/DriveFixture.h"

namespace {

using host::drive::ContainerRecord;
using platform::Url;
using namespace testing;
using testing_support::DriveFixture;

class ContainerTests : public testing::Test {
protected:
    platform::DocumentContainers& containers() { return _drive.cloud->containers(); }
    Url document(const std::string& pathBelowDocumentsArea) const
    {
        return Url::fileURL(_drive.layout().documents() + '/' + pathBelowDocumentsArea);
    }
    void describe(const std::string& identifier, std::string_view text) const
    {
        _drive.folder().write("drive/containers/" + identifier + ".json", text);
    }
    std::vector<std::string> names()
    {
        std::vector<std::string> result;
        for (const auto& container : containers().allContainers())
            result.push_back(container->localizedName);
        return result;
    }

    DriveFixture _drive;
};

TEST_F(ContainerTests, placesAndTheirContainers)
{
    _drive.makeContainer("app.notes");
    const struct {
        const char* path;
        bool isTop;
        const char* identifier; // empty: it is in no container
        const char* relative; // below the root of all documents; empty: it is outside
    } rows[] = {
        {"BrindleDefault", true, "BrindleDefault", "BrindleDefault"},
        {"BrindleDefault/Documents", false, "BrindleDefault", "BrindleDefault/Documents"},
        {"BrindleDefault/a/b.txt", false, "BrindleDefault", "BrindleDefault/a/b.txt"},
        {"app.notes/Documents", true, "app.notes", "app.notes/Documents"},
        {"app.notes/Documents/x", false, "app.notes", "app.notes/Documents/x"},
        {"app.notes/Documents/Documents", false, "app.notes", "app.notes/Documents/Documents"},
        {"app.notes", false, "app.notes", "app.notes"},
        {"app.notes/Other", false, "app.notes", "app.notes/Other"},
        {".hidden/Documents", true, "", ".hidden/Documents"},
        {"../documents-evil/app/Documents", false, "", ""},
    };
    for (const auto& row : rows) {
        const auto url = std::string_view(row.path).starts_with("..")
            ? Url::fileURL(_drive.layout().home() + std::string(row.path + 2))
            : document(row.path);
        EXPECT_EQ(containers().isContainerTopFolder(url), row.isTop) << row.path;
        EXPECT_EQ(containers().containerIdentifierInURL(url).value_or(""), row.identifier) << row.path;
        EXPECT_EQ(containers().pathRelativeToSyncedRoot(url).value_or(""), row.relative) << row.path;
        const auto container = containers().containerForItem(url);
        EXPECT_EQ(container ? (*container)->identifier : "", row.identifier) << row.path;
        EXPECT_NE(container.value.has_value(), container.error.has_value()) << row.path;
    }
    EXPECT_EQ(containers().pathRelativeToSyncedRoot(_drive.layout().documentsURL()), "");
    EXPECT_FALSE(containers().isContainerTopFolder(_drive.layout().documentsURL()));
}

TEST_F(ContainerTests, describedByTheirFileAsItIsNow)
{
    ContainerRecord record;
    record.names = {{"en", "Notebook"}, {"de", "Notizbuch"}};
    record.documentTypes = {{"Notes", {"public.text", std::nullopt, "public.image"}}};
    record.supportedFolderLevels = "one";
    record.owningApps = {"org.example.One", "org.example.Two"};
    record.iconName = "notes";
    const auto folder = _drive.makeContainer("app.notes", record);
    const auto container = *containers().containerForItem(folder);
    EXPECT_EQ(container->localizedName, "Notebook");
    EXPECT_EQ(container->documentsURL, folder);
    ASSERT_EQ(container->documentTypes.size(), 1U);
    EXPECT_EQ(container->documentTypes[0].contentTypes, record.documentTypes[0].contentTypes);
    EXPECT_EQ(container->supportedFolderLevels, "one");
    EXPECT_EQ(container->owningApps, record.owningApps);
    EXPECT_EQ(container->iconName, "notes");
    EXPECT_EQ(*containers().containerForItem(folder), container) << "it is kept while it does not change";

    record.names["en"] = "Renamed";
    _drive.makeContainer("app.notes", record);
    EXPECT_EQ((*containers().containerForItem(folder))->localizedName, "Renamed");
    std::filesystem::remove_all(folder.path());
    EXPECT_FALSE((*containers().containerForItem(folder))->documentsURL);
}

TEST_F(ContainerTests, aNameForTheUsersLanguage)
{
    ContainerRecord record;
    record.names = {{"ar", "دفتر"}, {"en", "Notebook"}, {"de", "Notizbuch"}, {"pt_BR", "Caderno"}};
    const std::pair<std::vector<std::string>, const char*> rows[] = {
        {{"de_AT", "en"}, "Notizbuch"},
        {{"fr", "ar", "en"}, "دفتر"},
        {{"pt_BR"}, "Caderno"},
        {{"pt"}, "Notebook"},
        {{}, "Notebook"},
    };
    for (const auto& [languages, name] : rows)
        EXPECT_EQ(record.nameIn(languages), name);
    record.names.erase("en");
    EXPECT_EQ(record.nameIn({"fr"}), "دفتر");
    EXPECT_EQ(ContainerRecord().nameIn({"en"}), "");
}

TEST_F(ContainerTests, aDamagedDescriptionIsAsIfThereWereNone)
{
    const auto folder = _drive.makeContainer("app.notes");
    describe("app.notes", "{");
    EXPECT_THAT(names(), ElementsAre("Tarrow Drive", "app.notes")) << "it goes by its folder's name";
    describe(
        "app.notes", R"({"names": {"en": 3, "de": ""}, "documentTypes": [7, {"name": 1, "contentTypes": {}}],
        "supportedFolderLevels": [], "owningApps": [null, "org.example.One"], "icon": {}})");
    const auto container = containers().containerForItem(folder);
    ASSERT_TRUE(container) << "fields of a wrong kind are left out";
    EXPECT_EQ((*container)->localizedName, "app.notes");
    EXPECT_THAT((*container)->owningApps, ElementsAre("org.example.One"));
    EXPECT_FALSE((*container)->supportedFolderLevels);
}

TEST_F(ContainerTests, allContainersTheDriveFirst)
{
    const auto named = [](const char* name) {
        ContainerRecord record;
        record.names["en"] = name;
        return record;
    };
    _drive.makeContainer("app.a", named("Zebra"));
    _drive.makeContainer("app.z", named("Apple"));
    _drive.makeContainer("app.plain");
    _drive.folder().write("drive/documents/stray file", "no container");
    std::filesystem::create_directory(_drive.layout().documents() + "/.hidden");
    std::filesystem::create_directory_symlink("/tmp", _drive.layout().documents() + "/link");
    EXPECT_THAT(names(), ElementsAre("Tarrow Drive", "app.plain", "Apple", "Zebra"));
    EXPECT_EQ(containers().containerWithIdentifier("app.z")->localizedName, "Apple");
    for (const char* identifier : {"", "unknown", "..", ".hidden", "link", "stray file", "app.a/Documents"})
        EXPECT_EQ(containers().containerWithIdentifier(identifier), nullptr) << identifier;

    std::filesystem::remove_all(_drive.layout().documents());
    EXPECT_THAT(containers().allContainers(), IsEmpty());
}

} // namespace
