// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

namespace platform {
}

/// The screens use the names of the platform's services and values without a prefix.
namespace screens {

using namespace platform;

} // namespace screens
