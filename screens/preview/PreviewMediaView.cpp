#include "screens/preview/PreviewMediaView.h"

#include <utility>

namespace platform::components {

void PreviewMediaView::setMedia(Content content)
{
    _content = std::move(content);
    native().notify([](auto& native) { native.previewContentDidChange(); });
}

} // namespace platform::components
