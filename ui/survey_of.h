// The run's result as a Survey, gathered from the tables a run leaves in its
// state, the field book it computed and its error report. It stands in until
// the run hands over its own typed result; nothing else reads those tables.
#pragma once

#include "core/state.h"
#include "core/survey.h"

namespace kavu {

// st is the state of a completed run (its tables, filesl and daufile).
Survey SurveyOf(const RunState& st);

}  // namespace kavu
