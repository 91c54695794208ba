// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/previews/PopplerEditing.h"

#include "host/previews/PopplerFields.h"
#include "host/system/files/FileDescriptor.h"

#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <charconv>
#include <numeric>
#include <set>
#include <string_view>

namespace host::previews {

using host::system::FileDescriptor;
using platform::Error;
using platform::FormField;
using platform::PagedDocumentEditing;
using platform::PageEdit;
using platform::PageMark;
using platform::PagesErrorCode;
using platform::Rect;
using platform::Result;

namespace {

constexpr PopplerColor highlightColor{0xFFFF, 0xE000, 0x4000};
constexpr PopplerColor underlineColor{0xE000, 0x2000, 0x2000};
constexpr PopplerColor noteColor{0xFFFF, 0xD800, 0x2000};

/// New marks get identifiers from here on, which are larger than the indexes of the marks in the document.
constexpr std::uint32_t firstNewMark = 1 << 24;

Result<Object<PopplerDocument>> openBytes(const std::shared_ptr<const std::string>& bytes)
{
    auto kept = std::make_unique<std::shared_ptr<const std::string>>(bytes);
    GBytes* content = g_bytes_new_with_free_func(
        bytes->data(), bytes->size(),
        [](gpointer owner) {
            const std::unique_ptr<std::shared_ptr<const std::string>> freed(
                static_cast<std::shared_ptr<const std::string>*>(owner));
        },
        kept.release());
    GError* problem = nullptr;
    Object<PopplerDocument> document(poppler_document_new_from_bytes(content, nullptr, &problem));
    g_bytes_unref(content);
    return PopplerPages::checked(std::move(document), problem);
}

bool isIndexAt(std::string_view bytes, std::size_t offset)
{
    if (offset >= bytes.size())
        return false;
    const auto there = bytes.substr(offset, 32);
    const auto first = there.find_first_not_of(" \r\n\t");
    if (first == std::string_view::npos)
        return false;
    // A cross-reference index is a table, or an object that holds one.
    return there.substr(first).starts_with("xref")
        || (there[first] >= '0' && there[first] <= '9' && there.find(" obj") != std::string_view::npos);
}

/// Answers whether the document's own cross-reference index can be found. A document whose index the library
/// had to rebuild is not changed, because appended changes would refer to objects that are not there.
bool hasIndex(std::string_view bytes)
{
    constexpr std::string_view keyword = "startxref";
    constexpr std::size_t searched = 1024; // bytes at the end that all readers search
    const auto end = bytes.size() > searched ? bytes.substr(bytes.size() - searched) : bytes;
    const auto at = end.rfind(keyword);
    if (at == std::string_view::npos)
        return false;
    auto number = end.substr(at + keyword.size());
    number.remove_prefix(std::min(number.find_first_not_of(" \r\n\t"), number.size()));
    std::size_t offset = 0;
    if (std::from_chars(number.data(), number.data() + number.size(), offset).ec != std::errc())
        return false;
    // Offsets count from the header, which may have other bytes before it.
    const auto header = bytes.substr(0, searched).find("%PDF-");
    return isIndexAt(bytes, offset)
        || (header != std::string_view::npos && isIndexAt(bytes, offset + header));
}

Rect around(const std::vector<Rect>& places)
{
    return std::accumulate(
        places.begin() + 1, places.end(), places.front(), [](const Rect& a, const Rect& b) {
            const double x = std::min(a.x, b.x), y = std::min(a.y, b.y);
            return Rect{x, y, std::max(a.maxX(), b.maxX()) - x, std::max(a.maxY(), b.maxY()) - y};
        });
}

struct FreeArray {
    void operator()(GArray* array) const { g_array_unref(array); }
};
using Quadrilaterals = std::unique_ptr<GArray, FreeArray>;

Quadrilaterals quadrilaterals(const std::vector<Rect>& places, double pageHeight)
{
    Quadrilaterals made(g_array_new(FALSE, FALSE, sizeof(PopplerQuadrilateral)));
    for (const auto& place : places) {
        const auto box = PopplerPages::toBottom(place, pageHeight);
        const PopplerQuadrilateral corners{
            {box.x1, box.y2}, {box.x2, box.y2}, {box.x1, box.y1}, {box.x2, box.y1}};
        g_array_append_val(made.get(), corners);
    }
    return made;
}

Object<PopplerAnnot> annotation(
    PopplerDocument& document, const platform::NewMarkEdit& edit, double pageHeight)
{
    auto place = PopplerPages::toBottom(around(edit.places), pageHeight);
    const auto corners = quadrilaterals(edit.places, pageHeight);
    Object<PopplerAnnot> made;
    auto color = noteColor;
    if (edit.kind == PageMark::Kind::Highlight) {
        made.reset(poppler_annot_text_markup_new_highlight(&document, &place, corners.get()));
        color = highlightColor;
    } else if (edit.kind == PageMark::Kind::Underline) {
        made.reset(poppler_annot_text_markup_new_underline(&document, &place, corners.get()));
        color = underlineColor;
    } else {
        made.reset(poppler_annot_text_new(&document, &place));
        poppler_annot_text_set_icon(POPPLER_ANNOT_TEXT(made.get()), POPPLER_ANNOT_TEXT_ICON_NOTE);
    }
    poppler_annot_set_color(made.get(), &color);
    if (!edit.text.empty())
        poppler_annot_set_contents(made.get(), edit.text.c_str());
    const auto flags = static_cast<unsigned>(poppler_annot_get_flags(made.get())) | POPPLER_ANNOT_FLAG_PRINT;
    poppler_annot_set_flags(made.get(), static_cast<PopplerAnnotFlag>(flags));
    return made;
}

std::size_t pageOf(const PageEdit& edit)
{
    return std::visit([](const auto& each) { return each.page; }, edit);
}

bool isFormEdit(const PageEdit& edit)
{
    return std::holds_alternative<platform::FieldTextEdit>(edit)
        || std::holds_alternative<platform::FieldStateEdit>(edit)
        || std::holds_alternative<platform::FieldChoiceEdit>(edit);
}

/// Answers the bytes that the library writes. It writes into memory, because it does not report a full disk.
Result<std::string> bytesOf(PopplerDocument& document)
{
    const FileDescriptor file(::memfd_create("pages", MFD_CLOEXEC));
    const auto place = "file:///proc/self/fd/" + std::to_string(file.get());
    if (!file || poppler_document_save(&document, place.c_str(), nullptr) == FALSE)
        return pagesError(PagesErrorCode::Damaged);
    struct stat status;
    if (::fstat(file.get(), &status) != 0)
        return pagesError(PagesErrorCode::Damaged);
    std::string bytes(static_cast<std::size_t>(status.st_size), '\0');
    for (std::size_t filled = 0; filled < bytes.size();) {
        const auto length =
            ::pread(file.get(), bytes.data() + filled, bytes.size() - filled, static_cast<off_t>(filled));
        if (length <= 0 && errno != EINTR)
            return pagesError(PagesErrorCode::Damaged);
        filled += length > 0 ? static_cast<std::size_t>(length) : 0;
    }
    return bytes;
}

std::vector<FormField> fieldsOn(const PopplerPages& pages, std::size_t index)
{
    return pages.withDocument([&](PopplerDocument& document) {
        auto fields = fieldsOf(PopplerPages::page(document, index).get());
        std::ranges::for_each(fields, [&](FormField& field) { field.page = index; });
        return fields;
    });
}

/// Answers whether two states of a document have the same content on a page, as far as edits can change it.
bool isSamePage(const PopplerPages& a, const PopplerPages& b, std::size_t page)
{
    const auto isSameField = [](const FormField& one, const FormField& other) {
        return one.id == other.id && one.text == other.text && one.isOn == other.isOn
            && one.chosen == other.chosen;
    };
    const auto isSameMark = [](const PageMark& one, const PageMark& other) {
        return one.kind == other.kind && one.text == other.text;
    };
    return std::ranges::equal(fieldsOn(a, page), fieldsOn(b, page), isSameField)
        && std::ranges::equal(a.marks(page), b.marks(page), isSameMark);
}

} // namespace

/// The pages with the edits. A mark keeps its identifier while others come and go.
class PopplerEditing::Pages : public PopplerPages {
public:
    using PopplerPages::PopplerPages;

