#pragma once

#include <string>
#include <vector>

namespace testing_support {

/// The warnings that the toolkit and its libraries have written since the last call.
std::vector<std::string> takeToolkitWarnings();

} // namespace testing_support
