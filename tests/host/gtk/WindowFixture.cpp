// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "WindowFixture.h"

#include "GtkEnvironment.h"
#include "host/previews/MakePreviewLibraries.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/controllers/ViewController.h"
#include "platform/NotificationCenter.h"
#include "tests/support/PlainTexts.h"

namespace testing_support {

namespace {

GtkWidget* find(GtkWidget* widget, const std::function<bool(GtkWidget*)>& matches)
{
    if (!gtk_widget_get_visible(widget))
        return nullptr;
    if (matches(widget))
        return widget;
    for (auto* child = gtk_widget_get_first_child(widget); child;
         child = gtk_widget_get_next_sibling(child)) {
        if (auto* found = find(child, matches))
            return found;
    }
    return nullptr;
}

} // namespace

std::shared_ptr<host::gtk::PreviewModule> linkedPreviews()
{
    return std::make_shared<host::gtk::PreviewModule>([] {
        std::shared_ptr<host::gtk::PreviewLibraries> made;
        trwMakePreviewLibraries(made);
        return made;
    });
}

WindowFixture::WindowFixture()
    : host(std::make_shared<host::gtk::GtkWindowHost>(
        nullptr, host::gtk::WindowSize{400, 700, false}, linkedPreviews()))
    , window(std::make_shared<kit::Window>())
{
    installed.localization = std::make_shared<PlainTexts>();
    installed.notificationCenter = std::make_shared<platform::NotificationCenter>();
    platform::installServices(installed);
    kit::WindowHost::install(host);
    g_object_set(gtk_settings_get_default(), "gtk-enable-animations", FALSE, nullptr);
}

WindowFixture::~WindowFixture()
{
    closeWindow();
    kit::WindowHost::install(nullptr);
    platform::installServices({});
}

void WindowFixture::TearDown()
{
    closeWindow();
    EXPECT_EQ(takeToolkitWarnings(), std::vector<std::string>());
}

void WindowFixture::closeWindow()
{
    if (!host->windowPeer())
        return;
    settle();
    host->close();
    while (g_main_context_iteration(nullptr, FALSE)) { }
}

void WindowFixture::show(const std::shared_ptr<kit::ViewController>& root)
{
    window->setRootViewController(root);
    window->makeKeyAndVisible();
    waitFor(
        [this] { return window->bounds().width > 0 && gtk_widget_get_mapped(windowWidget()); }, "a window");
    settle();
}

std::shared_ptr<kit::NavigationController> WindowFixture::showStack(
    std::vector<std::shared_ptr<kit::ViewController>> screens)
{
    auto stack = std::make_shared<kit::NavigationController>();
    stack->setViewControllers(std::move(screens), false);
    show(stack);
    return stack;
}

void WindowFixture::waitFor(const std::function<bool()>& condition, const char* what)
{
    constexpr guint patience = 5000; // milliseconds
    bool isLate = false;
    const guint alarm = g_timeout_add_once(
        patience, [](gpointer late) { *static_cast<bool*>(late) = true; }, &isLate);
    while (!condition() && !isLate)
        g_main_context_iteration(nullptr, TRUE);
    if (!isLate)
        g_source_remove(alarm);
    ASSERT_TRUE(condition()) << "waited in vain for " << what;
}

void WindowFixture::settle()
{
    auto* clock = gtk_widget_get_frame_clock(windowWidget());
    if (!clock)
        return;
    // A frame may schedule work for the next one; after three frames everything is shown.
    for (int frame = 0; frame < 3; ++frame) {
        bool painted = false;
        const gulong handler = g_signal_connect_swapped(
            clock, "after-paint", G_CALLBACK(+[](bool* flag) { *flag = true; }), &painted);
        gdk_frame_clock_request_phase(clock, GDK_FRAME_CLOCK_PHASE_PAINT);
        waitFor([&] { return painted; }, "a frame");
        g_signal_handler_disconnect(clock, handler);
    }
}

host::gtk::ViewPeer* WindowFixture::peerOf(const kit::View& view) const
{
    return peer().context()->peerOf(view);
}

platform::Rect WindowFixture::boundsIn(const kit::View& view, const kit::View& ancestor) const
{
    graphene_rect_t bounds;
    if (!gtk_widget_compute_bounds(peerOf(view)->widget(), peerOf(ancestor)->widget(), &bounds))
        return {};
    return {bounds.origin.x, bounds.origin.y, bounds.size.width, bounds.size.height};
}

GtkWidget* WindowFixture::findButton(const std::string& text) const
{
    return find(windowWidget(), [&](GtkWidget* widget) {
        if (!GTK_IS_BUTTON(widget))
            return false;
        const char* label = gtk_button_get_label(GTK_BUTTON(widget));
        return label && text == label;
    });
}

std::shared_ptr<kit::ViewController> makeScreen(const std::string& title)
{
    auto screen = std::make_shared<kit::ViewController>();
    screen->setTitle(title);
    return screen;
}

} // namespace testing_support
