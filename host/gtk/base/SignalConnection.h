// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <glib-object.h>

#include <functional>
#include <memory>
#include <utility>
#include <vector>

namespace host::gtk {

/// A handler that is connected to a signal of an object. It is disconnected when this is destroyed, even if
/// the object is gone by then.
class SignalConnection {
public:
    SignalConnection() = default;
    SignalConnection(gpointer object, gulong handler);
    SignalConnection(SignalConnection&&) noexcept = default;
    SignalConnection& operator=(SignalConnection&& other) noexcept;
    ~SignalConnection();

    void disconnect();
    /// While the handler is blocked, it is not told of changes that the program itself makes to the object.
    void block() const;
    void unblock() const;

private:
    struct Target;
    struct TargetDeleter {
        void operator()(Target* target) const;
    };
    std::unique_ptr<Target, TargetDeleter> _target;
};

/// The connections of one owner.
using SignalConnections = std::vector<SignalConnection>;

/// Blocks a handler for a scope.
class SignalBlock {
public:
    explicit SignalBlock(const SignalConnection& connection)
        : _connection(connection)
    {
        _connection.block();
    }
    ~SignalBlock() { _connection.unblock(); }
    SignalBlock(const SignalBlock&) = delete;
    SignalBlock& operator=(const SignalBlock&) = delete;

private:
    const SignalConnection& _connection;
};

namespace detail {

template <typename Signature>
struct SignalThunk;

/// The user data of a signal comes last, at a place that depends on the signal, so the signature is spelled
/// out.
template <typename Result, typename... Arguments>
struct SignalThunk<Result(Arguments...)> {
    using Function = std::function<Result(Arguments...)>;

    static Result call(gpointer /*object*/, Arguments... arguments, gpointer data)
    {
        return (*static_cast<Function*>(data))(arguments...);
    }
    static void destroy(gpointer data, GClosure*) { delete static_cast<Function*>(data); }
};

} // namespace detail

/// Connects for as long as the object lives, so the function must not refer to anything that is destroyed
/// earlier. `Signature` is as below.
template <typename Signature, typename Function>
gulong connectForLife(gpointer object, const char* signal, Function&& function)
{
    using Thunk = detail::SignalThunk<Signature>;
    auto handler = std::make_unique<typename Thunk::Function>(std::forward<Function>(function));
    return g_signal_connect_data(object, signal, G_CALLBACK(&Thunk::call), handler.release(), &Thunk::destroy,
        static_cast<GConnectFlags>(0));
}

/// Calls a function for a signal. `Signature` names the result and the arguments between the object and the
/// user data, as in `connectSignal<gboolean(guint, guint, GdkModifierType)>(keys, "key-pressed", ...)`.
template <typename Signature, typename Function>
[[nodiscard]] SignalConnection connectSignal(gpointer object, const char* signal, Function&& function)
{
    const gulong id = connectForLife<Signature>(object, signal, std::forward<Function>(function));
    return SignalConnection(object, id);
}

/// Connects to a property's "notify::name".
template <typename Function>
[[nodiscard]] SignalConnection connectNotify(gpointer object, const char* signal, Function&& function)
{
    return connectSignal<void(GParamSpec*)>(
        object, signal, [call = std::forward<Function>(function)](GParamSpec*) { call(); });
}

} // namespace host::gtk
