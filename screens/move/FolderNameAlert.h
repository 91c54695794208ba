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

/// An alert that asks for the name of a folder to be made. `chosen` is called once, after it has closed, with
/// a name that can be one; not when the user cancels. Main thread only.
std::shared_ptr<kit::AlertController> makeFolderNameAlert(std::function<void(const std::string&)> chosen);

} // namespace screens
