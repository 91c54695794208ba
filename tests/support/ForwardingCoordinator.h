// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/FileCoordinator.h"

#include <memory>

namespace testing_support {

/// Forwards every call to the real coordinator; a test derives from it and overrides the calls that it
/// changes.
class ForwardingCoordinator : public platform::FileCoordinator {
public:
    using Failure = std::optional<platform::Error>;
    using Url = platform::Url;

    explicit ForwardingCoordinator(std::shared_ptr<platform::FileCoordinator> coordinator)
        : real(std::move(coordinator))
    {
    }
    Failure coordinateReading(
        const Url& url, platform::ReadingOptions options, const Accessor& accessor) override
    {
        return real->coordinateReading(url, options, accessor);
    }
    Failure coordinateWriting(
        const Url& url, platform::WritingOptions options, const Accessor& accessor) override
    {
        return real->coordinateWriting(url, options, accessor);
    }
    Failure coordinateWriting(const Url& first, platform::WritingOptions firstOptions, const Url& second,
        platform::WritingOptions secondOptions, const PairAccessor& accessor) override
    {
        return real->coordinateWriting(first, firstOptions, second, secondOptions, accessor);
    }
    void itemWillMove(const Url& from, const Url& to) override { real->itemWillMove(from, to); }
    void itemDidMove(const Url& from, const Url& to) override { real->itemDidMove(from, to); }
    void addFilePresenter(const std::shared_ptr<platform::FilePresenter>& presenter) override
    {
        real->addFilePresenter(presenter);
    }
    void removeFilePresenter(const platform::FilePresenter& presenter) override
    {
        real->removeFilePresenter(presenter);
    }

protected:
    const std::shared_ptr<platform::FileCoordinator> real;
};

} // namespace testing_support
