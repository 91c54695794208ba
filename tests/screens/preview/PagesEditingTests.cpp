// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/PagedDocumentEditing.h"
#include "tests/screens/support/ScreensFixture.h"
#include "tests/support/FormPdf.h"
#include "tests/support/SimplePdf.h"

using namespace platform;
using namespace testing;
using namespace testing_support;

namespace {

using Kind = PageMark::Kind;

/// The fields of the form by their indexes.
enum Place : std::size_t { Name, Agree, Town, First, Second };

class PagesEditing : public ScreensFixture {
protected:
    static std::shared_ptr<PagedDocumentEditing> edit(const std::string& pdf)
    {
        const auto opened =
            services().pagedDocumentOpener().openForEditing(std::make_shared<const std::string>(pdf));
        return opened ? *opened.value : nullptr;
    }
    std::uint32_t field(Place place) const { return editing->fields(0)[place].id; }
    static std::vector<std::string> marks(const PagedDocumentEditing& document, std::size_t page = 0)
    {
        std::vector<std::string> texts;
        for (const auto& mark : document.pages()->marks(page))
            texts.push_back(mark.text);
        return texts;
    }
    static bool isRefused(const std::optional<Error>& error)
    {
        return error && error->domain() == errorDomain::pages
            && error->code() == static_cast<int>(PagesErrorCode::Refused);
    }
    static constexpr Rect line{30, 244, 100, 20};

