// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/CloudStore.h"
#include "platform/Dispatch.h"
#include "platform/FileCoordinator.h"
#include "platform/ItemDownload.h"

#include <memory>

namespace host::drive {

/// A download on a background queue. Its handlers run on the main queue.
class LocalDownload : public platform::ItemDownload {
public:
    /// The services that a download needs. They outlive it.
    struct Setting {
        DriveLayout layout;
        std::shared_ptr<CloudStore> store;
        std::shared_ptr<platform::OperationQueue> queue;
        std::shared_ptr<platform::Queue> mainQueue;
        std::shared_ptr<platform::FileCoordinator> coordinator; ///< null: no other writers are kept out
    };

    static std::unique_ptr<LocalDownload> start(
        const Setting& setting, const std::string& path, platform::DownloadHandlers handlers);

    ~LocalDownload() override { cancel(); }
    void cancel() override;

private:
    struct State;
    explicit LocalDownload(std::shared_ptr<State> state)
        : _state(std::move(state))
    {
    }
    static CloudStore::Continue tell(
        const std::shared_ptr<State>& state, std::uint64_t done, const std::optional<std::uint64_t>& total);

    std::shared_ptr<State> _state;
};

} // namespace host::drive
