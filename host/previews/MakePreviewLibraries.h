// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/preview/PreviewLibraries.h"

/// The one function of the module, found by this name (`host::gtk::makePreviewLibrariesName`).
extern "C" void trwMakePreviewLibraries(std::shared_ptr<host::gtk::PreviewLibraries>& made);
