// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/LayoutEngine.h"

#include "kit/LayoutTranslation.h"
#include "kit/View.h"
#include "kit/ViewController.h"
#include "platform/Log.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace platform::ui {

namespace {

// A layout settles in two or three passes; the bounds only end views whose answers go round in circles.
constexpr int maximumPasses = 12;
constexpr int maximumWrapRounds = 4;

// No length is negative, but a window that is too small is no reason to give up what was asked for.
constexpr LayoutPriority noNegativeLength = 999.5F;
// A wanted length whose priority says that it is required.
constexpr LayoutPriority requiredWish = 999.9F;
// How strongly a fitting size is kept that was asked for.
constexpr LayoutPriority targetSize = 999;
// Smaller differences of lengths are rounding errors.
constexpr double tolerance = 1e-6;

using ConstraintId = LayoutSolver::ConstraintId;
using Term = LayoutSolver::Term;

/// The wanted length of a view on one axis as it stands in the solver.
struct Wish {
    double wanted = LayoutItem::noIntrinsicMetric;
    LayoutPriority hugging = 0, resistance = 0;
    std::optional<ConstraintId> id, notNegative;
};

struct PlacedView {
    std::weak_ptr<View> view;
    std::array<Wish, 2> wishes;
    double wrappedAt = -1; ///< the width for which the wanted height was asked last
    bool wishesAreStale = true;
};

struct ActiveRule {
    std::weak_ptr<const LayoutConstraint> constraint;
    LayoutRule rule;
    LayoutPriority priority = 0;
    std::optional<ConstraintId> id; ///< nothing: given up
    std::uint64_t seen = 0;
    bool isReported = false; ///< that it was given up
};

struct Addition {
    LayoutRule rule;
    LayoutPriority priority;
    std::optional<ConstraintId>* id;
};

} // namespace

struct LayoutEngine::Impl {
    explicit Impl(View& view)
        : root(view)
        , translation(view, variables)
    {
    }

    View& root;
    LayoutSolver solver;
    LayoutTranslation::Variables variables;
    LayoutTranslation translation;
    std::unordered_map<const View*, PlacedView> placed;
    std::unordered_map<const LayoutConstraint*, ActiveRule> rules;
    std::vector<std::shared_ptr<View>> tree; ///< as of the last synchronisation, parents first
    std::vector<std::shared_ptr<View>> inner; ///< roots of layouts of their own in this tree
    std::vector<Addition> additions;
    std::uint64_t generation = 0;
    bool structureIsStale = true, wishesAreStale = true, isRunning = false, isFitting = false;

    bool hasVariables(const View& view) const { return &view == &root ? isFitting : !view.isPlacedByFrame(); }

    void updateConstraints(View& view);
    void collect(const std::shared_ptr<View>& view);
    void synchronize();
    void synchronizeRules();
    void removeRule(ActiveRule& rule);
    void placeViews();
    void removeGoneViews();
    void updateWishes(const View& view, PlacedView& entry);
    void updateWish(LayoutSolver::Variable length, Wish& wish, const View& view, Axis axis);
    void remove(std::optional<ConstraintId>& id);
    void addAll();
    void solve();
    bool updateWrappedHeights();
    Rect solvedFrame(const View& view) const;
    void applyFrames();
    void layoutViews();
};

void LayoutEngine::Impl::updateConstraints(View& view)
{
    if (view._needsUpdateConstraints) {
        view._needsUpdateConstraints = false;
        view.updateConstraints();
    }
    const auto subviews = view.subviews();
    for (const auto& subview : subviews) {
        if (!subview->_layoutBoundary)
            updateConstraints(*subview);
    }
}

