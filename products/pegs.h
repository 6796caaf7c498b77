// The auxiliary-peg file (.cp): the control points at its head, then a block
// in field-book form for each station that set out pegs.
#pragma once

#include "core/state.h"

namespace kavu {

// The control-point lines at the head of the file, when fcp is ticked.
void WritePegFileHead(RunState& st);

// The current station's peg block, when fcp is ticked and it has pegs.
void incocphu(RunState& st);

}  // namespace kavu
