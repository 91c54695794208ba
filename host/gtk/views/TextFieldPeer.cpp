// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/views/TextFieldPeer.h"

#include "host/gtk/base/TextLayout.h"
#include "kit/views/TextField.h"
#include "platform/Weakly.h"

#include <algorithm>

namespace host::gtk {

namespace {

kit::TextRange selectionOf(GtkEditable* editable)
{
    int start = 0, end = 0;
    if (!gtk_editable_get_selection_bounds(editable, &start, &end))
        start = end = gtk_editable_get_position(editable);
    return {static_cast<std::size_t>(start), static_cast<std::size_t>(end - start)};
}

GtkInputHints hints(const kit::TextInputTraits& traits)
{
    int hints = GTK_INPUT_HINT_NONE;
    if (traits.autocorrection == kit::Autocorrection::Off)
        hints |= GTK_INPUT_HINT_NO_SPELLCHECK;
    if (traits.capitalization == kit::Capitalization::Words)
        hints |= GTK_INPUT_HINT_UPPERCASE_WORDS;
    else if (traits.capitalization == kit::Capitalization::Sentences)
        hints |= GTK_INPUT_HINT_UPPERCASE_SENTENCES;
    if (traits.isSecret)
        hints |= GTK_INPUT_HINT_NO_SPELLCHECK | GTK_INPUT_HINT_NO_EMOJI | GTK_INPUT_HINT_PRIVATE;
    return static_cast<GtkInputHints>(hints);
}

} // namespace

TextFieldPeer::TextFieldPeer(
    std::shared_ptr<PeerContext> context, const std::shared_ptr<kit::TextField>& field)
    : ViewPeer(std::move(context), field)
    , _field(field)
{
    auto* entry = gtk_entry_new();
    gtk_editable_set_width_chars(GTK_EDITABLE(entry), 1);
    setNative(entry);
    connectEvents();
}

void TextFieldPeer::connectEvents()
{
    auto* entry = native();
    _onChanged = connectSignal<void()>(entry, "changed", [this] { edited(); });
    _onCursor = connectNotify(entry, "notify::cursor-position", [this] { selectionMoved(); });
    _onBound = connectNotify(entry, "notify::selection-bound", [this] { selectionMoved(); });
    connect(connectSignal<void()>(entry, "activate", [this] { returnPressed(); }));
    connect(connectSignal<void(GtkEntryIconPosition)>(entry, "icon-release",
        [entry](GtkEntryIconPosition) { gtk_editable_set_text(GTK_EDITABLE(entry), ""); }));
    auto* focus = gtk_event_controller_focus_new();
    gtk_widget_add_controller(entry, focus);
    connect(connectSignal<void()>(focus, "enter", [this] { entered(); }));
    connect(connectSignal<void()>(focus, "leave", [this] { left(); }));
}

void TextFieldPeer::viewDidChange(kit::View& view, kit::ViewChanges changes)
{
    ViewPeer::viewDidChange(view, changes);
    const auto field = _field.lock();
    if (_isEntering && field && changes.contains(kit::ViewChange::Selection))
        _wantedSelection = field->selectedRange();
}

/// The entry selects its text, or puts the caret where it was clicked, after it has got the focus. What the
/// field's delegate has selected then counts all the same.
void TextFieldPeer::entered()
{
    const auto keepsSelf = shared_from_this();
    const auto field = _field.lock();
    if (!field)
        return;
    _isEntering = true;
    _wantedSelection.reset();
    field->userFocused();
    _isEntering = false;
    if (!_wantedSelection)
        return;
    context().scheduler().schedule(
        &_wantedSelection, platform::weakly(this, [range = *_wantedSelection](TextFieldPeer& self) {
            if (const auto entered = self._field.lock())
                entered->setSelectedRange(range);
        }));
}

/// The focus also leaves a field whose window is not the active one any more, or over which an alert lies. It
/// comes back to that field afterwards, so the editing goes on.
void TextFieldPeer::left()
{
    const auto keepsSelf = shared_from_this();
    auto* root = gtk_widget_get_root(native());
    auto* focused = root ? gtk_root_get_focus(root) : nullptr;
    const bool isKept = focused && (focused == native() || gtk_widget_is_ancestor(focused, native()));
    if (isKept && GTK_IS_WINDOW(root) && !gtk_window_is_active(GTK_WINDOW(root)))
        return;
    for (auto* widget = native(); widget; widget = gtk_widget_get_parent(widget)) {
        if (!gtk_widget_get_can_focus(widget))
            return;
    }
    const auto field = _field.lock();
    if (!field || !field->userLeft())
        return;
    // A selection that stays visible looks as if the next key would replace it.
    const int caret = gtk_editable_get_position(GTK_EDITABLE(native()));
    gtk_editable_select_region(GTK_EDITABLE(native()), caret, caret);
}

void TextFieldPeer::edited()
{
    const auto keepsSelf = shared_from_this();
    const auto field = _field.lock();
    if (!field)
        return;
    auto* editable = GTK_EDITABLE(native());
    if (!field->userEdited(gtk_editable_get_text(editable), selectionOf(editable)))
        showAnew();
    mirrorClearButton(*field);
}

void TextFieldPeer::selectionMoved()
{
    const auto field = _field.lock();
    auto* editable = GTK_EDITABLE(native());
    // During an edit the entry moves its caret before it reports the new text, so the selection counts only
    // when the texts agree.
    if (field && field->text() == gtk_editable_get_text(editable))
        field->userSelected(selectionOf(editable));
}

void TextFieldPeer::returnPressed()
{
    const auto keepsSelf = shared_from_this();
    const auto field = _field.lock();
    if (field && field->userPressedReturn() && _onReturn)
        _onReturn();
}

void TextFieldPeer::mirror(kit::View& shown, kit::ViewChanges changes)
{
    ViewPeer::mirror(shown, changes);
    const auto field = _field.lock();
    if (!field)
        return;
    if (changes.contains(kit::ViewChange::Content))
        mirrorContent(*field);
    if (changes.contains(kit::ViewChange::Content) || changes.contains(kit::ViewChange::Selection))
        mirrorText(*field);
}

void TextFieldPeer::mirrorContent(const kit::TextField& field)
{
    auto* entry = GTK_ENTRY(native());
    const auto& traits = field.inputTraits();
    gtk_entry_set_placeholder_text(entry, field.placeholder().c_str());
    gtk_entry_set_input_hints(entry, hints(traits));
    gtk_entry_set_input_purpose(
        entry, traits.isSecret ? GTK_INPUT_PURPOSE_PASSWORD : GTK_INPUT_PURPOSE_FREE_FORM);
    gtk_entry_set_visibility(entry, !traits.isSecret);
    gtk_entry_set_attributes(entry, TextLayout::attributes(context().theme(), field.font(), nullptr).get());
    if (field.fieldStyle() == kit::FieldStyle::Plain)
        gtk_widget_add_css_class(native(), "plain-field");
    else
        gtk_widget_remove_css_class(native(), "plain-field");
    mirrorClearButton(field);
    gtk_editable_set_alignment(
        GTK_EDITABLE(entry), field.alignment() == kit::TextAlignment::Center ? 0.5F : 0.0F);
    const auto& label = field.accessibility().label;
    const auto& name = label.empty() ? field.placeholder() : label;
    if (!name.empty())
        setAccessibleName(name);
}

void TextFieldPeer::mirrorClearButton(const kit::TextField& field)
{
    const bool clears = field.inputTraits().clearButton == kit::ClearButton::WhileEditing && field.isEditing()
        && !field.text().empty();
    gtk_entry_set_icon_from_icon_name(
        GTK_ENTRY(native()), GTK_ENTRY_ICON_SECONDARY, clears ? "edit-clear-symbolic" : nullptr);
    // The entry keeps the room of an icon that is not there, and its text is then beside the middle.
    for (auto* child = gtk_widget_get_first_child(native()); child;
         child = gtk_widget_get_next_sibling(child)) {
        if (GTK_IS_IMAGE(child))
            gtk_widget_set_visible(child, clears);
    }
}

void TextFieldPeer::setAccessibleName(const std::string& name)
{
    gtk_accessible_update_property(GTK_ACCESSIBLE(native()), GTK_ACCESSIBLE_PROPERTY_LABEL, name.c_str(), -1);
}

void TextFieldPeer::mirrorText(const kit::TextField& field)
{
    const SignalBlock changed(_onChanged), cursor(_onCursor), bound(_onBound);
    auto* editable = GTK_EDITABLE(native());
    if (field.text() != gtk_editable_get_text(editable))
        gtk_editable_set_text(editable, field.text().c_str());
    const auto range = field.selectedRange();
    if (!(range == selectionOf(editable)))
        gtk_editable_select_region(
            editable, static_cast<int>(range.location), static_cast<int>(range.location + range.length));
}

bool TextFieldPeer::grabFocus()
{
    auto* text = gtk_editable_get_delegate(GTK_EDITABLE(native()));
    const bool taken = gtk_text_grab_focus_without_selecting(GTK_TEXT(text));
    if (const auto field = _field.lock())
        mirrorText(*field);
    return taken;
}

std::optional<platform::Size> TextFieldPeer::nativeSize(const kit::View&, double /*maxWidth*/)
{
    int height = 0;
    gtk_widget_measure(native(), GTK_ORIENTATION_VERTICAL, -1, nullptr, &height, nullptr, nullptr);
    return platform::Size{kit::View::noIntrinsicMetric, static_cast<double>(height)};
}

} // namespace host::gtk
