// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/LaunchUtils.h"
#include "tests/items/support/ItemsFixture.h"

namespace tarrow {
namespace {

using items_tests::ItemsFixture;
using namespace testing;
using testing_support::SimulatedApps;

class LaunchUtilsTest : public ItemsFixture {
protected:
    /// Answers the identifier of the app that opens a document; "" for none.
    static std::string appFor(const Url& url, bool requireOpenIn = true)
    {
        const auto app = LaunchUtils::defaultAppForDocumentRequireOpenIn(url, requireOpenIn);
        return app ? app->bundleIdentifier : "";
    }
    void setOwners(std::vector<platform::AppHandle> owners) const
    {
        apps->available = {{"Alternate", {editor}}, {"Owner", std::move(owners)}, {"None", {editor}}};
    }

    const platform::AppHandle editor = SimulatedApps::make("editor"),
                              painter = SimulatedApps::make("painter"),
                              importer = SimulatedApps::make("importer", false),
                              own = SimulatedApps::make("own");
};

TEST_F(LaunchUtilsTest, OnlyAnOwnerThatOpensInPlaceIsADefaultApp)
{
    const auto note = writeDocument("note.txt"), far = writePromise("far.txt", {});
    const struct {
        std::vector<platform::AppHandle> owners;
        std::string app;
    } rows[] = {{{}, ""}, {{importer}, ""}, {{importer, painter}, "painter"}, {{painter, editor}, "painter"},
        {{own}, ""}, {{own, painter}, ""}};
    for (const auto& row : rows) {
        setOwners(row.owners);
        EXPECT_EQ(appFor(note), row.app);
        EXPECT_EQ(appFor(far), row.app) << "a promise is ranked like any other document";
    }
    EXPECT_EQ(log->count("DEBUG Ignoring own as default app"), 4U);
    EXPECT_EQ(log->count("DEBUG Assuming apps can open a promised document..."), std::size(rows));

    log->clear();
    setOwners({importer, painter});
    EXPECT_EQ(LaunchUtils::defaultAppNameForDocumentRequireOpenIn(note, true), "The painter");
    EXPECT_THAT(log->lines(),
        testing::IsSupersetOf(
            {"DEBUG UTI public.plain-text: Found non-Owner 'Alternate' app The editor (editor)",
                "DEBUG UTI public.plain-text: Found non-OpenInPlace app The importer (importer)",
                "DEBUG UTI public.plain-text: Found *perfect* app: The painter (painter)",
                "DEBUG UTI public.plain-text: Found non-Owner 'None' app The editor (editor)"}));
}

TEST_F(LaunchUtilsTest, AnAppIsGivenOnlyWhatIsHere)
{
    setOwners({painter});
    const auto open = [](const Url& url) {
        return LaunchUtils::openInDefaultAppViewControllerRequireOpenIn(url, nullptr, true);
    };
    EXPECT_FALSE(open(writePromise("far.txt", {})));
    EXPECT_THAT(apps->opened, IsEmpty());
    const auto note = writeDocument("note.txt");
    EXPECT_TRUE(open(note));
    EXPECT_THAT(apps->opened, ElementsAre(SimulatedApps::Opened{note, "painter"}));
}

TEST_F(LaunchUtilsTest, WhatThePreviewShowsWellStaysInTheDefaultContainer)
{
    const auto library = describeContainer("box", R"({"owningApps": ["painter"]})");
    setOwners({painter});
    apps->known = {painter};
    for (const auto* name : {"a.pdf", "a.jpeg", "a.mov", "a.mp3"}) {
        EXPECT_EQ(appFor(writeDocument(name)), "") << name;
        EXPECT_EQ(appFor(testing_support::writeFile(library.path() + '/' + name, "1")), "painter") << name;
    }
    EXPECT_EQ(appFor(writeReference("pointer.txt.trwref", "box", "a.pdf")), "")
        << "what a reference leads to is judged";
}

TEST_F(LaunchUtilsTest, ALibrarysOwnAppComesFirst)
{
    const auto document = describeContainer(
        "box", R"({"names": {"en": "Box"}, "owningApps": ["gone", "importer", "painter", "own"]})")
                              .appendingPathComponent("a.txt");
    apps->known = {importer, painter, own};
    const struct {
        std::vector<platform::AppHandle> owners;
        std::string app;
    } rows[] = {{{editor, painter}, "painter"}, {{editor, own}, "editor"}, {{importer}, ""}, {{}, ""}};
    for (const auto& row : rows) {
        setOwners(row.owners);
        EXPECT_EQ(appFor(document), row.app);
        EXPECT_EQ(appFor(document, false), row.app);
    }
    EXPECT_EQ(log->count("DEBUG Container Box: Default app (gone) not installed"), 8U);
    EXPECT_EQ(log->count("DEBUG Container Box: Default app (importer) doesn't support open in place"), 8U);
    EXPECT_EQ(log->count("DEBUG Container Box: Default app (painter) supports open in place"), 8U);
    EXPECT_EQ(log->count("DEBUG Container Box: Default app does NOT support/own this document type."), 10U);
    EXPECT_EQ(log->count("DEBUG Falling back to default open-in-place app instead: The editor (editor)"), 2U);
    EXPECT_EQ(log->count("DEBUG No fallback app, using Lookwell"), 8U);

    setOwners({own});
    EXPECT_EQ(appFor(document), "") << "this program is no default app anywhere";
    setOwners({editor});
    describeContainer("empty", "{}");
    EXPECT_EQ(appFor(Url::fileURL(layout().containerDocuments("empty") + "/a.txt")), "");
    EXPECT_EQ(appFor(Url::fileURL("/outside/a.txt")), "");
}

} // namespace
} // namespace tarrow
