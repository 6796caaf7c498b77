// The auxiliary-peg file (.cp): the control points at its head, then a block
// in field-book form for each station that set out pegs.
#pragma once

#include "core/lines.h"
#include "core/survey.h"

namespace kavu {

// The control-point lines at the head of the file: the known points the run
// read, with their heights when heights are on.
void WritePegFileHead(TextOut& out, const Survey& survey, bool heights);

// A block in field-book form for each station that set out pegs: the station,
// its orientation, its check record, then each peg up to one with a reading
// that cannot be one.
void WritePegBlocks(TextOut& out, const Survey& survey);

}  // namespace kavu