void LayoutEngine::Impl::collect(const std::shared_ptr<View>& view)
{
    // The root owns this engine, but for one that is made for a fitting size alone: to hold the root from
    // here would keep both for ever.
    const bool isOwner = view.get() == &root && !isFitting;
    tree.push_back(isOwner ? std::shared_ptr<View>(std::shared_ptr<void>(), &root) : view);
    for (const auto& subview : view->subviews()) {
        if (subview->_layoutBoundary)
            inner.push_back(subview);
        else
            collect(subview);
    }
}

void LayoutEngine::Impl::synchronize()
{
    if (structureIsStale) {
        updateConstraints(root);
        structureIsStale = false;
        tree.clear();
        inner.clear();
        collect(root.shared_from_this());
        ++generation;
        placeViews();
        synchronizeRules();
        removeGoneViews();
        wishesAreStale = true;
    }
    // Before the wishes: most of them then find a length that is still free.
    addAll();
    if (wishesAreStale) {
        for (const auto& view : tree) {
            if (const auto entry = placed.find(view.get()); entry != placed.end())
                updateWishes(*view, entry->second);
        }
        wishesAreStale = false;
    }
}

void LayoutEngine::Impl::placeViews()
{
    for (const auto& view : tree) {
        if (!hasVariables(*view))
            continue;
        if (const auto found = placed.find(view.get()); found != placed.end()) {
            if (found->second.view.lock() == view)
                continue;
            // Another view has come to stand at the address of one that is gone; nothing of the old one
            // holds.
            found->second = {view, found->second.wishes, -1, true};
            continue;
        }
        auto& entry = placed[view.get()];
        entry.view = view;
        const LayoutVariables own{
            solver.addVariable(), solver.addVariable(), solver.addVariable(), solver.addVariable()};
        variables[view.get()] = own;
    }
}

void LayoutEngine::Impl::removeRule(ActiveRule& rule)
{
    remove(rule.id);
}

void LayoutEngine::Impl::synchronizeRules()
{
    translation.forgetFramesUsed();
    for (const auto& view : tree) {
        for (const auto& constraint : view->constraints()) {
            auto rule = translation.translate(*constraint);
            if (!rule)
                continue;
            auto& active = rules[constraint.get()];
            active.seen = generation;
            const bool isSame = active.id && active.constraint.lock() == constraint
                && active.priority == constraint->priority() && active.rule.hasSameTerms(*rule);
            active.constraint = constraint;
            active.priority = constraint->priority();
            if (isSame) {
                solver.setConstant(*active.id, rule->constant);
            } else {
                removeRule(active);
                additions.push_back({*rule, active.priority, &active.id});
            }
            active.rule = std::move(*rule);
        }
    }
    for (auto entry = rules.begin(); entry != rules.end();) {
        if (entry->second.seen == generation) {
            ++entry;
            continue;
        }
        removeRule(entry->second);
        entry = rules.erase(entry);
    }
}

void LayoutEngine::Impl::removeGoneViews()
{
    std::unordered_set<const View*> present;
    for (const auto& view : tree) {
        if (hasVariables(*view))
            present.insert(view.get());
    }
    std::erase_if(placed, [&](auto& entry) {
        if (present.contains(entry.first))
            return false;
        auto& view = entry.second;
        for (const auto& wish : view.wishes) {
            for (const auto& id : {wish.id, wish.notNegative}) {
                if (id)
                    solver.removeConstraint(*id);
            }
        }
        const auto& own = variables.at(entry.first);
        for (const auto variable : {own.x, own.y, own.width, own.height})
            solver.removeVariable(variable);
        variables.erase(entry.first);
        return true;
    });
}

void LayoutEngine::Impl::updateWishes(const View& view, PlacedView& entry)
{
    const auto& own = variables.at(&view);
    if (std::exchange(entry.wishesAreStale, false)) {
        const Size size = view.intrinsicContentSize();
        entry.wishes[0].wanted = size.width;
        entry.wishes[1].wanted = size.height;
        entry.wrappedAt = -1;
    }
    updateWish(own.width, entry.wishes[0], view, Axis::Horizontal);
    updateWish(own.height, entry.wishes[1], view, Axis::Vertical);
}

