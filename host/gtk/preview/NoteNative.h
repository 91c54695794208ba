#pragma once

#include "host/gtk/base/PeerContext.h"

namespace host::gtk {

/// Makes a context know notes: texts of several lines.
void addNoteMaker(PeerContext& context);

} // namespace host::gtk
