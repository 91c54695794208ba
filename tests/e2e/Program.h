// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "Accessible.h"

#include <gio/gio.h>

#include <map>
#include <string>
#include <vector>

namespace e2e {

/// A running Tarrow Drive that is driven through its accessibility tree and the keyboard. The test fails when
/// the program writes a warning or ends with an error.
class Program {
public:
    using Environment = std::map<std::string, std::string>;

    /// Starts the program with a changed environment, and waits until it shows its window.
    explicit Program(const Environment& changes = {}, const std::vector<std::string>& arguments = {});
    ~Program();

    std::vector<Accessible> all(const std::function<bool(const Accessible&)>& matches) const
    {
        return _tree.all(matches);
    }
    /// Answers the visible buttons and rows whose names begin so, the frontmost last.
    std::vector<Accessible> buttons(const std::string& beginning) const;
    bool shows(const std::string& beginning) const { return !buttons(beginning).empty(); }
    /// Answers whether a visible node has exactly this name.
    bool says(const std::string& name) const;
    /// Answers whether a node whose name begins so has the keyboard focus.
    bool hasKeyboardAt(const std::string& beginning) const;
    /// Answers the texts that a preview shows; empty when it shows none.
    std::string document() const;
    std::vector<Accessible> entries() const { return all(&Accessible::isEntry); }
    /// Answers the names of all visible nodes and the end of the log, for the message of a failed test.
    std::string state() const;
    std::vector<Accessible> dialogs() const { return all(&Accessible::isDialog); }

    /// Presses the frontmost button whose name begins so, as soon as it exists.
    void press(const std::string& beginning) const;
    /// Presses a button again and again until that has an effect. A press on a bar that still slides in may
    /// be lost with the button.
    void pressUntil(const std::string& beginning, const std::function<bool()>& effect) const;

    /// Runs a command of this build to its end, with the environment of the tests.
    static int run(const std::vector<std::string>& command, const Environment& changes = {});

private:
    void expectOrderlyEnd();

    std::string _errors; ///< the file with what the program writes
    std::shared_ptr<GSubprocess> _process;
    Accessible _tree;
};

enum class Modifier { None, Control, Shift, ControlAndShift };

/// Presses a key, given as a symbol of the X server.
void pressKey(unsigned symbol, Modifier modifier = Modifier::None);
/// Types letters and digits.
void type(const std::string& text);

} // namespace e2e