void LayoutEngine::Impl::updateWish(LayoutSolver::Variable length, Wish& wish, const View& view, Axis axis)
{
    const auto hugging = view.hugging(axis), resistance = view.compressionResistance(axis);
    const bool isKept = wish.hugging == hugging && wish.resistance == resistance;
    wish.hugging = hugging;
    wish.resistance = resistance;
    // Of what resists being short nothing more has to be said.
    const bool isWanted = wish.wanted >= 0 && (hugging > 0 || resistance > 0);
    if (isWanted && resistance > 0) {
        remove(wish.notNegative);
    } else if (!wish.notNegative) {
        wish.notNegative = solver.addWish(length, 0, 0, noNegativeLength);
    }
    if (wish.id && isWanted && isKept) {
        solver.setConstant(*wish.id, wish.wanted);
        return;
    }
    remove(wish.id);
    // A wish that is required would be in the way of what was asked for in so many words.
    const auto atMost = [](LayoutPriority priority) { return std::min(priority, requiredWish); };
    if (isWanted)
        wish.id = solver.addWish(length, wish.wanted, atMost(hugging), atMost(resistance));
}

void LayoutEngine::Impl::remove(std::optional<ConstraintId>& id)
{
    if (id)
        solver.removeConstraint(*id);
    id.reset();
}

void LayoutEngine::Impl::addAll()
{
    static constexpr Operation op{"-[LayoutEngine addAll]"};
    // The important ones first, so that most of the others find their optimum as they come.
    std::stable_sort(additions.begin(), additions.end(),
        [](const auto& a, const auto& b) { return a.priority > b.priority; });
    for (const auto& addition : additions) {
        const auto& rule = addition.rule;
        *addition.id = solver.addConstraint(rule.terms, rule.relation, rule.constant, addition.priority);
    }
    if (std::exchange(additions, {}).empty())
        return;
    for (auto& [key, active] : rules) {
        const auto constraint = active.constraint.lock();
        if (constraint && !active.id && !std::exchange(active.isReported, true))
            op.warning("Ignored, as it contradicts other required constraints: %{public}@",
                constraint->description());
    }
}

void LayoutEngine::Impl::solve()
{
    static constexpr Operation op{"-[LayoutEngine solve]"};
    for (const auto givenUp : solver.solve()) {
        const auto isIt = [givenUp](const auto& entry) { return entry.second.id == givenUp; };
        const auto active = std::find_if(rules.begin(), rules.end(), isIt);
        if (active == rules.end())
            continue;
        active->second.id.reset();
        if (const auto constraint = active->second.constraint.lock())
            op.warning("Given up, as it contradicts other required constraints: %{public}@",
                constraint->description());
    }
}

/// Asks views whose height depends on their width anew where the width has changed. True when a height is
/// another.
bool LayoutEngine::Impl::updateWrappedHeights()
{
    bool isAnother = false;
    for (const auto& view : tree) {
        const auto found = placed.find(view.get());
        if (found == placed.end() || !view->wrapsContent())
            continue;
        auto& entry = found->second;
        const double width = solver.value(variables.at(view.get()).width);
        if (width <= 0 || std::abs(width - entry.wrappedAt) < tolerance)
            continue;
        entry.wrappedAt = width;
        const double height = view->intrinsicContentSize(width).height;
        if (std::abs(height - entry.wishes[1].wanted) < tolerance)
            continue;
        entry.wishes[1].wanted = height;
        updateWish(variables.at(view.get()).height, entry.wishes[1], *view, Axis::Vertical);
        isAnother = true;
    }
    return isAnother;
}

Rect LayoutEngine::Impl::solvedFrame(const View& view) const
{
    const auto& own = variables.at(&view);
    const double x = solver.value(own.x), y = solver.value(own.y);
    const double left = View::roundToPixel(x), top = View::roundToPixel(y);
    return {left, top, std::max(0.0, View::roundToPixel(x + solver.value(own.width)) - left),
        std::max(0.0, View::roundToPixel(y + solver.value(own.height)) - top)};
}

