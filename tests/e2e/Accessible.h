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

/// A place in the program's window, which begins at the corner of its display; pixels.
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
    /// Whether the node was there at the last look and is meant to be seen.
    bool isVisible() const { return hasState(ATSPI_STATE_VISIBLE); }
    /// Performs the first action of the node; false when it has none.
    bool press() const;
    /// Performs the action of this name; false when there is none.
    bool perform(const std::string& action) const;
    /// All visible nodes below that match, in the order of the tree. Of a long list only the first are looked
    /// at.
    std::vector<Accessible> all(const std::function<bool(const Accessible&)>& matches) const;
    bool isButton() const;
    bool isEntry() const;
    bool isDialog() const;
    bool hasRole(AtspiRole role) const;
    /// Whether the keyboard is here.
    bool isFocused() const { return hasState(ATSPI_STATE_FOCUSED); }
    /// Whether the keyboard can go here.
    bool isFocusable() const { return hasState(ATSPI_STATE_FOCUSABLE); }
    std::string roleName() const;
    bool isSensitive() const { return hasState(ATSPI_STATE_SENSITIVE); }
    /// The content of a text.
    std::string text() const;
    Place middle() const;
    /// Replaces the text of an entry; false when it takes none.
    bool enter(const std::string& text) const;

    /// The running application of this program name and process; null: it has not appeared.
    static Accessible application(const std::string& program, pid_t process);
    /// Lets messages through until a condition holds; false after twenty seconds.
    static bool waitFor(const std::function<bool()>& condition);

private:
    bool hasState(AtspiStateType state) const;
    void collect(const std::function<bool(const Accessible&)>& matches, std::vector<Accessible>& found) const;

    std::shared_ptr<AtspiAccessible> _node;
};

} // namespace e2e
