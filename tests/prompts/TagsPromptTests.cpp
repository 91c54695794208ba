// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "prompts/TagEditing.h"
#include "prompts/TagsPrompt.h"

#include "items/DRItem.h"
#include "items/FileUtils.h"
#include "kit/controllers/AlertController.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/controllers/Window.h"
#include "kit/views/ListView.h"
#include "kit/views/TextField.h"
#include "tests/support/DriveFixture.h"

namespace tarrow {
namespace {

using namespace testing;
using Names = std::vector<std::string>;

Names namesOf(const TagChoices& choices)
{
    Names names;
    for (std::size_t index = 0; index < choices.count(); ++index)
        names.push_back(choices.name(index));
    return names;
}

TEST(TagChoices, KnownTagsComeFirstAndOnlyWhatWasSetIsChanged)
{
    TagChoices choices({"Red", "Blue", "Red"}, {{"Zoo", "Blue"}, {"Blue", "Attic"}});
    EXPECT_THAT(namesOf(choices), ElementsAre("Red", "Blue", "Attic", "Zoo"));
    EXPECT_TRUE(choices.isOn(1)) << "both items have it";
    EXPECT_FALSE(choices.isOn(3));
    EXPECT_EQ(choices.itemsWith(3), 1U);
    EXPECT_TRUE(choices.edit().isEmpty());

    choices.set(0, true);
    choices.set(3, true);
    choices.set(1, false);
    EXPECT_EQ(choices.edit(), (TagEdit{{"Red", "Zoo"}, {"Blue"}}));
    choices.set(0, false);
    choices.set(1, true);
    choices.set(3, false);
    EXPECT_EQ(choices.edit(), (TagEdit{{}, {"Zoo"}})) << "what is as it was is not changed";
}

TEST(TagChoices, TypedNamesAreFoundOrAdded)
{
    const struct {
        const char* typed;
        Names added, all;
    } rows[] = {
        {"red", {"Red"}, {"Red", "Blue"}},
        {" New ", {"New"}, {"Red", "Blue", "New"}},
        {"Blue, Green ,,red", {"Red", "Blue", "Green"}, {"Red", "Blue", "Green"}},
        {" , ", {}, {"Red", "Blue"}},
        {"Grün", {"Grün"}, {"Red", "Blue", "Grün"}},
    };
    for (const auto& row : rows) {
        TagChoices choices({"Red", "Blue"}, {{}});
        const auto last = choices.add(row.typed);
        EXPECT_EQ(choices.edit().added, row.added) << row.typed;
        EXPECT_EQ(namesOf(choices), row.all) << row.typed;
        EXPECT_EQ(last == choices.count(), row.added.empty()) << row.typed;
    }
}

class TagsPrompts : public testing::Test {
protected:
    TagsPrompts()
    {
        window->setRootViewController(screen);
        window->makeKeyAndVisible();
        prompt = TagsPrompt::present(
            screen, {{"Red", "Work"}, {"Red"}}, [this](const TagEdit& edit) { chosen.push_back(edit); });
        prompt->view();
    }
    void press(const kit::BarButtonItems& items) const
    {
        ASSERT_EQ(items.size(), 1U);
        EXPECT_TRUE(items.front()->press());
    }

    testing_support::DriveFixture drive;
    std::shared_ptr<kit::ViewController> screen = std::make_shared<kit::ViewController>();
    std::shared_ptr<kit::Window> window = std::make_shared<kit::Window>(platform::Rect{0, 0, 360, 640});
    std::vector<TagEdit> chosen;
    std::shared_ptr<TagsPrompt> prompt;
};

TEST_F(TagsPrompts, AnswersWhatWasCheckedAndTyped)
{
    auto& list = *prompt->listView();
    ASSERT_EQ(list.rowCount(), 2U);
    EXPECT_EQ(list.row(0).title, "Red");
    EXPECT_EQ(list.row(0).check, kit::CheckState::On);
    EXPECT_EQ(list.row(1).check, kit::CheckState::Off);
    EXPECT_EQ(list.row(1).detail, "1 of 2");
    EXPECT_EQ(list.row(1).tagDots.size(), 1U);
    list.activateRow(0);
    prompt->nameField()->userEdited("Later", {});
    EXPECT_FALSE(prompt->nameField()->userPressedReturn());
    EXPECT_EQ(prompt->nameField()->text(), "");
    ASSERT_EQ(list.rowCount(), 3U);
    EXPECT_EQ(list.row(2).check, kit::CheckState::On);
    EXPECT_EQ(list.row(0).check, kit::CheckState::Off) << "the others stay as they were set";
    prompt->nameField()->userEdited("Soon", {});
    press(prompt->navigationItem().rightItems());
    EXPECT_THAT(chosen, ElementsAre(TagEdit{{"Later", "Soon"}, {"Red"}}));
    EXPECT_FALSE(screen->presentedViewController());
}

TEST_F(TagsPrompts, CancellingOrChangingNothingAnswersNothing)
{
    prompt->listView()->activateRow(1);
    press(prompt->navigationItem().leftItems());
    EXPECT_FALSE(screen->presentedViewController());
    prompt = TagsPrompt::present(screen, {{"Red"}}, [this](const TagEdit& edit) { chosen.push_back(edit); });
    prompt->view();
    press(prompt->navigationItem().rightItems());
    EXPECT_THAT(chosen, IsEmpty());
}

class EditingTags : public testing::Test {
protected:
    EditingTags()
    {
        window->setRootViewController(screen);
        window->makeKeyAndVisible();
        here = drive.writeDocument("Here.txt");
        drive.mark(here, host::drive::itemMark::tags, "Red");
        host::drive::PromiseRecord record;
        record.tags = {"Red", "Work"};
        promised = drive.writePromise("Far.txt", record);
    }
    std::shared_ptr<TagsPrompt> begin()
    {
        TagEditing::begin({here, promised}, screen, history);
        drive.dispatch->runUntilIdle();
        const auto stack =
            std::dynamic_pointer_cast<kit::NavigationController>(screen->presentedViewController());
        const auto prompt =
            stack ? std::dynamic_pointer_cast<TagsPrompt>(stack->topViewController()) : nullptr;
        if (prompt)
            prompt->view();
        return prompt;
    }
    void done(TagsPrompt& prompt)
    {
        prompt.navigationItem().rightItems().front()->press();
        drive.dispatch->runUntilIdle();
    }
    static Names tags(const platform::Url& url) { return DRItem::initWithURL(url)->tags(); }

