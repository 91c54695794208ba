// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "PreviewFixture.h"
#include "kit/views/Button.h"
#include "kit/views/TextField.h"
#include "platform/FileChanges.h"
#include "platform/PagedDocumentEditing.h"
#include "screens/preview/NoteView.h"
#include "screens/preview/PreviewContent.h"
#include "screens/preview/PreviewEditor.h"
#include "screens/preview/PreviewFieldBar.h"
#include "screens/preview/PreviewPagesView.h"
#include "screens/preview/PreviewScreenView.h"
#include "screens/preview/PreviewToolbar.h"
#include "tests/support/FormPdf.h"
#include "tests/support/SimplePdf.h"

#include <sys/stat.h>

namespace {

namespace fs = std::filesystem;

using namespace platform;
using namespace screens;
using tarrow::DRItem;
using namespace testing;
using namespace testing_support;

class PreviewEditingTest : public testing_support::PreviewFixture {
protected:
    void show(const std::string& content, const char* name = "Form.pdf")
    {
        item = drive.writeDocument(name, content);
        manager->previewItem(DRItem::initWithURL(item));
        drive.dispatch->runUntilIdle();
    }
    void edit()
    {
        preview->screenView()->toolbar()->editButton()->press();
        drive.dispatch->runUntilIdle();
    }
    PreviewPagesView& pages() const { return dynamic_cast<PreviewPagesView&>(*preview->previewView()); }
    void press(EditTool tool)
    {
        ASSERT_TRUE(preview->editor());
        preview->editor()->bar()->button(tool)->press();
        drive.dispatch->runUntilIdle();
    }
    /// Writes a text into the first field.
    void write(const std::string& text)
    {
        press(EditTool::NextField);
        ASSERT_TRUE(preview->editor()->fieldBar()->textField()->userEdited(text, {}));
    }
    /// Shows the form and writes a text into its first field.
    void fillIn(const std::string& text)
    {
        show(formPdf());
        edit();
        write(text);
    }
    void leave() const
    {
        navigation->popViewController(false);
        drive.dispatch->runUntilIdle();
    }
    void answer(const std::string& title) const { pressTitled(alert(), title); }
    void writeNote(const std::string& text) const
    {
        const auto screen = std::dynamic_pointer_cast<NoteScreen>(alert()->contentViewController());
        ASSERT_TRUE(screen);
        screen->note()->userEdited(text);
    }
    /// Answers the content of the first field of a document on the disk.
    static std::string written(const Url& url)
    {
        const auto opened = services().pagedDocumentOpener().openForEditing(
            std::make_shared<const std::string>(contentOf(url)));
        return opened ? (*opened.value)->fields(0)[0].text : "unreadable";
    }

