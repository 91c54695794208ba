#include "platform/AppRegistry.h"

namespace platform {

std::string logText(const AppHandle& app)
{
    return app.localizedName + " (" + app.bundleIdentifier + ")";
}

} // namespace platform
