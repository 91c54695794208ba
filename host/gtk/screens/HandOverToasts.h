// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ObjectRef.h"
#include "host/gtk/base/SignalConnection.h"
#include "platform/ActivityHandOver.h"
#include "platform/Error.h"
#include "platform/NotificationCenter.h"

#include <adwaita.h>

#include <functional>
#include <memory>
#include <optional>
#include <set>
#include <string>

namespace host::gtk {

/// Shows a toast at the bottom of the window that offers to continue with the document that another device of
/// the account shows. An offer that the user dismissed or took does not come back until the device shows
/// another document. Main thread only.
class HandOverToasts : public std::enable_shared_from_this<HandOverToasts> {
public:
    using Continue = std::function<void(const platform::UserActivity&)>;
    /// Called when the document of an offer that the user took cannot be found any more.
    using Fail = std::function<void(const platform::UserActivity&, const platform::Error&)>;

    /// Shows the current offer and follows the offers of the installed service.
    static std::shared_ptr<HandOverToasts> make(
        AdwToastOverlay* overlay, Continue continueActivity, Fail failed);
    HandOverToasts(AdwToastOverlay* overlay, Continue continueActivity, Fail failed);
    ~HandOverToasts();

    /// Answers the toast on the screen, or null.
    AdwToast* toast() const { return _toast.get(); }

private:
    void refresh();
    void show(const platform::ActivityOffer& offer);
    void dismissed();
    void takeAway();
    void chosen(const platform::ActivityOffer& offer);

    ObjectRef<AdwToastOverlay> _overlay;
    Continue _continue;
    Fail _fail;
    platform::Observation _offers;
    ObjectRef<AdwToast> _toast;
    SignalConnections _connections; ///< connections to the toast
    std::string _shown; ///< key of the offer in the toast
    std::set<std::string> _settled; ///< keys of the offers that the user dismissed or took
};

} // namespace host::gtk
