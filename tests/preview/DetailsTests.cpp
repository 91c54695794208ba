// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "preview/PreviewDetailsViewController.h"

#include "PreviewFixture.h"
#include "drawing/PieProgressIndicatorView.h"
#include "drawing/ThumbnailImageView.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/values/KeyboardNotice.h"
#include "kit/values/Screen.h"
#include "kit/views/Button.h"
#include "kit/views/ScrollView.h"
#include "kit/views/StackView.h"
#include "kit/views/TextField.h"
#include "platform/NotificationCenter.h"
#include "preview/FileInfoStackView.h"
#include "tests/support/ForwardingCoordinator.h"

using namespace platform;
using namespace tarrow;
using kit::SystemItem;
using testing::ElementsAre;
using testing::IsEmpty;

namespace {

using testing_support::lying;
using testing_support::phone;
using testing_support::symbols;
using testing_support::tablet;

class Details : public testing_support::PreviewFixture {
protected:
    Details() { resize({360, 640}, phone); }
    void settle()
    {
        drive.dispatch->runUntilIdle();
        window->layoutIfNeeded();
    }
    void open(const char* name)
    {
        url = document(name)->url();
        manager->setMode(PreviewModeDetails);
        manager->previewItem(DRItem::initWithURL(url));
        settle();
        details = manager->detailsViewController();
        field = details->filenameTextField();
    }
    /// Begins to edit the name and types another one.
    void type(const std::string& name)
    {
        ASSERT_TRUE(field->userFocused());
        ASSERT_TRUE(field->userEdited(name, {name.size(), 0}));
    }
    void press(const kit::BarButtonItems& items)
    {
        ASSERT_EQ(items.size(), 1U);
        EXPECT_TRUE(items.front()->press());
        settle();
    }
    kit::NavigationItem& bar() const { return details->navigationItem(); }
    bool exists(const char* name) const { return std::filesystem::exists(drive.url(name).path()); }
    Rect inWindow(const kit::View& view) const { return view.convertRect(view.bounds(), *details->view()); }

