// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/list/DocumentRows.h"

#include <gtest/gtest.h>

#include <set>

using namespace platform;
using namespace screens;

namespace {

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
