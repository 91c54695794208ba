// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "Accessible.h"

#include <algorithm>

namespace e2e {

namespace {

constexpr int mostChildren = 40;
constexpr gint64 patience = 20'000'000; ///< microseconds
constexpr guint pause = 50; ///< milliseconds

struct Unref {
    void operator()(gpointer held) const { g_object_unref(held); }
};

/// Holds an interface of a node, or null when the node has none.
template <typename Interface>
using Held = std::unique_ptr<Interface, Unref>;

/// Frees a text and answers its content.
std::string taken(char* text)
{
    std::string answer = text ? text : "";
    g_free(text);
    return answer;
}

} // namespace

Accessible::Accessible(AtspiAccessible* node)
{
    if (node)
        _node.reset(node, Unref());
}

std::string Accessible::name() const
{
    return taken(atspi_accessible_get_name(_node.get(), nullptr));
}

std::string Accessible::roleName() const
{
    return taken(atspi_accessible_get_role_name(_node.get(), nullptr));
}

bool Accessible::hasState(AtspiStateType state) const
{
    const Held<AtspiStateSet> states(atspi_accessible_get_state_set(_node.get()));
    return states && atspi_state_set_contains(states.get(), state);
}

std::string Accessible::text() const
{
    const Held<AtspiText> content(atspi_accessible_get_text_iface(_node.get()));
    if (!content)
        return {};
    const int length = atspi_text_get_character_count(content.get(), nullptr);
    return taken(atspi_text_get_text(content.get(), 0, length, nullptr));
}

Place Accessible::middle() const
{
    const Held<AtspiComponent> component(atspi_accessible_get_component_iface(_node.get()));
    if (!component)
        return {};
    auto* extents = atspi_component_get_extents(component.get(), ATSPI_COORD_TYPE_WINDOW, nullptr);
    Place answer;
    if (extents)
        answer = {extents->x + extents->width / 2.0, extents->y + extents->height / 2.0};
    g_free(extents);
    return answer;
}

bool Accessible::hasRole(AtspiRole role) const
{
    return atspi_accessible_get_role(_node.get(), nullptr) == role;
}

bool Accessible::enter(const std::string& text) const
{
    const Held<AtspiEditableText> entry(atspi_accessible_get_editable_text_iface(_node.get()));
    return entry && atspi_editable_text_set_text_contents(entry.get(), text.c_str(), nullptr);
}

bool Accessible::perform(const std::string& action) const
{
    const Held<AtspiAction> actions(atspi_accessible_get_action_iface(_node.get()));
    const int count = actions ? atspi_action_get_n_actions(actions.get(), nullptr) : 0;
    for (int i = 0; i < count; ++i) {
        if (action.empty() || taken(atspi_action_get_action_name(actions.get(), i, nullptr)) == action)
            return atspi_action_do_action(actions.get(), i, nullptr);
    }
    return false;
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
    const auto deadline = g_get_monotonic_time() + patience;
    // The accessibility tree sends no notice of its own, so it is read again at each tick.
    const guint tick = g_timeout_add(
        pause, [](gpointer) -> gboolean { return G_SOURCE_CONTINUE; }, nullptr);
    bool holds = condition();
    while (!holds && g_get_monotonic_time() < deadline) {
        g_main_context_iteration(nullptr, TRUE);
        holds = condition();
    }
    g_source_remove(tick);
    return holds;
}

} // namespace e2e
