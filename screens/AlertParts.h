// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/AlertController.h"

#include <functional>
#include <memory>
#include <string>

namespace screens {

/// A button of an alert that does something, or nothing but to close it.
std::shared_ptr<kit::AlertAction> alertAction(
    std::string title, kit::AlertActionStyle style, std::function<void()> act = {});
/// A message that is closed with OK.
std::shared_ptr<kit::AlertController> messageAlert(const std::string& title, const std::string& words);

} // namespace screens