    std::vector<PageMark> marks(std::size_t index) const override
    {
        return withDocument([&](PopplerDocument& document) {
            std::vector<PageMark> seen;
            for (auto& found : identified(document, index)) {
                if (found.isSeen)
                    seen.push_back(std::move(found.mark));
            }
            return seen;
        });
    }

    bool apply(const PageEdit& edit)
    {
        return withDocument([&](PopplerDocument& document) { return applyTo(document, edit); });
    }

    /// Replaces the document by a newly read one with these edits.
    void restart(Object<PopplerDocument> document, const std::vector<PageEdit>& edits)
    {
        setDocument(std::move(document));
        withDocument([&](PopplerDocument& fresh) {
            _marks.clear();
            _nextMark = firstNewMark;
            for (const auto& edit : edits)
                applyTo(fresh, edit);
        });
    }

private:
    using Identifiers = std::vector<std::uint32_t>;

    bool applyTo(PopplerDocument& document, const PageEdit& edit)
    {
        const auto edited = page(document, pageOf(edit));
        return edited && std::visit([&](const auto& each) { return make(document, *edited, each); }, edit);
    }

    template <typename Edit>
    bool make(PopplerDocument&, PopplerPage& page, const Edit& edit)
    {
        return fillField(&page, edit);
    }