void LayoutEngine::Impl::applyFrames()
{
    for (const auto& view : tree) {
        if (view.get() != &root && placed.contains(view.get()))
            view->setFrame(solvedFrame(*view));
    }
}

void LayoutEngine::Impl::layoutViews()
{
    // A view may change the tree while it lays out its subviews.
    const auto views = tree;
    for (const auto& view : views) {
        if (!view->_needsLayout)
            continue;
        view->_needsLayout = false;
        const auto controller = view->_controller.lock();
        if (controller)
            controller->viewWillLayoutSubviews();
        view->layoutSubviews();
        if (controller)
            controller->viewDidLayoutSubviews();
    }
}

LayoutEngine::LayoutEngine(View& root)
    : _impl(std::make_unique<Impl>(root))
{
}

LayoutEngine::~LayoutEngine() = default;

void LayoutEngine::structureDidChange()
{
    _impl->structureIsStale = true;
}

void LayoutEngine::constantDidChange(const LayoutConstraint& constraint)
{
    const auto found = _impl->rules.find(&constraint);
    if (_impl->structureIsStale || found == _impl->rules.end() || !found->second.id)
        return structureDidChange();
    const auto rule = _impl->translation.translate(constraint);
    if (!rule)
        return structureDidChange();
    found->second.rule.constant = rule->constant;
    _impl->solver.setConstant(*found->second.id, rule->constant);
}

void LayoutEngine::intrinsicSizeDidChange(const View& view)
{
    const auto found = _impl->placed.find(&view);
    if (found == _impl->placed.end())
        return;
    found->second.wishesAreStale = true;
    _impl->wishesAreStale = true;
}

void LayoutEngine::frameDidChange(const View& view)
{
    if (!_impl->hasVariables(view) && _impl->translation.framesUsed().contains(&view))
        _impl->structureIsStale = true;
}

bool LayoutEngine::isRunning() const
{
    return _impl->isRunning;
}

void LayoutEngine::layout()
{
    static constexpr Operation op{"-[LayoutEngine layout]"};
    if (_impl->isRunning)
        return;
    _impl->isRunning = true;
    View& root = _impl->root;
    int passes = 0;
    for (; root._treeNeedsLayout && passes < maximumPasses; ++passes) {
        root._treeNeedsLayout = false;
        _impl->synchronize();
        _impl->solve();
        for (int round = 0; round < maximumWrapRounds && _impl->updateWrappedHeights(); ++round)
            _impl->solve();
        _impl->applyFrames();
        _impl->layoutViews();
    }
    if (passes == maximumPasses)
        op.warning("The layout of %{public}@ does not settle", root.debugName());
    const auto inner = _impl->inner;
    for (const auto& view : inner) {
        if (view->_treeNeedsLayout)
            view->engine().layout();
    }
    root._treeNeedsLayout = false;
    _impl->isRunning = false;
}

Size LayoutEngine::fittingSize(Size target)
{
    _impl->isFitting = true;
    _impl->synchronize();
    const auto own = _impl->variables.at(&_impl->root);
    const auto pull = [this](LayoutSolver::Variable length, double wanted) {
        const Term term{length, 1};
        _impl->solver.addConstraint({&term, 1}, LayoutRelation::Equal, std::max(0.0, wanted),
            wanted > 0 ? targetSize : LayoutPriorities::fittingSize);
    };
    pull(own.width, target.width);
    pull(own.height, target.height);
    _impl->solve();
    for (int round = 0; round < maximumWrapRounds && _impl->updateWrappedHeights(); ++round)
        _impl->solve();
    return {_impl->solver.value(own.width), _impl->solver.value(own.height)};
}

} // namespace platform::ui
