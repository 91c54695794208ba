// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/base/SignalConnection.h"

namespace host::gtk {

struct SignalConnection::Target {
    GWeakRef object;
    gulong handler;

    Target(gpointer target, gulong id)
        : handler(id)
    {
        g_weak_ref_init(&object, target);
    }
    ~Target() { g_weak_ref_clear(&object); }
    Target(const Target&) = delete;
    Target& operator=(const Target&) = delete;

    template <typename Call>
    void withObject(Call&& call)
    {
        if (gpointer alive = g_weak_ref_get(&object)) {
            call(alive);
            g_object_unref(alive);
        }
    }
};

void SignalConnection::TargetDeleter::operator()(Target* target) const
{
    delete target;
}

SignalConnection::SignalConnection(gpointer object, gulong handler)
    : _target(new Target(object, handler))
{
}

SignalConnection& SignalConnection::operator=(SignalConnection&& other) noexcept
{
    disconnect();
    _target = std::move(other._target);
    return *this;
}

SignalConnection::~SignalConnection()
{
    disconnect();
}

void SignalConnection::disconnect()
{
    const auto target = std::move(_target);
    if (!target)
        return;
    target->withObject([&](gpointer object) {
        if (g_signal_handler_is_connected(object, target->handler))
            g_signal_handler_disconnect(object, target->handler);
    });
}

void SignalConnection::block() const
{
    if (_target)
        _target->withObject([this](gpointer object) { g_signal_handler_block(object, _target->handler); });
}

void SignalConnection::unblock() const
{
    if (_target)
        _target->withObject([this](gpointer object) { g_signal_handler_unblock(object, _target->handler); });
}

} // namespace host::gtk
