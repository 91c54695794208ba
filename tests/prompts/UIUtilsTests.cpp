// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/controllers/AlertController.h"
#include "kit/controllers/BarButtonItem.h"
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
    void askToDelete(const std::vector<Url>& items, const std::shared_ptr<kit::View>& view = nullptr,
        const std::shared_ptr<kit::BarButtonItem>& button = nullptr)
    {
        UIUtils::showDeleteWarningAlertHasContainerViewControllerUsingViewUsingButtonCompletion(
            items, false, root, view, button, [this](const auto& pressed, bool cancelled) {
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

    writeDocument("Plans.pdf", "kept");
    const auto taken = UIUtils::renameItemAtURLToName(url("REPORT.pdf"), "Plans");
    EXPECT_EQ(UIUtils::bestMessage(taken), "Name is already taken");
    for (const char* name : {"", ".", "a/b", "a:b", ".hidden"}) {
        const auto refused = UIUtils::renameItemAtURLToName(url("REPORT.pdf"), name);
        ASSERT_TRUE(refused) << name;
        EXPECT_TRUE(refused->is(FileErrorCode::InvalidName));
        EXPECT_EQ(UIUtils::bestMessage(refused), "Character not allowed in filename");
    }
    EXPECT_EQ(log->count("DEBUG Rename: empty, reverting"), 1);
    EXPECT_EQ(log->count("DEBUG Name is invalid: a/b"), 1);
    EXPECT_EQ(log->count("DEBUG Name is valid: Plans"), 1);
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
    const auto described = [](const char* text) {
        return platform::PropertyDictionary{{"LocalizedDescription", text}};
    };
    const auto explained = [](const char* text) {
        return platform::PropertyDictionary{{"LocalizedFailureReason", text}};
    };
    auto both = described("Description");
    both.merge(explained("Reason"));
    struct Row {
        Error error;
        const char *shortMessage, *alertTitle;
    };
    const Row rows[] = {
        {Error(FileErrorCode::ItemExists, described("It exists")), "Name is already taken", "It exists"},
        {Error("another domain", 516), "Name is already taken", "Mishap exception"},
        {Error(FileErrorCode::InvalidName, explained("Bad name")), "Character not allowed in filename",
            "Bad name"},
        {Error("any", 1, both), "Description", "Description"},
        {Error("any", 1, explained("Reason")), "Reason", "Reason"},
        {Error("any", 1), "Mishap exception", "Mishap exception"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(UIUtils::bestMessage(row.error), row.shortMessage);
        UIUtils::showErrorParentViewController(row.error, root);
        ASSERT_NE(alert(), nullptr);
        EXPECT_EQ(alert()->title(), row.alertTitle);
        EXPECT_EQ(alert()->message(), "");
        EXPECT_TRUE(alert()->press(0));
    }
    EXPECT_EQ(UIUtils::bestMessage(std::nullopt), "");
}

TEST_F(UIUtilsTest, FriendlyErrorsHaveOneButtonAndMayLieOverAnother)
{
    const auto moved = [](FileErrorCode code) {
        return Error(code, {{"DestinationFilePath", "/drive/Letters/Report.pdf"}});
    };
    const auto taken = Error(FileErrorCode::ItemExists), invalid = Error(FileErrorCode::InvalidName);
    const auto other = Error("any", 7, {{"LocalizedDescription", "Out of paper"}});
    const auto move = [&](const Error& error) {
        UIUtils::showFriendlyMoveErrorParentViewController(error, root);
    };
    const auto rename = [this](const Error& error, const char* name) {
        UIUtils::showFriendlyRenameErrorBasenameParentViewController(error, name, root);
    };
    struct Row {
        std::function<void()> show;
        std::string title, message;
    };
    const std::vector<Row> rows{
        {[&] { move(moved(FileErrorCode::ItemExists)); },
            "An item named “Report.pdf” already exists in the new location.", ""},
        {[&] { move(taken); }, "An item named “” already exists in the new location.", ""},
        {[&] { rename(taken, "Report.pdf"); }, "The name “Report” with extension “.pdf” is already taken.",
            "Choose a different name."},
        {[&] { rename(taken, "a.tar.gz"); }, "The name “a.tar” with extension “.gz” is already taken.",
            "Choose a different name."},
        {[&] { rename(taken, "Letters"); }, "The name “Letters” is already taken.",
            "Choose a different name."},
        {[&] { rename(invalid, "a/b"); }, "",
            "The name “a/b” can’t be used. Try using a name with fewer characters, or with no punctuation "
            "marks."},
        {[&] { rename(other, "Letters"); }, "Out of paper", ""},
        {[&] { move(other); }, "Out of paper", ""},
        {[&] { UIUtils::showUnsupportedError(root); }, "This operation is not supported.", ""},
        {[&] { UIUtils::showErrorParentViewController(std::nullopt, root); }, "Mishap exception", ""},
    };
    for (const auto& row : rows) {
        row.show();
        ASSERT_NE(alert(), nullptr) << row.title;
        EXPECT_EQ(alert()->title(), row.title);
        EXPECT_EQ(alert()->message(), row.message);
        EXPECT_EQ(alert()->alertStyle(), kit::AlertStyle::Alert);
        ASSERT_EQ(alert()->actions().size(), 1);
        EXPECT_EQ(alert()->actions()[0]->title(), "OK");
        EXPECT_EQ(alert()->actions()[0]->style(), AlertActionStyle::Default);
        ASSERT_TRUE(alert()->press(0));
    }
    for (const auto& parent : {root, root, std::shared_ptr<kit::ViewController>()})
        UIUtils::showAlertMessageParentViewController("Title", "", parent);
    EXPECT_EQ(window->presentedScreens().size(), 2);
}

TEST_F(UIUtilsTest, WhatADeletionWouldLose)
{
    const std::string rest =
        " will be permanently deleted from Tarrow Drive on all your devices. This action cannot be undone.";
    const auto budget = writeDocument("Budget"), plans = writeDocument("Plans.txt");
    const auto recipes = makeContainer("app.recipes",
        {.names = {{"en", "Recipes"}},
            .documentTypes = {},
            .supportedFolderLevels = {},
            .owningApps = {},
            .iconName = {}});
    EXPECT_EQ(UIUtils::messageForDeletePrompt({budget}), "\"Budget\"" + rest);
    EXPECT_EQ(
        UIUtils::messageForDeletePrompt({recipes}), "The Recipes app library, and all its documents," + rest);
    EXPECT_EQ(UIUtils::messageForDeletePrompt({budget, plans, recipes}), ".DICT.ITEMS.3" + rest);
    EXPECT_EQ(UIUtils::messageForDeletePrompt({url("gone.txt"), url("gone2.txt")}), ".DICT.ITEMS.2" + rest);
    EXPECT_EQ(UIUtils::messageForDeletePrompt({}), ".DICT.ITEMS.0" + rest);
    EXPECT_EQ(UIUtils::messageForDeletePrompt({url("gone.txt")}), std::nullopt);
}

TEST_F(UIUtilsTest, TheSheetAnswersOnceAndAsksNothingAboutNothing)
{
    const auto budget = writeDocument("Budget");
    askToDelete({});
    askToDelete({url("gone.txt")});
    EXPECT_EQ(alert(), nullptr);
    askToDelete({budget});
    ASSERT_NE(alert(), nullptr);
    EXPECT_EQ(alert()->alertStyle(), kit::AlertStyle::ActionSheet);
    EXPECT_EQ(alert()->title(), "");
    EXPECT_EQ(alert()->actions().at(0)->style(), AlertActionStyle::Destructive);
    EXPECT_EQ(alert()->actions().at(1)->style(), AlertActionStyle::Cancel);
    EXPECT_TRUE(alert()->press(0));
    askToDelete({budget});
    EXPECT_TRUE(alert()->press(1));
    EXPECT_THAT(answers,
        testing::ElementsAre(
            "nothing, cancelled", "nothing, cancelled", "Delete from Tarrow Drive", "Cancel, cancelled"));
    EXPECT_TRUE(isThere("Budget")) << "deleting is the caller's work";
}

TEST_F(UIUtilsTest, TheSheetPointsAtWhatAskedForIt)
{
    using kit::BarButtonItem;
    const auto budget = writeDocument("Budget");
    const auto view = std::make_shared<kit::View>(platform::Rect{10, 20, 200, 60});
    const auto button = std::make_shared<BarButtonItem>("Delete", nullptr);
    askToDelete({budget}, view, button);
    const auto* place = std::get_if<kit::ViewAnchor>(&alert()->popoverAnchor());
    ASSERT_NE(place, nullptr);
    EXPECT_EQ(place->view.lock(), view);
    EXPECT_EQ(place->rect, (platform::Rect{0, 30, 200, 0}));
    EXPECT_EQ(place->arrows, kit::ArrowDirections::LeftOrRight);
    alert()->userCancelled();

    askToDelete({budget}, nullptr, button);
    const auto* item = std::get_if<std::weak_ptr<BarButtonItem>>(&alert()->popoverAnchor());
    ASSERT_NE(item, nullptr);
    EXPECT_EQ(item->lock(), button);
}

TEST_F(UIUtilsTest, AChildsViewIsInPlaceWhenItIsTold)
{
    struct Child : kit::ViewController {
        bool viewWasInPlace = false;
        void didMoveToParentViewController(const std::shared_ptr<kit::ViewController>& parent) override
        {
            viewWasInPlace = parent && view()->superview() == parent->view();
        }
    };
    const auto child = std::make_shared<Child>();
    UIUtils::addChildViewControllerChildViewController(root, child);
    EXPECT_EQ(child->parent(), root);
    EXPECT_TRUE(child->viewWasInPlace);
}

} // namespace
} // namespace tarrow
