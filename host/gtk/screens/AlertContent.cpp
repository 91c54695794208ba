// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/screens/AlertContent.h"

#include "host/gtk/screens/BarItemPeer.h"
#include "host/gtk/screens/ScrolledBody.h"
#include "host/gtk/views/TextFieldPeer.h"
#include "kit/views/HostedView.h"
#include "kit/views/TextField.h"
#include "platform/Weakly.h"

#include <algorithm>

namespace host::gtk {

namespace {

constexpr double fieldHeight = 44; ///< points
constexpr double assumedWidth = 280; ///< width of the content before the alert has a width
constexpr std::size_t standingButtons = 3; ///< so many buttons fit below the text in a low window
constexpr std::size_t longestTitleBesideAnother = 14; ///< characters

GtkWidget* makeLabel(const char* styleClass)
{
    auto* label = gtk_label_new(nullptr);
    gtk_label_set_wrap(GTK_LABEL(label), TRUE);
    gtk_label_set_wrap_mode(GTK_LABEL(label), PANGO_WRAP_WORD_CHAR);
    gtk_label_set_justify(GTK_LABEL(label), GTK_JUSTIFY_CENTER);
    // A broken name must not look as if it contained hyphens.
    auto* attributes = pango_attr_list_new();
    pango_attr_list_insert(attributes, pango_attr_insert_hyphens_new(FALSE));
    gtk_label_set_attributes(GTK_LABEL(label), attributes);
    pango_attr_list_unref(attributes);
    gtk_label_set_max_width_chars(GTK_LABEL(label), 36);
    gtk_widget_add_css_class(label, styleClass);
    return label;
}

/// Two buttons with short titles stand side by side. Others stand in a column.
GtkOrientation buttonOrientation(const kit::AlertController& alert)
{
    const auto& actions = alert.actions();
    const bool isShort = std::ranges::all_of(
        actions, [](const auto& action) { return action->title().size() <= longestTitleBesideAnother; });
    const bool isRow = alert.alertStyle() == kit::AlertStyle::Alert && actions.size() == 2 && isShort;
    return isRow ? GTK_ORIENTATION_HORIZONTAL : GTK_ORIENTATION_VERTICAL;
}

/// Answers whether a button stands out: the preferred action does, and without one, and in every sheet, the
/// cancel action.
bool standsOut(const kit::AlertAction& action, const kit::AlertController& alert)
{
    const auto preferred = alert.preferredAction();
    const bool mayCancel = !preferred || alert.alertStyle() == kit::AlertStyle::ActionSheet;
    return preferred.get() == &action || (mayCancel && action.style() == kit::AlertActionStyle::Cancel);
}

void setText(GtkWidget* label, const std::string& text)
{
    gtk_label_set_label(GTK_LABEL(label), text.c_str());
    gtk_widget_set_visible(label, !text.empty());
}

/// Gives the focus to the first widget that takes it.
bool focusWithin(GtkWidget* widget)
{
    if (gtk_widget_get_focusable(widget) && gtk_widget_grab_focus(widget))
        return true;
    for (auto* child = gtk_widget_get_first_child(widget); child;
         child = gtk_widget_get_next_sibling(child)) {
        if (focusWithin(child))
            return true;
    }
    return false;
}

} // namespace

/// Gathers the alert's changes and shows them once a frame.
class AlertContent::Observer : public kit::AlertObserver {
public:
    explicit Observer(AlertContent& content)
        : _content(content)
    {
    }
    ~Observer() override { _content._context->scheduler().cancel(this); }
    void alertDidChange(kit::AlertController&) override
    {
        _content._context->scheduler().schedule(this, [this] { _content.mirror(); });
    }

private:
    AlertContent& _content;
};

AlertContent::AlertContent(std::shared_ptr<PeerContext> context, std::shared_ptr<kit::AlertController> alert)
    : _context(std::move(context))
    , _alert(alert)
    , _card(ObjectRef<GtkWidget>::retain(GTK_WIDGET(g_object_new(GTK_TYPE_BOX, "accessible-role",
          GTK_ACCESSIBLE_ROLE_ALERT_DIALOG, "orientation", GTK_ORIENTATION_VERTICAL, nullptr))))
    , _lines(gtk_box_new(GTK_ORIENTATION_VERTICAL, 0))
    , _body(gtk_box_new(GTK_ORIENTATION_VERTICAL, 0))
    , _title(makeLabel("alert-title"))
    , _message(makeLabel("alert-message"))
    , _observer(std::make_shared<Observer>(*this))
{
    gtk_widget_add_css_class(widget(), "alert");
    buildBody();
    addFields(*alert);
    addContentView(*alert);
    mirror();
    alert->setAlertObserver(_observer);
}

AlertContent::~AlertContent()
{
    _observer.reset();
    _connections.clear();
    for (auto& peer : _peers) {
        gtk_box_remove(GTK_BOX(_body), peer->widget());
        _context->scheduler().release(std::move(peer));
    }
}

/// Content that does not fit a low window scrolls. A few buttons stay in place.
void AlertContent::buildBody()
{
    gtk_widget_add_css_class(_body, "alert-body");
    gtk_box_append(GTK_BOX(_body), _title);
    gtk_box_append(GTK_BOX(_body), _message);
    gtk_box_append(GTK_BOX(_lines), _body);
    gtk_box_append(GTK_BOX(widget()), makeScrolledBody(_lines));
}

void AlertContent::addFields(const Alert& alert)
{
    for (const auto& field : alert.textFields()) {
        auto peer = std::make_shared<TextFieldPeer>(_context, field);
        peer->start();
        peer->setOnReturn([this] { returnPressed(); });
        // The alert places its fields itself, so the frames of the model do not count.
        peer->setRoot([](platform::Size) {}, [](double) { return platform::Size{0, fieldHeight}; });
        if (field->accessibility().label.empty() && field->placeholder().empty())
            peer->setAccessibleName(alert.message().empty() ? alert.title() : alert.message());
        gtk_box_append(GTK_BOX(_body), peer->widget());
        _peers.push_back(std::move(peer));
    }
}

void AlertContent::addContentView(const Alert& alert)
{
    const auto content = alert.contentViewController();
    if (!content)
        return;
    auto peer = makePeer(_context, content->view());
    const auto resize = platform::weakly(content->view(), [](kit::View& view, platform::Size size) {
        view.setFrame({0, 0, size.width, size.height});
    });
    const auto fit =
        platform::weaklyOr(platform::Size(), content->view(), [](kit::View& view, double forWidth) {
            const double width = forWidth > 0 ? forWidth : assumedWidth;
            return platform::Size{0, view.systemLayoutSizeFitting({width, 0}).height};
        });
    peer->setRoot(resize, fit);
    gtk_box_append(GTK_BOX(_body), peer->widget());
    _peers.push_back(std::move(peer));
}

GtkWidget* AlertContent::makeActionButton(const std::shared_ptr<kit::AlertAction>& action, const Alert& alert)
{
    auto* button = gtk_button_new_with_label(action->title().c_str());
    gtk_widget_add_css_class(button, "alert-action");
    gtk_widget_set_hexpand(button, TRUE);
    if (action->style() == kit::AlertActionStyle::Destructive)
        gtk_widget_add_css_class(button, "destructive");
    if (standsOut(*action, alert))
        gtk_widget_add_css_class(button, "preferred");
    _connections.push_back(connectSignal<void()>(button, "clicked",
        platform::weakly(_alert, [weak = std::weak_ptr(action)](kit::AlertController& asked) {
            if (const auto pressed = weak.lock())
                asked.press(pressed);
        })));
    return button;
}

void AlertContent::rebuildButtons(const Alert& alert)
{
    _connections.clear();
    _buttons.clear();
    if (_buttonBox)
        gtk_box_remove(GTK_BOX(gtk_widget_get_parent(_buttonBox)), _buttonBox);
    const auto orientation = buttonOrientation(alert);
    _buttonBox = gtk_box_new(orientation, 0);
    gtk_box_set_homogeneous(GTK_BOX(_buttonBox), orientation == GTK_ORIENTATION_HORIZONTAL);
    gtk_widget_add_css_class(_buttonBox, "alert-actions");
    gtk_widget_add_css_class(_buttonBox, orientation == GTK_ORIENTATION_HORIZONTAL ? "in-row" : "in-column");
    for (const auto& action : alert.actions()) {
        _buttons.push_back(makeActionButton(action, alert));
        gtk_box_append(GTK_BOX(_buttonBox), _buttons.back());
    }
    const bool areFew = _buttons.size() <= standingButtons;
    gtk_box_append(GTK_BOX(areFew ? widget() : _lines), _buttonBox);
}

void AlertContent::mirror()
{
    const auto alert = _alert.lock();
    if (!alert)
        return;
    setText(_title, alert->title());
    setText(_message, alert->message());
    if (_buttons.size() != alert->actions().size() || !_buttonBox)
        rebuildButtons(*alert);
    for (std::size_t i = 0; i < _buttons.size(); ++i)
        gtk_widget_set_sensitive(_buttons[i], alert->actions()[i]->isEnabled());
    auto* accessible = GTK_ACCESSIBLE(widget());
    const auto& name = alert->title().empty() ? alert->message() : alert->title();
    gtk_accessible_update_property(accessible, GTK_ACCESSIBLE_PROPERTY_LABEL, name.c_str(), -1);
    gtk_accessible_update_property(
        accessible, GTK_ACCESSIBLE_PROPERTY_DESCRIPTION, alert->message().c_str(), -1);
}

void AlertContent::returnPressed()
{
    const auto alert = _alert.lock();
    if (alert && alert->preferredAction())
        alert->press(alert->preferredAction());
}

void AlertContent::focus()
{
    const auto alert = _alert.lock();
    if (!alert)
        return;
    if (!alert->textFields().empty() && !_peers.empty()) {
        alert->textFields().front()->becomeFirstResponder();
        _peers.front()->grabFocus();
        return;
    }
    // A native view in an alert, such as a note to be written, is the purpose of the alert, so it gets the
    // focus.
    const auto content = alert->contentViewController();
    const bool isHosted = content && std::dynamic_pointer_cast<kit::HostedView>(content->view());
    if (isHosted && !_peers.empty() && focusWithin(_peers.front()->widget()))
        return;
    const auto preferred = alert->preferredAction() ? alert->preferredAction() : alert->escapeAction();
    for (std::size_t i = 0; i < _buttons.size(); ++i) {
        if (!preferred || alert->actions()[i] == preferred) {
            gtk_widget_grab_focus(_buttons[i]);
            return;
        }
    }
    gtk_widget_child_focus(widget(), GTK_DIR_TAB_FORWARD);
}

} // namespace host::gtk