    Url url = drive.url("");
    std::shared_ptr<PreviewDetailsViewController> details;
    std::shared_ptr<kit::TextField> field;
};

TEST_F(Details, AnUprightScreenHasOneColumnAndALyingOneTwo)
{
    open("Notes.txt");
    const auto thumbnail = details->thumbnailView();
    const auto facts = details->fileDetailsView();
    EXPECT_EQ(thumbnail->frame().width, 360);
    EXPECT_EQ(facts->frame().width, 360);
    EXPECT_GE(inWindow(*facts).y, inWindow(*thumbnail).maxY());
    EXPECT_EQ(field->alignment(), kit::TextAlignment::Center);
    EXPECT_EQ(field->frame().width, 360 - 16);
    EXPECT_NEAR(inWindow(*details->fileInfoView()).midX(), 180, 1);

    resize({640, 400}, lying);
    EXPECT_EQ(thumbnail->frame().width, 320);
    EXPECT_EQ(facts->frame().width, 320);
    EXPECT_EQ(inWindow(*facts).x, 320);
    EXPECT_EQ(thumbnail->frame().height, details->mainStackView()->frame().height);
    EXPECT_NEAR(inWindow(*facts).midY(), inWindow(*thumbnail).midY(), 1);
    EXPECT_EQ(field->alignment(), kit::TextAlignment::Natural);

    resize({360, 640}, phone);
    EXPECT_EQ(facts->frame().width, 360);
    EXPECT_GE(inWindow(*facts).y, inWindow(*thumbnail).maxY());
}

TEST_F(Details, OnALowScreenTheFactsCanBeScrolledTo)
{
    open("Notes.txt");
    for (const auto& [size, traits] : {std::pair{Size{640, 150}, lying}, std::pair{Size{300, 310}, phone}}) {
        resize(size, traits);
        const double bottom = inWindow(*details->fileInfoView()).maxY();
        EXPECT_LE(bottom, details->scrollView()->contentSize().height);
        EXPECT_GT(details->scrollView()->contentSize().height, size.height);
        EXPECT_GE(inWindow(*details->filenameStackView()).y, 0);
    }
}

TEST_F(Details, TheAppThatOpensTheDocumentIsNamedWhereThereIsRoom)
{
    apps->available = {{std::string(platform::ownerRank), {apps->make("editor")}}};
    open("Notes.txt");
    ASSERT_TRUE(details->openInAppButton());
    EXPECT_EQ(details->openInAppButton()->title(), "Open in “The editor”");
    const auto facts = [&] { return details->fileDetailsView()->arrangedSubviews(); };
    EXPECT_EQ(facts().size(), 2U);
    ASSERT_EQ(bar().rightItems().size(), 1U);
    EXPECT_EQ(bar().rightItems().front()->customView(), details->openInAppButton());

    resize({1024, 768}, tablet, kit::UserInterfaceIdiom::Tablet);
    ASSERT_EQ(facts().size(), 4U) << "the button stands below a hairline";
    EXPECT_EQ(facts().back(), details->openInAppButton());
    EXPECT_EQ(bar().rightItems().size(), 5U);
    EXPECT_TRUE(details->openInAppButton()->press());
    drive.settle();
    EXPECT_THAT(apps->opened, ElementsAre(testing_support::SimulatedApps::Opened{url, "editor"}));

    resize({360, 640}, phone);
    EXPECT_EQ(facts().size(), 2U);
    ASSERT_EQ(bar().rightItems().size(), 1U);
    EXPECT_EQ(bar().rightItems().front()->customView(), details->openInAppButton());
}

TEST_F(Details, TheNameIsEditedInPlace)
{
    open("Notes.txt");
    EXPECT_EQ(field->text(), "Notes.txt");
    ASSERT_TRUE(field->userFocused());
    EXPECT_EQ(field->selectedRange(), (kit::TextRange{5, 0})) << "the caret stands before the extension";
    EXPECT_EQ(bar().title(), "Rename File");
    EXPECT_TRUE(bar().hidesBackButton());
    EXPECT_THAT(symbols(bar().leftItems()), ElementsAre(SystemItem::Cancel));
    EXPECT_THAT(symbols(bar().rightItems()), ElementsAre(SystemItem::Done));
    window->layoutIfNeeded();
    EXPECT_EQ(field->frame().width, 360);

    type("Plans.txt");
    press(bar().rightItems());
    EXPECT_TRUE(exists("Plans.txt"));
    EXPECT_FALSE(exists("Notes.txt"));
    EXPECT_FALSE(field->isEditing());
    EXPECT_EQ(bar().title(), "");
    EXPECT_FALSE(bar().hidesBackButton());
    EXPECT_THAT(bar().leftItems(), IsEmpty());
    EXPECT_THAT(bar().rightItems(), IsEmpty());
    const auto now = manager->detailsViewController();
    ASSERT_TRUE(now) << "the move's notice leads to the document under its new name";
    EXPECT_EQ(now->filenameTextField()->text(), "Plans.txt");
}

TEST_F(Details, NothingIsRenamedWithoutAnotherName)
{
    open("Notes.txt");
    const struct {
        const char* what;
        std::string typed;
        bool isCancelled;
    } rows[] = {{"same", "Notes.txt", false}, {"empty", "", false}, {"cancelled", "Other.txt", true}};
    for (const auto& row : rows) {
        ASSERT_TRUE(field->userFocused());
        field->userEdited(row.typed, {});
        press(row.isCancelled ? bar().leftItems() : bar().rightItems());
        EXPECT_FALSE(field->isEditing()) << row.what;
        EXPECT_EQ(field->text(), "Notes.txt") << row.what;
        EXPECT_TRUE(exists("Notes.txt")) << row.what;
        EXPECT_EQ(bar().title(), "") << row.what;
    }
    field->userFocused();
    details->viewWasTapped();
    EXPECT_FALSE(field->isEditing());

    type("Dropped.txt");
    navigation->popViewController(false);
    settle();
    EXPECT_TRUE(exists("Notes.txt")) << "a name that was being typed is dropped with its screen";
}

TEST_F(Details, ARefusedNameStaysInTheField)
{
    drive.writeDocument("Taken.txt");
    open("Notes.txt");
    type("Taken.txt");
    EXPECT_TRUE(field->userPressedReturn());
    settle();
    ASSERT_TRUE(alertOver(*details));
    EXPECT_TRUE(field->isEditing());
    EXPECT_EQ(field->text(), "Taken.txt");
    pressTitled(alertOver(*details), "OK");
    field->userEdited("Free.txt", {});
    EXPECT_FALSE(field->userEdited("Free.txt\n", {})) << "a line break ends the editing";
    settle();
    EXPECT_TRUE(exists("Free.txt"));
    EXPECT_FALSE(field->isEditing());
}

TEST_F(Details, AnItemThatKeepsItsNameIsNotEdited)
{
    open("Notes.txt");
    manager->item()->setRenameable(false);
    EXPECT_FALSE(field->userFocused());
    EXPECT_EQ(bar().title(), "");
}

TEST_F(Details, WhileTheNameIsGivenTheFieldCanBeTypedIn)
{
    open("Notes.txt");
    type("Plans.txt");
    ASSERT_TRUE(bar().rightItems().front()->press());
    EXPECT_TRUE(field->isEditing()) << "the answer is not there yet";
    EXPECT_TRUE(bar().rightItems().front()->press()) << "pressing again changes nothing";
    field->userEdited("Plans for May.txt", {});
    settle();
    EXPECT_TRUE(exists("Plans.txt"));
    const auto now = manager->detailsViewController()->filenameTextField();
    EXPECT_EQ(now->text(), "Plans for May.txt") << "what was typed meanwhile is still there";
    EXPECT_TRUE(now->isEditing());
}

TEST_F(Details, ANewScreenOfTheItemGoesOnOnlyWithAnotherName)
{
    open("Notes.txt");
    details->continueAt({.scrolledTo = {}, .typedName = "Notes.txt", .selection = {}, .givenName = {}});
    EXPECT_FALSE(field->isEditing()) << "the name was given already, and its notice came first";
    details->continueAt({.scrolledTo = {}, .typedName = "Plans", .selection = {2, 1}, .givenName = {}});
    EXPECT_TRUE(field->isEditing());
    EXPECT_EQ(field->text(), "Plans");
    EXPECT_EQ(field->selectedRange(), (kit::TextRange{2, 1}));
}

TEST_F(Details, WhoCancelsWhileTheNameIsGivenSeesTheRealName)
{
    open("Notes.txt");
    type("Plans.txt");
    ASSERT_TRUE(bar().rightItems().front()->press());
    ASSERT_TRUE(bar().leftItems().front()->press());
    EXPECT_FALSE(field->isEditing());
    EXPECT_EQ(bar().title(), "");
    settle();
    EXPECT_FALSE(alertOver(*navigation));
    const auto real = exists("Plans.txt") ? "Plans.txt" : "Notes.txt";
    EXPECT_EQ(manager->detailsViewController()->filenameTextField()->text(), real);
}

TEST_F(Details, AChangeOfTheWindowKeepsDoneAndTheButtonsOfAfterwards)
{
    open("Notes.txt");
    type("Plans.txt");
    resize({1024, 768}, tablet, kit::UserInterfaceIdiom::Tablet);
    EXPECT_THAT(symbols(bar().rightItems()), ElementsAre(SystemItem::Done));
    EXPECT_EQ(field->text(), "Plans.txt");
    details->forceRenameCancel();
    EXPECT_EQ(bar().rightItems().size(), 5U);
    EXPECT_EQ(bar().rightItems().front(), details->barButtonActionItem());
}

TEST_F(Details, TheNameFieldMovesAboveTheKeyboard)
{
    open("Notes.txt");
    const auto& scroll = *details->scrollView();
    const auto post = [&](Notification notification, double height) {
        kit::KeyboardNotice notice;
        notice.beginFrame = notice.endFrame = {0, 640 - height, 360, height};
        drive.notifications->post(notification, notice.toUserInfo());
    };
    const double fieldTop = field->convertRect(field->bounds(), scroll).y;
    post(Notification::KeyboardWillShow, 300);
    EXPECT_EQ(scroll.contentInsets().bottom, 300 - 17 + 30) << "17 points below the columns are free";
    const double lowest = scroll.contentSize().height - 640 + scroll.contentInsets().bottom;
    EXPECT_EQ(scroll.contentOffset().y, std::min(lowest, fieldTop - 30));
    post(Notification::KeyboardWillHide, 300);
    EXPECT_EQ(scroll.contentInsets(), details->scrollViewDefaultEdgeInsets());

    post(Notification::KeyboardWillShow, 10);
    EXPECT_EQ(scroll.contentInsets().bottom, 23);
    EXPECT_LE(scroll.contentOffset().y, 23) << "never beyond the end of the content";
    navigation->popViewController(false);
    post(Notification::KeyboardWillHide, 10);
    EXPECT_EQ(scroll.contentInsets().bottom, 23) << "who is gone hears nothing";
}

} // namespace
