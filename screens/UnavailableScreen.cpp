// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/UnavailableScreen.h"

#include "platform/Localization.h"
#include "screens/PlatformNames.h"

#include <utility>

namespace screens {

std::shared_ptr<UnavailableScreen> UnavailableScreen::create()
{
    return std::make_shared<UnavailableScreen>(
        PlaceholderView::Content{
            .iconName = "avatar-default-symbolic",
            .title = localized("You are not signed in"),
            .message = localized("Sign in to your drive’s account. Your folders and "
                                 "documents appear here as soon as you are signed in."),
        },
        std::vector<PlaceholderView::Action>());
}

std::shared_ptr<UnavailableScreen> UnavailableScreen::createForMissingDrive(std::function<void()> tryAgain)
{
    return std::make_shared<UnavailableScreen>(
        PlaceholderView::Content{
            .iconName = "dialog-warning-symbolic",
            .title = localized("Your drive cannot be shown"),
            .message = localized("You are signed in, but the folder of your drive cannot be found."),
        },
        std::vector{PlaceholderView::Action{localized("Try Again"), std::move(tryAgain), true}});
}

UnavailableScreen::UnavailableScreen(
    PlaceholderView::Content content, std::vector<PlaceholderView::Action> actions)
    : _content(std::move(content))
    , _actions(std::move(actions))
{
    setTitle(localized("Tarrow Drive"));
}

void UnavailableScreen::loadView()
{
    _placeholder = PlaceholderView::create();
    _placeholder->setContent(_content);
    _placeholder->setActions(_actions);
    setView(_placeholder);
}

} // namespace screens
