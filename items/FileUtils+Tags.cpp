// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/FileUtils.h"
#include "items/UrlResolution.h"

#include "platform/FileChanges.h"
#include "platform/FileCoordinator.h"

#include <algorithm>

namespace tarrow {

namespace {

using Tags = std::vector<std::string>;

/// Changes the tags of an item in a coordinated write.
Result<Tags> editTags(const Url& url, const FileUtils::StillWanted& stillWanted, const Operation& op,
    const platform::FileChanges::TagEdit& edit)
{
    const auto item = trw_URLByResolvingBookmark(url);
    if (!item)
        return Error(FileErrorCode::NoSuchItem);
    Result<Tags> before = Error(FileErrorCode::Cancelled);
    const auto refused = services().fileCoordinator().coordinateWriting(
        *item, platform::WritingOptions::None, [&](const Url& location) {
            if (!stillWanted || stillWanted())
                before = services().fileChanges().editTags(location.path(), edit);
        });
    if (refused)
        return *refused;
    if (before)
        op.info("Changed the tags of '%@'", *item);
    else
        op.error("failed to change the tags of '%@': %@", *item, *before.error);
    return before;
}

bool has(const Tags& tags, const std::string& tag)
{
    return std::ranges::find(tags, tag) != tags.end();
}

Tags changed(Tags tags, const Tags& added, const Tags& removed)
{
    std::erase_if(tags, [&](const std::string& tag) { return has(removed, tag); });
    for (const auto& tag : added) {
        if (!has(tags, tag))
            tags.push_back(tag);
    }
    return tags;
}

} // namespace

Result<Tags> FileUtils::setTags(const Url& url, const Tags& tags, const StillWanted& stillWanted)
{
    static constexpr Operation op{"+[FileUtils setTags:]"};
    return editTags(url, stillWanted, op, [&](const Tags&) { return tags; });
}

Result<Tags> FileUtils::changeTags(
    const Url& url, const Tags& added, const Tags& removed, const StillWanted& stillWanted)
{
    static constexpr Operation op{"+[FileUtils changeTags:]"};
    return editTags(
        url, stillWanted, op, [&](Tags tags) { return changed(std::move(tags), added, removed); });
}

Result<Tags> FileUtils::changeTagsBack(const Url& url, const Tags& before, const Tags& added,
    const Tags& removed, const StillWanted& stillWanted)
{
    static constexpr Operation op{"+[FileUtils changeTagsBack:]"};
    return editTags(url, stillWanted, op, [&](Tags tags) {
        if (tags == changed(before, added, removed))
            return before;
        Tags gone = added, back = removed;
        std::erase_if(gone, [&](const std::string& tag) { return has(before, tag); });
        std::erase_if(back, [&](const std::string& tag) { return !has(before, tag); });
        return changed(std::move(tags), back, gone);
    });
}

} // namespace tarrow
