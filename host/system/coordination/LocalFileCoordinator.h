// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/coordination/LockFile.h"
#include "host/system/coordination/PresenterNotices.h"
#include "host/system/coordination/PresenterWatch.h"
#include "platform/FileCoordinator.h"

#include <span>

namespace host::system {

/// Coordinates the access to files on this machine. A metadata read runs at once: a file has a temporary name
/// until it is whole, so a reader never sees half of it. Every other read and every write locks its items in
/// a LockFile. Presenters are asked before the locks are taken, so that their preparations do not wait for
/// the writer that waits for them.
class LocalFileCoordinator : public platform::FileCoordinator {
public:
    struct Settings {
        /// The lock file of all processes that exclude each other; empty means this process alone.
        std::string lockFile = {};
        /// The longest time for which each write waits for presenters.
        platform::Duration patience = std::chrono::seconds(3);
        /// The longest time for which each read and write waits for others that have its item. It is longer
        /// than any save takes, and no longer than a person waits for a program that hangs.
        platform::Duration lockPatience = std::chrono::seconds(10);
        /// The folder whose items are presented, and the queues on which changes by other processes are
        /// searched for; a watch in the main loop (GLib's default main context) reports them. When these are
        /// empty and null, presenters are told of this process's changes alone.
        std::string root = {};
        std::shared_ptr<platform::Dispatch> dispatch = nullptr;
        /// Runs on the writer's thread before it waits for presenters.
        std::function<void()> beforeWaiting = nullptr;
    };

    LocalFileCoordinator();
    explicit LocalFileCoordinator(Settings settings);
    ~LocalFileCoordinator() override;

    std::optional<platform::Error> coordinateReading(
        const platform::Url& url, platform::ReadingOptions options, const Accessor& accessor) override;
    std::optional<platform::Error> coordinateWriting(
        const platform::Url& url, platform::WritingOptions options, const Accessor& accessor) override;
    std::optional<platform::Error> coordinateWriting(const platform::Url& first,
        platform::WritingOptions firstOptions, const platform::Url& second,
        platform::WritingOptions secondOptions, const PairAccessor& accessor) override;
    void itemWillMove(const platform::Url& from, const platform::Url& to) override;
    void itemDidMove(const platform::Url& from, const platform::Url& to) override;
    void addFilePresenter(const std::shared_ptr<platform::FilePresenter>& presenter) override;
    void removeFilePresenter(const platform::FilePresenter& presenter) override;

private:
    struct Target {
        platform::Url url;
        platform::WritingOptions options;
    };
    std::optional<platform::Error> write(std::span<const Target> targets, const std::function<void()>& body);
    void runWatched(std::span<const Target> targets, const std::function<void()>& body);
    std::optional<platform::Error> runLocked(
        const std::vector<LockFile::Claim>& claims, const std::function<void()>& body);
    void tellAfterwards(const Target& target);

    LockFile _locks;
    platform::Duration _lockPatience;
    std::shared_ptr<PresenterNotices> _notices;
    std::shared_ptr<PresenterWatch> _watch; ///< null without a root
};

} // namespace host::system
