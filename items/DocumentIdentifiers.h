// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/PlatformNames.h"

#include <cstdint>
#include <optional>
#include <string>

namespace tarrow {

// The number that the drive keeps for a document while it is renamed and moved. Any thread.

/// The document identifier of the item at a URL, present or promised; 0 when it has none.
std::int64_t trw_DocumentID(const Url& url);

/// The current location of the document whose identifier stands, in decimal, at the start of the text
/// (leading blanks and whatever follows the digits are passed over). Nothing for a missing text, a text
/// without a number, a number of more than 32 bits, and a document that is not there any more.
std::optional<Url> trw_URLFromDocumentID(const std::optional<std::string>& documentID);

} // namespace tarrow
