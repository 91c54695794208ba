// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/views/RowModel.h"

namespace {

struct TrwRowModel {
    GObject parent;
    guint count;
    std::span<const host::gtk::ObjectRef<GObject>>
        leaving; ///< objects that inserted rows may take over; only during a splice
};

struct TrwRowModelClass {
    GObjectClass parent;
};

TrwRowModel* rowsOf(gpointer model)
{
    return static_cast<TrwRowModel*>(model);
}

GType itemType(GListModel*)
{
    return G_TYPE_OBJECT;
}

guint itemCount(GListModel* model)
{
    return rowsOf(model)->count;
}

gpointer item(GListModel* model, guint position)
{
    auto& leaving = rowsOf(model)->leaving;
    if (position >= rowsOf(model)->count)
        return nullptr;
    if (leaving.empty())
        return g_object_new(G_TYPE_OBJECT, nullptr);
    auto* reused = leaving.front().get();
    leaving = leaving.subspan(1);
    return g_object_ref(reused);
}

void implementListModel(gpointer type, gpointer)
{
    auto* interface = static_cast<GListModelInterface*>(type);
    interface->get_item_type = itemType;
    interface->get_n_items = itemCount;
    interface->get_item = item;
}

G_DEFINE_TYPE_WITH_CODE(
    TrwRowModel, trw_row_model, G_TYPE_OBJECT, G_IMPLEMENT_INTERFACE(G_TYPE_LIST_MODEL, implementListModel))

void trw_row_model_class_init(TrwRowModelClass*) { }
void trw_row_model_init(TrwRowModel*) { }

} // namespace

namespace host::gtk::RowModel {

ObjectRef<GListModel> make()
{
    return ObjectRef<GListModel>::adopt(G_LIST_MODEL(g_object_new(trw_row_model_get_type(), nullptr)));
}

void splice(GListModel* model, guint position, guint removed, guint inserted,
    std::span<const host::gtk::ObjectRef<GObject>> leaving)
{
    if (removed == 0 && inserted == 0)
        return;
    rowsOf(model)->count = rowsOf(model)->count - removed + inserted;
    rowsOf(model)->leaving = leaving;
    g_list_model_items_changed(model, position, removed, inserted);
    rowsOf(model)->leaving = {};
}

void complete(GListModel* model, guint count)
{
    const guint known = rowsOf(model)->count;
    if (known < count)
        splice(model, known, 0, count - known);
}

void reset(GListModel* model, guint count)
{
    splice(model, 0, rowsOf(model)->count, count);
}

} // namespace host::gtk::RowModel
