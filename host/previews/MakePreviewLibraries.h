#pragma once

#include "host/gtk/preview/PreviewLibraries.h"

/// The one function of the module, found by this name (`host::gtk::makePreviewLibrariesName`).
extern "C" void trwMakePreviewLibraries(std::shared_ptr<host::gtk::PreviewLibraries>& made);
