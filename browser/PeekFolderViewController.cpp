#include "browser/PeekFolderViewController.h"

namespace tarrow {

std::shared_ptr<PeekFolderViewController> PeekFolderViewController::initWithURL(const platform::Url& url)
{
    return std::make_shared<PeekFolderViewController>(url);
}

} // namespace tarrow
