// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file offers the previewed document to the account's other devices.

#include "items/DRItem.h"
#include "items/Settings.h"
#include "items/UrlResolution.h"
#include "platform/ActivityHandOver.h"
#include "platform/CloudDocumentService.h"
#include "platform/Dispatch.h"
#include "platform/Log.h"
#include "platform/Services.h"
#include "platform/Weakly.h"
#include "preview/PreviewItemManager.h"

namespace tarrow {

using platform::Operation;
using platform::Result;
using platform::services;
using platform::UserActivity;
using platform::weakly;

namespace {

constexpr Operation op{"-[PreviewItemManager registerBatonneActivity]"};

void logFailure(const Error& error)
{
    // Not every document can be named for other devices, so this failure is expected.
    const bool isExpected =
        error.domain() == platform::errorDomain::cloud && error.code() == platform::notBookmarkableCode;
    if (isExpected)
        op.info("RZBookmarkableStringFromDocumentURL returned %{public}@", error);
    else
        op.error("RZBookmarkableStringFromDocumentURL returned %{public}@", error);
}

} // namespace

std::shared_ptr<const UserActivity> PreviewItemManager::batonneActivity() const
{
    const std::lock_guard lock(_mutex);
    return _batonneActivity;
}

void PreviewItemManager::registerBatonneActivity()
{
    const auto url = itemURL();
    if (!url)
        return;
    services().cloudDocumentService().items().RZBookmarkableStringFromDocumentURL(
        trw_URLByResolvingAlias(*url),
        [weak = weak_from_this(), main = services().dispatch().mainQueue()](
            const Result<std::string>& answer) {
            if (answer.error)
                return logFailure(*answer.error);
            if (!answer.value) {
                op.error("RZBookmarkableStringFromDocumentURL returned empty bookmark");
                return;
            }
            main->async(weakly(weak, [bookmark = *answer.value](PreviewItemManager& self) {
                // Making the bookmark may have taken long, and the item may no longer be presented.
                if (self.filePresenterRegistered())
                    self.registerBatonneActivityForBookmark(bookmark);
            }));
        });
}

void PreviewItemManager::registerBatonneActivityForBookmark(const std::string& bookmark)
{
    if (bookmark.empty())
        return;
    auto activity = std::make_shared<UserActivity>();
    activity->type = Settings::batonneTarrowActivityType();
    activity->isEligibleForHandOff = true;
    activity->userInfo.emplace(platform::activityKey::documentURL, bookmark);
    {
        const std::lock_guard lock(_mutex);
        _batonneActivity = activity;
    }
    auto& handOver = services().activityHandOver();
    handOver.becomeCurrent(activity);
    // A deletion unregisters on another thread and may have happened meanwhile.
    if (batonneActivity() != activity)
        handOver.resignCurrent(activity);
}

void PreviewItemManager::unregisterBatonneActivity()
{
    std::shared_ptr<const UserActivity> activity;
    {
        const std::lock_guard lock(_mutex);
        activity.swap(_batonneActivity);
    }
    if (activity)
        services().activityHandOver().resignCurrent(activity);
}

} // namespace tarrow
