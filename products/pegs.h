// The auxiliary-peg file (.cp): the control points at its head, then a block
// in field-book form for each station that set out pegs.
#pragma once

#include "core/state.h"

namespace kavu {

// The control-point lines at the head of the file: the known points the run
// read, with their heights when heights are on.
void WritePegFileHead(TextOut& out, const Survey& survey, bool heights);

// Reports the first peg of the station just computed (its points from
// firstPoint on) whose reading cannot be a DDDMMSS reading: it ends the
// station's block in the peg file. Only when fcp is ticked.
void CheckPegReadings(RunState& st, std::size_t firstPoint);

// A block in field-book form for each station that set out pegs: the station,
// its orientation, its check record, then each peg up to one with a reading
// that cannot be one.
void WritePegBlocks(TextOut& out, const Survey& survey);

}  // namespace kavu
