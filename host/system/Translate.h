#pragma once

#include <string>

namespace host::system {

/// The name of the program's message catalogue.
inline constexpr const char* textDomain = "tarrow-drive";

/// A text of the host's own in the user's language; the key itself when the catalogue has none. Any thread.
std::string translated(const char* key);

} // namespace host::system
