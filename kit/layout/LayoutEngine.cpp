// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/layout/LayoutEngine.h"

#include "kit/layout/LayoutItem.h"
#include "kit/layout/LayoutTranslation.h"
#include "platform/Log.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace kit {

namespace {

// A layout settles in two or three passes. The bounds end a layout whose items keep changing their answers.
constexpr int maximumPasses = 12;
constexpr int maximumWrapRounds = 4;

// No length is negative. This is not required, because a window that is too small must not make the solver
// give up the constraints that were asked for.
constexpr LayoutPriority noNegativeLength = 999.5F;
// The priority of a wanted length that asks to be required.
constexpr LayoutPriority requiredWish = 999.9F;
// The priority with which a requested side of a fitting size is kept.
constexpr LayoutPriority targetSize = 999;
// Smaller differences between lengths are rounding errors.
constexpr double tolerance = 1e-6;

using ConstraintId = LayoutSolver::ConstraintId;
using Term = LayoutSolver::Term;

/// The wanted length of an item on one axis, as the solver knows it.
struct Wish {
    double wanted = LayoutItem::noIntrinsicMetric;
    LayoutPriority hugging = 0, resistance = 0;
    std::optional<ConstraintId> id, notNegative;
};

struct PlacedItem {
    std::weak_ptr<LayoutItem> item;
    std::array<Wish, 2> wishes;
    double wrappedAt = -1; ///< the width for which the wanted height was last asked
    bool wishesAreStale = true;
};

struct ActiveRule {
    std::weak_ptr<const LayoutConstraint> constraint;
    LayoutRule rule;
    LayoutPriority priority = 0;
    std::optional<ConstraintId> id; ///< absent: the constraint was given up
    std::uint64_t seen = 0;
    bool isReported = false; ///< whether the log says that it was given up
};

struct Addition {
    LayoutRule rule;
    LayoutPriority priority;
    std::optional<ConstraintId>* id;
};

} // namespace

struct LayoutEngine::Impl {
    explicit Impl(LayoutItem& item)
        : root(item)
        , translation(item, variables)
    {
    }

    LayoutItem& root;
    LayoutSolver solver;
    LayoutTranslation::Variables variables;
    LayoutTranslation translation;
    std::unordered_map<const LayoutItem*, PlacedItem> placed;
    std::unordered_map<const LayoutConstraint*, ActiveRule> rules;
    std::vector<std::shared_ptr<LayoutItem>>
        tree; ///< the items as of the last synchronisation, parents first
    std::vector<std::shared_ptr<LayoutItem>> inner; ///< the roots of separate layouts within this tree
    std::vector<Addition> additions;
    std::uint64_t generation = 0;
    bool structureIsStale = true, wishesAreStale = true, isRunning = false, isFitting = false;

    bool hasVariables(const LayoutItem& item) const
    {
        return &item == &root ? isFitting : !item.isPlacedByFrame();
    }

    void updateConstraints(LayoutItem& item);
    void collect(const std::shared_ptr<LayoutItem>& item);
    void synchronize();
    void synchronizeRules();
    void removeRule(ActiveRule& rule);
    void placeItems();
    void removeGoneItems();
    void updateWishes(const LayoutItem& item, PlacedItem& entry);
    void updateWish(LayoutSolver::Variable length, Wish& wish, const LayoutItem& item, Axis axis);
    void remove(std::optional<ConstraintId>& id);
    void addAll();
    void solve();
    bool updateWrappedHeights();
    Rect solvedFrame(const LayoutItem& item) const;
    void applyFrames();
    void layOutContents();
};

void LayoutEngine::Impl::updateConstraints(LayoutItem& item)
{
    if (item._needsUpdateConstraints) {
        item._needsUpdateConstraints = false;
        item.updateConstraints();
    }
    for (const auto& child : item.layoutChildren()) {
        if (!child->_layoutBoundary)
            updateConstraints(*child);
    }
}

void LayoutEngine::Impl::collect(const std::shared_ptr<LayoutItem>& item)
{
    // The root owns this engine, so the engine must not hold the root or neither would ever be destroyed. An
    // engine made for one fitting size is owned by nobody and may hold it.
    const bool isOwner = item.get() == &root && !isFitting;
    tree.push_back(isOwner ? std::shared_ptr<LayoutItem>(std::shared_ptr<void>(), &root) : item);
    for (const auto& child : item->layoutChildren()) {
        if (child->_layoutBoundary)
            inner.push_back(child);
        else
            collect(child);
    }
}

void LayoutEngine::Impl::synchronize()
{
    if (structureIsStale) {
        updateConstraints(root);
        structureIsStale = false;
        tree.clear();
        inner.clear();
        collect(root.layoutReference());
        ++generation;
        placeItems();
        synchronizeRules();
        removeGoneItems();
        wishesAreStale = true;
    }
    // Constraints are added before the wanted lengths, because most wanted lengths then find a variable that
    // is still free.
    addAll();
    if (wishesAreStale) {
        for (const auto& item : tree) {
            if (const auto entry = placed.find(item.get()); entry != placed.end())
                updateWishes(*item, entry->second);
        }
        wishesAreStale = false;
    }
}

void LayoutEngine::Impl::placeItems()
{
    for (const auto& item : tree) {
        if (!hasVariables(*item))
            continue;
        if (const auto found = placed.find(item.get()); found != placed.end()) {
            if (found->second.item.lock() == item)
                continue;
            // Another item was created at the address of a destroyed one, so nothing that is known of the old
            // item holds.
            found->second = {item, found->second.wishes, -1, true};
            continue;
        }
        auto& entry = placed[item.get()];
        entry.item = item;
        const LayoutVariables own{
            solver.addVariable(), solver.addVariable(), solver.addVariable(), solver.addVariable()};
        variables[item.get()] = own;
    }
}

