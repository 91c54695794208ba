// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/views/ListRowWidget.h"

#include "host/gtk/base/ImagePaint.h"
#include "host/system/drawing/CairoCanvas.h"

#include <algorithm>
#include <memory>
#include <numbers>
#include <string_view>

namespace {

constexpr int iconSize = 40, smallIconSize = 16;
constexpr float markMargin = 8; ///< points beside a check mark in which a touch still counts
constexpr int dotHeight = 10;

/// The parts of a row, from its leading edge to its trailing one.
enum Part { Check, Icon, Texts, Dots, Download, Progress, Chevron, Menu, partCount };

struct TrwListRow {
    GtkWidget parent;
    GtkListItem* item; ///< owns this widget
    GtkWidget* parts[partCount]; ///< made on first use, because 205 rows live beside the visible ones
    GtkWidget *title, *detail;
    kit::ListRow* shown;
    host::gtk::ListRowWidget::Handler* handler;
    bool isFilled;
};

struct TrwListRowClass {
    GtkWidgetClass parent;
};

G_DEFINE_TYPE(TrwListRow, trw_list_row, GTK_TYPE_WIDGET)

TrwListRow* rowOf(gpointer widget)
{
    return static_cast<TrwListRow*>(widget);
}

void activate(GtkWidget* widget, const char*, GVariant*)
{
    gtk_widget_activate_action(
        widget, "list.activate-item", "u", gtk_list_item_get_position(rowOf(widget)->item));
}

void request(GtkWidget* widget, const char* action, GVariant*)
{
    using host::gtk::ListRowWidget::Request;
    const bool isMenu = std::string_view(action) == "row.menu";
    (*rowOf(widget)->handler)(widget, isMenu ? Request::Menu : Request::Peek,
        gtk_widget_get_width(widget) / 2.0, gtk_widget_get_height(widget) / 2.0);
}

void menuPressed(GtkButton* button, gpointer data)
{
    auto* widget = static_cast<GtkWidget*>(data);
    double x = 0, y = 0;
    gtk_widget_translate_coordinates(GTK_WIDGET(button), widget,
        gtk_widget_get_width(GTK_WIDGET(button)) / 2.0, gtk_widget_get_height(GTK_WIDGET(button)) / 2.0, &x,
        &y);
    (*rowOf(widget)->handler)(widget, host::gtk::ListRowWidget::Request::Menu, x, y);
}

void removeParts(TrwListRow* row)
{
    while (GtkWidget* child = gtk_widget_get_first_child(GTK_WIDGET(row)))
        gtk_widget_unparent(child);
    std::ranges::fill(row->parts, nullptr);
    row->title = row->detail = nullptr;
    row->isFilled = false;
}

void dispose(GObject* object)
{
    removeParts(rowOf(object));
    G_OBJECT_CLASS(trw_list_row_parent_class)->dispose(object);
}

void finalize(GObject* object)
{
    delete rowOf(object)->shown;
    delete rowOf(object)->handler;
    G_OBJECT_CLASS(trw_list_row_parent_class)->finalize(object);
}

void drawDots(GtkDrawingArea*, cairo_t* cairo, int /*width*/, int /*height*/, gpointer data)
{
    host::system::CairoCanvas canvas(cairo);
    kit::TagDots::draw(canvas, rowOf(data)->shown->tagDots, dotHeight);
}

void drawProgress(GtkDrawingArea* area, cairo_t* cairo, int width, int height, gpointer data)
{
    GdkRGBA color;
    gtk_style_context_get_color(gtk_widget_get_style_context(GTK_WIDGET(area)), &color);
    const double radius = std::min(width, height) / 2.0 - 1, turn = 2 * std::numbers::pi;
    const double start = -turn / 4, done = std::clamp(rowOf(data)->shown->downloadProgress, 0.0, 1.0);
    cairo_set_line_width(cairo, 1);
    gdk_cairo_set_source_rgba(cairo, &color);
    cairo_arc(cairo, width / 2.0, height / 2.0, radius, 0, turn);
    cairo_stroke(cairo);
    cairo_move_to(cairo, width / 2.0, height / 2.0);
    cairo_arc(cairo, width / 2.0, height / 2.0, radius, start, start + turn * done);
    cairo_fill(cairo);
}

void trw_list_row_class_init(TrwListRowClass* type)
{
    G_OBJECT_CLASS(type)->dispose = dispose;
    G_OBJECT_CLASS(type)->finalize = finalize;
    auto* widget = GTK_WIDGET_CLASS(type);
    gtk_widget_class_set_layout_manager_type(widget, GTK_TYPE_BOX_LAYOUT);
    gtk_widget_class_set_accessible_role(widget, GTK_ACCESSIBLE_ROLE_BUTTON);
    gtk_widget_class_set_css_name(widget, "kit-row");
    gtk_widget_class_install_action(widget, "row.menu", nullptr, request);
    gtk_widget_class_install_action(widget, "row.peek", nullptr, request);
    // The last action is the first that assistive technology sees and the one that it performs by default.
    gtk_widget_class_install_action(widget, "row.activate", nullptr, activate);
}

GtkWidget* label(const char* styleClass, PangoEllipsizeMode ellipsize)
{
    auto* made = gtk_label_new(nullptr);
    gtk_label_set_xalign(GTK_LABEL(made), 0);
    gtk_label_set_ellipsize(GTK_LABEL(made), ellipsize);
    gtk_widget_add_css_class(made, styleClass);
    return made;
}

GtkWidget* drawing(TrwListRow* row, GtkDrawingAreaDrawFunc draw, int width, int height)
{
    auto* area = gtk_drawing_area_new();
    gtk_drawing_area_set_content_width(GTK_DRAWING_AREA(area), width);
    gtk_drawing_area_set_content_height(GTK_DRAWING_AREA(area), height);
    gtk_drawing_area_set_draw_func(GTK_DRAWING_AREA(area), draw, row, nullptr);
    return area;
}

GtkWidget* texts(TrwListRow* row)
{
    auto* box = gtk_box_new(GTK_ORIENTATION_VERTICAL, 2);
    gtk_widget_set_hexpand(box, TRUE);
    row->title = label("title", PANGO_ELLIPSIZE_MIDDLE);
    row->detail = label("detail", PANGO_ELLIPSIZE_END);
    gtk_box_append(GTK_BOX(box), row->title);
    gtk_box_append(GTK_BOX(box), row->detail);
    return box;
}

GtkWidget* checkMark()
{
    auto* check = gtk_check_button_new();
    gtk_widget_add_css_class(check, "selection-mode");
    gtk_widget_set_can_target(check, FALSE);
    gtk_widget_set_focusable(check, FALSE);
    return check;
}

/// The row's own keys open the menu, so the button is for touches, clicks and assistive technology only.
GtkWidget* menuButton(TrwListRow* row)
{
    auto* button = gtk_button_new_from_icon_name("view-more-symbolic");
    gtk_button_set_has_frame(GTK_BUTTON(button), FALSE);
    gtk_widget_add_css_class(button, "row-menu");
    gtk_widget_set_focusable(button, FALSE);
    gtk_widget_set_focus_on_click(button, FALSE);
    g_signal_connect(button, "clicked", G_CALLBACK(menuPressed), row);
    return button;
}

GtkWidget* makePart(TrwListRow* row, Part part)
{
    switch (part) {
    case Check:
        return checkMark();
    case Icon:
        return gtk_image_new();
    case Texts:
        return texts(row);
    case Dots:
        return drawing(row, drawDots, dotHeight, dotHeight);
    case Download:
        return gtk_image_new_from_icon_name("trw-in-cloud-symbolic");
    case Progress:
        return drawing(row, drawProgress, smallIconSize, smallIconSize);
    case Menu:
        return menuButton(row);
    default:
        return gtk_image_new_from_icon_name("go-next-symbolic");
    }
}

/// Inserts a new part behind the parts before it.
void insert(TrwListRow* row, Part part, GtkWidget* made)
{
    GtkWidget* before = nullptr;
    for (int i = 0; i < part; ++i)
        before = row->parts[i] ? row->parts[i] : before;
    gtk_widget_set_valign(made, GTK_ALIGN_CENTER);
    if (part == Download || part == Progress || part == Chevron)
        gtk_widget_add_css_class(made, "dim-label");
    gtk_widget_insert_after(made, GTK_WIDGET(row), before);
    row->parts[part] = made;
}

/// Shows or hides a part. Answers null when it is not wanted and was never made.
GtkWidget* showPart(TrwListRow* row, Part part, bool wanted)
{
    if (wanted && !row->parts[part])
        insert(row, part, makePart(row, part));
    else if (row->parts[part])
        gtk_widget_set_visible(row->parts[part], wanted);
    return row->parts[part];
}

void trw_list_row_init(TrwListRow* row)
{
    row->shown = new kit::ListRow();
    // A name of many combining marks would be higher than the row, so it is clipped.
    gtk_widget_set_overflow(GTK_WIDGET(row), GTK_OVERFLOW_HIDDEN);
}

void showTexts(TrwListRow* row, const kit::ListRow& content)
{
    gtk_label_set_label(GTK_LABEL(row->title), content.title.c_str());
    gtk_label_set_label(GTK_LABEL(row->detail), content.detail.c_str());
    gtk_widget_set_visible(row->detail, !content.detail.empty());
}

void showMarks(TrwListRow* row, const kit::ListRow& content)
{
    const bool isEditing = content.check != kit::CheckState::None;
    if (auto* check = showPart(row, Check, isEditing))
        gtk_check_button_set_active(GTK_CHECK_BUTTON(check), content.check == kit::CheckState::On);
    showPart(row, Download, content.download == kit::DownloadState::InCloud);
    if (auto* progress = showPart(row, Progress, content.download == kit::DownloadState::Downloading))
        gtk_widget_queue_draw(progress);
    showPart(row, Chevron, content.accessory == kit::RowAccessory::Disclosure && !isEditing);
    if (auto* menu = showPart(row, Menu, !content.menuName.empty() && !isEditing))
        gtk_accessible_update_property(
            GTK_ACCESSIBLE(menu), GTK_ACCESSIBLE_PROPERTY_LABEL, content.menuName.c_str(), -1);
    if (auto* dots = showPart(row, Dots, !content.tagDots.empty())) {
        gtk_drawing_area_set_content_width(GTK_DRAWING_AREA(dots),
            static_cast<int>(kit::TagDots::size(content.tagDots.size(), dotHeight).width));
        gtk_widget_queue_draw(dots);
    }
}

void showIcon(TrwListRow* row, const kit::ListRow& content)
{
    auto* icon = showPart(row, Icon, content.image.has_value());
    if (content.image)
        host::gtk::ImagePaint::show(GTK_IMAGE(icon), *content.image, iconSize);
}

void showStyle(TrwListRow* row, const kit::ListRow& content)
{
    const auto setClass = [row](const char* name, bool wanted) {
        if (wanted)
            gtk_widget_add_css_class(GTK_WIDGET(row), name);
        else
            gtk_widget_remove_css_class(GTK_WIDGET(row), name);
    };
    setClass("section", content.kind == kit::RowKind::SectionHeader);
    setClass("dimmed", content.isDimmed);
    setClass("with-menu", row->parts[Menu] && gtk_widget_get_visible(row->parts[Menu]));
    gtk_list_item_set_activatable(row->item, content.kind == kit::RowKind::Item);
}

void showAccessible(TrwListRow* row, const kit::ListRow& content)
{
    std::string name = content.accessibleDescription;
    if (name.empty())
        name = content.detail.empty() ? content.title : content.title + ", " + content.detail;
    gtk_accessible_update_property(GTK_ACCESSIBLE(row), GTK_ACCESSIBLE_PROPERTY_LABEL, name.c_str(), -1);
    // The list item around the row, which has the keyboard focus, gets the same name.
    if (auto* place = gtk_widget_get_parent(GTK_WIDGET(row)))
        gtk_accessible_update_property(
            GTK_ACCESSIBLE(place), GTK_ACCESSIBLE_PROPERTY_LABEL, name.c_str(), -1);
    if (content.check == kit::CheckState::None)
        gtk_accessible_reset_state(GTK_ACCESSIBLE(row), GTK_ACCESSIBLE_STATE_PRESSED);
    else
        gtk_accessible_update_state(GTK_ACCESSIBLE(row), GTK_ACCESSIBLE_STATE_PRESSED,
            content.check == kit::CheckState::On ? GTK_ACCESSIBLE_TRISTATE_TRUE
                                                 : GTK_ACCESSIBLE_TRISTATE_FALSE,
            -1);
}

} // namespace