    testing_support::DriveFixture drive;
    Names offered; ///< what can be undone
    std::shared_ptr<UndoHistory> history = std::make_shared<UndoHistory>(UndoHistory::Handlers{
        .added = [this](auto, const UndoEntry& entry) { offered.push_back(entry.sentence); },
        .begun = [](const auto&) {},
        .ended = [](const auto&, const auto&) {},
    });
    std::shared_ptr<kit::ViewController> screen = std::make_shared<kit::ViewController>();
    std::shared_ptr<kit::Window> window = std::make_shared<kit::Window>(platform::Rect{0, 0, 360, 640});
    platform::Url here = drive.url(""), promised = drive.url("");
};

TEST_F(EditingTags, ChangesWhatIsHereAndWhatIsPromisedAndTakesItBack)
{
    const auto prompt = begin();
    ASSERT_TRUE(prompt);
    EXPECT_THAT(namesOf(prompt->choices()), ElementsAre("Red", "Work"));
    prompt->listView()->activateRow(0);
    prompt->nameField()->userEdited("New", {});
    done(*prompt);
    EXPECT_THAT(tags(here), ElementsAre("New"));
    EXPECT_THAT(tags(promised), ElementsAre("Work", "New"));
    EXPECT_THAT(offered, ElementsAre(".DICT.TAGS_CHANGED.2"));
    history->undoLatest();
    drive.dispatch->runUntilIdle();
    EXPECT_THAT(tags(here), ElementsAre("Red"));
    EXPECT_THAT(tags(promised), ElementsAre("Red", "Work"));
    EXPECT_FALSE(screen->presentedViewController());
}

TEST_F(EditingTags, TakenBackKeepsWhatWasChangedSince)
{
    const auto prompt = begin();
    ASSERT_TRUE(prompt);
    prompt->listView()->activateRow(0);
    prompt->nameField()->userEdited("New", {});
    done(*prompt);
    ASSERT_TRUE(FileUtils::changeTags(here, {"Later"}, {}));
    history->undoLatest();
    drive.dispatch->runUntilIdle();
    EXPECT_THAT(tags(here), ElementsAre("Later", "Red"));
    EXPECT_THAT(tags(promised), ElementsAre("Red", "Work"));
}

TEST_F(EditingTags, SaysWhatCouldNotBeChangedAndNothingAfterASignOut)
{
    auto prompt = begin();
    ASSERT_TRUE(prompt);
    std::filesystem::remove(here.path());
    prompt->nameField()->userEdited("New", {});
    done(*prompt);
    EXPECT_THAT(tags(promised), ElementsAre("Red", "Work", "New"));
    EXPECT_THAT(offered, ElementsAre(".DICT.TAGS_CHANGED.1"));
    EXPECT_TRUE(std::dynamic_pointer_cast<kit::AlertController>(screen->presentedViewController()));
    screen->dismissViewController(false);

    prompt = begin();
    ASSERT_TRUE(prompt);
    drive.signOut();
    prompt->nameField()->userEdited("Other", {});
    done(*prompt);
    EXPECT_THAT(tags(promised), ElementsAre("Red", "Work", "New"));
    EXPECT_EQ(offered.size(), 1U);
}

} // namespace
} // namespace tarrow
