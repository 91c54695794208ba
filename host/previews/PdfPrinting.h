// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/preview/PrintablePages.h"

namespace host::previews {

/// Reads a PDF document to be printed. It may take long; any thread. The error says in a sentence why it
/// cannot be printed.
platform::Result<std::shared_ptr<gtk::PrintablePages>> readPrintablePdf(const std::string& path);

} // namespace host::previews
