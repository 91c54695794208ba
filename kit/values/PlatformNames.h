// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

namespace platform {
}

/// The kit calls the platform's services and values by their own names.
namespace kit {

using namespace platform;

} // namespace kit
