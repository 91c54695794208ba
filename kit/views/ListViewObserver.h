// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/ListChanges.h"

namespace kit {

class ListView;

enum class RowPosition { Nearest, Top, Middle };

/// Calls down that only a list makes, beside those of ViewObserver and ScrollObserver. The model has already
/// changed when they come.
class ListViewObserver {
public:
    virtual ~ListViewObserver() = default;

    virtual void rowsWereReset(ListView& list) = 0;
    virtual void rowsDidChange(ListView& list, const ListChanges& changes) = 0;
    virtual void rowDidChange(ListView& list, std::size_t index) = 0;
    /// The check marks of the visible rows have to be shown anew.
    virtual void selectionDidChange(ListView& list) = 0;
    virtual void scrollToRow(ListView& list, std::size_t index, RowPosition position, bool animated) = 0;
    /// Scrolls to a row and gives it the keyboard.
    virtual void focusRow(ListView& list, std::size_t index) = 0;
    /// Refreshing has ended, or the list became refreshable or not.
    virtual void refreshStateDidChange(ListView& list) = 0;
};

} // namespace kit
