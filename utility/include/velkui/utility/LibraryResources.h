#pragma once

#include <velkcore/Resources.h>

namespace velkui::utility {

// The archives and images compiled into velkui (everything under resources/).
const velkcore::ResourceModule& LibraryResources();

}  // namespace velkui::utility
