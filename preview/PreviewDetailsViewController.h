// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/LaunchUtils.h"
#include "kit/layout/LayoutConstraint.h"
#include "kit/values/Animation.h"
#include "kit/values/Menu.h"
#include "kit/views/TextFieldDelegate.h"
#include "platform/NotificationCenter.h"
#include "platform/Url.h"
#include "preview/PreviewBaseViewController.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace kit {
class Button;
class StackView;
class TextField;
} // namespace kit
namespace platform {
class Error;
}

namespace tarrow {

class DRItem;
class FileInfoStackView;
class HairlineView;
class ItemChange;
class PieProgressIndicatorView;
class ThumbnailImageView;

/// Shows one item: its thumbnail, its name, which can be edited in place, and its facts. An upright screen
/// has one column, a lying one has the thumbnail beside the rest. Main thread only.
///
/// A changed name is given to the item on a queue, because the item may be locked by another program. The
/// field stays in editing until the answer comes.
class PreviewDetailsViewController : public PreviewBaseViewController, public kit::TextFieldDelegate {
public:
    using View = std::shared_ptr<kit::View>;
    using Stack = std::shared_ptr<kit::StackView>;

    // These are null before the view is loaded.
    const std::shared_ptr<ThumbnailImageView>& thumbnailView() const { return _thumbnailView; }
    const std::shared_ptr<kit::TextField>& filenameTextField() const { return _filenameTextField; }
    const std::shared_ptr<FileInfoStackView>& fileInfoView() const { return _fileInfoView; }
    const Stack& mainStackView() const { return _mainStackView; }
    const Stack& filenameStackView() const { return _filenameStackView; }
    const Stack& fileDetailsView() const { return _fileDetailsView; }
    /// Answers null without an app that opens the document, and until it was looked up.
    const std::shared_ptr<kit::Button>& openInAppButton() const { return _openInAppButton; }
    /// The field's width is that of its stack and this constant: -16 at rest, 0 while the name is edited.
    const auto& filenameTextFieldFullWidthConstraint() const { return _filenameTextFieldFullWidthConstraint; }
    const kit::LayoutConstraints& portraitConstraints() const { return _portraitConstraints; }
    const kit::LayoutConstraints& landscapeConstraints() const { return _landscapeConstraints; }
    /// The name as it was shown or given last. Cancelling restores it.
    const std::string& originalFilename() const { return _originalFilename; }
    /// The bar's right items to be shown again when the name is no longer edited.
    const kit::BarButtonItems& originalRightBarButtonItems() const { return _originalRightBarButtonItems; }
    /// Shows the progress of the item's download; hidden while there is none.
    const std::shared_ptr<PieProgressIndicatorView>& downloadView() const { return _downloadView; }

    void viewDidLoad() override;
    void viewWillAppear(bool animated) override;
    void viewWillDisappear(bool animated) override;
    void viewWillTransitionToSizeWithTransitionCoordinator(
        platform::Size size, kit::TransitionCoordinator& coordinator) override;
    void traitsDidChange(const kit::TraitCollection& previous) override;
    std::shared_ptr<kit::Button> openInAppNavControllerButton() override;
    void refreshItem() override;
    /// What a person was doing on the screen.
    struct Progress {
        platform::Point scrolledTo;
        std::optional<std::string> typedName; ///< a name that is being typed and was not given to the item
        kit::TextRange selection; ///< in the typed name
        std::string givenName; ///< the name that was given to the item here last; empty: none
    };
    Progress progress() const;
    /// Goes on where another screen of the same item was. The screen is on the stack already.
    void continueAt(const Progress& progress);

    // Layout.
    void setupViewsAndConstraints();
    Stack buildStackViewForFilenameWithHairlines();
    Stack buildFileDetailsStackView();
    static Stack buildVerticalStackWithSubviewsSpacing(const std::vector<View>& subviews, double spacing);
    /// Makes a view as wide as its container and gives it the container's top, and its bottom as well.
    static void stretchSubviewWithinViewIncludeBottom(
        const View& subview, const View& view, bool includeBottom);
    /// Answers two constraints, not active yet, that give a view the container's centre and width.
    static kit::LayoutConstraints stretchSubviewWidthWithinView(const View& subview, const View& view);
    void setupPortraitConstraints();
    void setupLandscapeConstraints();
    /// Takes the number of an InterfaceOrientation.
    void adjustViewsForOrientation(int orientation);
    /// Answers whether the button stands among the facts and not in the navigation bar.
    bool shouldDisplayOpenInAppButtonInView() const;

    // Renaming in place.
    bool textFieldShouldBeginEditing(kit::TextField& field) override;
    void textFieldDidBeginEditing(kit::TextField& field) override;
    bool textFieldShouldEndEditing(kit::TextField& field) override;
    void textFieldDidEndEditing(kit::TextField& field) override;
    bool textFieldShouldReturn(kit::TextField& field) override;
    bool textFieldShouldChangeCharactersInRangeReplacementString(
        kit::TextField& field, const kit::TextRange& range, const std::string& replacement) override;
    void updateNavBarForRename(bool renaming);
    void forceRenameCancel();
    void forceRenameDone();
    void viewWasTapped();

    // The keyboard on the screen.
    void registerForKeyboardNotifications();
    void unregisterForKeyboardNotifications();
    void keyboardWillBeShown(const platform::PropertyDictionary& notice);
    void keyboardWillBeHidden(const platform::PropertyDictionary& notice);
    /// Answers how much of the content lies below the columns; points.
    double _mainStackViewContentViewYDifference() const;
    static void _animateWithKeyboardInfoDictionaryAnimationBlock(
        const platform::PropertyDictionary& notice, const std::function<void()>& animation);

protected:
    void showRightBarButtonItems(kit::BarButtonItems items) override;
    double contentHeight(double available) const override;

private:
    std::shared_ptr<PreviewDetailsViewController> self();
    std::shared_ptr<DRItem> item() const;
    void offerMenu();
    kit::Menu menu();
    void editTags();
    void lookUpApp();
    void offerApp(const LaunchUtils::DocumentFacts& facts);
    void placeOpenInAppButton();
    void makeDownloadView();
    void showDownload();
    void rename(const platform::Url& url, const std::string& name);
    void renameEnded(const std::string& name, const std::optional<platform::Error>& error);

    std::shared_ptr<ThumbnailImageView> _thumbnailView;
    std::shared_ptr<kit::TextField> _filenameTextField;
    std::shared_ptr<FileInfoStackView> _fileInfoView;
    std::shared_ptr<kit::LayoutConstraint> _filenameTextFieldFullWidthConstraint;
    Stack _mainStackView, _filenameStackView, _fileDetailsView;
    kit::LayoutConstraints _portraitConstraints, _landscapeConstraints, _openInConstraints;
    std::shared_ptr<kit::Button> _openInAppButton;
    std::shared_ptr<HairlineView> _openInHairline;
    std::shared_ptr<PieProgressIndicatorView> _downloadView;
    std::string _originalFilename;
    kit::BarButtonItems _originalRightBarButtonItems;
    std::shared_ptr<ItemChange> _renaming; ///< the change that gives the item its new name; null: none
    std::string _givenName; ///< see Progress
    bool _barIsForRename = false; ///< the bar shows Cancel and Done
    bool _endsWhenRenamed = false; ///< the user asked for the end of the editing
    std::vector<platform::Observation> _keyboardObservations;
    platform::Observation _onDownloads;
    const std::shared_ptr<platform::LatestLook> _appLook = std::make_shared<platform::LatestLook>();
};

} // namespace tarrow
