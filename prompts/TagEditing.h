// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/AccountSession.h"
#include "platform/Url.h"
#include "prompts/TagChoices.h"

#include <memory>
#include <string>
#include <vector>

namespace kit {
class ViewController;
}

namespace tarrow {

/// Asks over a screen which tags items shall have, gives them these tags, and tells of it in a message with
/// which the change can be taken back. It lives until that message has gone. Main thread only.
class TagEditing : public std::enable_shared_from_this<TagEditing> {
    struct Token {
        explicit Token() = default;
    };

public:
    /// Reads the items' tags on a queue and shows the prompt. Nothing is shown when the account has changed
    /// or the screen has gone meanwhile.
    static void begin(std::vector<platform::Url> items, const std::shared_ptr<kit::ViewController>& screen);
    TagEditing(Token, std::vector<platform::Url> items, std::weak_ptr<kit::ViewController> screen);

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
    void undo(const std::vector<Tagged>& changed);
    void tell(const Outcome& outcome);
    void showErrors(const std::vector<platform::Error>& errors) const;

    const AccountSession _asked;
    const std::vector<platform::Url> _items;
    std::weak_ptr<kit::ViewController> _screen;
};

} // namespace tarrow
