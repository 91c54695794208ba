#include "kit/ViewObserver.h"

namespace platform::ui {

void ViewObserver::viewWantsFocus(View&, bool) { }

std::optional<Size> ViewObserver::nativeSize(const View&, double)
{
    return std::nullopt;
}

} // namespace platform::ui