    Url item = drive.url("Form.pdf");
};

TEST_F(PreviewEditingTest, OffersItWhereDelegateAndDocumentAllowItAndSaysWhyNotOtherwise)
{
    const auto isOffered = [&] { return !preview->screenView()->toolbar()->editButton()->isHidden(); };
    show(formPdf());
    EXPECT_TRUE(isOffered());
    show("text", "Notes.txt");
    EXPECT_FALSE(isOffered());
    // The content is a PDF document but the name is not one, and the delegate decides by the name.
    show(formPdf(), "Form.ai");
    EXPECT_FALSE(preview->canEdit());
    EXPECT_FALSE(preview->_lwPreviewItemIsPDFKind(drive.url("Notes.txt")));

    show(testing_support::simplePdf({"no index"}), "Damaged.pdf");
    edit();
    EXPECT_FALSE(preview->editor());
    ASSERT_TRUE(alert());
    EXPECT_THAT(alert()->message(), HasSubstr("damaged"));
    answer("OK");
    show(formPdf(), "Fixed.pdf");
    ::chmod(item.path().c_str(), 0444);
    edit();
    EXPECT_FALSE(preview->editor());
    ASSERT_TRUE(alert());
    EXPECT_THAT(alert()->message(), HasSubstr("permission"));
}

TEST_F(PreviewEditingTest, SavesWhenThePersonIsDoneAndGoesOnShowingThePlace)
{
    show(formPdf());
    pages().userResized(224, 1);
    pages().peerShowsZoom(2);
    pages().userSees({0, 300, 224, 300});
    edit();
    EXPECT_TRUE(preview->screenView()->toolbar()->isHidden());
    EXPECT_THAT(pages().fields(), SizeIs(6));
    write("Ada");
    EXPECT_EQ(preview->editor()->fieldBar()->nameLabel()->text(), "Your name");
    const auto box = pages().fields()[1];
    pages().userTaps(pages().deck().toContent(0, box.place).origin());
    drive.dispatch->runUntilIdle();
    EXPECT_TRUE(pages().fields()[1].isOn);
    EXPECT_EQ(contentOf(item), formPdf()) << "before it is done";
    press(EditTool::Done);
    EXPECT_FALSE(preview->editor());
    EXPECT_FALSE(preview->screenView()->toolbar()->isHidden());
    EXPECT_EQ(written(item), "Ada");

    // The presenter is told of the save, but the content on the screen is the saved one.
    const auto shown = preview->content();
    drive.dispatch->advance(3);
    EXPECT_EQ(preview->content(), shown);
    EXPECT_EQ(pages().zoom(), 2);
    EXPECT_EQ(pages().visiblePlace(), (Point{0, 300}));
    edit();
    EXPECT_EQ(pages().fields()[0].text, "Ada");
    write("Ada Lovelace");
    const auto before = *pages().deck().picture(0);
    press(EditTool::Done);
    EXPECT_EQ(alert(), nullptr);
    EXPECT_FALSE(*pages().deck().picture(0) == before) << "what was written last is seen";
}

TEST_F(PreviewEditingTest, TakesBackMarksAndNotesAndReadsThem)
{
    show(formPdf());
    pages().userResized(224, 1);
    pages().userSees({0, 0, 224, 400});
    const auto at = [&](double x, double y) { return pages().deck().toContent(0, {x, y, 0, 0}).origin(); };
    const auto tap = [&](Point place) {
        pages().userTaps(place);
        drive.dispatch->runUntilIdle();
    };
    tap(at(170, 270));
    ASSERT_TRUE(alert());
    EXPECT_EQ(alert()->message(), "Seen by Ada") << "also where nothing is being changed";
    answer("OK");
    edit();
    EXPECT_FALSE(preview->editor()->bar()->button(EditTool::Highlight)->isEnabled());
    pages().userSelects(at(31, 255), at(120, 255));
    drive.dispatch->runUntilIdle();
    press(EditTool::Highlight);
    press(EditTool::Note);
    EXPECT_THAT(preview->screenView()->note(), HasSubstr("Tap"));
    tap(at(100, 150));
    ASSERT_TRUE(alert());
    writeNote("mine");
    answer("Done");
    tap(at(100, 150));
    EXPECT_EQ(alert()->message(), "mine");
    answer("Change Text");
    writeNote("ours\nand theirs");
    answer("Done");
    const auto marks = [&] { return preview->editor()->editing()->pages()->marks(0); };
    ASSERT_THAT(marks(), SizeIs(3));
    EXPECT_EQ(marks()[2].text, "ours\nand theirs");
    tap(at(60, 255));
    answer("Remove");
    EXPECT_THAT(marks(), SizeIs(2));
    for (const std::size_t count : {3U, 3U, 2U, 1U}) {
        press(EditTool::Undo);
        EXPECT_THAT(marks(), SizeIs(count));
    }
    EXPECT_FALSE(preview->editor()->editing()->hasUnsavedEdits());
    press(EditTool::Done);
    EXPECT_EQ(contentOf(item), formPdf());
}

TEST_F(PreviewEditingTest, LeavingSavesAndNeverReplacesWhatAnotherProgramWrote)
{
    fillIn("Ada");
    leave();
    EXPECT_EQ(written(item), "Ada");
    EXPECT_FALSE(alert());

    fillIn("Bob");
    const auto theirs = testing_support::simplePdf({"theirs"});
    drive.writeDocument("Form.pdf", theirs);
    preview->refreshCurrentPreviewItem();
    drive.dispatch->runUntilIdle();
    EXPECT_TRUE(preview->editor()) << "what is being changed is not taken away";
    EXPECT_THAT(preview->screenView()->note(), HasSubstr("copy"));
    press(EditTool::Done);
    EXPECT_EQ(contentOf(item), theirs);
    EXPECT_EQ(written(drive.url("Form 2.pdf")), "Bob");
    ASSERT_TRUE(alert());
    EXPECT_THAT(alert()->message(), HasSubstr("Form 2.pdf"));
    EXPECT_EQ(preview->content()->pages->pageCount(), 1U) << "theirs is shown";
}

TEST_F(PreviewEditingTest, WhatIsChangedWhileItIsSavedIntoACopyIsInThatCopy)
{
    const auto loseFocus = [&] { drive.notifications->post(Notification::ApplicationDidLoseFocus); };
    const auto press = [&](const char* title) {
        const auto action = std::ranges::find(alert()->actions(), title, &kit::AlertAction::title);
        alert()->press(*action);
    };
    const auto saveElsewhere = [&] {
        ::chmod(item.path().c_str(), 0444);
        loseFocus();
        drive.dispatch->runUntilIdle();
        press("Keep a Copy");
        ::chmod(item.path().c_str(), 0644);
    };
    const auto done = [&] { preview->editor()->bar()->button(EditTool::Done)->press(); };
    const auto end = [&] { drive.notifications->post(Notification::ApplicationWillTerminate); };
    const struct {
        const char* what;
        std::function<void()> save, goOn;
    } rows[] = {
        {"another program has saved", loseFocus, [] {}},
        {"the user is done meanwhile", loseFocus, done},
        {"the program ends meanwhile", loseFocus, end},
        {"a copy was asked for", saveElsewhere, [] {}},
    };
    const auto theirs = testing_support::simplePdf({"theirs"});
    for (const auto& row : rows) {
        SCOPED_TRACE(row.what);
        fillIn("Ada");
        drive.writeDocument("Form.pdf", theirs);
        row.save();
        ASSERT_TRUE(preview->editor());
        EXPECT_TRUE(preview->editor()->fieldBar()->textField()->userEdited("Ada and Bob", {}));
        row.goOn();
        drive.dispatch->runUntilIdle();
        EXPECT_EQ(contentOf(item), theirs);
        EXPECT_EQ(written(drive.url("Form 2.pdf")), "Ada and Bob");
        EXPECT_FALSE(fs::exists(drive.url("Form 3.pdf").path()));
        ASSERT_TRUE(alert());
        EXPECT_THAT(alert()->message(), HasSubstr("Form 2.pdf"));
        answer("OK");
        EXPECT_FALSE(alert()) << "it is said once";
        leave();
        fs::remove(drive.url("Form 2.pdf").path());
    }
}

TEST_F(PreviewEditingTest, ANoteThatWasBegunBeforeAnotherProgramSavedIsKept)
{
    show(formPdf());
    pages().userResized(224, 1);
    edit();
    press(EditTool::Note);
    pages().userTaps(pages().deck().toContent(0, {100, 150, 0, 0}).origin());
    ASSERT_TRUE(alert());
    drive.writeDocument("Form.pdf", testing_support::simplePdf({"theirs"}));
    preview->refreshCurrentPreviewItem();
    drive.dispatch->runUntilIdle();
    EXPECT_FALSE(preview->editor()) << "nothing was changed yet";
    writeNote("mine");
    answer("Done");
    ASSERT_TRUE(alert());
    EXPECT_THAT(alert()->message(), HasSubstr("Form 2.pdf"));
    const auto copy = services().pagedDocumentOpener().open(drive.url("Form 2.pdf").path());
    ASSERT_TRUE(copy);
    EXPECT_EQ((*copy)->marks(0).back().text, "mine");
}

TEST_F(PreviewEditingTest, ACopyHasANameThatIsNotTooLong)
{
    std::string stem;
    for (int i = 0; i < 125; ++i)
        stem += "é";
    show(formPdf(), (stem + ".pdf").c_str());
    edit();
    write("Ada");
    drive.writeDocument(stem + ".pdf", "theirs");
    leave();
    EXPECT_EQ(written(drive.url(stem.substr(0, 248) + " 2.pdf")), "Ada");
}

TEST_F(PreviewEditingTest, UndoOfARefusedEditTakesBackNoOther)
{
    show(formPdf());
    edit();
    const auto editing = preview->editor()->editing();
    const auto name = pages().fields().front();
    const auto ignore = [](const auto&) {};
    editing->apply(FieldTextEdit{0, name.id, "Ada"}, ignore);
    editing->apply(MarkRemoval{0, 99}, ignore);
    editing->undo(ignore);
    drive.dispatch->runUntilIdle();
    press(EditTool::Done);
    EXPECT_EQ(written(item), "Ada");
}

TEST_F(PreviewEditingTest, HidesWhatIsWrittenInASecretField)
{
    auto content = formPdf();
    content.replace(content.find("/Ff 4096"), 8, "/Ff 8192");
    show(content);
    edit();
    const auto isHidden = [&] { return preview->editor()->fieldBar()->textField()->inputTraits().isSecret; };
    press(EditTool::PreviousField);
    EXPECT_EQ(preview->editor()->fieldBar()->nameLabel()->text(), "remarks");
    EXPECT_TRUE(isHidden());
    press(EditTool::NextField);
    EXPECT_FALSE(isHidden());
}

TEST_F(PreviewEditingTest, AFailedSaveLosesNothing)
{
    fillIn("Ada");
    ::chmod(item.path().c_str(), 0444);
    leave();
    EXPECT_EQ(contentOf(item), formPdf());
    ASSERT_TRUE(alert()) << "over the screen that is shown by now";
    EXPECT_THAT(alert()->message(), HasSubstr("permission"));
    answer("Try Again");
    ASSERT_TRUE(alert());
    ::chmod(item.path().c_str(), 0644);
    answer("Try Again");
    EXPECT_FALSE(alert());
    EXPECT_EQ(written(item), "Ada");

    for (const char* choice : {"Keep a Copy", "Discard Changes"}) {
        fillIn("Bob");
        fs::remove(item.path());
        press(EditTool::Done);
        answer(choice);
        const bool isKept = fs::exists(item.path());
        EXPECT_EQ(isKept, std::string_view(choice) == "Keep a Copy");
        EXPECT_EQ(isKept ? written(item) : "Bob", "Bob");
        navigation->dismissViewController(false);
        leave();
    }
}

TEST_F(PreviewEditingTest, FollowsAMoveAndSavesWhereTheProgramIsLeftOrEnds)
{
    fillIn("Ada");
    const auto moved = drive.url("Moved.pdf");
    fs::rename(item.path(), moved.path());
    manager->presentedItemDidMoveToURL(moved);
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(written(moved), "Ada");
    EXPECT_FALSE(fs::exists(item.path()));

    fillIn("");
    for (const auto notice :
        {Notification::ApplicationDidLoseFocus, Notification::ApplicationWillResignActive}) {
        const auto text = "Ada" + std::to_string(static_cast<int>(notice));
        preview->editor()->fieldBar()->textField()->userEdited(text, {});
        drive.notifications->post(notice);
        drive.dispatch->runUntilIdle();
        EXPECT_EQ(written(item), text);
        EXPECT_TRUE(preview->editor());
    }
    preview->editor()->fieldBar()->textField()->userEdited("Bob", {});
    drive.notifications->post(Notification::ApplicationWillTerminate);
    EXPECT_EQ(written(item), "Bob") << "without any queue";
}

} // namespace
