// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "preview/PreviewDetailsViewController.h"

#include "drawing/ConstraintUtils.h"
#include "drawing/HairlineView.h"
#include "drawing/PieProgressIndicatorView.h"
#include "drawing/ThumbnailImageView.h"
#include "kit/values/Screen.h"
#include "kit/views/Button.h"
#include "kit/views/StackView.h"
#include "kit/views/TextField.h"
#include "preview/FileInfoStackView.h"

#include <algorithm>

namespace tarrow {

using kit::Axis;
using kit::Font;
using kit::InterfaceOrientation;
using kit::LayoutConstraint;
using kit::LayoutConstraints;
using kit::StackAlignment;
using kit::StackDistribution;
using kit::StackView;
using kit::TextField;
namespace LayoutPriorities = kit::LayoutPriorities;

namespace {

// The thumbnail is the first to give up room.
constexpr kit::LayoutPriority thumbnailHugging = LayoutPriorities::defaultLow - 1;
constexpr double fieldHeightToLineHeight = 1.3;
constexpr double hairlineGap = 7, detailsGap = 15; // points
constexpr double titlePointSize = 24;
/// The name and the facts keep half of this from either side; points.
constexpr double sideMargins = 16;
/// An upright screen that has no room for so high a thumbnail (points) scrolls.
constexpr double leastThumbnailHeight = 160;
constexpr double pieSize = 32, pieMargin = 8; // points

Font titleFont()
{
    return Font::preferred(kit::TextStyle::Title2, titlePointSize);
}

bool isLandscape(int orientation)
{
    return orientation == static_cast<int>(InterfaceOrientation::LandscapeLeft)
        || orientation == static_cast<int>(InterfaceOrientation::LandscapeRight);
}

std::shared_ptr<TextField> makeNameField()
{
    auto field = std::make_shared<TextField>();
    field->setDebugName("FilenameTextField");
    field->setPlacedByFrame(false);
    field->setFieldStyle(kit::FieldStyle::Plain);
    field->setInputTraits({.returnKey = kit::ReturnKey::Done,
        .returnKeyNeedsText = true,
        .capitalization = kit::Capitalization::Words,
        .clearButton = kit::ClearButton::WhileEditing});
    field->setCompressionResistance(LayoutPriorities::required, Axis::Horizontal);
    field->setCompressionResistance(LayoutPriorities::required, Axis::Vertical);
    field->setHugging(0, Axis::Horizontal);
    // The height is that of the font before the larger one is set.
    field->heightAnchor()
        .equalToConstant(field->font().lineHeight() * fieldHeightToLineHeight)
        ->setActive(true);
    field->setFont(titleFont());
    return field;
}

} // namespace

PreviewDetailsViewController::Stack PreviewDetailsViewController::buildVerticalStackWithSubviewsSpacing(
    const std::vector<View>& subviews, double spacing)
{
    auto stack = std::make_shared<StackView>(Axis::Vertical);
    stack->setPlacedByFrame(false);
    for (const auto& view : subviews)
        stack->addArrangedSubview(view);
    stack->setDistribution(StackDistribution::Fill);
    stack->setStackAlignment(StackAlignment::Center);
    stack->setSpacing(spacing);
    stack->setHugging(LayoutPriorities::required, Axis::Vertical);
    return stack;
}

void PreviewDetailsViewController::stretchSubviewWithinViewIncludeBottom(
    const View& subview, const View& view, bool includeBottom)
{
    LayoutConstraint::activate(stretchSubviewWidthWithinView(subview, view));
    subview->topAnchor().equalTo(view->topAnchor())->setActive(true);
    if (includeBottom)
        subview->bottomAnchor().equalTo(view->bottomAnchor())->setActive(true);
}

LayoutConstraints PreviewDetailsViewController::stretchSubviewWidthWithinView(
    const View& subview, const View& view)
{
    return {subview->centerXAnchor().equalTo(view->centerXAnchor()),
        subview->widthAnchor().equalTo(view->widthAnchor())};
}

void PreviewDetailsViewController::setupViewsAndConstraints()
{
    _thumbnailView = ThumbnailImageView::initWithFrame({});
    for (const auto axis : {Axis::Horizontal, Axis::Vertical}) {
        _thumbnailView->setHugging(thumbnailHugging, axis);
        _thumbnailView->setCompressionResistance(LayoutPriorities::required, axis);
    }
    _fileDetailsView = buildFileDetailsStackView();
    _mainStackView = buildVerticalStackWithSubviewsSpacing({_thumbnailView, _fileDetailsView}, 0);
    _mainStackView->setDebugName("MainStackView");
    wrapperView()->addSubview(_mainStackView);
    stretchSubviewWithinViewIncludeBottom(_mainStackView, wrapperView(), true);
    setupPortraitConstraints();
    setupLandscapeConstraints();
    makeDownloadView();
    placeOpenInAppButton();
    adjustViewsForOrientation(currentPseudoOrientation());
}

PreviewDetailsViewController::Stack PreviewDetailsViewController::buildStackViewForFilenameWithHairlines()
{
    _filenameTextField = makeNameField();
    _filenameTextField->setDelegate(self());
    const auto above = HairlineView::init(), below = HairlineView::init();
    auto stack = buildVerticalStackWithSubviewsSpacing({above, _filenameTextField, below}, hairlineGap);
    stack->setDebugName("FilenameStackView");
    for (const auto& hairline : {above, below})
        LayoutConstraint::activate(stretchSubviewWidthWithinView(hairline, stack));
    return stack;
}

PreviewDetailsViewController::Stack PreviewDetailsViewController::buildFileDetailsStackView()
{
    _filenameStackView = buildStackViewForFilenameWithHairlines();
    _fileInfoView = FileInfoStackView::initWithFrame({});
    _fileInfoView->setAxis(Axis::Vertical);
    auto stack = buildVerticalStackWithSubviewsSpacing({_filenameStackView, _fileInfoView}, detailsGap);
    stack->setDebugName("FileDetailsView");
    _filenameTextFieldFullWidthConstraint =
        _filenameTextField->widthAnchor().equalTo(_filenameStackView->widthAnchor(), -sideMargins);
    LayoutConstraint::activate({_filenameTextFieldFullWidthConstraint,
        _filenameTextField->centerXAnchor().equalTo(_filenameStackView->centerXAnchor()),
        _fileInfoView->centerXAnchor().equalTo(stack->centerXAnchor()),
        _fileInfoView->widthAnchor().lessThanOrEqualTo(stack->widthAnchor(), -sideMargins)});
    LayoutConstraint::activate(stretchSubviewWidthWithinView(_filenameStackView, stack));
    return stack;
}

/// Puts the button below the facts where it belongs there, and takes it away where it does not. The window
/// may become wide or narrow while the screen is shown.
void PreviewDetailsViewController::placeOpenInAppButton()
{
    if (!_openInAppButton || !_fileDetailsView)
        return;
    const bool isThere = _openInHairline != nullptr;
    if (isThere == shouldDisplayOpenInAppButtonInView())
        return;
    if (isThere) {
        _openInHairline->removeFromSuperview();
        _openInHairline = nullptr;
        _openInAppButton->removeFromSuperview();
        _openInAppButton->setTitleFont(Font::preferred(kit::TextStyle::Body));
        _openInAppButton->setPlacedByFrame(true);
        return;
    }
    _openInHairline = HairlineView::init();
    _openInAppButton->setTitleFont(titleFont());
    for (const auto axis : {Axis::Horizontal, Axis::Vertical})
        _openInAppButton->setCompressionResistance(LayoutPriorities::required, axis);
    _fileDetailsView->addArrangedSubview(_openInHairline);
    _fileDetailsView->addArrangedSubview(_openInAppButton);
    LayoutConstraint::activate(stretchSubviewWidthWithinView(_openInHairline, _fileDetailsView));
}

void PreviewDetailsViewController::makeDownloadView()
{
    _downloadView = PieProgressIndicatorView::initWithFrame({});
    _downloadView->setPlacedByFrame(false);
    _downloadView->setHidden(true);
    wrapperView()->addSubview(_downloadView);
    LayoutConstraint::activate({_downloadView->widthAnchor().equalToConstant(pieSize),
        _downloadView->heightAnchor().equalToConstant(pieSize),
        _downloadView->centerXAnchor().equalTo(_thumbnailView->centerXAnchor()),
        _downloadView->bottomAnchor().equalTo(_thumbnailView->bottomAnchor(), -pieMargin)});
}

void PreviewDetailsViewController::setupPortraitConstraints()
{
    _portraitConstraints = stretchSubviewWidthWithinView(_fileDetailsView, _mainStackView);
    std::ranges::copy(stretchSubviewWidthWithinView(_thumbnailView, _mainStackView),
        std::back_inserter(_portraitConstraints));
}

void PreviewDetailsViewController::setupLandscapeConstraints()
{
    _landscapeConstraints = {_fileDetailsView->centerYAnchor().equalTo(_mainStackView->centerYAnchor()),
        _fileDetailsView->heightAnchor().lessThanOrEqualTo(_mainStackView->heightAnchor()),
        _thumbnailView->heightAnchor().equalTo(_mainStackView->heightAnchor())};
}

void PreviewDetailsViewController::adjustViewsForOrientation(int orientation)
{
    const bool lies = isLandscape(orientation);
    LayoutConstraint::deactivate(lies ? _portraitConstraints : _landscapeConstraints);
    _mainStackView->setAxis(lies ? Axis::Horizontal : Axis::Vertical);
    _mainStackView->setDistribution(lies ? StackDistribution::FillEqually : StackDistribution::Fill);
    for (const auto& stack : {_fileDetailsView, _filenameStackView})
        stack->setStackAlignment(lies ? StackAlignment::Leading : StackAlignment::Center);
    _filenameTextField->setAlignment(lies ? kit::TextAlignment::Natural : kit::TextAlignment::Center);
    LayoutConstraint::activate(lies ? _landscapeConstraints : _portraitConstraints);
}

/// The facts of an item can be higher than a low window. The content then grows, and the screen scrolls.
double PreviewDetailsViewController::contentHeight(double available) const
{
    if (!_fileDetailsView || !parentBottomConstraint())
        return available;
    const bool lies = _mainStackView->axis() == Axis::Horizontal;
    const double column = contentView()->frame().width / (lies ? 2 : 1);
    const double details = _fileDetailsView->systemLayoutSizeFitting({column, 0}).height;
    const double margin = -parentBottomConstraint()->constant();
    return std::max(available, details + margin + (lies ? 0 : leastThumbnailHeight));
}

} // namespace tarrow
