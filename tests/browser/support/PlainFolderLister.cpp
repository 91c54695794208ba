#include "tests/browser/support/PlainFolderLister.h"

#include <filesystem>
#include <set>

namespace testing_support {

namespace {

using platform::FolderEntryKind;
using platform::FolderSnapshot;
using platform::Url;
namespace fs = std::filesystem;

FolderEntryKind kindOf(const fs::directory_entry& entry)
{
    if (entry.is_symlink())
        return FolderEntryKind::Link;
    return entry.is_directory() ? FolderEntryKind::Folder : FolderEntryKind::Document;
}

std::shared_ptr<const FolderSnapshot> read(
    const Url& folder, const std::vector<FolderSnapshot::ExtraItem>& extraItems)
{
    FolderSnapshot::Builder builder(folder);
    for (const auto& item : extraItems)
        builder.append(item);
    std::error_code problem;
    std::set<fs::directory_entry> entries;
    for (fs::directory_iterator at(folder.path(), problem), end; !problem && at != end; at.increment(problem))
        entries.insert(*at);
    for (const auto& entry : entries) {
        if (const auto name = entry.path().filename().string(); !name.starts_with('.'))
            builder.append(name, kindOf(entry), false);
    }
    if (!problem)
        return builder.finish(platform::ListingStage::Complete);
    return builder.finish(
        platform::ListingStage::Failed, platform::Error(platform::FileErrorCode::NoSuchItem));
}

class Listing : public platform::FolderListing, public std::enable_shared_from_this<Listing> {
public:
    Listing(std::shared_ptr<platform::Dispatch> dispatch, Url folder,
        std::vector<FolderSnapshot::ExtraItem> extraItems, platform::FolderLister::Update update)
        : _dispatch(std::move(dispatch))
        , _folder(std::move(folder))
        , _extraItems(std::move(extraItems))
        , _update(std::move(update))
    {
    }

    void refresh() override
    {
        _dispatch->mainQueue()->async([weak = weak_from_this()] {
            if (const auto self = weak.lock())
                self->_update(read(self->_folder, self->_extraItems));
        });
    }

private:
    std::shared_ptr<platform::Dispatch> _dispatch;
    Url _folder;
    std::vector<FolderSnapshot::ExtraItem> _extraItems;
    platform::FolderLister::Update _update;
};

} // namespace

std::shared_ptr<platform::FolderListing> PlainFolderLister::list(
    const Url& folder, std::vector<FolderSnapshot::ExtraItem> extraItems, Update update)
{
    auto listing = std::make_shared<Listing>(_dispatch, folder, std::move(extraItems), std::move(update));
    listing->refresh();
    return listing;
}

} // namespace testing_support
