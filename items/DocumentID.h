// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/PlatformNames.h"

#include <cstdint>
#include <optional>
#include <string>

namespace tarrow {

// The drive keeps a number for each document, which stays the same when it is renamed or moved. Any thread.

/// Answers the document identifier of the item at a URL, present or promised, or 0 when it has none.
std::int64_t trw_DocumentID(const Url& url);

/// Answers the current location of the document whose identifier stands, in decimal, at the start of the
/// text; leading blanks and everything behind the digits are skipped. Answers nothing for a missing text, a
/// text without a number, a number of more than 32 bits, and a document that does not exist any more.
std::optional<Url> trw_URLFromDocumentID(const std::optional<std::string>& documentID);

} // namespace tarrow
