// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ObjectRef.h"

#include <gio/gio.h>

#include <span>

namespace host::gtk {

/// The rows of a list as the toolkit wants them: a count, and an empty object for each row that is looked at.
namespace RowModel {

ObjectRef<GListModel> make();
/// Tells the widgets which rows went and came. `position` and `removed` are of the rows as they were.
/// `leaving` are objects of rows that go, which live until the call ends: rows that come get them, and with
/// them the widgets, which would cost much more to make than to fill anew.
void splice(GListModel* model, guint position, guint removed, guint inserted,
    std::span<const ObjectRef<GObject>> leaving = {});
/// Adds the rows that the widgets do not know of yet, at the end.
void complete(GListModel* model, guint count);
/// Other rows, whatever they were before.
void reset(GListModel* model, guint count);

} // namespace RowModel

} // namespace host::gtk
