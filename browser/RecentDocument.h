// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Url.h"

#include <memory>

namespace platform {
class Queue;
}

namespace tarrow {

class DRItem;

/// Keeps the launcher's shortcut to the document that was opened last: the reference through which it was
/// opened (the alias), its identifier and its place. The identifier finds it after it was moved or renamed.
/// Main thread only.
class RecentDocument {
public:
    RecentDocument();

    /// A document was opened. The shortcut is kept a little later, because the document may have to be given
    /// an identifier first.
    void opened(const DRItem& item);
    /// Forgets the shortcut, because the documents of another account are shown from now on.
    static void forget();

private:
    std::shared_ptr<platform::Queue> _queue;
};

} // namespace tarrow
