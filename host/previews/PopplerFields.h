// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/previews/PopplerPages.h"
#include "platform/PagedDocumentEditing.h"

#include <vector>

namespace host::previews {

/// The fields of a page that a person may fill in, in the order of the form.
std::vector<platform::FormField> fieldsOf(PopplerPage* page);

/// Fills in a field of a page. False for a field that is not there, or that takes no such thing.
bool fillField(PopplerPage* page, const platform::FieldTextEdit& edit);
bool fillField(PopplerPage* page, const platform::FieldStateEdit& edit);
bool fillField(PopplerPage* page, const platform::FieldChoiceEdit& edit);

} // namespace host::previews
