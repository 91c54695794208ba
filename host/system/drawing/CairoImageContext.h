// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/ImageContext.h"

#include <memory>

namespace host::system {

/// Opens a context for an image that is drawn in memory, as kit::ImageContext::open() says.
std::unique_ptr<kit::ImageContext> openImageContext(const platform::Size& size, double scale);

} // namespace host::system
