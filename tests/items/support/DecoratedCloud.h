// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/CloudDocumentService.h"
#include "tests/support/ForwardingCoordinator.h"
#include "tests/support/SimulatedCloud.h"

#include <functional>
#include <memory>

namespace items_tests {

using platform::AttributeKeys;
using platform::AttributeMap;
using platform::Error;
using platform::Result;
using platform::Url;

/// Refuses to coordinate, or sends readers to another location than the one they asked for.
class DecoratedCoordinator : public testing_support::ForwardingCoordinator {
public:
    using ForwardingCoordinator::ForwardingCoordinator;
    Failure refusal;
    std::optional<Url> elsewhere;
    int reads = 0;

    Failure coordinateReading(
        const Url& url, platform::ReadingOptions options, const Accessor& accessor) override
    {
        ++reads;
        return refusal ? refusal : real->coordinateReading(elsewhere.value_or(url), options, accessor);
    }
};

/// The real items, whose attributes a test may change before they are handed out.
class DecoratedItems : public platform::PromisedItems {
public:
    std::optional<Error> unreachable; ///< the answer to every question of reachability, when it is set
    std::function<void(const Url&, Result<AttributeMap>&)> changePromised;
    std::function<void(const Url&, Result<AttributeMap>&)> changePlain;

    explicit DecoratedItems(platform::PromisedItems& real)
        : _real(real)
    {
    }
    std::optional<Error> checkPromisedItemIsReachable(const Url& url) const override
    {
        return unreachable ? unreachable : _real.checkPromisedItemIsReachable(url);
    }
    Result<AttributeMap> promisedItemResourceValues(const Url& url, AttributeKeys keys) const override
    {
        auto values = _real.promisedItemResourceValues(url, keys);
        if (changePromised)
            changePromised(url, values);
        return values;
    }
    platform::ItemReading readItem(const Url& url, AttributeKeys keys) const override
    {
        auto reading = _real.readItem(url, keys);
        if (unreachable)
            return {unreachable, {}, std::move(reading.physicalURL), {}};
        if (changePromised && !reading.unreachable)
            changePromised(url, reading.values);
        return reading;
    }
    Result<AttributeMap> resourceValues(const Url& url, AttributeKeys keys) const override
    {
        auto values = _real.resourceValues(url, keys);
        if (changePlain)
            changePlain(url, values);
        return values;
    }
    Url physicalURLForPromise(const Url& url) const override { return _real.physicalURLForPromise(url); }
    bool isItemPromise(const Url& url) const override { return _real.isItemPromise(url); }
    Url logicalURLForPromise(const Url& url) const override { return _real.logicalURLForPromise(url); }
    bool isExternalDocumentReference(const Url& url) const override
    {
        return _real.isExternalDocumentReference(url);
    }
    Result<Url> resolveExternalDocumentReference(const Url& url) const override
    {
        return _real.resolveExternalDocumentReference(url);
    }
    Result<Url> resolveAliasFile(const Url& url) const override { return _real.resolveAliasFile(url); }

private:
    platform::PromisedItems& _real;
};

/// Counts the accesses that were begun and ended. Every location needs one while `isNeeded`.
class CountingAccess : public platform::SecurityScopedAccess {
public:
    bool isNeeded = true;
    int started = 0, stopped = 0;

    bool startAccessing(const Url&) override
    {
        ++started;
        return isNeeded;
    }
    void stopAccessing(const Url&) override { ++stopped; }
};

/// The real identifiers, with a hook between the steps of a look-up.
class DecoratedIdentifiers : public platform::DocumentIdentifiers {
public:
    std::function<void()> beforeOpening, beforeReading;

    explicit DecoratedIdentifiers(platform::DocumentIdentifiers& real)
        : _real(real)
    {
    }
    std::optional<std::uint64_t> deviceIdentifier() override { return _real.deviceIdentifier(); }
    Result<File> resolve(std::uint32_t identifier) override { return _real.resolve(identifier); }
    Result<std::shared_ptr<const OpenFile>> open(const File& file) override
    {
        if (beforeOpening)
            beforeOpening();
        auto opened = _real.open(file);
        if (beforeReading)
            beforeReading();
        return opened;
    }
    Result<std::uint32_t> identify(const Url& url) override { return _real.identify(url); }

private:
    platform::DocumentIdentifiers& _real;
};

/// The real documents with the decorators above in front of their roles.
class DecoratedCloud : public testing_support::SimulatedCloud {
public:
    explicit DecoratedCloud(const std::shared_ptr<platform::CloudDocumentService>& real)
        : SimulatedCloud(real)
        , decoratedItems(real->promisedItems())
        , decoratedIdentifiers(real->documentIdentifiers())
    {
    }
    DecoratedItems decoratedItems;
    DecoratedIdentifiers decoratedIdentifiers;
    CountingAccess access;

    platform::PromisedItems& promisedItems() override { return decoratedItems; }
    platform::DocumentIdentifiers& documentIdentifiers() override { return decoratedIdentifiers; }
    platform::SecurityScopedAccess& securityScopedAccess() override { return access; }
};

} // namespace items_tests
