// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PagedDocument.h"

#include <cstdint>
#include <variant>

namespace platform {

/// A field of a form that a person may fill in.
struct FormField {
    /// What is filled in: words, a box, one of several buttons, or a choice among options.
    enum class Kind { Text, CheckBox, RadioButton, Choice };

    std::uint32_t id = 0; ///< tells the fields of a document apart
    Kind kind = Kind::Text;
    std::size_t page = 0; ///< the page that the field is on
    Rect place; ///< on its page; never empty
    std::string name; ///< the name for people; may be empty
    /// Of a text, and of a choice that takes other words: what is filled in.
    std::string text;
    /// Of a text: it has several lines; it is not to be shown, as a password.
    bool isMultiline = false, isSecret = false;
    std::size_t maxLength = 0; ///< of a text: the most characters that fit; 0 for any number
    bool isOn = false; ///< of a box or button: it is checked
    std::vector<std::string> options; ///< of a choice: what can be chosen
    std::vector<std::size_t> chosen; ///< of a choice: the indexes of the options that are chosen
    /// Of a choice: words that are none of its options may be filled in; several options may be chosen.
    bool takesOtherWords = false, takesSeveral = false;
    bool operator==(const FormField&) const = default;
};

/// Fills words into a text field, or into a choice that takes other words.
struct FieldTextEdit {
    std::size_t page = 0;
    std::uint32_t field = 0;
    std::string text;
};
/// Switches a box or a button on or off. To switch on a radio button switches off the others of its group.
struct FieldStateEdit {
    std::size_t page = 0;
    std::uint32_t field = 0;
    bool isOn = false;
};
/// Chooses among the options of a choice, in place of those that were chosen before.
struct FieldChoiceEdit {
    std::size_t page = 0;
    std::uint32_t field = 0;
    std::vector<std::size_t> chosen; ///< indexes of options; more than one only where that is allowed
};
/// Adds a mark over these places, or a note at the first of them. There must be one, and the kind must not be
/// Other.
struct NewMarkEdit {
    std::size_t page = 0;
    PageMark::Kind kind = PageMark::Kind::Highlight;
    std::vector<Rect> places;
    std::string text;
};
/// Changes what a mark says.
struct MarkTextEdit {
    std::size_t page = 0;
    std::uint32_t mark = 0;
    std::string text;
};
/// Removes a mark.
struct MarkRemoval {
    std::size_t page = 0;
    std::uint32_t mark = 0;
};
/// One step that a person takes, which is undone as one.
using PageEdit =
    std::variant<FieldTextEdit, FieldStateEdit, FieldChoiceEdit, NewMarkEdit, MarkTextEdit, MarkRemoval>;

/// A document of pages that is being changed. The changes live in memory alone: who wants them kept writes
/// what `written` answers. Any thread may call; a call takes as long as its work, and edits of one document
/// are made one after the other.
class PagedDocumentEditing {
public:
    /// The largest document that callers open for changing, in bytes, since all of it is kept in memory.
    static constexpr std::size_t maxBytes = 256 << 20;

    virtual ~PagedDocumentEditing() = default;

    /// Answers the document as it is with all edits so far. It is always the same object, so a view can keep
    /// it.
    virtual std::shared_ptr<PagedDocument> pages() const = 0;
    /// Answers the fields of a page that a person may fill in and can see, in the order of the form.
    virtual std::vector<FormField> fields(std::size_t page) const = 0;
    /// Makes an edit. It answers PagesErrorCode::Refused, and has changed nothing, when the page does not
    /// have what is to be changed, when the edit does not fit it, and when the document's author does not
    /// allow it.
    virtual std::optional<Error> apply(const PageEdit& edit) = 0;
    /// Takes the last edit back and answers its page; nothing when there is no edit. It takes as long as
    /// opening the document and making all other edits again.
    virtual std::optional<std::size_t> undo() = 0;
    /// The number of edits that were made and not taken back.
    virtual std::size_t editCount() const = 0;
    /// Answers the bytes of the whole document with its edits. They are read again before, and must hold what
    /// was edited. Errors: PagesErrorCode::Damaged when they do not; nothing is lost then but the bytes.
    virtual Result<std::string> written() const = 0;
};

} // namespace platform
