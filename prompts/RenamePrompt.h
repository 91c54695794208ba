// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "prompts/FilenamePrompt.h"

namespace tarrow {

/// Asks for another name of an item.
class RenamePrompt : public FilenamePrompt {
public:
    using FilenamePrompt::FilenamePrompt;

    static std::shared_ptr<RenamePrompt> newWithFilenameCompletion(
        const std::string& filename, ValidateNewFilenameCallback completion);
};

} // namespace tarrow
