// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/CloudAccount.h"
#include "platform/CloudItems.h"
#include "platform/DocumentContainers.h"
#include "platform/DocumentIdentifiers.h"
#include "platform/PromisedItems.h"
#include "platform/SecurityScopedAccess.h"

namespace platform {

/// The cloud document service, by the roles it plays.
class CloudDocumentService {
public:
    virtual ~CloudDocumentService() = default;

    virtual CloudAccount& account() = 0;
    virtual PromisedItems& promisedItems() = 0;
    virtual DocumentContainers& containers() = 0;
    virtual CloudItems& items() = 0;
    virtual DocumentIdentifiers& documentIdentifiers() = 0;
    virtual SecurityScopedAccess& securityScopedAccess() = 0;
};

} // namespace platform
