// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Dispatch.h"

#include <memory>
#include <thread>

namespace host::system {

/// The queue of the thread that makes it. Its work runs when that thread iterates GLib's default main
/// context. Work that has not run when the queue is destroyed never runs.
///
/// The work has the priority of the toolkit's drawing, so that much work takes turns with frames, and input
/// comes before both. A turn runs only the work that was waiting when it began.
class MainQueue : public platform::Queue {
public:
    MainQueue();
    ~MainQueue() override;
    MainQueue(const MainQueue&) = delete;
    MainQueue& operator=(const MainQueue&) = delete;

    void async(platform::Work work) override;
    const std::string& label() const override { return _label; }
    bool isCurrentThread() const { return std::this_thread::get_id() == _thread; }

private:
    struct State;
    struct Source;
    std::shared_ptr<State> _state;
    std::string _label = "main";
    std::thread::id _thread = std::this_thread::get_id();
};

} // namespace host::system
