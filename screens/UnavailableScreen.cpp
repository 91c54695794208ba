// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/UnavailableScreen.h"

#include "platform/Localization.h"
#include "screens/PlaceholderView.h"
#include "screens/PlatformNames.h"

namespace screens {

std::shared_ptr<UnavailableScreen> UnavailableScreen::create()
{
    return std::make_shared<UnavailableScreen>();
}

UnavailableScreen::UnavailableScreen()
{
    setTitle(localized("Tarrow Drive"));
}

void UnavailableScreen::loadView()
{
    const auto placeholder = PlaceholderView::create();
    placeholder->setContent({
        .iconName = "avatar-default-symbolic",
        .title = localized("You are not signed in"),
        .message = localized("Sign in to your drive’s account. Your folders and "
                             "documents appear here as soon as you are signed in."),
    });
    setView(placeholder);
}

} // namespace screens
