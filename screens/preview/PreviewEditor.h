// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "screens/preview/PreviewEditBar.h"
#include "screens/preview/PreviewEditing.h"
#include "screens/preview/PreviewPagesView.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace kit {
class ViewController;
} // namespace kit

namespace screens {

class PreviewFieldBar;

/// Lets the user change the pages that a preview screen shows: it carries out the tools and the taps. Main
/// thread only.
class PreviewEditor : public std::enable_shared_from_this<PreviewEditor> {
public:
    struct Callbacks {
        std::function<void(const std::shared_ptr<kit::ViewController>&)> present; ///< presents an alert
        std::function<void()> layoutDidChange; ///< the field's bar appeared or disappeared
        std::function<void()> done; ///< the user pressed Done
        /// An alert was answered when this object had gone. The edit is made, but not saved.
        std::function<void(const std::shared_ptr<PreviewEditing>&)> editedLate;
    };
    static std::shared_ptr<PreviewEditor> create(std::shared_ptr<PreviewEditing> editing,
        const std::shared_ptr<PreviewPagesView>& pages, Callbacks callbacks);
    PreviewEditor(std::shared_ptr<PreviewEditing> editing, const std::shared_ptr<PreviewPagesView>& pages,
        Callbacks callbacks); ///< use create()
    ~PreviewEditor();

    const std::shared_ptr<PreviewEditing>& editing() const { return _editing; }
    const std::shared_ptr<PreviewEditBar>& bar() const { return _bar; }
    const std::shared_ptr<PreviewFieldBar>& fieldBar() const { return _fieldBar; } ///< hidden without a field
    /// Answers a sentence that asks the user for the next step; empty for none.
    std::string hint() const;

    /// Shows the current state of the view.
    void update();
    /// Puts the text that is being written into its field.
    void finishWriting();
    /// The user asks to go back: the current action ends, not the editing. Answers false when no action was
    /// under way.
    bool backRequested();

private:
    void connect();
    void use(EditTool tool);
    void apply(PageEdit edit);
    /// Answers a function that makes an edit also when this object has gone.
    std::function<void(PageEdit)> applier();
    void undo();
    PreviewEditing::Stepped changed();
    void readFields();
    void showFields(std::vector<FormField> fields);
    void mark(PageMark::Kind kind);
    void stepField(int direction);
    void show(const FormField& field);
    void endField();
    void pressField();
    void choose(const FormField& field);
    void askForOtherWords(const FormField& field);
    void tapped(const PreviewPagesView::PagePlace& place);
    void fillIn(const FormField& field);
    void placeNote(const PreviewPagesView::PagePlace& place);
    /// `edit` answers what is to be made of the text, or nothing.
    void askForText(const std::string& title, const std::string& text,
        std::function<std::optional<PageEdit>(const std::string&)> edit);
    void showMark(std::size_t page, const PageMark& mark);
    void askForWords(std::size_t page, const PageMark& mark);

    std::shared_ptr<PreviewEditing> _editing;
    std::weak_ptr<PreviewPagesView> _pages;
    Callbacks _callbacks;
    std::shared_ptr<PreviewEditBar> _bar;
    std::shared_ptr<PreviewFieldBar> _fieldBar;
    PagesRights _rights;
    bool _hasField = false; ///< a field is being filled in
};

/// Answers an alert that shows the text of a note.
std::shared_ptr<kit::ViewController> makeNoteAlert(const PageMark& mark);

} // namespace screens
