// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/previews/PopplerPages.h"
#include "platform/PagedDocumentEditing.h"

#include <vector>

namespace host::previews {

/// Answers the fields of a page that a user may fill in, in the order of the form.
std::vector<platform::FormField> fieldsOf(PopplerPage* page);

/// These fill in a field of a page. They answer false when the field does not exist or does not take such a
/// value.
bool fillField(PopplerPage* page, const platform::FieldTextEdit& edit);
bool fillField(PopplerPage* page, const platform::FieldStateEdit& edit);
bool fillField(PopplerPage* page, const platform::FieldChoiceEdit& edit);

} // namespace host::previews
