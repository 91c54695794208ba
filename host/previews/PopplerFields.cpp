// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/previews/PopplerFields.h"

#include <algorithm>

namespace host::previews {

using platform::FormField;
using platform::Rect;
using Kind = platform::FormField::Kind;

namespace {

struct FoundField {
    FormField field;
    Object<PopplerFormField> handle;
};

/// Answers the rectangles of hidden fields. They are found by their widget annotations, because the library
/// does not say it of a field itself.
std::vector<Rect> hiddenPlaces(PopplerPage* page)
{
    constexpr unsigned unseen = POPPLER_ANNOT_FLAG_HIDDEN | POPPLER_ANNOT_FLAG_NO_VIEW;
    std::vector<Rect> places;
    for (const auto& found : PopplerPages::foundMarks(page)) {
        const bool isWidget = poppler_annot_get_annot_type(found.handle.get()) == POPPLER_ANNOT_WIDGET;
        const auto flags = static_cast<unsigned>(poppler_annot_get_flags(found.handle.get()));
        if (isWidget && (flags & unseen) != 0)
            places.push_back(found.mark.place);
    }
    return places;
}

bool readButton(PopplerFormField* handle, FormField& field)
{
    const auto type = poppler_form_field_button_get_button_type(handle);
    if (type == POPPLER_FORM_BUTTON_PUSH)
        return false;
    field.kind = type == POPPLER_FORM_BUTTON_CHECK ? Kind::CheckBox : Kind::RadioButton;
    field.isOn = poppler_form_field_button_get_state(handle) != FALSE;
    return true;
}

bool readText(PopplerFormField* handle, FormField& field)
{
    const auto type = poppler_form_field_text_get_text_type(handle);
    if (type == POPPLER_FORM_TEXT_FILE_SELECT)
        return false;
    field.kind = Kind::Text;
    field.text = takenText(poppler_form_field_text_get_text(handle));
    field.isSecret = poppler_form_field_text_is_password(handle) != FALSE;
    // A text of several lines is written in a view that cannot hide it.
    field.isMultiline = type == POPPLER_FORM_TEXT_MULTILINE && !field.isSecret;
    field.maxLength = static_cast<std::size_t>(std::max(0, poppler_form_field_text_get_max_len(handle)));
    return true;
}

void readChoice(PopplerFormField* handle, FormField& field)
{
    field.kind = Kind::Choice;
    field.takesSeveral = poppler_form_field_choice_can_select_multiple(handle) != FALSE;
    field.takesOtherWords = poppler_form_field_choice_get_choice_type(handle) == POPPLER_FORM_CHOICE_COMBO
        && poppler_form_field_choice_is_editable(handle) != FALSE;
    const int count = poppler_form_field_choice_get_n_items(handle);
    for (int i = 0; i < count; ++i) {
        field.options.push_back(takenText(poppler_form_field_choice_get_item(handle, i)));
        if (poppler_form_field_choice_is_item_selected(handle, i) != FALSE)
            field.chosen.push_back(static_cast<std::size_t>(i));
    }
    if (field.takesOtherWords)
        field.text = takenText(poppler_form_field_choice_get_text(handle));
}

/// Answers false for a field that no user fills in.
bool read(PopplerFormField* handle, FormField& field)
{
    if (poppler_form_field_is_read_only(handle) != FALSE)
        return false;
    field.id = static_cast<std::uint32_t>(poppler_form_field_get_id(handle));
    field.name = takenText(poppler_form_field_get_alternate_ui_name(handle));
    if (field.name.empty())
        field.name = takenText(poppler_form_field_get_partial_name(handle));
    switch (poppler_form_field_get_field_type(handle)) {
    case POPPLER_FORM_FIELD_BUTTON:
        return readButton(handle, field);
    case POPPLER_FORM_FIELD_TEXT:
        return readText(handle, field);
    case POPPLER_FORM_FIELD_CHOICE:
        readChoice(handle, field);
        return true;
    default:
        return false;
    }
}

std::vector<FoundField> foundFields(PopplerPage* page)
{
    std::vector<FoundField> fields;
    auto* list = page ? poppler_page_get_form_field_mapping(page) : nullptr;
    if (!list)
        return fields;
    const double height = PopplerPages::sizeOf(page).height;
    const auto hidden = hiddenPlaces(page);
    for (auto* entry = list; entry; entry = entry->next) {
        const auto* mapping = static_cast<PopplerFormFieldMapping*>(entry->data);
        FoundField found;
        found.field.place = PopplerPages::fromBottom(mapping->area, height);
        if (found.field.place.width <= 0 || found.field.place.height <= 0
            || std::ranges::count(hidden, found.field.place) > 0 || !read(mapping->field, found.field))
            continue;
        found.handle.reset(static_cast<PopplerFormField*>(g_object_ref(mapping->field)));
        fields.push_back(std::move(found));
    }
    poppler_page_free_form_field_mapping(list);
    // The library answers the fields in reverse order.
    std::ranges::reverse(fields);
    return fields;
}

std::optional<FoundField> findField(PopplerPage* page, std::uint32_t id)
{
    auto fields = foundFields(page);
    const auto found =
        std::ranges::find_if(fields, [&](const FoundField& each) { return each.field.id == id; });
    return found == fields.end() ? std::nullopt : std::optional(std::move(*found));
}

} // namespace

std::vector<FormField> fieldsOf(PopplerPage* page)
{
    std::vector<FormField> fields;
    for (auto& found : foundFields(page))
        fields.push_back(std::move(found.field));
    return fields;
}

bool fillField(PopplerPage* page, const platform::FieldTextEdit& edit)
{
    const auto found = findField(page, edit.field);
    if (found && found->field.kind == Kind::Text)
        poppler_form_field_text_set_text(found->handle.get(), edit.text.c_str());
    else if (found && found->field.takesOtherWords)
        poppler_form_field_choice_set_text(found->handle.get(), edit.text.c_str());
    else
        return false;
    return true;
}

bool fillField(PopplerPage* page, const platform::FieldStateEdit& edit)
{
    const auto found = findField(page, edit.field);
    if (!found || (found->field.kind != Kind::CheckBox && found->field.kind != Kind::RadioButton))
        return false;
    poppler_form_field_button_set_state(found->handle.get(), edit.isOn ? TRUE : FALSE);
    return true;
}

bool fillField(PopplerPage* page, const platform::FieldChoiceEdit& edit)
{
    const auto found = findField(page, edit.field);
    if (!found || found->field.kind != Kind::Choice || (edit.chosen.size() > 1 && !found->field.takesSeveral))
        return false;
    const auto count = found->field.options.size();
    if (std::ranges::any_of(edit.chosen, [&](std::size_t index) { return index >= count; }))
        return false;
    poppler_form_field_choice_unselect_all(found->handle.get());
    for (const auto index : edit.chosen)
        poppler_form_field_choice_select_item(found->handle.get(), static_cast<int>(index));
    return true;
}

} // namespace host::previews
