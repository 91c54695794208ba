#pragma once

#include "platform/Geometry.h"
#include "platform/ui/LayoutSolver.h"

#include <array>
#include <memory>
#include <optional>
#include <unordered_map>
#include <vector>

namespace platform::ui {

class View;

/// Lays out one tree of views: brings the active constraints and the wanted sizes into a solver, reads the
/// frames out of it and calls `layoutSubviews` where it is due. The root view of the tree owns it.
class LayoutEngine {
public:
    explicit LayoutEngine(View& root);
    ~LayoutEngine();

    /// Which views or constraints there are has changed.
    void structureDidChange() { _structureIsStale = true; }
    void constantDidChange(const LayoutConstraint& constraint);
    void constraintDidChange(const LayoutConstraint& constraint);
    void intrinsicSizeDidChange(View& view);
    /// A view that is placed by its frame got another one.
    void frameDidChange(View& view);

    /// One layout of everything that is stale. Ends also when the views' answers do not settle.
    void layout();
    Size fittingSize(Size target);

private:
    struct Impl;
    std::unique_ptr<Impl> _impl;
    bool _structureIsStale = true;
};

} // namespace platform::ui