    bool make(PopplerDocument& document, PopplerPage& page, const platform::NewMarkEdit& edit)
    {
        if (edit.places.empty() || edit.kind == PageMark::Kind::Other)
            return false;
        identifiers(page, edit.page).push_back(_nextMark++);
        poppler_page_add_annot(&page, annotation(document, edit, sizeOf(&page).height).get());
        return true;
    }

    bool make(PopplerDocument& document, PopplerPage&, const platform::MarkTextEdit& edit)
    {
        const auto found = changeable(document, edit.page, edit.mark);
        if (!found)
            return false;
        poppler_annot_set_contents(found->handle.get(), edit.text.c_str());
        return true;
    }

    bool make(PopplerDocument& document, PopplerPage& page, const platform::MarkRemoval& edit)
    {
        const auto found = changeable(document, edit.page, edit.mark);
        if (!found)
            return false;
        poppler_page_remove_annot(&page, found->handle.get());
        std::erase(identifiers(page, edit.page), edit.mark);
        return true;
    }

    Identifiers& identifiers(PopplerPage& page, std::size_t index) const
    {
        const auto [known, isNew] = _marks.try_emplace(index);
        if (isNew) {
            known->second.resize(foundMarks(&page).size());
            std::iota(known->second.begin(), known->second.end(), 0U);
        }
        return known->second;
    }

    std::vector<FoundMark> identified(PopplerDocument& document, std::size_t index) const
    {
        const auto marked = page(document, index);
        auto found = foundMarks(marked.get());
        if (!marked)
            return found;
        const auto& known = identifiers(*marked, index);
        for (std::size_t i = 0; i < std::min(found.size(), known.size()); ++i)
            found[i].mark.id = known[i];
        return found;
    }

    std::optional<FoundMark> changeable(PopplerDocument& document, std::size_t index, std::uint32_t id) const
    {
        for (auto& found : identified(document, index)) {
            if (found.mark.id == id && found.isSeen && !found.mark.isLocked)
                return std::move(found);
        }
        return std::nullopt;
    }

    mutable std::map<std::size_t, Identifiers> _marks; ///< by page, in the library's order
    std::uint32_t _nextMark = firstNewMark;
};

Result<std::shared_ptr<PagedDocumentEditing>> PopplerEditing::open(std::shared_ptr<const std::string> bytes)
{
    auto opened = openBytes(bytes);
    if (!opened)
        return *opened.error;
    if (!hasIndex(*bytes))
        return pagesError(PagesErrorCode::Damaged);
    auto pages = std::make_shared<Pages>(std::move(*opened.value));
    return std::shared_ptr<PagedDocumentEditing>(
        std::make_shared<PopplerEditing>(std::move(bytes), std::move(pages)));
}

PopplerEditing::PopplerEditing(std::shared_ptr<const std::string> bytes, std::shared_ptr<Pages> pages)
    : _bytes(std::move(bytes))
    , _pages(std::move(pages))
{
}

std::shared_ptr<platform::PagedDocument> PopplerEditing::pages() const
{
    return _pages;
}

std::vector<FormField> PopplerEditing::fields(std::size_t page) const
{
    return fieldsOn(*_pages, page);
}

std::optional<Error> PopplerEditing::apply(const PageEdit& edit)
{
    const auto rights = _pages->rights();
    const std::lock_guard lock(_mutex);
    if (!(isFormEdit(edit) ? rights.canFillForms : rights.canMark) || !_pages->apply(edit))
        return pagesError(PagesErrorCode::Refused);
    _edits.push_back(edit);
    return std::nullopt;
}

std::optional<std::size_t> PopplerEditing::undo()
{
    const std::lock_guard lock(_mutex);
    auto fresh = _edits.empty() ? pagesError(PagesErrorCode::Refused) : openBytes(_bytes);
    if (!fresh)
        return std::nullopt;
    const auto page = pageOf(_edits.back());
    _edits.pop_back();
    _pages->restart(std::move(*fresh.value), _edits);
    return page;
}

std::size_t PopplerEditing::editCount() const
{
    const std::lock_guard lock(_mutex);
    return _edits.size();
}

Result<std::string> PopplerEditing::written() const
{
    const std::lock_guard lock(_mutex);
    auto bytes = _pages->withDocument([](PopplerDocument& document) { return bytesOf(document); });
    if (!bytes)
        return bytes;
    const auto content = std::make_shared<const std::string>(std::move(*bytes.value));
    auto reopened = openBytes(content);
    if (!reopened)
        return *reopened.error;
    const PopplerPages read(std::move(*reopened.value));
    std::set<std::size_t> edited;
    for (const auto& edit : _edits)
        edited.insert(pageOf(edit));
    const bool isWhole = read.pageCount() == _pages->pageCount()
        && std::ranges::all_of(edited, [&](std::size_t page) { return isSamePage(read, *_pages, page); });
    if (!isWhole)
        return pagesError(PagesErrorCode::Damaged);
    return *content;
}

} // namespace host::previews
