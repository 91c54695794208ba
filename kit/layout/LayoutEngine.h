// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/PlatformNames.h"
#include "platform/Geometry.h"

#include <memory>

namespace kit {

class LayoutConstraint;
class LayoutItem;

/// Lays out one tree of items: brings the active constraints and the wanted sizes into a solver, reads the
/// frames out of it, on whole device pixels, and calls `layoutSubviews` where it is due, until nothing is
/// stale. The root item of the tree owns it. A constant that changes costs a few pivots; a change of
/// structure compares all rules and adds or removes what differs. Required constraints that contradict each
/// other are named in the log and dropped, the younger first, and are tried again when the structure changes.
class LayoutEngine {
public:
    explicit LayoutEngine(LayoutItem& root);
    ~LayoutEngine();

    /// Which items, constraints or priorities there are has changed.
    void structureDidChange();
    void constantDidChange(const LayoutConstraint& constraint);
    void intrinsicSizeDidChange(const LayoutItem& item);
    /// A item that is placed by its frame, or the root, got another one.
    void frameDidChange(const LayoutItem& item);

    /// Lays out everything that is stale. Ends also when the items' answers do not settle. A call from within
    /// a layout does nothing.
    void layout();
    bool isRunning() const;
    /// The smallest size of the root; a positive target side is kept. For an engine that does nothing else.
    Size fittingSize(Size target);

private:
    struct Impl;
    std::unique_ptr<Impl> _impl;
};

} // namespace kit
