// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "Accessible.h"

#include <algorithm>

namespace e2e {

namespace {

constexpr int mostChildren = 40;
constexpr guint patience = 20'000, pause = 50; ///< milliseconds

} // namespace

Accessible::Accessible(AtspiAccessible* node)
    : _node(node, [](AtspiAccessible* held) {
        if (held)
            g_object_unref(held);
    })
{
    if (!node)
        _node.reset();
}

std::string Accessible::name() const
{
    char* text = atspi_accessible_get_name(_node.get(), nullptr);
    std::string answer = text ? text : "";
    g_free(text);
    return answer;
}

std::string Accessible::roleName() const
{
    char* text = atspi_accessible_get_role_name(_node.get(), nullptr);
    std::string answer = text ? text : "";
    g_free(text);
    return answer;
}

bool Accessible::hasState(AtspiStateType state) const
{
    auto* states = atspi_accessible_get_state_set(_node.get());
    const bool has = states && atspi_state_set_contains(states, state);
    if (states)
        g_object_unref(states);
    return has;
}

std::string Accessible::text() const
{
    auto* content = atspi_accessible_get_text_iface(_node.get());
    if (!content)
        return {};
    const int length = atspi_text_get_character_count(content, nullptr);
    char* text = atspi_text_get_text(content, 0, length, nullptr);
    std::string answer = text ? text : "";
    g_free(text);
    g_object_unref(content);
    return answer;
}

Place Accessible::middle() const
{
    auto* component = atspi_accessible_get_component_iface(_node.get());
    if (!component)
        return {};
    auto* extents = atspi_component_get_extents(component, ATSPI_COORD_TYPE_WINDOW, nullptr);
    Place answer;
    if (extents)
        answer = {extents->x + extents->width / 2.0, extents->y + extents->height / 2.0};
    g_free(extents);
    g_object_unref(component);
    return answer;
}

bool Accessible::hasRole(AtspiRole role) const
{
    return atspi_accessible_get_role(_node.get(), nullptr) == role;
}

bool Accessible::isButton() const
{
    return hasRole(ATSPI_ROLE_PUSH_BUTTON);
}

bool Accessible::isEntry() const
{
    const auto role = atspi_accessible_get_role(_node.get(), nullptr);
    return role == ATSPI_ROLE_ENTRY || role == ATSPI_ROLE_TEXT;
}

bool Accessible::isDialog() const
{
    return hasRole(ATSPI_ROLE_DIALOG);
}

bool Accessible::enter(const std::string& text) const
{
    auto* editable = atspi_accessible_get_editable_text_iface(_node.get());
    if (!editable)
        return false;
    const bool done = atspi_editable_text_set_text_contents(editable, text.c_str(), nullptr);
    g_object_unref(editable);
    return done;
}

bool Accessible::press() const
{
    auto* action = atspi_accessible_get_action_iface(_node.get());
    if (!action)
        return false;
    const bool done =
        atspi_action_get_n_actions(action, nullptr) > 0 && atspi_action_do_action(action, 0, nullptr);
    g_object_unref(action);
    return done;
}

bool Accessible::perform(const std::string& action) const
{
    auto* actions = atspi_accessible_get_action_iface(_node.get());
    if (!actions)
        return false;
    bool done = false;
    const int count = atspi_action_get_n_actions(actions, nullptr);
    for (int i = 0; i < count && !done; ++i) {
        char* name = atspi_action_get_action_name(actions, i, nullptr);
        done = name && action == name && atspi_action_do_action(actions, i, nullptr);
        g_free(name);
    }
    g_object_unref(actions);
    return done;
}

void Accessible::collect(
    const std::function<bool(const Accessible&)>& matches, std::vector<Accessible>& found) const
{
    const int count = std::min(atspi_accessible_get_child_count(_node.get(), nullptr), mostChildren);
    for (int i = 0; i < count; ++i) {
        const Accessible child(atspi_accessible_get_child_at_index(_node.get(), i, nullptr));
        if (!child || !child.isVisible())
            continue;
        if (matches(child))
            found.push_back(child);
        child.collect(matches, found);
    }
}

std::vector<Accessible> Accessible::all(const std::function<bool(const Accessible&)>& matches) const
{
    std::vector<Accessible> found;
    if (_node)
        collect(matches, found);
    return found;
}

Accessible Accessible::application(const std::string& program, pid_t process)
{
    const Accessible desktop(atspi_get_desktop(0));
    const int count = atspi_accessible_get_child_count(desktop._node.get(), nullptr);
    for (int i = 0; i < count; ++i) {
        const Accessible child(atspi_accessible_get_child_at_index(desktop._node.get(), i, nullptr));
        const auto owner = static_cast<pid_t>(atspi_accessible_get_process_id(child._node.get(), nullptr));
        if (child && owner == process && child.name() == program)
            return child;
    }
    return {};
}

bool Accessible::waitFor(const std::function<bool()>& condition)
{
    bool isLate = false;
    const guint alarm = g_timeout_add(
        patience,
        [](gpointer late) -> gboolean {
            *static_cast<bool*>(late) = true;
            return G_SOURCE_CONTINUE;
        },
        &isLate);
    // The accessibility tree sends no notice of its own, so it is read again at each tick.
    const guint tick = g_timeout_add(
        pause, [](gpointer) -> gboolean { return G_SOURCE_CONTINUE; }, nullptr);
    bool holds = condition();
    while (!holds && !isLate) {
        g_main_context_iteration(nullptr, TRUE);
        holds = condition();
    }
    g_source_remove(alarm);
    g_source_remove(tick);
    return holds;
}

} // namespace e2e
