// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/UndoHistory.h"
#include "platform/Url.h"
#include "prompts/TagChoices.h"

#include <memory>
#include <string>
#include <vector>

namespace kit {
class ViewController;
}

namespace tarrow {

/// Asks over a screen which tags items shall have, and gives them these tags. It lives until they have them.
/// Main thread only.
class TagEditing : public std::enable_shared_from_this<TagEditing> {
    struct Token {
        explicit Token() = default;
    };

public:
    /// Reads the items' tags on a queue and shows the prompt. Nothing is shown when the account has changed
    /// or the screen has gone meanwhile. The history, which may be null, gets an entry for the change.
    static void begin(std::vector<platform::Url> items, const std::shared_ptr<kit::ViewController>& screen,
        const std::shared_ptr<UndoHistory>& history);
    TagEditing(Token, std::vector<platform::Url> items, std::weak_ptr<kit::ViewController> screen,
        std::weak_ptr<UndoHistory> history);

private:
    struct Tagged {
        platform::Url item;
        std::vector<std::string> tagsBefore;
    };
    struct Outcome {
        std::vector<Tagged> changed;
        std::vector<platform::Error> errors;
    };
    using TagLists = std::vector<std::vector<std::string>>;

    void show(TagLists tagsOfItems);
    void apply(const TagEdit& edit);
    static UndoEntry undoOf(const std::vector<Tagged>& changed, const TagEdit& edit);
    void showErrors(const std::vector<platform::Error>& errors) const;

    const AccountSession _asked;
    const std::vector<platform::Url> _items;
    std::weak_ptr<kit::ViewController> _screen;
    std::weak_ptr<UndoHistory> _history;
};

} // namespace tarrow
