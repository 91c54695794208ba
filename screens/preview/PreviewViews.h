// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "screens/preview/PreviewContent.h"

#include <memory>

namespace screens {

class PreviewView;

/// The view for a content: the one that shows the content before when it is of the same kind, so that place
/// and zoom stay, else a new one. Null for what has no view of its own (a summary, a failure). Main thread.
std::shared_ptr<PreviewView> previewViewFor(
    const PreviewContent& content, const std::shared_ptr<PreviewView>& before);

} // namespace screens
