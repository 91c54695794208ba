#pragma once

#include "platform/CloudDocumentService.h"

#include <optional>
#include <stdexcept>
#include <vector>

namespace testing_support {

/// An account whose token and quota answers the test chooses. It has no documents.
class SimulatedCloud : public platform::CloudDocumentService, public platform::CloudAccount {
public:
    std::optional<platform::PropertyValue> token = platform::PropertyValue("account-1");
    platform::Result<std::int64_t> quota = std::int64_t{1000};
    mutable int requests = 0;

    platform::CloudAccount& account() override { return *this; }
    platform::PromisedItems& promisedItems() override { throw std::logic_error("no items here"); }
    platform::DocumentContainers& containers() override { throw std::logic_error("no containers here"); }
    platform::CloudItems& items() override { throw std::logic_error("no items here"); }
    platform::SecurityScopedAccess& securityScopedAccess() override
    {
        throw std::logic_error("nothing here");
    }

    std::optional<platform::PropertyValue> identityToken() const override { return token; }
    platform::Work makeQuotaFetchOperation(
        std::function<void(platform::Result<std::int64_t>)> completion) const override
    {
        return [this, completion = std::move(completion)] {
            ++requests;
            completion(quota);
        };
    }
};

} // namespace testing_support
