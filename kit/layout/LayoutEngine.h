// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/PlatformNames.h"
#include "platform/Geometry.h"

#include <memory>

namespace kit {

class LayoutConstraint;
class LayoutItem;

/// Lays out one tree of items. It brings the active constraints and the wanted sizes into a solver, reads the
/// frames out of it, on whole device pixels, and calls `layoutSubviews` where it is due, until nothing is
/// stale. The root item of the tree owns it. A constant that changes costs a few pivots; a change of
/// structure compares all rules and adds or removes those that differ. Required constraints that contradict
/// each other are named in the log and dropped, the younger first, and are tried again when the structure
/// changes.
class LayoutEngine {
public:
    explicit LayoutEngine(LayoutItem& root);
    ~LayoutEngine();

    /// The set of items, of constraints or of priorities has changed.
    void structureDidChange();
    void constantDidChange(const LayoutConstraint& constraint);
    void intrinsicSizeDidChange(const LayoutItem& item);
    /// The root, or an item that is placed by its frame, got another frame.
    void frameDidChange(const LayoutItem& item);

    /// Lays out everything that is stale. It also ends when the items' answers do not settle. A call from
    /// within a layout does nothing.
    void layout();
    bool isRunning() const;
    /// Answers the smallest size of the root; a positive side of the target is kept. An engine that is asked
    /// this must be used for nothing else.
    Size fittingSize(Size target);

private:
    struct Impl;
    std::unique_ptr<Impl> _impl;
};

} // namespace kit
