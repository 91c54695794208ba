// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "prompts/FilenamePrompt.h"

namespace tarrow {

/// Asks for the name of a new folder.
class NewFolderPrompt : public FilenamePrompt {
public:
    using FilenamePrompt::FilenamePrompt;

    static std::shared_ptr<NewFolderPrompt> newWithTitleDoneButtonTextCompletion(
        const std::string& title, const std::string& doneButtonText, ValidateNewFilenameCallback completion);
};

} // namespace tarrow
