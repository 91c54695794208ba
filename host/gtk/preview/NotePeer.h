// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/PeerContext.h"

namespace host::gtk {

/// Registers a maker for notes (texts of several lines) with a context.
void addNoteMaker(PeerContext& context);

} // namespace host::gtk
