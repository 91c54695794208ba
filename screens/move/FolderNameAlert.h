// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <functional>
#include <memory>
#include <string>

namespace kit {
class AlertController;
} // namespace kit

namespace screens {

/// Answers an alert that asks for the name of a new folder. `chosen` is called once with a valid name, after
/// the alert has closed; it is not called when the user cancels. Main thread only.
std::shared_ptr<kit::AlertController> makeFolderNameAlert(std::function<void(const std::string&)> chosen);

} // namespace screens
