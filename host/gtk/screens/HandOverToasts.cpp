// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/screens/HandOverToasts.h"

#include "host/gtk/screens/ToastTitle.h"
#include "platform/CloudDocumentService.h"
#include "platform/Dispatch.h"
#include "platform/Localization.h"
#include "platform/Services.h"
#include "platform/Weakly.h"
#include "screens/DisplayName.h"

#include <algorithm>
#include <utility>

namespace host::gtk {

using platform::ActivityOffer;
using platform::services;
using platform::UserActivity;
using platform::weakly;

namespace {

constexpr int titleLines = 2;

/// Answers the same key for as long as one device shows one document.
std::string keyOf(const ActivityOffer& offer)
{
    return offer.deviceIdentifier + '\n' + offer.document.path();
}

GtkWidget* makeTitle(const ActivityOffer& offer)
{
    using screens::displayName;
    return makeToastTitle(
        platform::localized("“%1$@” on %2$@",
            {displayName(offer.document.lastPathComponent()), displayName(offer.deviceName)}),
        titleLines);
}

std::string bookmarkOf(const UserActivity& activity)
{
    const auto* value = platform::find(activity.userInfo, platform::activityKey::documentURL);
    const auto* text = value ? value->get<std::string>() : nullptr;
    return text ? *text : std::string();
}

} // namespace

std::shared_ptr<HandOverToasts> HandOverToasts::make(
    AdwToastOverlay* overlay, Continue continueActivity, Fail failed)
{
    const auto toasts =
        std::make_shared<HandOverToasts>(overlay, std::move(continueActivity), std::move(failed));
    toasts->_offers = services().notificationCenter().observe(
        platform::Notification::ActivityOffersDidChange, weakly(toasts, &HandOverToasts::refresh));
    toasts->refresh();
    return toasts;
}

HandOverToasts::HandOverToasts(AdwToastOverlay* overlay, Continue continueActivity, Fail failed)
    : _overlay(ObjectRef<AdwToastOverlay>::retain(overlay))
    , _continue(std::move(continueActivity))
    , _fail(std::move(failed))
{
}

HandOverToasts::~HandOverToasts()
{
    takeAway();
}

void HandOverToasts::refresh()
{
    const auto offers = services().activityHandOver().offers();
    std::erase_if(_settled, [&](const auto& key) {
        return std::ranges::none_of(offers, [&](const auto& offer) { return keyOf(offer) == key; });
    });
    const auto latest =
        std::ranges::find_if(offers, [&](const auto& offer) { return !_settled.contains(keyOf(offer)); });
    if (latest != offers.end() && keyOf(*latest) == _shown)
        return;
    takeAway();
    if (latest != offers.end())
        show(*latest);
}

void HandOverToasts::show(const ActivityOffer& offer)
{
    _shown = keyOf(offer);
    _toast = ObjectRef<AdwToast>::retain(adw_toast_new(""));
    adw_toast_set_custom_title(_toast.get(), makeTitle(offer));
    adw_toast_set_button_label(_toast.get(), platform::localized("Continue").c_str());
    adw_toast_set_timeout(_toast.get(), 0);
    _connections.push_back(
        connectSignal<void()>(_toast.get(), "button-clicked", weakly(this, &HandOverToasts::chosen, offer)));
    _connections.push_back(
        connectSignal<void()>(_toast.get(), "dismissed", weakly(this, &HandOverToasts::dismissed)));
    adw_toast_overlay_add_toast(_overlay.get(), _toast.get());
}

void HandOverToasts::dismissed()
{
    _settled.insert(std::exchange(_shown, {}));
    _toast = {};
    refresh();
}

void HandOverToasts::takeAway()
{
    _connections.clear();
    _shown.clear();
    if (const auto toast = std::exchange(_toast, {}))
        adw_toast_dismiss(toast.get());
}

/// Continues with an offered document. The document is looked up first, because it may have gone since it was
/// offered, and the stack must then stay as it is.
void HandOverToasts::chosen(const ActivityOffer& offer)
{
    services().cloudDocumentService().items().decodeBookmark(bookmarkOf(offer.activity),
        [weak = weak_from_this(), activity = offer.activity, main = services().dispatch().mainQueue()](
            const platform::Result<platform::Url>& document) {
            main->async(weakly(weak, [activity, error = document.error](HandOverToasts& self) {
                if (error)
                    self._fail(activity, *error);
                else
                    self._continue(activity);
            }));
        });
}

} // namespace host::gtk
