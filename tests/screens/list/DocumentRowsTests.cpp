// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/list/DocumentRows.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <set>

using namespace platform;
using namespace screens;

namespace {

std::shared_ptr<const FolderSnapshot> snapshot(
    std::initializer_list<const char*> names, std::initializer_list<const char*> promised = {})
{
    FolderSnapshot::Builder builder(Url::fileURL("/drive"));
    for (const auto* name : names) {
        const bool isPromise = std::ranges::find(promised, std::string_view(name)) != promised.end();
        builder.append(name, FolderEntryKind::Document, isPromise);
    }
    return builder.finish(ListingStage::Complete);
}

TEST(DocumentRows, TellsWhatChangedBetweenTwoStates)
{
    const auto before = DocumentRows::make(snapshot({"a", "b", "c", "d"}, {"b", "c"}));
    const auto after = DocumentRows::make(snapshot({"a", "b", "bb", "d", "e"}, {"e"}));
    const auto changes = DocumentRows::changes(*before, *after);

    std::vector<kit::RowId> replayed(before->ids().begin(), before->ids().end());
    auto inserted = after->ids().begin();
    for (const auto& splice : changes.splices) {
        const auto at = replayed.erase(replayed.begin() + static_cast<std::ptrdiff_t>(splice.position),
            replayed.begin() + static_cast<std::ptrdiff_t>(splice.position + splice.removed));
        inserted = after->ids().begin() + static_cast<std::ptrdiff_t>(splice.position);
        replayed.insert(at, inserted, inserted + static_cast<std::ptrdiff_t>(splice.inserted));
    }
    EXPECT_TRUE(std::ranges::equal(replayed, after->ids()));
    // "b" is downloaded now, which changes its row. "e" is new, which changes no row.
    EXPECT_EQ(changes.changed, (std::vector<kit::RowRange>{{1, 1}}));
}

TEST(DocumentRows, GivesEveryRowAnIdentifierOfItsOwn)
{
    FolderSnapshot::Builder builder(Url::fileURL("/drive"));
    const auto library = Url::fileURL("/libraries/Notes");
    builder.append(FolderSnapshot::ExtraItem{library, "Notes", FolderEntryKind::Library, {}});
    builder.append("Notes", FolderEntryKind::Folder, false);
    builder.append("text", FolderEntryKind::Document, false);
    builder.append("text", FolderEntryKind::Document, true);
    const auto rows = DocumentRows::make(builder.finish(ListingStage::Complete));

    EXPECT_EQ(std::set<kit::RowId>(rows->ids().begin(), rows->ids().end()).size(), 4U);
    EXPECT_EQ(rows->idFor(library), rows->ids()[0]);
    EXPECT_EQ(rows->idFor(Url::fileURL("/drive/Notes")), rows->ids()[1]);
}

} // namespace
