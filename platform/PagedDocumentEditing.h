// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PagedDocument.h"

#include <cstdint>
#include <variant>

namespace platform {

/// A field of a form that a person may fill in.
struct FormField {
    enum class Kind { Text, CheckBox, RadioButton, Choice };

    std::uint32_t id = 0; ///< one in its document
    Kind kind = Kind::Text;
    std::size_t page = 0;
    Rect place; ///< on its page
    std::string name; ///< for people; may be empty
    std::string text; ///< of a text, and of a choice that takes other words
    bool isMultiline = false, isSecret = false; ///< of a text
    std::size_t maxLength = 0; ///< of a text, in characters; 0: any
    bool isOn = false; ///< of a box or button
    std::vector<std::string> options; ///< of a choice
    std::vector<std::size_t> chosen; ///< of a choice: which of its options
    bool takesOtherWords = false, takesSeveral = false; ///< of a choice
    bool operator==(const FormField&) const = default;
};

struct FieldTextEdit {
    std::size_t page = 0;
    std::uint32_t field = 0;
    std::string text; ///< of a choice: words that are none of its options
};
struct FieldStateEdit {
    std::size_t page = 0;
    std::uint32_t field = 0;
    bool isOn = false;
};
struct FieldChoiceEdit {
    std::size_t page = 0;
    std::uint32_t field = 0;
    std::vector<std::size_t> chosen;
};
/// A mark over these places, or a note at the first one.
struct NewMarkEdit {
    std::size_t page = 0;
    PageMark::Kind kind = PageMark::Kind::Highlight;
    std::vector<Rect> places;
    std::string text;
};
struct MarkTextEdit {
    std::size_t page = 0;
    std::uint32_t mark = 0;
    std::string text;
};
struct MarkRemoval {
    std::size_t page = 0;
    std::uint32_t mark = 0;
};
/// One step of a person, which is undone as one.
using PageEdit =
    std::variant<FieldTextEdit, FieldStateEdit, FieldChoiceEdit, NewMarkEdit, MarkTextEdit, MarkRemoval>;

/// A document of pages that is being changed. It lives in memory alone: whoever wants it kept writes what
/// `written` answers. Threads and waiting as for PagedDocument.
class PagedDocumentEditing {
public:
    static constexpr std::size_t maxBytes = 256 << 20; ///< of a document to be changed

    virtual ~PagedDocumentEditing() = default;

    /// The document as it is with all edits so far: the same object always.
    virtual std::shared_ptr<PagedDocument> pages() const = 0;
    /// The fields of a page that may be filled in, in the order of the form.
    virtual std::vector<FormField> fields(std::size_t page) const = 0;
    /// Answers PagesErrorCode::Refused for what is not there, or not allowed.
    virtual std::optional<Error> apply(const PageEdit& edit) = 0;
    /// Takes the last edit back. Answers its page; nothing without one.
    virtual std::optional<std::size_t> undo() = 0;
    virtual std::size_t editCount() const = 0; ///< of those that were not taken back
    /// The whole document with its edits, checked by reading it anew. Errors: PagesErrorCode::Damaged.
    virtual Result<std::string> written() const = 0;
};

} // namespace platform
