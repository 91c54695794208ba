// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

namespace platform {
}

/// The kit uses the names of the platform's services and values without a prefix.
namespace kit {

using namespace platform;

} // namespace kit
