// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/ContainerRecord.h"
#include "kit/controllers/AlertController.h"
#include "kit/controllers/Window.h"
#include "kit/views/View.h"
#include "prompts/UIUtils.h"
#include "screens/list/DocumentListController.h"
#include "tests/support/DriveFixture.h"

namespace tarrow {
namespace {

using namespace testing_support;
using namespace kit;
using namespace platform;

class UIUtilsTest : public testing::Test, protected DriveFixture {
protected:
    UIUtilsTest()
    {
        window->setRootViewController(root);
        window->makeKeyAndVisible();
    }

    bool isThere(const char* path) const { return std::filesystem::exists(url(path).path()); }
    std::shared_ptr<AlertController> alert() const
    {
        return std::dynamic_pointer_cast<AlertController>(root->presentedViewController());
    }
    void askToDelete(const std::vector<Url>& items, const std::shared_ptr<kit::View>& view = nullptr)
    {
        UIUtils::showDeleteWarningAlertHasContainerViewControllerUsingViewUsingButtonCompletion(
            items, false, root, view, nullptr, [this](const auto& pressed, bool cancelled) {
                answers.push_back(
                    (pressed ? pressed->title() : "nothing") + (cancelled ? ", cancelled" : ""));
            });
    }

    std::shared_ptr<kit::ViewController> root = std::make_shared<kit::ViewController>();
    std::shared_ptr<kit::Window> window = std::make_shared<kit::Window>(platform::Rect{0, 0, 400, 800});
    std::vector<std::string> answers;
};

TEST_F(UIUtilsTest, ARenamedItemKeepsItsExtension)
{
    struct Row {
        const char *before, *typed, *after;
    };
    for (const Row row : {Row{"Report.pdf", "Summary", "Summary.pdf"},
             {"Report.pdf", "Summary.PDF", "Summary.PDF"}, {"Report.pdf", "Summary.txt", "Summary.txt.pdf"},
             {"Photo.JPG", "Holiday.jpg", "Holiday.jpg"}, {"Photo.JPG", "Holiday", "Holiday.JPG"},
             {"README", "Guide", "Guide"}, {"README", "Guide.md", "Guide.md"}, {"a.tar.gz", "b", "b.gz"},
             {"a.\u00c9", "b.\u00e9", "b.\u00e9"}, {"Report.pdf", "Report", "Report.pdf"},
             {"Report.pdf", "v1.", "v1..pdf"}}) {
        EXPECT_EQ(UIUtils::computeNewURLNewBasename(url(std::string("Letters/") + row.before), row.typed),
            url(std::string("Letters/") + row.after))
            << row.before << " as " << row.typed;
    }
}

TEST_F(UIUtilsTest, ARenameMovesTheItemOnlyWhenItsNameChanges)
{
    const auto report = writeDocument("Report.pdf");
    EXPECT_EQ(UIUtils::renameItemAtURLToName(report, "Report"), std::nullopt);
    EXPECT_EQ(log->count("INFO Move successful"), 0);
    EXPECT_EQ(UIUtils::renameItemAtURLToName(report, "REPORT"), std::nullopt);
    EXPECT_TRUE(isThere("REPORT.pdf") && !isThere("Report.pdf")) << "another letter case is another name";

    for (const char* name : {"", ".", "a/b", "a:b", ".hidden"}) {
        const auto refused = UIUtils::renameItemAtURLToName(url("REPORT.pdf"), name);
        ASSERT_TRUE(refused) << name;
        EXPECT_TRUE(refused->is(FileErrorCode::InvalidName));
        EXPECT_EQ(UIUtils::bestMessage(refused), "Character not allowed in filename");
    }
    EXPECT_EQ(log->count("DEBUG Rename: empty, reverting"), 1);
    EXPECT_EQ(log->count("DEBUG Name is invalid: a/b"), 1);
    EXPECT_TRUE(isThere("REPORT.pdf"));
}

TEST_F(UIUtilsTest, AReferenceRenamesTheDocumentItStandsFor)
{
    const auto documents = makeContainer("app.notes");
    const auto target = documents.appendingPathComponent("Draft.txt");
    std::filesystem::copy_file(writeDocument("seed.txt").path(), target.path());
    const auto reference = writeReference("Draft.trwref", "app.notes", "Draft.txt");
    EXPECT_EQ(UIUtils::renameItemAtURLToName(reference, "Final"), std::nullopt);
    EXPECT_TRUE(std::filesystem::exists(documents.appendingPathComponent("Final.txt").path()));
    EXPECT_TRUE(isThere("Draft.trwref"));

    const auto broken = writeReference("Broken.trwref", "..", "Draft.txt");
    EXPECT_EQ(UIUtils::renameItemAtURLToName(broken, "Other"), std::nullopt);
    EXPECT_TRUE(isThere("Other.trwref")) << "nothing else can be meant";
}

TEST_F(UIUtilsTest, WhatIsSaidAboutAnError)
{
    const Error exists(FileErrorCode::ItemExists, {{"LocalizedDescription", "It exists"}}),
        invalid(FileErrorCode::InvalidName, {{"LocalizedFailureReason", "Bad name"}}),
        described("any", 7, {{"LocalizedDescription", "Description"}, {"LocalizedFailureReason", "Reason"}}),
        unknown("any", 1);
    EXPECT_EQ(UIUtils::bestMessage(exists), "Name is already taken");
    EXPECT_EQ(UIUtils::bestMessage(Error("another domain", 516)), "Name is already taken");
    EXPECT_EQ(UIUtils::bestMessage(invalid), "Character not allowed in filename");
    EXPECT_EQ(UIUtils::bestMessage(described), "Description");
    EXPECT_EQ(UIUtils::bestMessage(unknown), "Mishap exception");
    EXPECT_EQ(UIUtils::bestMessage(std::nullopt), "");
    const auto show = [this](const platform::Error& error) {
        return [this, error] { UIUtils::showErrorParentViewController(error, root); };
    };
    const auto rename = [this](const Error& error, const char* name) {
        return [=, this] { UIUtils::showFriendlyRenameErrorBasenameParentViewController(error, name, root); };
    };
    struct Row {
        std::function<void()> show;
        std::string title, message;
    };
    const std::vector<Row> rows{
        {show(exists), "It exists", ""},
        {show(invalid), "Bad name", ""},
        {show(unknown), "Mishap exception", ""},
        {rename(exists, "Report.pdf"), "The name “Report” with extension “.pdf” is already taken.",
            "Choose a different name."},
        {rename(exists, "Letters"), "The name “Letters” is already taken.", "Choose a different name."},
        {rename(invalid, "a/b"), "",
            "The name “a/b” can’t be used. Try using a name with fewer characters, or with no punctuation "
            "marks."},
        {rename(described, "Letters"), "Description", ""},
        {[&] { UIUtils::showErrorParentViewController(std::nullopt, root); }, "Mishap exception", ""},
    };
    for (const auto& row : rows) {
        row.show();
        ASSERT_NE(alert(), nullptr) << row.title;
        EXPECT_EQ(alert()->title(), row.title);
        EXPECT_EQ(alert()->message(), row.message);
        EXPECT_EQ(alert()->alertStyle(), kit::AlertStyle::Alert);
        ASSERT_EQ(alert()->actions().size(), 1);
        ASSERT_TRUE(alert()->press(0));
    }
    for (const auto& parent : {root, root, std::shared_ptr<kit::ViewController>()})
        UIUtils::showAlertMessageParentViewController("Title", "", parent);
    EXPECT_EQ(window->presentedScreens().size(), 2) << "one alert may lie over another";
}

TEST_F(UIUtilsTest, WhatADeletionWouldLose)
{
    const std::string rest =
        " will be permanently deleted from Tarrow Drive on all your devices. This action cannot be undone.";
    host::drive::ContainerRecord record;
    record.names = {{"en", "Recipes"}};
    const auto recipes = makeContainer("app.recipes", record);
    EXPECT_EQ(
        UIUtils::messageForDeletePrompt({recipes}), "The Recipes app library, and all its documents," + rest);
    EXPECT_EQ(UIUtils::messageForDeletePrompt({url("gone.txt"), recipes}), ".DICT.ITEMS.2" + rest);
    EXPECT_EQ(UIUtils::messageForDeletePrompt({url("gone.txt")}), std::nullopt);
}

TEST_F(UIUtilsTest, TheSheetAsksNothingAboutNothing)
{
    askToDelete({});
    askToDelete({url("gone.txt")});
    EXPECT_EQ(alert(), nullptr);
    EXPECT_THAT(answers, testing::ElementsAre("nothing, cancelled", "nothing, cancelled"));
}

TEST_F(UIUtilsTest, TheSheetPointsAtTheMiddleOfTheViewThatAskedForIt)
{
    const auto view = std::make_shared<kit::View>(platform::Rect{10, 20, 200, 60});
    askToDelete({writeDocument("Budget")}, view);
    ASSERT_NE(alert(), nullptr);
    EXPECT_EQ(alert()->alertStyle(), kit::AlertStyle::ActionSheet);
    EXPECT_EQ(alert()->actions().at(0)->style(), AlertActionStyle::Destructive);
    EXPECT_EQ(alert()->actions().at(1)->style(), AlertActionStyle::Cancel);
    const auto* place = std::get_if<kit::ViewAnchor>(&alert()->popoverAnchor());
    ASSERT_NE(place, nullptr);
    EXPECT_EQ(place->view.lock(), view);
    EXPECT_EQ(place->rect, (platform::Rect{0, 30, 200, 0}));
    EXPECT_EQ(place->arrows, kit::ArrowDirections::LeftOrRight);
    EXPECT_TRUE(alert()->press(0));
    EXPECT_THAT(answers, testing::ElementsAre("Delete from Tarrow Drive"));
    EXPECT_TRUE(isThere("Budget")) << "deleting is the caller's work";
}

} // namespace
} // namespace tarrow
