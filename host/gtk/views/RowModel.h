// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ObjectRef.h"

#include <gio/gio.h>

#include <span>

namespace host::gtk {

/// The rows of a list as a GListModel: a count, and an empty object for each row that is asked for.
namespace RowModel {

ObjectRef<GListModel> make();
/// Tells the widgets which rows were removed and inserted. `position` and `removed` are indexes in the old
/// rows. `leaving` are objects of removed rows, which live until the call ends. Inserted rows get them, and
/// with them their widgets, because filling a widget is much cheaper than making one.
void splice(GListModel* model, guint position, guint removed, guint inserted,
    std::span<const ObjectRef<GObject>> leaving = {});
/// Appends the rows that the widgets do not know of yet.
void complete(GListModel* model, guint count);
/// Replaces all rows.
void reset(GListModel* model, guint count);

} // namespace RowModel

} // namespace host::gtk
