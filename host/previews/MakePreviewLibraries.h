// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/preview/PreviewLibraries.h"

/// The module's one function, which is found by this name (`host::gtk::makePreviewLibrariesName`).
extern "C" void trwMakePreviewLibraries(std::shared_ptr<host::gtk::PreviewLibraries>& made);
