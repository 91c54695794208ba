// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/texts/UnicodeCharacterData.h"
#include "kit/controllers/AlertController.h"
#include "kit/controllers/Window.h"
#include "kit/views/Label.h"
#include "kit/views/TextField.h"
#include "platform/Services.h"
#include "prompts/NewFolderPrompt.h"
#include "prompts/RenamePrompt.h"
#include "prompts/SimpleTextViewController.h"
#include "tests/support/PlainTexts.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace tarrow {
namespace {

using namespace kit;
using namespace testing;

class FilenamePromptTest : public testing::Test {
protected:
    FilenamePromptTest()
    {
        platform::ServiceSet set;
        set.localization = std::make_shared<testing_support::PlainTexts>();
        set.characterData = std::make_shared<host::system::UnicodeCharacterData>();
        platform::installServices(std::move(set));
        window->setRootViewController(root);
        window->makeKeyAndVisible();
    }
    ~FilenamePromptTest() override { platform::installServices({}); }

    /// The caller's callback records a name and answers as the test wants.
    FilenamePrompt::ValidateNewFilenameCallback callback()
    {
        return [this](const std::string& name, bool& accepted) {
            EXPECT_FALSE(accepted);
            confirmed.push_back(name);
            accepted = accepts;
            return refusal;
        };
    }
    void rename(const std::string& name) { show(RenamePrompt::newWithFilenameCompletion(name, callback())); }
    void show(std::shared_ptr<FilenamePrompt> made)
    {
        prompt = std::move(made);
        alert = prompt->alert();
        root->presentViewController(alert, true);
    }
    TextField& field() const { return *alert->textFields().front(); }
    void type(const std::string& text) const { field().userEdited(text, {text.size(), 0}); }
    bool pressDone() const { return alert->press(1); }
    bool isOpen() const { return root->presentedViewController() == alert; }
    /// Answers the red message, or nothing while its area is hidden.
    std::optional<std::string> message() const
    {
        const auto area = std::static_pointer_cast<SimpleTextViewController>(alert->contentViewController());
        if (area->view()->isHidden())
            return std::nullopt;
        return area->messageLabel()->text();
    }

