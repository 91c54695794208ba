#pragma once

#include "platform/Dispatch.h"
#include "platform/FolderLister.h"

#include <memory>

namespace testing_support {

/// Lists a folder's visible names in one go, in the order of their bytes, from the queue that is given. It
/// watches nothing: changes show after a refresh.
class PlainFolderLister : public platform::FolderLister {
public:
    explicit PlainFolderLister(std::shared_ptr<platform::Dispatch> dispatch)
        : _dispatch(std::move(dispatch))
    {
    }

    std::shared_ptr<platform::FolderListing> list(const platform::Url& folder,
        std::vector<platform::FolderSnapshot::ExtraItem> extraItems, Update update) override;

private:
    std::shared_ptr<platform::Dispatch> _dispatch;
};

} // namespace testing_support
