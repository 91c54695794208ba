#pragma once

#include "host/gtk/ObjectRef.h"

#include <gio/gio.h>

namespace host::gtk {

/// The rows of a list as the toolkit wants them: a count, and an empty object for each row that is looked at.
namespace RowModel {

ObjectRef<GListModel> make();
/// Tells the widgets which rows went and came. `position` and `removed` are of the rows as they were.
void splice(GListModel* model, guint position, guint removed, guint inserted);
/// Adds the rows that the widgets do not know of yet, at the end.
void complete(GListModel* model, guint count);
/// Other rows, whatever they were before.
void reset(GListModel* model, guint count);

} // namespace RowModel

} // namespace host::gtk
