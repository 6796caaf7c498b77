// The drawing exchange file (.dxf): control and detail points with their
// names, for a CAD program.
#pragma once

#include "core/state.h"

namespace kavu {

// The drawing of the run's control points (MangKhongChe) and detail points,
// labels as high as the run's text height at its scale.
void WriteDrawing(TextOut& out, const RunState& st);

}  // namespace kavu