    std::shared_ptr<ViewController> root = std::make_shared<ViewController>();
    std::shared_ptr<kit::Window> window = std::make_shared<kit::Window>(platform::Rect{0, 0, 400, 800});
    std::shared_ptr<FilenamePrompt> prompt;
    std::shared_ptr<kit::AlertController> alert;
    std::vector<std::string> confirmed;
    bool accepts = false;
    std::string refusal = "Name is already taken";
};

TEST_F(FilenamePromptTest, ARenameBeginsBeforeTheExtension)
{
    struct Row {
        const char* name;
        std::size_t caret;
    };
    for (const Row row : {Row{"Notes.txt", 5}, {"Archive.tar.gz", 11}, {"README", 6}, {"\u65e5\u672c.md", 2},
             {"\U0001f600 e\u0301.txt", 4}, {"\u0645\u0644\u0641.pdf", 3}, {"Notes.", 5}}) {
        SCOPED_TRACE(row.name);
        rename(row.name);
        EXPECT_EQ(prompt->origFilename(), row.name);
        EXPECT_TRUE(field().isEditing());
        EXPECT_EQ(field().selectedRange(), (TextRange{row.caret, 0}));
        EXPECT_TRUE(prompt->defaultAction()->isEnabled());
        EXPECT_EQ(prompt->defaultAction()->title(), "Done");
        EXPECT_TRUE(alert->press(0));
    }
    EXPECT_THAT(confirmed, IsEmpty()) << "Cancel asks nobody";
}

TEST_F(FilenamePromptTest, NamesAreJudgedWhileTheyAreTyped)
{
    const std::string different = "Choose a different name.", character = "Character not allowed in filename";
    const std::optional<std::string> silent;
    struct Row {
        std::string text;
        std::optional<std::string> message;
        bool usable;
    };
    const std::vector<Row> rows{{"Notes", silent, true}, {"", silent, false}, {" \t\u00a0", silent, false},
        {".Notes", different, false}, {"  .", different, false}, {"a/b", character, false},
        {"a:b", character, false}, {"a\u0007b", character, false}, {"a\u0378", character, false},
        {"a\ufdd0", character, false}, {"\u202etxt.exe", character, false}, {"a\u2028b", character, false},
        {" Notes.txt \n", silent, true}, {"\u0645\u0644\u0641", silent, true}, {"\U0001f600", silent, true},
        {std::string(300, 'x'), silent, true}};
    show(NewFolderPrompt::newWithTitleDoneButtonTextCompletion("New Folder", "Create", callback()));
    EXPECT_FALSE(prompt->defaultAction()->isEnabled());
    EXPECT_FALSE(field().userPressedReturn()) << "the return key needs a text";
    for (const auto& row : rows) {
        SCOPED_TRACE(row.text);
        type(row.text);
        EXPECT_EQ(message(), row.message);
        EXPECT_EQ(prompt->defaultAction()->isEnabled(), row.usable);
        EXPECT_EQ(pressDone(), false);
        EXPECT_FALSE(!row.usable && field().userPressedReturn());
        EXPECT_EQ(field().text(), row.text) << "the field keeps what was typed";
    }
    EXPECT_THAT(confirmed,
        ElementsAre("Notes", "Notes.txt", "\u0645\u0644\u0641", "\U0001f600", std::string(300, 'x')));
}

TEST_F(FilenamePromptTest, StaysOpenUntilANameIsAccepted)
{
    for (const bool byReturn : {false, true}) {
        SCOPED_TRACE(byReturn);
        const auto confirm = [&] { return byReturn ? field().userPressedReturn() : pressDone(); };
        accepts = false;
        confirmed.clear();
        rename("Notes.txt");
        EXPECT_FALSE(confirm());
        EXPECT_TRUE(isOpen());
        EXPECT_TRUE(field().isEditing()) << "the keyboard stays";
        EXPECT_EQ(message(), "Name is already taken");
        type("\u3000Plans ");
        EXPECT_EQ(message(), std::nullopt) << "an edit is judged anew";
        accepts = true;
        EXPECT_TRUE(confirm());
        EXPECT_FALSE(isOpen());
        confirm();
        EXPECT_THAT(confirmed, ElementsAre("Notes.txt", "Plans"))
            << "an accepted name is not asked for again";
    }
    accepts = false;
    refusal.clear();
    rename("Notes.txt");
    EXPECT_FALSE(pressDone());
    EXPECT_EQ(message(), std::nullopt) << "a refusal without words shows nothing";
    EXPECT_TRUE(isOpen());
}

TEST_F(FilenamePromptTest, AnAlertOutlivesItsPrompt)
{
    rename("Notes.txt");
    accepts = true;
    const std::weak_ptr<FilenamePrompt> weak = prompt;
    prompt = nullptr;
    EXPECT_TRUE(weak.expired());
    EXPECT_FALSE(pressDone());
    type("a/b");
    EXPECT_EQ(message(), std::nullopt) << "nobody judges it any more";
    field().userPressedReturn();
    EXPECT_TRUE(isOpen());
    EXPECT_THAT(confirmed, IsEmpty());
    alert->userCancelled();
    EXPECT_FALSE(isOpen()) << "but there is a way out";
}

TEST_F(FilenamePromptTest, ThePromptMayBeDroppedWhileItAsks)
{
    for (const bool byReturn : {false, true}) {
        show(RenamePrompt::newWithFilenameCompletion("Notes", [this](const std::string&, bool& accepted) {
            prompt = nullptr;
            accepted = true;
            return std::string();
        }));
        EXPECT_TRUE(byReturn ? field().userPressedReturn() : pressDone());
        EXPECT_FALSE(isOpen());
    }
}

TEST_F(FilenamePromptTest, AnAnswerMayComeLater)
{
    int withdrawn = 0;
    const auto begin = [&](const std::string& name) {
        show(RenamePrompt::newWithFilenameCompletion(name, [&](const std::string& typed, bool&) {
            confirmed.push_back(typed);
            prompt->waitForAnswer([&] { ++withdrawn; });
            return std::string("it does not count");
        }));
        field().userLeft(); // for the button, which is disabled then
        EXPECT_FALSE(pressDone());
        EXPECT_TRUE(field().isEditing());
    };
    for (const bool accepted : {true, false}) {
        begin("Notes.txt");
        EXPECT_TRUE(isOpen());
        EXPECT_EQ(message(), std::nullopt);
        EXPECT_FALSE(prompt->defaultAction()->isEnabled());
        EXPECT_FALSE(pressDone());
        EXPECT_FALSE(field().userPressedReturn());
        prompt->answer(accepted, "Name is already taken");
        EXPECT_EQ(isOpen(), !accepted);
        prompt->answer(true, {});
        EXPECT_EQ(isOpen(), !accepted) << "there is one answer";
    }
    EXPECT_EQ(message(), "Name is already taken");
    EXPECT_TRUE(field().isEditing());
    EXPECT_FALSE(pressDone()) << "it asks again";
    type("Plans.txt");
    EXPECT_FALSE(prompt->defaultAction()->isEnabled()) << "the first name is not decided yet";
    prompt->answer(false, "Name is already taken");
    EXPECT_EQ(message(), std::nullopt) << "another name stands there now";
    EXPECT_TRUE(prompt->defaultAction()->isEnabled());
    EXPECT_THAT(confirmed, ElementsAre("Notes.txt", "Notes.txt", "Notes.txt"));
    EXPECT_TRUE(alert->press(0));
    EXPECT_EQ(withdrawn, 0) << "nothing was waited for";

    begin("Notes.txt");
    EXPECT_TRUE(alert->press(0));
    EXPECT_FALSE(isOpen());
    EXPECT_EQ(withdrawn, 1);
    prompt->answer(false, "Name is already taken");
    EXPECT_EQ(withdrawn, 1);
    EXPECT_FALSE(prompt->isWaiting());
}

TEST_F(FilenamePromptTest, TheMessageIsAsTallAsItsText)
{
    const auto area = std::make_shared<SimpleTextViewController>();
    const auto heightOf = [&](const std::string& text) {
        area->view();
        area->messageLabel()->setText(text);
        return area->view()->systemLayoutSizeFitting({300, 0}).height;
    };
    const double line = area->messageLabelFont().lineHeight();
    EXPECT_NEAR(heightOf("Short"), line, 1);
    std::string words;
    for (int i = 0; i < 200; ++i)
        words += "word ";
    EXPECT_NEAR(heightOf(words), 5 * line, 1) << "five lines at most";
}

} // namespace
} // namespace tarrow
