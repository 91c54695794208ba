// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "prompts/NewFolderPrompt.h"

#include "platform/Localization.h"

namespace tarrow {

using platform::localized;

std::shared_ptr<NewFolderPrompt> NewFolderPrompt::newWithTitleDoneButtonTextCompletion(
    const std::string& title, const std::string& doneButtonText, ValidateNewFilenameCallback completion)
{
    auto prompt = std::make_shared<NewFolderPrompt>(Token{});
    prompt->build({.title = title,
                      .message = localized("Enter a name for this folder."),
                      .placeholder = localized("Folder Name"),
                      .filename = std::nullopt,
                      .doneButtonText = doneButtonText},
        std::move(completion));
    return prompt;
}

} // namespace tarrow
