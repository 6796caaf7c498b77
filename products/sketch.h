// The field sketch (.sdo): the observations laid out per station as the
// ruled form filed with the survey.
#pragma once

#include "core/state.h"

namespace kavu {

// Writes the current station's section when fsdo is ticked.
void insodo(RunState& st);

}  // namespace kavu
