#pragma once

#include "host/gtk/PeerContext.h"

namespace host::gtk {

/// Makes a context know notes: texts of several lines that take the focus when they are shown.
void addNoteMaker(PeerContext& context);

} // namespace host::gtk
