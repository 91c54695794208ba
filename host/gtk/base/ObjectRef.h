// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <glib-object.h>

#include <utility>

namespace host::gtk {

/// A counted reference to a GObject.
template <typename T>
class ObjectRef {
public:
    ObjectRef() = default;
    ObjectRef(const ObjectRef& other)
        : _object(other._object)
    {
        if (_object)
            g_object_ref(_object);
    }
    ObjectRef(ObjectRef&& other) noexcept
        : _object(std::exchange(other._object, nullptr))
    {
    }
    ObjectRef& operator=(ObjectRef other) noexcept
    {
        std::swap(_object, other._object);
        return *this;
    }
    ~ObjectRef()
    {
        if (_object)
            g_object_unref(_object);
    }

    /// Takes over a reference that the caller owns.
    static ObjectRef adopt(T* object)
    {
        ObjectRef ref;
        ref._object = object;
        return ref;
    }
    /// Adds a reference. A floating reference, as a new widget has, is taken over instead.
    static ObjectRef retain(T* object)
    {
        if (object)
            g_object_ref_sink(object);
        return adopt(object);
    }

    T* get() const { return _object; }
    explicit operator bool() const { return _object != nullptr; }
    void reset() { *this = ObjectRef(); }

private:
    T* _object = nullptr;
};

} // namespace host::gtk
