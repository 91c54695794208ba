// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/preview/PreviewEditor.h"

#include "kit/views/Button.h"
#include "kit/views/TextField.h"
#include "platform/Localization.h"
#include "platform/Weakly.h"
#include "screens/AlertParts.h"
#include "screens/PlatformNames.h"
#include "screens/preview/NoteView.h"
#include "screens/preview/PreviewFieldBar.h"

#include <algorithm>
#include <utility>

namespace screens {

namespace {

constexpr double noteSide = 24; ///< page points

std::string markTitle(const PageMark& mark)
{
    switch (mark.kind) {
    case PageMark::Kind::Highlight:
        return localized("Highlighted text");
    case PageMark::Kind::Underline:
        return localized("Underlined text");
    case PageMark::Kind::Note:
        return localized("Note");
    case PageMark::Kind::Other:
        break;
    }
    return localized("Mark");
}

} // namespace

std::shared_ptr<kit::ViewController> makeNoteAlert(const PageMark& mark)
{
    return messageAlert(markTitle(mark), mark.text);
}

std::shared_ptr<PreviewEditor> PreviewEditor::create(std::shared_ptr<PreviewEditing> editing,
    const std::shared_ptr<PreviewPagesView>& pages, Callbacks callbacks)
{
    const auto editor = std::make_shared<PreviewEditor>(std::move(editing), pages, std::move(callbacks));
    editor->connect();
    return editor;
}

PreviewEditor::PreviewEditor(std::shared_ptr<PreviewEditing> editing,
    const std::shared_ptr<PreviewPagesView>& pages, Callbacks callbacks)
    : _editing(std::move(editing))
    , _pages(pages)
    , _callbacks(std::move(callbacks))
    , _bar(PreviewEditBar::create())
    , _fieldBar(PreviewFieldBar::create())
    , _rights(_editing->rights())
{
    _fieldBar->setHidden(true);
}

PreviewEditor::~PreviewEditor()
{
    const auto pages = _pages.lock();
    if (!pages)
        return;
    pages->setOnUndo({});
    pages->setPlacing(false);
    pages->setActiveField(std::nullopt);
    pages->setFields({});
}

void PreviewEditor::connect()
{
    _bar->setOnTool(weakly(this, &PreviewEditor::use));
    _fieldBar->setOnPress(weakly(this, &PreviewEditor::pressField));
    _fieldBar->setOnLeave(weakly(this, &PreviewEditor::finishWriting));
    _fieldBar->setOnNext(weakly(this, &PreviewEditor::use, EditTool::NextField));
    if (const auto pages = _pages.lock()) {
        pages->setOnUndo(weakly(this, &PreviewEditor::undo));
        pages->setOnTap(weakly(this, &PreviewEditor::tapped));
    }
    readFields();
    update();
}

std::string PreviewEditor::hint() const
{
    const auto pages = _pages.lock();
    return pages && pages->isPlacing() ? localized("Tap where the note belongs.") : std::string();
}

void PreviewEditor::update()
{
    const auto pages = _pages.lock();
    if (!pages)
        return;
    _bar->setState({.canUndo = _editing->canUndo(),
        .canMark = _rights.canMark,
        .hasMarkable = !pages->chosenPlaces().empty(),
        .hasFields = !pages->fields().empty()});
}

void PreviewEditor::use(EditTool tool)
{
    const auto pages = _pages.lock();
    if (!pages)
        return;
    finishWriting();
    switch (tool) {
    case EditTool::Undo:
        return undo();
    case EditTool::Highlight:
        return mark(PageMark::Kind::Highlight);
    case EditTool::Underline:
        return mark(PageMark::Kind::Underline);
    case EditTool::Note:
        pages->setPlacing(!pages->isPlacing());
        pages->takeFocus();
        return _callbacks.layoutDidChange();
    case EditTool::PreviousField:
        return stepField(-1);
    case EditTool::NextField:
        return stepField(1);
    case EditTool::Done:
        return _callbacks.done();
    }
}

void PreviewEditor::apply(PageEdit edit)
{
    _editing->apply(std::move(edit), changed());
    update();
}

std::function<void(PageEdit)> PreviewEditor::applier()
{
    return [weak = weak_from_this(), editing = _editing, followed = changed(), late = _callbacks.editedLate](
               PageEdit edit) {
        if (const auto self = weak.lock())
            return self->apply(std::move(edit));
        editing->apply(std::move(edit), followed);
        late(editing);
    };
}

void PreviewEditor::undo()
{
    if (!_editing->canUndo())
        return;
    // A text that is still being written is the latest edit, so it is finished first and then undone.
    finishWriting();
    _editing->undo(changed());
    update();
}

/// Answers what follows an edit. The last one before Done is made when this object has gone, and must be seen
/// all the same.
PreviewEditing::Stepped PreviewEditor::changed()
{
    return [weak = weak_from_this(), pages = _pages, present = _callbacks.present](const auto& error) {
        if (error)
            present(messageAlert(
                localized("This cannot be changed"), localized("The document does not allow it.")));
        if (const auto shown = pages.lock())
            shown->documentDidChange();
        if (const auto self = weak.lock()) {
            self->readFields();
            self->update();
        }
    };
}

void PreviewEditor::readFields()
{
    if (!_rights.canFillForms)
        return;
    _editing->readFields(weakly(this, &PreviewEditor::showFields));
}

void PreviewEditor::showFields(std::vector<FormField> fields)
{
    const auto pages = _pages.lock();
    if (!pages)
        return;
    pages->setFields(std::move(fields));
    if (const auto* field = pages->activeField())
        _fieldBar->setField(*field);
    update();
}

void PreviewEditor::mark(PageMark::Kind kind)
{
    const auto pages = _pages.lock();
    if (!pages)
        return;
    for (const auto& [page, places] : pages->chosenPlaces())
        apply(NewMarkEdit{page, kind, places, {}});
    pages->clearSelection();
}

void PreviewEditor::stepField(int direction)
{
    const auto pages = _pages.lock();
    if (!pages || pages->fields().empty())
        return;
    const auto& fields = pages->fields();
    const auto count = static_cast<int>(fields.size());
    int index = direction > 0 ? -1 : count;
    if (const auto* active = pages->activeField()) {
        index = static_cast<int>(active - fields.data());
    } else {
        // The search for a field begins on the page that is being read.
        const auto here = std::ranges::find_if(
            fields, [&](const FormField& field) { return field.page >= pages->currentPage(); });
        index = static_cast<int>(here - fields.begin()) - (direction > 0 ? 1 : 0);
    }
    show(fields[static_cast<std::size_t>((index + direction + count) % count)]);
}

void PreviewEditor::show(const FormField& field)
{
    const auto pages = _pages.lock();
    if (!pages)
        return;
    const bool isText = field.kind == FormField::Kind::Text && !field.isMultiline;
    _fieldBar->setField(field);
    if (!std::exchange(_hasField, true)) {
        _fieldBar->setHidden(false);
        _callbacks.layoutDidChange();
    }
    pages->setActiveField(field.id);
    if (isText) {
        _fieldBar->textField()->becomeFirstResponder();
    } else {
        _fieldBar->textField()->resignFirstResponder();
    }
}

void PreviewEditor::endField()
{
    _fieldBar->textField()->resignFirstResponder();
    _fieldBar->setHidden(true);
    _hasField = false;
    if (const auto pages = _pages.lock())
        pages->setActiveField(std::nullopt);
    _callbacks.layoutDidChange();
}

void PreviewEditor::finishWriting()
{
    const auto pages = _pages.lock();
    const auto* field = pages ? pages->activeField() : nullptr;
    if (!field)
        return;
    if (auto text = _fieldBar->takeText())
        apply(FieldTextEdit{field->page, field->id, std::move(*text)});
}

bool PreviewEditor::backRequested()
{
    const auto pages = _pages.lock();
    if (!pages)
        return false;
    if (pages->isPlacing()) {
        pages->setPlacing(false);
        _callbacks.layoutDidChange();
        return true;
    }
    if (!_hasField)
        return false;
    finishWriting();
    endField();
    return true;
}

void PreviewEditor::pressField()
{
    const auto pages = _pages.lock();
    if (const auto* field = pages ? pages->activeField() : nullptr)
        fillIn(*field);
}

/// Fills in a field as far as a tap decides its value.
void PreviewEditor::fillIn(const FormField& field)
{
    using Kind = FormField::Kind;
    if (field.kind == Kind::Choice)
        choose(field);
    else if (field.isMultiline)
        askForText(fieldName(field), field.text, [field](const std::string& text) {
            return text == field.text ? std::optional<PageEdit>() : FieldTextEdit{field.page, field.id, text};
        });
    else if (field.kind == Kind::CheckBox)
        apply(FieldStateEdit{field.page, field.id, !field.isOn});
    else if (field.kind == Kind::RadioButton && !field.isOn)
        apply(FieldStateEdit{field.page, field.id, true});
}

void PreviewEditor::choose(const FormField& field)
{
    const auto sheet =
        std::make_shared<kit::AlertController>(fieldName(field), std::string(), kit::AlertStyle::ActionSheet);
    for (std::size_t i = 0; i < field.options.size(); ++i) {
        const bool isChosen = std::ranges::count(field.chosen, i) > 0;
        auto chosen = field.takesSeveral ? field.chosen : std::vector<std::size_t>();
        std::erase(chosen, i);
        if (!isChosen || !field.takesSeveral)
            chosen.push_back(i);
        std::ranges::sort(chosen);
        sheet->addAction(alertAction((isChosen ? "✓ " : "") + field.options[i],
            kit::AlertActionStyle::Default, [make = applier(), field, chosen] {
                make(FieldChoiceEdit{field.page, field.id, chosen});
            }));
    }
    if (field.takesOtherWords)
        sheet->addAction(alertAction(localized("Other…"), kit::AlertActionStyle::Default,
            weakly(this, &PreviewEditor::askForOtherWords, field)));
    sheet->addAction(alertAction(localized("Cancel"), kit::AlertActionStyle::Cancel));
    sheet->setPopoverAnchor(kit::ViewAnchor{_fieldBar->button(), _fieldBar->button()->bounds()});
    _callbacks.present(sheet);
}

void PreviewEditor::askForOtherWords(const FormField& field)
{
    askForText(fieldName(field), field.text, [field](const std::string& text) {
        return std::optional<PageEdit>(FieldTextEdit{field.page, field.id, text});
    });
}

void PreviewEditor::tapped(const PreviewPagesView::PagePlace& place)
{
    const auto pages = _pages.lock();
    if (!pages)
        return;
    finishWriting();
    if (pages->isPlacing())
        return placeNote(place);
    if (const auto* field = pages->fieldAt(place)) {
        const auto tappedField = *field;
        show(tappedField);
        return fillIn(tappedField);
    }
    if (_hasField)
        endField();
    pages->findMark(
        place, weakly(this, [page = place.page](PreviewEditor& self, const std::optional<PageMark>& mark) {
            if (mark)
                self.showMark(page, *mark);
        }));
}

void PreviewEditor::placeNote(const PreviewPagesView::PagePlace& place)
{
    const auto pages = _pages.lock();
    pages->setPlacing(false);
    _callbacks.layoutDidChange();
    askForText(localized("Note"), {}, [place](const std::string& text) {
        const Rect there{place.point.x - noteSide / 2, place.point.y - noteSide / 2, noteSide, noteSide};
        return text.empty() ? std::optional<PageEdit>()
                            : NewMarkEdit{place.page, PageMark::Kind::Note, {there}, text};
    });
}

void PreviewEditor::askForText(const std::string& title, const std::string& text,
    std::function<std::optional<PageEdit>(const std::string&)> edit)
{
    const auto alert = std::make_shared<kit::AlertController>(title, std::string(), kit::AlertStyle::Alert);
    const auto screen = std::make_shared<NoteScreen>(title, text);
    alert->setContentViewController(screen);
    alert->addAction(alertAction(localized("Cancel"), kit::AlertActionStyle::Cancel));
    const auto done = alertAction(localized("Done"), kit::AlertActionStyle::Default,
        [note = screen->note(), edit = std::move(edit), make = applier()] {
            if (auto made = edit(note->text()))
                make(std::move(*made));
        });
    alert->addAction(done);
    _callbacks.present(alert);
}

void PreviewEditor::showMark(std::size_t page, const PageMark& mark)
{
    if (mark.isLocked || !_rights.canMark) {
        if (!mark.text.empty())
            _callbacks.present(makeNoteAlert(mark));
        return;
    }
    const auto alert =
        std::make_shared<kit::AlertController>(markTitle(mark), mark.text, kit::AlertStyle::Alert);
    alert->addAction(alertAction(mark.text.empty() ? localized("Add Comment") : localized("Change Text"),
        kit::AlertActionStyle::Default, weakly(this, &PreviewEditor::askForWords, page, mark)));
    alert->addAction(alertAction(
        localized("Remove"), kit::AlertActionStyle::Destructive, [make = applier(), page, id = mark.id] {
            make(MarkRemoval{page, id});
        }));
    alert->addAction(alertAction(localized("Cancel"), kit::AlertActionStyle::Cancel));
    _callbacks.present(alert);
}

void PreviewEditor::askForWords(std::size_t page, const PageMark& mark)
{
    askForText(markTitle(mark), mark.text, [page, mark](const std::string& text) {
        return text == mark.text ? std::optional<PageEdit>() : MarkTextEdit{page, mark.id, text};
    });
}

} // namespace screens
