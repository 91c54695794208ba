// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <atspi/atspi.h>

#include <functional>
#include <memory>
#include <string>
#include <sys/types.h>
#include <vector>

namespace e2e {

/// A point in the program's window, in pixels from the corner of its display.
struct Place {
    double x = 0, y = 0;
};

/// A node of the accessibility tree.
class Accessible {
public:
    Accessible() = default;
    /// Takes over a reference.
    explicit Accessible(AtspiAccessible* node);

    explicit operator bool() const { return _node != nullptr; }
    std::string name() const;
    /// Answers whether the node existed at the last look and is visible.
    bool isVisible() const { return hasState(ATSPI_STATE_VISIBLE); }
    /// Performs the first action of the node. Answers false when it has none.
    bool press() const { return perform({}); }
    /// Performs the action of this name. Answers false when there is none.
    bool perform(const std::string& action) const;
    /// Answers all visible nodes below that match, in the order of the tree. Of a long list only the first
    /// rows are searched.
    std::vector<Accessible> all(const std::function<bool(const Accessible&)>& matches) const;
    bool isButton() const { return hasRole(ATSPI_ROLE_PUSH_BUTTON); }
    bool isEntry() const { return hasRole(ATSPI_ROLE_ENTRY) || hasRole(ATSPI_ROLE_TEXT); }
    bool isDialog() const { return hasRole(ATSPI_ROLE_DIALOG); }
    bool hasRole(AtspiRole role) const;
    /// Answers whether the node has the keyboard focus.
    bool isFocused() const { return hasState(ATSPI_STATE_FOCUSED); }
    /// Answers whether the node can take the keyboard focus.
    bool isFocusable() const { return hasState(ATSPI_STATE_FOCUSABLE); }
    std::string roleName() const;
    bool isSensitive() const { return hasState(ATSPI_STATE_SENSITIVE); }
    /// Answers the content of a text widget.
    std::string text() const;
    Place middle() const;
    /// Replaces the text of an entry. Answers false when it takes none.
    bool enter(const std::string& text) const;

    /// Answers the running application of this name and process, or null when it has not appeared.
    static Accessible application(const std::string& program, pid_t process);
    /// Runs the main loop until a condition holds. Answers false after twenty seconds.
    static bool waitFor(const std::function<bool()>& condition);

private:
    bool hasState(AtspiStateType state) const;
    void collect(const std::function<bool(const Accessible&)>& matches, std::vector<Accessible>& found) const;

    std::shared_ptr<AtspiAccessible> _node;
};

} // namespace e2e
