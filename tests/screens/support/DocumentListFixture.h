// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/ContainerRecord.h"
#include "kit/views/ListView.h"
#include "kit/views/ListViewObserver.h"
#include "tests/screens/support/ComponentsFixture.h"

#include <gmock/gmock.h>

#include <string>
#include <vector>

namespace testing_support {

using Lines = std::vector<std::string>;

/// Lists of folders whose listings the test delivers.
class DocumentList : public ComponentsFixture {
protected:
    platform::Url makePaintLibrary() const
    {
        host::drive::ContainerRecord record;
        record.names = {{"en", "Paint"}};
        record.iconName = "paint-icon";
        return drive.makeContainer("com.example.paint", record);
    }
    static HandLister::Entries documents(std::size_t count)
    {
        HandLister::Entries entries;
        for (std::size_t i = 0; i < count; ++i)
            entries.push_back({"item " + std::to_string(100'000 + i) + ".txt"});
        return entries;
    }
};

/// Records the exact changes that a list's peer is told.
struct RecordingListObserver : kit::ListViewObserver {
    using ListView = kit::ListView;

    void rowsWereReset(ListView&) override { ++resets; }
    void rowsDidChange(ListView&, const kit::ListChanges& changes) override { last = changes; }
    void rowDidChange(ListView&, std::size_t index) override { changedRows.push_back(index); }
    void selectionDidChange(ListView&) override { }
    void scrollToRow(ListView&, std::size_t, kit::RowPosition, bool) override { }
    void focusRow(ListView&, std::size_t) override { }
    void refreshStateDidChange(ListView&) override { }

    int resets = 0;
    kit::ListChanges last;
    std::vector<std::size_t> changedRows;
};

} // namespace testing_support
