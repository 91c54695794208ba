// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "WindowFixture.h"
#include "host/gtk/screens/KeyboardWatch.h"
#include "kit/controllers/AlertController.h"
#include "kit/controllers/ViewController.h"
#include "kit/views/Button.h"
#include "kit/views/Label.h"
#include "kit/views/StackView.h"
#include "kit/views/TextField.h"
#include "platform/Color.h"

#include <gmock/gmock.h>

namespace {
using platform::Rect;
using testing_support::makeScreen;

class PeerTests : public testing_support::WindowFixture {
protected:
    /// Shows a screen that contains this view at a frame.
    std::shared_ptr<kit::View> showOne(const std::shared_ptr<kit::View>& view, const Rect& frame)
    {
        const auto screen = makeScreen("");
        view->setFrame(frame);
        screen->view()->addSubview(view);
        show(screen);
        return screen->view();
    }
};

TEST_F(PeerTests, WidgetsStandWhereTheModelPutsThem)
{
    const auto label = std::make_shared<kit::Label>("Some words"),
               second = std::make_shared<kit::Label>("More");
    const auto button = std::make_shared<kit::Button>("Press");
    const auto stack = std::make_shared<kit::StackView>(kit::Axis::Vertical);
    for (const auto& view : std::vector<std::shared_ptr<kit::View>>{label, second, button})
        stack->addArrangedSubview(view);
    stack->setSpacing(8);
    const auto root = showOne(stack, {20, 30, 300, 200});
    EXPECT_EQ(root->frame().size(), window->bounds().size());

    for (const auto& view : std::vector<std::shared_ptr<kit::View>>{label, second, button}) {
        const auto shown = boundsIn(*view, *stack);
        EXPECT_NEAR(shown.x, view->frame().x, 1);
        EXPECT_NEAR(shown.y, view->frame().y, 1);
        EXPECT_NEAR(shown.width, view->frame().width, 1);
    }
    EXPECT_EQ(boundsIn(*stack, *root).origin(), (platform::Point{20, 30}));

    stack->setFrame({40, 50, 300, 200});
    second->setHidden(true);
    settle();
    EXPECT_EQ(boundsIn(*stack, *root).origin(), (platform::Point{40, 50}));
    EXPECT_FALSE(gtk_widget_get_visible(peerOf(*second)->widget()));
    EXPECT_NEAR(boundsIn(*button, *stack).y, button->frame().y, 1);
}

TEST_F(PeerTests, ATextThatFitsItsMeasureIsNotCut)
{
    for (const char* text : {"iiiiiiii", "Wide Words", "مرحبا", "naïve – ☂"}) {
        const auto label = std::make_shared<kit::Label>(text);
        label->sizeToFit();
        const auto screen = makeScreen("");
        screen->view()->addSubview(label);
        show(screen);
        label->sizeToFit(); // with the window's own measurer
        settle();
        EXPECT_FALSE(pango_layout_is_ellipsized(gtk_label_get_layout(GTK_LABEL(nativeOf(*label))))) << text;
    }
}

TEST_F(PeerTests, ChangesOfOneFrameAreShownTogether)
{
    const auto label = std::make_shared<kit::Label>("one");
    showOne(label, {0, 0, 100, 30});
    int notices = 0;
    g_signal_connect_swapped(
        nativeOf(*label), "notify::label", G_CALLBACK(+[](int* count) { ++*count; }), &notices);
    for (const char* text : {"two", "three", "four"})
        label->setText(text);
    settle();
    EXPECT_STREQ(gtk_label_get_label(GTK_LABEL(nativeOf(*label))), "four");
    EXPECT_EQ(notices, 1);
}

TEST_F(PeerTests, APressReachesTheActionOnlyWhileTheButtonIsEnabled)
{
    int presses = 0;
    const auto button = std::make_shared<kit::Button>("Press", [&] { ++presses; });
    showOne(button, {10, 10, 80, 20});
    g_signal_emit_by_name(nativeOf(*button), "clicked");
    EXPECT_EQ(presses, 1);
    button->setEnabled(false);
    settle();
    EXPECT_FALSE(gtk_widget_is_sensitive(nativeOf(*button)));
    // A touch above the small button still belongs to it, because a finger is larger.
    EXPECT_TRUE(gtk_widget_contains(nativeOf(*button), 40, -10));
    EXPECT_FALSE(gtk_widget_contains(nativeOf(*button), 40, -13));
}

/// Refuses edits with digits.
class NoDigits : public kit::TextFieldDelegate {
public:
    bool textFieldShouldChangeCharactersInRangeReplacementString(
        kit::TextField&, const kit::TextRange&, const std::string& replacement) override
    {
        return replacement.find_first_of("0123456789") == std::string::npos;
    }
};

TEST_F(PeerTests, AFieldFollowsTheEditsThatItsDelegateAllows)
{
    const auto field = std::make_shared<kit::TextField>("Report.pdf");
    const auto delegate = std::make_shared<NoDigits>();
    field->setDelegate(delegate);
    showOne(field, {10, 10, 300, 40});
    auto* editable = GTK_EDITABLE(nativeOf(*field));

    field->setSelectedRange({6, 0});
    settle();
    EXPECT_EQ(gtk_editable_get_position(editable), 6);
    int position = 6;
    gtk_editable_insert_text(editable, "s", -1, &position);
    EXPECT_EQ(field->text(), "Reports.pdf");
    gtk_editable_insert_text(editable, "7", -1, &position);
    settle();
    EXPECT_EQ(field->text(), "Reports.pdf");
    EXPECT_STREQ(gtk_editable_get_text(editable), "Reports.pdf");
}

TEST_F(PeerTests, AFieldHidesASecretAndShowsTheNextText)
{
    const auto field = std::make_shared<kit::TextField>("open sesame");
    showOne(field, {10, 10, 300, 40});
    for (const bool isSecret : {true, false}) {
        field->setInputTraits({.isSecret = isSecret});
        settle();
        EXPECT_EQ(gtk_entry_get_visibility(GTK_ENTRY(nativeOf(*field))) != FALSE, !isSecret);
    }
}

TEST_F(PeerTests, AFieldThatIsTooLowForItsTextStandsOutOnBothSides)
{
    const auto field = std::make_shared<kit::TextField>("Report.pdf");
    field->setFieldStyle(kit::FieldStyle::Plain);
    field->setFont(kit::Font::preferred(kit::TextStyle::Title2, 40));
    showOne(field, {10, 100, 300, 20});
    graphene_rect_t place;
    ASSERT_TRUE(gtk_widget_compute_bounds(nativeOf(*field), peerOf(*field)->widget(), &place));
    EXPECT_GT(place.size.height, 30);
    EXPECT_NEAR(place.origin.y + place.size.height / 2, 10, 1);
}

TEST_F(PeerTests, TheEditingOutlivesAnAlertOverTheField)
{
    const auto field = std::make_shared<kit::TextField>("Report.pdf");
    const auto screen = makeScreen("");
    field->setFrame({10, 10, 300, 40});
    screen->view()->addSubview(field);
    show(screen);
    ASSERT_TRUE(field->becomeFirstResponder());
    settle();
    const auto alert =
        std::make_shared<kit::AlertController>("No", "This name is taken", kit::AlertStyle::Alert);
    alert->addAction(std::make_shared<kit::AlertAction>("OK", kit::AlertActionStyle::Default));
    screen->presentViewController(alert, false);
    settle();
    EXPECT_TRUE(field->isEditing());
    screen->dismissViewController(false);
    settle();
    EXPECT_TRUE(field->isEditing());
    auto* focused = gtk_window_get_focus(peer().window());
    EXPECT_TRUE(focused && gtk_widget_is_ancestor(focused, nativeOf(*field))) << "the focus is back";
    gtk_window_set_focus(peer().window(), nullptr);
    settle();
    EXPECT_FALSE(field->isEditing());
}

TEST_F(PeerTests, AViewIsPaintedInItsOwnSizeAndNotInWholePoints)
{
    const auto line = std::make_shared<kit::View>();
    line->setBackground(platform::Color{1, 0, 0, 1});
    showOne(line, {10, 10, 100, 0.5});
    auto* snapshot = gtk_snapshot_new();
    peerOf(*line)->canvasSnapshot(snapshot);
    auto* node = gtk_snapshot_free_to_node(snapshot);
    ASSERT_TRUE(node);
    graphene_rect_t painted;
    gsk_render_node_get_bounds(node, &painted);
    EXPECT_EQ(painted.size.width, 100);
    EXPECT_EQ(painted.size.height, 0.5F);
    gsk_render_node_unref(node);
}

TEST_F(PeerTests, AssistiveTechnologyHearsNoPlaceholdersForImages)
{
    const auto label = std::make_shared<kit::Label>();
    kit::AttributedText text;
    text.append(platform::Image::fromPixels(4, 4, 1, {}));
    text.append("Red ");
    text.append(platform::Image::fromPixels(4, 4, 1, {}));
    text.append("Work");
    label->setAttributedText(text);
    showOne(label, {10, 10, 200, 20});
    EXPECT_STREQ(gtk_label_get_label(GTK_LABEL(nativeOf(*label))), "Red Work");
}

TEST(KeyboardWatch, ATallStepWhileATextHasTheFocusIsAKeyboard)
{
    using Event = host::gtk::KeyboardWatch::Event;
    const struct {
        platform::Size size;
        bool textHasFocus;
        Event event;
        double height;
    } steps[] = {
        {{360, 640}, true, Event::None, 0},
        {{360, 400}, false, Event::None, 0},
        {{360, 640}, true, Event::None, 0},
        {{360, 600}, true, Event::None, 0}, // somebody drags the window's edge
        {{360, 340}, true, Event::Appears, 260},
        {{360, 300}, true, Event::None, 260}, // the keyboard shows a row more
        {{360, 600}, true, Event::Disappears, 0},
        {{360, 340}, true, Event::Appears, 260},
        {{640, 300}, true, Event::Disappears, 0}, // the device was turned
        {{300, 100}, true, Event::None, 0},
    };
    host::gtk::KeyboardWatch watch;
    for (const auto& step : steps) {
        EXPECT_EQ(watch.resized(step.size, step.textHasFocus), step.event) << &step - steps;
        EXPECT_EQ(watch.height(), step.height) << &step - steps;
    }
}

TEST_F(PeerTests, StandardColoursFollowTheTheme)
{
    showOne(std::make_shared<kit::View>(), {});
    auto& theme = peer().context()->theme();
    auto* style = adw_style_manager_get_default();
    const auto brightness = [&](host::gtk::ColorUse use, const platform::Color& color) {
        const auto shown = theme.resolve(color, use);
        return (shown.red + shown.green + shown.blue) / 3;
    };
    using host::gtk::ColorUse;
    EXPECT_GT(brightness(ColorUse::Background, platform::Color::white()), 0.9F);
    adw_style_manager_set_color_scheme(style, ADW_COLOR_SCHEME_FORCE_DARK);
    settle();
    EXPECT_LT(brightness(ColorUse::Background, platform::Color::white()), 0.3F);
    EXPECT_GT(brightness(ColorUse::Content, platform::Color::black()), 0.7F);
    EXPECT_GT(brightness(ColorUse::Content, platform::Color::white()), 0.9F);
    EXPECT_EQ(window->traits().colorScheme, kit::ColorScheme::Dark);
    adw_style_manager_set_color_scheme(style, ADW_COLOR_SCHEME_FORCE_LIGHT);
}

TEST_F(PeerTests, NothingThatHasEndedIsCalled)
{
    const auto screen = makeScreen("");
    auto button = std::make_shared<kit::Button>("Gone");
    auto label = std::make_shared<kit::Label>("Stays");
    screen->view()->addSubview(button);
    screen->view()->addSubview(label);
    show(screen);
    auto* native = GTK_WIDGET(g_object_ref(nativeOf(*button)));

    // The view is destroyed, and its widget is pressed before the next frame.
    button->setTitle("Changed");
    button->removeFromSuperview();
    button.reset();
    g_signal_emit_by_name(native, "clicked");
    settle();
    g_signal_emit_by_name(native, "clicked");
    g_object_unref(native);

    // The window closes with a change still pending, and the view lives on.
    label->setText("Changed");
    host->close();
    label->setText("Again");
    label->setFrame({1, 2, 3, 4});
    while (g_main_context_iteration(nullptr, FALSE)) { }
    EXPECT_EQ(label->text(), "Again");
}

} // namespace
