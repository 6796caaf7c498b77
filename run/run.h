// One computation run: from the compute button to the summary.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "core/host.h"
#include "core/state.h"
#include "core/survey.h"

namespace kavu {

enum class RunOutcome {
  NotStarted,    // the chosen file was refused (message box shown)
  StoppedEarly,  // the run ended before the station loop (message box shown)
  Completed,     // the summary was shown
  Cancelled,     // the user stopped the station loop: nothing written (message box shown)
};

struct RunResult {
  RunOutcome outcome = RunOutcome::NotStarted;
  int stations = 0;
  long long bodyRecords = 0;
  std::int32_t err = 0;
  std::string startTime, endTime;       // HH:MM:SS
  std::vector<std::string> unwritable;  // products that could not be written, with the reason
  std::vector<std::string> written;     // products put in place, in the order of the summary
  bool stopTooLate = false;             // a stop asked for once the products were in place
  MsgAnswer answer = MsgAnswer::Ok;     // the answer to the closing question
  Survey survey;                        // what the run computed and reported
};

// The summary's lines (UTF-8), without the empty line and the question.
std::vector<std::string> SummaryLines(const RunResult& result);

// tinh_Click: the run with the window state in st, the window behind host.
RunResult tinh_Click(RunState& st, Host& host);

}  // namespace kavu
