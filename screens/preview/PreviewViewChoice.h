// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "screens/preview/PreviewContent.h"

#include <memory>

namespace screens {

class PreviewView;

/// Answers the view for a content. It is the view before when the kind is the same, so that place and zoom
/// stay, else a new one. Answers null for content without a view (a summary, a failure). Main thread.
std::shared_ptr<PreviewView> previewViewFor(
    const PreviewContent& content, const std::shared_ptr<PreviewView>& before);

} // namespace screens
