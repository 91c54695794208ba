// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/screens/ScreenPage.h"

#include "host/gtk/base/ViewPeer.h"
#include "kit/controllers/NavigationController.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/values/TraitCollection.h"
#include "platform/Weakly.h"

namespace host::gtk {

std::shared_ptr<ScreenPage> ScreenPage::make(const std::shared_ptr<PeerContext>& context,
    const std::shared_ptr<kit::NavigationController>& navigation,
    const std::shared_ptr<kit::ViewController>& screen, WindowButtons buttons)
{
    auto page = std::make_shared<ScreenPage>(context, navigation, screen, buttons);
    screen->setObserver(page);
    page->mirrorBars();
    return page;
}

ScreenPage::ScreenPage(std::shared_ptr<PeerContext> context,
    const std::shared_ptr<kit::NavigationController>& navigation,
    const std::shared_ptr<kit::ViewController>& screen, WindowButtons buttons)
    : _context(std::move(context))
    , _navigation(navigation)
    , _screen(screen)
    , _box(ObjectRef<GtkWidget>::retain(gtk_box_new(GTK_ORIENTATION_VERTICAL, 0)))
    , _navigationBar(_context)
    , _toolbar(_context)
{
    gtk_box_append(GTK_BOX(widget()), _navigationBar.widget());
    gtk_box_append(GTK_BOX(widget()), _toolbar.widget());
    gtk_widget_add_css_class(widget(), "background");
    _navigationBar.setWindowButtons(buttons == WindowButtons::Shown);
    _navigationBar.setOnBack(
        platform::weakly(_navigation, [](kit::NavigationController& stack) { stack.userWentBack(); }));
    // A screen below the top one is loaded when a swipe uncovers it.
    _onMap = connectSignal<void()>(widget(), "map", [this] { load(); });
    if (screen->isViewLoaded())
        load();
}

ScreenPage::~ScreenPage()
{
    _onMap.disconnect();
    _context->scheduler().cancel(this);
    if (_content)
        gtk_box_remove(GTK_BOX(widget()), _content->widget());
}

void ScreenPage::load()
{
    const auto shown = screen();
    if (_content || !shown)
        return;
    _content = makePeer(_context, shown->view());
    _content->setRoot([this, navigation = _navigation, weak = _screen](platform::Size size) {
        const auto stack = navigation.lock();
        const auto resized = weak.lock();
        if (stack && resized)
            stack->screenResized(*resized, size);
        updateBars();
    });
    gtk_widget_set_vexpand(_content->widget(), TRUE);
    gtk_box_insert_child_after(GTK_BOX(widget()), _content->widget(), _navigationBar.widget());
}

void ScreenPage::barsDidChange(kit::ViewController&)
{
    updateBars();
}

void ScreenPage::updateBars()
{
    _context->scheduler().schedule(this, [this] { mirrorBars(); });
}

void ScreenPage::mirrorBars()
{
    const auto shown = screen();
    const auto stack = _navigation.lock();
    if (!shown || !stack)
        return;
    const auto& screens = stack->viewControllers();
    const bool hasBackTarget = !screens.empty() && screens.front() != shown;
    _navigationBar.show(shown->navigationItem(), hasBackTarget);
    _navigationBar.setNarrow(shown->traits().horizontalSizeClass == kit::SizeClass::Compact);
    _toolbar.show(shown->toolbarItems());
    _toolbar.setHidden(stack->isToolbarHidden() || shown->toolbarItems().empty());
}

void ScreenPage::focus()
{
    if (_content)
        gtk_widget_child_focus(_content->widget(), GTK_DIR_TAB_FORWARD);
}

} // namespace host::gtk
