// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/AlertController.h"

#include <functional>
#include <memory>
#include <string>

namespace screens {

/// Answers a button of an alert. Without `act` it only closes the alert.
std::shared_ptr<kit::AlertAction> alertAction(
    std::string title, kit::AlertActionStyle style, std::function<void()> act = {});
/// Answers an alert with a message and an OK button.
std::shared_ptr<kit::AlertController> messageAlert(const std::string& title, const std::string& words);

} // namespace screens
