// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <concepts>
#include <functional>
#include <memory>
#include <tuple>
#include <utility>

/// Callbacks that do not keep their object alive: every timer, notice, signal and queue that calls an object
/// back is given one of these, because the object may be gone by then.
///
///     queue->async(weakly(this, &FolderContents::readAgain));
///     queue->async(weakly(this, &FolderContents::showError, error));               // with an argument bound
///     button->setAction(weakly(screen, [](Screen& self) { self.setPage(0); }));    // with a lambda
///     action->setShouldClose(weaklyOr(false, this, &NamePrompt::nameIsAccepted));  // with an answer
namespace platform {

namespace detail {

/// Shares the count of the object's base class, so that a member of a derived class needs no cast. An object
/// that no shared_ptr holds, as in its own constructor, counts as one that is gone.
template <typename T>
std::weak_ptr<T> weakTo(T* object)
{
    if (auto alive = object->weak_from_this().lock())
        return std::shared_ptr<T>(std::move(alive), object);
    return {};
}

template <typename T>
std::weak_ptr<T> weakTo(const std::shared_ptr<T>& object)
{
    return object;
}

template <typename T>
std::weak_ptr<T> weakTo(const std::weak_ptr<T>& object)
{
    return object;
}

/// What weakly() and weaklyOr() answer: `otherwise` is called in place of the step once the object is gone.
template <typename Answer, typename Otherwise, typename T, typename Step, typename... Bound>
class WeakCall {
public:
    WeakCall(Otherwise otherwise, std::weak_ptr<T> object, Step step, Bound... bound)
        : _otherwise(std::move(otherwise))
        , _object(std::move(object))
        , _step(std::move(step))
        , _bound(std::move(bound)...)
    {
    }

    template <typename... Event>
    static constexpr bool takes = std::invocable<const Step&, T&, const Bound&..., Event...>;

    template <typename... Event>
    requires(takes<Event...> || takes<>) Answer operator()(Event&&... event) const
    {
        const auto self = _object.lock();
        if (!self)
            return _otherwise();
        const auto call = [&](const Bound&... bound) -> Answer {
            if constexpr (takes<Event...>)
                return static_cast<Answer>(
                    std::invoke(_step, *self, bound..., std::forward<Event>(event)...));
            else
                return static_cast<Answer>(std::invoke(_step, *self, bound...));
        };
        return std::apply(call, _bound);
    }

private:
    Otherwise _otherwise;
    std::weak_ptr<T> _object;
    Step _step;
    std::tuple<Bound...> _bound;
};

/// Names the answer; the other types follow from the arguments.
template <typename Answer, typename Otherwise, typename T, typename Step, typename... Bound>
auto weakCall(Otherwise otherwise, std::weak_ptr<T> object, Step step, Bound... bound)
{
    return WeakCall<Answer, Otherwise, T, Step, Bound...>(
        std::move(otherwise), std::move(object), std::move(step), std::move(bound)...);
}

} // namespace detail

/// A function that calls a step of an object while the object lives, and does nothing afterwards. The object
/// stays alive during the call. It may be called on any thread, and any number of times.
///
/// `object` is `this` or another pointer to a class with weak_from_this(), a shared_ptr or a weak_ptr. `step`
/// is a member function or a function that takes the object by reference. It is called with copies of the
/// bound arguments and then with what the caller passes; a step that does not take the latter is called
/// without it.
template <typename Object, typename Step, typename... Bound>
auto weakly(const Object& object, Step step, Bound... bound)
{
    return detail::weakCall<void>([] {}, detail::weakTo(object), std::move(step), std::move(bound)...);
}

/// The same for a callback that answers: it answers what the step does, and `fallback` once the object is
/// gone.
template <typename Answer, typename Object, typename Step, typename... Bound>
auto weaklyOr(Answer fallback, const Object& object, Step step, Bound... bound)
{
    return detail::weakCall<Answer>([fallback = std::move(fallback)] { return fallback; },
        detail::weakTo(object), std::move(step), std::move(bound)...);
}

} // namespace platform
