// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/previews/PopplerPages.h"
#include "platform/PagedDocumentEditing.h"

#include <map>

namespace host::previews {

/// Changes a PDF document with Poppler. An edit is undone by reading the document again and applying all
/// other edits, so that content that other programs have added is never lost. A document whose own index
/// cannot be found is not changed at all. The library writes into memory first, because it does not report a
/// full disk. It cannot make drawings by hand (ink), so there are none.
class PopplerEditing : public platform::PagedDocumentEditing {
public:
    static platform::Result<std::shared_ptr<platform::PagedDocumentEditing>> open(
        std::shared_ptr<const std::string> bytes);

    class Pages;
    PopplerEditing(std::shared_ptr<const std::string> bytes, std::shared_ptr<Pages> pages);

    std::shared_ptr<platform::PagedDocument> pages() const override;
    std::vector<platform::FormField> fields(std::size_t page) const override;
    std::optional<platform::Error> apply(const platform::PageEdit& edit) override;
    std::optional<std::size_t> undo() override;
    std::size_t editCount() const override;
    platform::Result<std::string> written() const override;

private:
    std::shared_ptr<const std::string> _bytes;
    std::shared_ptr<Pages> _pages;
    mutable std::mutex _mutex; ///< guards the edits, which are made one at a time
    std::vector<platform::PageEdit> _edits;
};

} // namespace host::previews
