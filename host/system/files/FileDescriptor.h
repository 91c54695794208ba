// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <unistd.h>

#include <utility>

namespace host::system {

/// Owns an open descriptor and closes it in its destructor. Movable only.
class FileDescriptor {
public:
    FileDescriptor() = default;
    /// Takes over the result of a system call; a negative number means "none".
    explicit FileDescriptor(int descriptor)
        : _descriptor(descriptor)
    {
    }
    FileDescriptor(FileDescriptor&& other) noexcept
        : _descriptor(std::exchange(other._descriptor, -1))
    {
    }
    FileDescriptor& operator=(FileDescriptor&& other) noexcept
    {
        std::swap(_descriptor, other._descriptor);
        return *this;
    }
    ~FileDescriptor() { reset(); }

    explicit operator bool() const { return _descriptor >= 0; }
    int get() const { return _descriptor; }
    void reset()
    {
        if (_descriptor >= 0)
            ::close(std::exchange(_descriptor, -1));
    }

private:
    int _descriptor = -1;
};

} // namespace host::system
