// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/preview/PrintablePages.h"

namespace host::previews {

/// Reads a PDF document to be printed. Any thread; may take long. Errors: why it cannot be, in words.
platform::Result<std::shared_ptr<gtk::PrintablePages>> readPrintablePdf(const std::string& path);

} // namespace host::previews
