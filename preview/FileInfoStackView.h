// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/DRItem.h"
#include "kit/values/AttributedText.h"
#include "kit/views/StackView.h"
#include "preview/FileInfoCell.h"

#include <memory>
#include <optional>
#include <string>

namespace platform {
class OperationQueue;
}

namespace tarrow {

/// Shows the facts of an item as rows of names and values: kind, size, place, dates and tags. All names are
/// as wide as the widest. The dates are written as fully as the room allows. Main thread only.
class FileInfoStackView : public kit::StackView {
public:
    using StackView::StackView;
    static std::shared_ptr<FileInfoStackView> initWithFrame(const platform::Rect& frame);

    const std::shared_ptr<DRItem>& item() const { return _item; }
    /// Shows an item's facts; without an item the rows stay. The row of the place appears when the place is
    /// known, because finding it reads the drive on another thread.
    void setItem(std::shared_ptr<DRItem> item);
    /// Answers the row of the creation date, or null without such a row; the next one, that of the
    /// modification date.
    const std::shared_ptr<FileInfoCell>& creationDateCell() const { return _creationDateCell; }
    const std::shared_ptr<FileInfoCell>& modifiedDateCell() const { return _modifiedDateCell; }

    /// Appends a row and answers it.
    std::shared_ptr<FileInfoCell> addCellValueMaxLines(
        const std::string& name, const std::string& value, int maxLines);
    /// Answers the names of an item's tags, each behind a dot in its colour, or nothing without tags.
    static std::optional<kit::AttributedText> buildTagsWithImagesStringFont(
        const DRItem& item, const kit::Font& font);

    void layoutSubviews() override;

private:
    struct Dates;
    static Dates datesOf(const DRItem& item, platform::DateStyle style);
    static Dates fittingDates(const DRItem& item, double width);
    bool showDates(const Dates& dates);
    void rebuild();
    void removeRows();
    std::shared_ptr<FileInfoCell> addRow(const char* name, const std::string& value, int maxLines = 1);
    void findLocation();
    void locationIsKnown(const platform::Url& url, const std::optional<std::string>& line);

    std::shared_ptr<DRItem> _item;
    std::shared_ptr<FileInfoCell> _creationDateCell, _modifiedDateCell;
    std::shared_ptr<platform::OperationQueue> _queue; ///< finds places; null before the first
    std::optional<platform::Url> _located; ///< the URL whose place is known
    std::string _location;
    double _room = 0; ///< the width of the superview for which the dates were chosen last; points
};

} // namespace tarrow
