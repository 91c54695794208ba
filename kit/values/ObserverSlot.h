// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <memory>
#include <utility>

namespace kit {

/// Holds the peer that mirrors a kit object. The reference is weak, so that a destroyed peer is never called.
/// Main thread only.
template <typename Observer>
class ObserverSlot {
public:
    void set(std::weak_ptr<Observer> observer) { _observer = std::move(observer); }
    std::shared_ptr<Observer> lock() const { return _observer.lock(); }

    template <typename Call>
    void notify(Call&& call) const
    {
        if (const auto observer = _observer.lock())
            std::forward<Call>(call)(*observer);
    }

private:
    std::weak_ptr<Observer> _observer;
};

} // namespace kit
