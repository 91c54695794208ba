// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "preview/PreviewDetailsViewController.h"

#include "kit/values/KeyboardNotice.h"
#include "kit/views/ScrollView.h"
#include "kit/views/StackView.h"
#include "kit/views/TextField.h"
#include "platform/Services.h"
#include "platform/Weakly.h"

#include <algorithm>

namespace tarrow {

using platform::Notification;
using platform::PropertyDictionary;

namespace {

/// The name field comes to lie this far below the top, and the content ends this far above the keyboard;
/// points.
constexpr double margin = 30;
/// Notices with a higher number have a curve of their own.
constexpr int numberOfCurves = 4;

} // namespace

void PreviewDetailsViewController::registerForKeyboardNotifications()
{
    if (!_keyboardObservations.empty())
        return;
    auto& center = platform::services().notificationCenter();
    _keyboardObservations.push_back(center.observe(Notification::KeyboardWillShow,
        platform::weakly(this, &PreviewDetailsViewController::keyboardWillBeShown)));
    _keyboardObservations.push_back(center.observe(Notification::KeyboardWillHide,
        platform::weakly(this, &PreviewDetailsViewController::keyboardWillBeHidden)));
}

void PreviewDetailsViewController::unregisterForKeyboardNotifications()
{
    _keyboardObservations.clear();
}

double PreviewDetailsViewController::_mainStackViewContentViewYDifference() const
{
    const auto& columns = *_mainStackView;
    const double bottom = columns.convertRect(columns.bounds(), *scrollView()).maxY();
    return std::max(0.0, contentView()->frame().maxY() - bottom);
}

void PreviewDetailsViewController::_animateWithKeyboardInfoDictionaryAnimationBlock(
    const PropertyDictionary& notice, const std::function<void()>& animation)
{
    const auto keyboard = kit::KeyboardNotice::fromUserInfo(notice);
    kit::AnimationOptions options{
        .duration = keyboard.animationDuration, .laysOutSubviews = true, .beginsFromCurrentState = true};
    if (keyboard.animationCurve >= 0 && keyboard.animationCurve < numberOfCurves)
        options.curve = static_cast<kit::AnimationCurve>(keyboard.animationCurve);
    kit::animate(options, animation);
}

void PreviewDetailsViewController::keyboardWillBeShown(const PropertyDictionary& notice)
{
    const double height = kit::KeyboardNotice::fromUserInfo(notice).beginFrame.height;
    auto insets = scrollView()->contentInsets();
    insets.bottom = height - _mainStackViewContentViewYDifference() + margin;
    _animateWithKeyboardInfoDictionaryAnimationBlock(notice, [this, insets] {
        auto& scroll = *scrollView();
        scroll.setContentInsets(insets);
        const auto& field = *_filenameTextField;
        const double fieldTop = field.convertRect(field.bounds(), scroll).y;
        const double lowest =
            std::max(0.0, scroll.contentSize().height - scroll.frame().height + insets.bottom);
        scroll.setContentOffset({0, std::min(lowest, std::max(0.0, fieldTop - insets.top - margin))});
    });
}

void PreviewDetailsViewController::keyboardWillBeHidden(const PropertyDictionary& notice)
{
    _animateWithKeyboardInfoDictionaryAnimationBlock(
        notice, [this] { scrollView()->setContentInsets(scrollViewDefaultEdgeInsets()); });
}

} // namespace tarrow
