// The drawing exchange file (.dxf): control and detail points with their
// names, for a CAD program.
#pragma once

#include "core/state.h"

namespace kavu {

// Writes daufile + ".dxf"; false when the file could not be written.
bool indxf(const RunState& st);

}  // namespace kavu
