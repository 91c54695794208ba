// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "prompts/RenamePrompt.h"

#include "platform/Localization.h"

namespace tarrow {

using platform::localized;

std::shared_ptr<RenamePrompt> RenamePrompt::newWithFilenameCompletion(
    const std::string& filename, ValidateNewFilenameCallback completion)
{
    auto prompt = std::make_shared<RenamePrompt>(Token{});
    prompt->build({.title = localized("Rename Item"),
                      .message = localized("Enter a new name for this item."),
                      .placeholder = std::nullopt,
                      .filename = filename,
                      .doneButtonText = localized("Done")},
        std::move(completion));
    return prompt;
}

} // namespace tarrow
