// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/NavigationController.h"
#include "platform/Url.h"
#include "screens/PlatformNames.h"

#include <memory>
#include <vector>

namespace screens {

class MoveTargetPicker;
class MoveTargetScreen;

/// Is told where the items shall go. Main thread only.
class MoveTargetPickerDelegate {
public:
    virtual ~MoveTargetPickerDelegate() = default;

    /// The user chose a destination folder; called at most once for each picker. The picker stays until the
    /// delegate dismisses it, and moves nothing itself.
    virtual void documentTargetSelectionControllerDidSelectItemAtURL(
        const std::shared_ptr<MoveTargetPicker>& picker, const Url& folder) = 0;
    /// The user went away without a choice; the picker is dismissed already.
    virtual void documentTargetSelectionControllerWasCancelled(const std::shared_ptr<MoveTargetPicker>&) { }
};

/// Where a picker may lead to: the folders of the container that the items lie in, or of every container.
enum class MoveTargetScope { Container, AllContainers };

/// The screens in which the destination folder of a move is chosen: a stack of folder lists of its own, which
/// starts in the folder that the items lie in and shows new folders as they appear. A folder that is to be
/// moved is dimmed and cannot be entered; the folder that the items lie in cannot be chosen. Main thread
/// only.
class MoveTargetPicker : public kit::NavigationController {
public:
    /// For items of one folder; with no item the picker starts at the drive's top level and lets nothing be
    /// chosen.
    static std::shared_ptr<MoveTargetPicker> initWithItemsScope(
        std::vector<Url> items, MoveTargetScope scope);

    MoveTargetPicker(std::vector<Url> items, MoveTargetScope scope);

    const std::vector<Url>& itemsToMove() const { return _itemsToMove; }
    MoveTargetScope scope() const { return _scope; }
    void setDelegate(std::weak_ptr<MoveTargetPickerDelegate> delegate) { _delegate = std::move(delegate); }

    /// Whether a folder lies within the picker's scope.
    bool offers(const Url& folder) const;
    /// Whether a folder is one of the items, or lies in one.
    bool isToBeMoved(const Url& folder) const;
    /// Whether the items can go into a folder.
    bool canChoose(const Url& folder) const;

    // The user's steps, as the screens report them.
    void enter(const Url& folder); ///< one level down
    void show(const Url& folder); ///< the whole way to a folder, in place of the stack
    void choose(const Url& folder);
    void cancel();

    void userCancelled() override;

private:
    std::shared_ptr<MoveTargetPicker> self();
    std::shared_ptr<MoveTargetScreen> makeScreen(const Url& folder);
    /// The folders from the first screen down to a folder; empty when the picker does not lead there.
    std::vector<Url> wayTo(const Url& folder) const;

    std::vector<Url> _itemsToMove;
    MoveTargetScope _scope;
    std::weak_ptr<MoveTargetPickerDelegate> _delegate;
    bool _hasEnded = false;
};

} // namespace screens
