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

/// The cloud document service, divided into the roles that it plays. Each role's header says what it answers
/// and on which threads. The roles live as long as the service, so the references stay valid until then.
class CloudDocumentService {
public:
    virtual ~CloudDocumentService() = default;

    /// Who is signed in, and how much space the account has.
    virtual CloudAccount& account() = 0;
    /// The items of the drive and their attributes, whether they are here or only promised.
    virtual PromisedItems& promisedItems() = 0;
    /// The drive's top level and the app libraries.
    virtual DocumentContainers& containers() = 0;
    /// Places, downloads and bookmarks of items.
    virtual CloudItems& items() = 0;
    /// The numbers by which documents are found again.
    virtual DocumentIdentifiers& documentIdentifiers() = 0;
    /// Access to locations that the system grants for a while only.
    virtual SecurityScopedAccess& securityScopedAccess() = 0;

    /// Whether the drive still completes or takes back what programs were doing when they were killed. It is
    /// true only for work of more than half a second. Notification::PuttingRightDidChange is posted whenever
    /// the answer changes. Main thread.
    virtual bool isPuttingRight() const = 0;
};

} // namespace platform