void LayoutEngine::Impl::removeRule(ActiveRule& rule)
{
    remove(rule.id);
}

void LayoutEngine::Impl::synchronizeRules()
{
    translation.forgetFramesUsed();
    for (const auto& item : tree) {
        for (const auto& constraint : item->constraints()) {
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

void LayoutEngine::Impl::removeGoneItems()
{
    std::unordered_set<const LayoutItem*> present;
    for (const auto& item : tree) {
        if (hasVariables(*item))
            present.insert(item.get());
    }
    std::erase_if(placed, [&](auto& entry) {
        if (present.contains(entry.first))
            return false;
        auto& item = entry.second;
        for (const auto& wish : item.wishes) {
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

void LayoutEngine::Impl::updateWishes(const LayoutItem& item, PlacedItem& entry)
{
    const auto& own = variables.at(&item);
    if (std::exchange(entry.wishesAreStale, false)) {
        const Size size = item.intrinsicContentSize();
        entry.wishes[0].wanted = size.width;
        entry.wishes[1].wanted = size.height;
        entry.wrappedAt = -1;
    }
    updateWish(own.width, entry.wishes[0], item, Axis::Horizontal);
    updateWish(own.height, entry.wishes[1], item, Axis::Vertical);
}

void LayoutEngine::Impl::updateWish(
    LayoutSolver::Variable length, Wish& wish, const LayoutItem& item, Axis axis)
{
    const auto hugging = item.hugging(axis), resistance = item.compressionResistance(axis);
    const bool isKept = wish.hugging == hugging && wish.resistance == resistance;
    wish.hugging = hugging;
    wish.resistance = resistance;
    // An item that resists being shorter than its content, whose length is positive, needs no constraint
    // against negative lengths.
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
    // The wish stays below required, because a required wish could contradict an explicit constraint.
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
    // Constraints of high priority are added first, because most of the others then find their optimum at
    // once.
    std::ranges::stable_sort(additions, [](const auto& a, const auto& b) { return a.priority > b.priority; });
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
        const auto active = std::ranges::find_if(rules, isIt);
        if (active == rules.end())
            continue;
        active->second.id.reset();
        if (const auto constraint = active->second.constraint.lock())
            op.warning("Given up, as it contradicts other required constraints: %{public}@",
                constraint->description());
    }
}

/// Asks items whose height depends on their width again where the width has changed. Answers whether a height
/// changed.
bool LayoutEngine::Impl::updateWrappedHeights()
{
    bool isAnother = false;
    for (const auto& item : tree) {
        const auto found = placed.find(item.get());
        if (found == placed.end() || !item->wrapsContent())
            continue;
        auto& entry = found->second;
        const double width = solver.value(variables.at(item.get()).width);
        if (width <= 0 || std::abs(width - entry.wrappedAt) < tolerance)
            continue;
        entry.wrappedAt = width;
        const double height = item->intrinsicContentSize(width).height;
        if (std::abs(height - entry.wishes[1].wanted) < tolerance)
            continue;
        entry.wishes[1].wanted = height;
        updateWish(variables.at(item.get()).height, entry.wishes[1], *item, Axis::Vertical);
        isAnother = true;
    }
    return isAnother;
}

Rect LayoutEngine::Impl::solvedFrame(const LayoutItem& item) const
{
    const auto& own = variables.at(&item);
    const double x = solver.value(own.x), y = solver.value(own.y);
    const double left = LayoutItem::roundToPixel(x), top = LayoutItem::roundToPixel(y);
    return {left, top, std::max(0.0, LayoutItem::roundToPixel(x + solver.value(own.width)) - left),
        std::max(0.0, LayoutItem::roundToPixel(y + solver.value(own.height)) - top)};
}

void LayoutEngine::Impl::applyFrames()
{
    for (const auto& item : tree) {
        if (item.get() != &root && placed.contains(item.get()))
            item->setFrame(solvedFrame(*item));
    }
}

void LayoutEngine::Impl::layOutContents()
{
    // The list is copied, because an item may change the tree while it lays out its subviews.
    const auto items = tree;
    for (const auto& item : items) {
        if (!item->_needsLayout)
            continue;
        item->_needsLayout = false;
        item->layOutContent();
    }
}

LayoutEngine::LayoutEngine(LayoutItem& root)
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

void LayoutEngine::intrinsicSizeDidChange(const LayoutItem& item)
{
    const auto found = _impl->placed.find(&item);
    if (found == _impl->placed.end())
        return;
    found->second.wishesAreStale = true;
    _impl->wishesAreStale = true;
}

void LayoutEngine::frameDidChange(const LayoutItem& item)
{
    if (!_impl->hasVariables(item) && _impl->translation.framesUsed().contains(&item))
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
    LayoutItem& root = _impl->root;
    int passes = 0;
    for (; root._treeNeedsLayout && passes < maximumPasses; ++passes) {
        root._treeNeedsLayout = false;
        _impl->synchronize();
        _impl->solve();
        for (int round = 0; round < maximumWrapRounds && _impl->updateWrappedHeights(); ++round)
            _impl->solve();
        _impl->applyFrames();
        _impl->layOutContents();
    }
    if (passes == maximumPasses)
        op.warning("The layout of %{public}@ does not settle", root.debugName());
    const auto inner = _impl->inner;
    for (const auto& item : inner) {
        if (item->_treeNeedsLayout)
            item->engine().layout();
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

} // namespace kit
