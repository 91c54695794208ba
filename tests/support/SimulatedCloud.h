// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/CloudDocumentService.h"

#include <functional>
#include <memory>
#include <optional>

namespace testing_support {

/// An account whose token and quota the test chooses, over the documents of another service. Without such a
/// service only the account works.
class SimulatedCloud : public platform::CloudDocumentService, public platform::CloudAccount {
public:
    explicit SimulatedCloud(std::shared_ptr<platform::CloudDocumentService> documents = nullptr)
        : _documents(std::move(documents))
    {
    }

    std::optional<platform::PropertyValue> token = platform::PropertyValue("account-1");
    platform::Result<std::int64_t> quota = std::int64_t{1000};
    mutable int requests = 0;
    bool putsRight = false;
    int looksAtItems = 0; ///< how often an item's attributes were asked for
    std::function<void()> beforeAnswer; ///< called while a quota request is pending

    platform::CloudAccount& account() override { return *this; }
    platform::PromisedItems& promisedItems() override
    {
        ++looksAtItems;
        return _documents->promisedItems();
    }
    platform::DocumentContainers& containers() override { return _documents->containers(); }
    platform::CloudItems& items() override { return _documents->items(); }
    platform::DocumentIdentifiers& documentIdentifiers() override
    {
        return _documents->documentIdentifiers();
    }
    platform::SecurityScopedAccess& securityScopedAccess() override
    {
        return _documents->securityScopedAccess();
    }

    bool isPuttingRight() const override { return putsRight; }

    std::optional<platform::PropertyValue> identityToken() const override { return token; }
    std::optional<platform::PropertyValue> knownIdentityToken() const override { return token; }
    platform::Work makeQuotaFetchOperation(
        std::function<void(platform::Result<std::int64_t>)> completion) const override
    {
        return [this, completion = std::move(completion)] {
            ++requests;
            if (beforeAnswer)
                beforeAnswer();
            completion(quota);
        };
    }

private:
    std::shared_ptr<platform::CloudDocumentService> _documents;
};

} // namespace testing_support