    std::shared_ptr<PagedDocumentEditing> editing = edit(formPdf());
};

TEST_F(PagesEditing, FillsInAFormThatOthersCanReadAfterwards)
{
    ASSERT_EQ(editing->fields(0).size(), 5U) << "neither the one that is fixed nor the one that is hidden";
    const auto name = editing->fields(0)[Name];
    EXPECT_EQ(name.name, "Your name");
    EXPECT_EQ(name.place, (Rect{20, 30, 160, 20}));
    EXPECT_THAT(editing->fields(0)[Town].options, ElementsAre("Rome", "Oslo", "Bern"));
    ASSERT_EQ(editing->fields(1).size(), 1U);
    EXPECT_TRUE(editing->fields(1)[0].isMultiline);
    EXPECT_EQ(editing->fields(1)[0].page, 1U);

    EXPECT_FALSE(editing->apply(FieldTextEdit{0, field(Name), "Zoë Žižka علي"}));
    EXPECT_FALSE(editing->apply(FieldStateEdit{0, field(Agree), true}));
    EXPECT_FALSE(editing->apply(FieldChoiceEdit{0, field(Town), {2}}));
    EXPECT_FALSE(editing->apply(FieldStateEdit{0, field(Second), true}));
    EXPECT_TRUE(isRefused(editing->apply(FieldTextEdit{0, field(Agree), "yes"})));
    EXPECT_TRUE(isRefused(editing->apply(FieldChoiceEdit{0, field(Town), {3}})));
    EXPECT_TRUE(isRefused(editing->apply(FieldChoiceEdit{0, field(Town), {0, 1}})));
    EXPECT_TRUE(isRefused(editing->apply(FieldStateEdit{1, field(Agree), false})));

    const auto written = editing->written();
    ASSERT_TRUE(written);
    EXPECT_TRUE(written->starts_with(formPdf())) << "what was there before stays as it was";
    const auto read = edit(*written)->fields(0);
    EXPECT_EQ(read[Name].text, "Zoë Žižka علي");
    EXPECT_TRUE(read[Agree].isOn);
    EXPECT_THAT(read[Town].chosen, ElementsAre(2U));
    EXPECT_FALSE(read[First].isOn);
    EXPECT_TRUE(read[Second].isOn);
}

TEST_F(PagesEditing, TakesBackEveryEditInItsTurn)
{
    EXPECT_FALSE(editing->undo());
    EXPECT_FALSE(editing->apply(FieldTextEdit{0, field(Name), "Ada"}));
    EXPECT_FALSE(editing->apply(NewMarkEdit{1, Kind::Note, {{10, 10, 20, 20}}, "first"}));
    EXPECT_FALSE(editing->apply(NewMarkEdit{1, Kind::Note, {{40, 10, 20, 20}}, "second"}));
    const auto first = editing->pages()->marks(1)[0].id, second = editing->pages()->marks(1)[1].id;
    EXPECT_FALSE(editing->apply(MarkRemoval{1, first}));
    EXPECT_FALSE(editing->apply(MarkTextEdit{1, second, "changed"}));
    EXPECT_TRUE(isRefused(editing->apply(MarkTextEdit{1, first, "gone"})));
    EXPECT_THAT(marks(*editing, 1), ElementsAre("changed"));
    EXPECT_THAT(marks(*edit(*editing->written().value), 1), ElementsAre("changed"));

    const auto shown = editing->pages();
    EXPECT_EQ(editing->undo(), 1U);
    EXPECT_THAT(marks(*editing, 1), ElementsAre("second"));
    EXPECT_EQ(editing->undo(), 1U);
    EXPECT_THAT(marks(*editing, 1), ElementsAre("first", "second"));
    EXPECT_EQ(editing->pages()->marks(1)[1].id, second);
    editing->undo();
    editing->undo();
    EXPECT_THAT(marks(*editing, 1), IsEmpty());
    EXPECT_EQ(editing->undo(), 0U);
    EXPECT_EQ(editing->fields(0)[Name].text, "");
    EXPECT_EQ(editing->editCount(), 0U);
    EXPECT_EQ(editing->pages(), shown);
}

TEST_F(PagesEditing, MarksTextsAndKeepsWhatOthersWrote)
{
    EXPECT_THAT(marks(*editing), ElementsAre("Seen by Ada"));
    EXPECT_FALSE(editing->apply(NewMarkEdit{0, Kind::Highlight, {line}, {}}));
    EXPECT_FALSE(editing->apply(NewMarkEdit{0, Kind::Underline, {line, {30, 270, 50, 20}}, {}}));
    EXPECT_TRUE(isRefused(editing->apply(NewMarkEdit{0, Kind::Highlight, {}, {}})));
    // The mark lies on the selected text.
    const auto drawn = editing->pages()->renderPage(0, 1, {0, 0, 200, 300});
    const auto pixel = [&](int x, int y) {
        return drawn->pixels()[static_cast<std::size_t>(y * 200 + x)] & 0xFFFFFFU;
    };
    EXPECT_LT(pixel(125, 247) & 0xFFU, 0x80U) << "yellow";
    EXPECT_EQ(pixel(125, 235), 0xFFFFFFU);
    const auto read = edit(*editing->written().value)->pages()->marks(0);
    ASSERT_EQ(read.size(), 3U);
    EXPECT_EQ(read[0].text, "Seen by Ada");
    EXPECT_EQ(read[1].kind, Kind::Highlight);
    EXPECT_NEAR(read[1].place.midY(), line.midY(), 1);
    EXPECT_EQ(read[2].kind, Kind::Underline);
}

TEST_F(PagesEditing, RefusesWhatCannotBeChangedSafely)
{
    const auto codeOf = [](const std::string& pdf) {
        const auto opened =
            services().pagedDocumentOpener().openForEditing(std::make_shared<const std::string>(pdf));
        return opened.error ? opened.error->code() : 0;
    };
    EXPECT_EQ(codeOf("no document"), static_cast<int>(PagesErrorCode::Damaged));
    EXPECT_EQ(codeOf(simplePdf({"no index"})), static_cast<int>(PagesErrorCode::Damaged));
    auto moved = formPdf();
    moved.replace(moved.rfind("startxref\n") + 10, 1, "9");
    EXPECT_EQ(codeOf(moved), static_cast<int>(PagesErrorCode::Damaged));
    EXPECT_EQ(codeOf(testing_support::passwordPdf()), static_cast<int>(PagesErrorCode::PasswordRequired));
    EXPECT_EQ(codeOf("some junk before it\n" + formPdf()), 0);
}

} // namespace
