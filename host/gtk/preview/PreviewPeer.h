// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ObjectRef.h"
#include "host/gtk/base/PeerContext.h"
#include "screens/preview/PreviewView.h"

#include <gtk/gtk.h>

#include <memory>

namespace host::gtk {

class PreviewModule;

/// Shows a previewed document's view with a native widget, and lives as long as the widget. Main thread only.
class PreviewPeer : public screens::PreviewViewObserver, public std::enable_shared_from_this<PreviewPeer> {
public:
    virtual GtkWidget* widget() const = 0;
    /// Shows the view for the first time.
    virtual void start() = 0;

protected:
    /// Adds Ctrl+F and the keys for the zoom. They work wherever the focus is in the window while the widget
    /// is visible.
    static void addShortcuts(GtkWidget* widget, const std::weak_ptr<screens::PreviewView>& view);
};

/// Registers makers for the views of previewed documents with a context.
void addPreviewMakers(PeerContext& context, const std::shared_ptr<PreviewModule>& previews);

} // namespace host::gtk
