// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/NavigationController.h"
#include "platform/Url.h"
#include "screens/PlatformNames.h"

#include <memory>
#include <vector>

namespace screens {

class DrivePlaces;
class MoveTargetPicker;
class MoveTargetScreen;

/// Is told which destination the user chose. Main thread only.
class MoveTargetPickerDelegate {
public:
    virtual ~MoveTargetPickerDelegate() = default;

    /// The user chose a destination folder. Called at most once for each picker. The picker stays until the
    /// delegate dismisses it, and moves nothing itself.
    virtual void documentTargetSelectionControllerDidSelectItemAtURL(
        const std::shared_ptr<MoveTargetPicker>& picker, const Url& folder) = 0;
    /// The user left without a choice. The picker is dismissed already.
    virtual void documentTargetSelectionControllerWasCancelled(const std::shared_ptr<MoveTargetPicker>&) { }
};

/// The folders that a picker offers: those of the container in which the items lie, or of every container.
enum class MoveTargetScope { Container, AllContainers };

/// The screens in which the user chooses the destination folder of a move: a separate stack of folder lists
/// that starts in the items' folder and follows changes. A folder that is to be moved is dimmed and cannot be
/// entered, and the items' own folder cannot be chosen. Main thread only.
class MoveTargetPicker : public kit::NavigationController {
public:
    /// All items are of one folder. With no item the picker starts at the drive's top level and offers no
    /// choice.
    static std::shared_ptr<MoveTargetPicker> initWithItemsScope(
        std::vector<Url> items, MoveTargetScope scope);
    /// Makes the same from places that were looked up, and looks at nothing itself.
    static std::shared_ptr<MoveTargetPicker> initWithItemsScopePlaces(
        std::vector<Url> items, MoveTargetScope scope, std::shared_ptr<const DrivePlaces> places);
    /// Answers the folders whose places a picker for these items needs.
    static std::vector<Url> foldersToLookUp(const std::vector<Url>& items);

    MoveTargetPicker(
        std::vector<Url> items, MoveTargetScope scope, std::shared_ptr<const DrivePlaces> places);

    const std::vector<Url>& itemsToMove() const { return _itemsToMove; }
    MoveTargetScope scope() const { return _scope; }
    const DrivePlaces& places() const { return *_places; }
    const std::shared_ptr<const DrivePlaces>& sharedPlaces() const { return _places; }
    void setDelegate(std::weak_ptr<MoveTargetPickerDelegate> delegate) { _delegate = std::move(delegate); }

    /// Answers whether a folder lies within the picker's scope.
    bool offers(const Url& folder) const;
    /// Answers whether a folder is one of the items or lies in one.
    bool isToBeMoved(const Url& folder) const;
    /// Answers whether the items can be moved into a folder.
    bool canChoose(const Url& folder) const;

    // The screens report the user's steps through these.
    void enter(const Url& folder); ///< one level down
    void show(const Url& folder); ///< opens the whole path to a folder, in place of the stack
    void choose(const Url& folder);
    void cancel();

    void userCancelled() override;

private:
    std::shared_ptr<MoveTargetPicker> self();
    std::shared_ptr<MoveTargetScreen> makeScreen(const Url& folder);
    /// Answers the folders from the first screen down to a folder, or nothing when the picker does not lead
    /// there.
    std::vector<Url> wayTo(const Url& folder) const;

    std::vector<Url> _itemsToMove;
    MoveTargetScope _scope;
    std::shared_ptr<const DrivePlaces> _places;
    std::weak_ptr<MoveTargetPickerDelegate> _delegate;
    bool _hasEnded = false;
};

} // namespace screens