namespace host::gtk::ListRowWidget {

GtkWidget* make(GtkListItem* item, Handler handler)
{
    auto* row = rowOf(g_object_new(trw_list_row_get_type(), nullptr));
    row->item = item;
    row->handler = new Handler(std::move(handler));
    return GTK_WIDGET(row);
}

bool isRow(GtkWidget* widget)
{
    return G_TYPE_CHECK_INSTANCE_TYPE(widget, trw_list_row_get_type());
}

void reserve(GtkWidget* row, double height)
{
    gtk_widget_set_size_request(row, -1, static_cast<int>(height));
}

void show(GtkWidget* widget, const kit::ListRow& content, double height)
{
    auto* row = rowOf(widget);
    reserve(widget, height);
    if (row->isFilled && *row->shown == content)
        return;
    showPart(row, Texts, true);
    const bool sameIcon = row->isFilled && row->shown->image == content.image;
    *row->shown = content;
    showTexts(row, content);
    showMarks(row, content);
    if (!sameIcon)
        showIcon(row, content);
    showStyle(row, content);
    showAccessible(row, content);
    row->isFilled = true;
}

void announce(GtkWidget* widget, const kit::ListRow& content, double height)
{
    auto* row = rowOf(widget);
    reserve(widget, height);
    if (row->isFilled)
        removeParts(row);
    else if (*row->shown == content)
        return;
    *row->shown = content;
    showStyle(row, content);
    showAccessible(row, content);
}

bool isShown(GtkWidget* row)
{
    return rowOf(row)->isFilled;
}

const kit::ListRow& shown(GtkWidget* row)
{
    return *rowOf(row)->shown;
}

guint position(GtkWidget* row)
{
    return gtk_list_item_get_position(rowOf(row)->item);
}

bool isOnMark(GtkWidget* row, double x)
{
    auto* mark = rowOf(row)->parts[Check];
    graphene_rect_t bounds;
    if (!mark || !gtk_widget_get_visible(mark) || !gtk_widget_compute_bounds(mark, row, &bounds))
        return false;
    const bool isRightToLeft = gtk_widget_get_direction(row) == GTK_TEXT_DIR_RTL;
    return isRightToLeft ? x >= bounds.origin.x - markMargin
                         : x <= bounds.origin.x + bounds.size.width + markMargin;
}

const char* titleText(GtkWidget* row)
{
    return rowOf(row)->isFilled ? gtk_label_get_label(GTK_LABEL(rowOf(row)->title)) : "";
}

} // namespace host::gtk::ListRowWidget
