// Control points and the working copy of the field book.
#pragma once

#include <string>
#include <vector>

#include "core/host.h"
#include "core/state.h"

namespace kavu {

// DocFileKhongChe: fills MangKhongChe from the field book's bytes or from the
// common control-point file and counts the lines of the working copy, the
// rest of the field book (workingLines). A working copy without a station
// record that the station loop can reach counts none. False when the run must
// end (message box shown).
bool DocFileKhongChe(RunState& st, Host& host, std::string_view fieldBook);

// Whether a line of the field book belongs to the working copy (neither blank
// nor a control record); its surrounding spaces removed, normalised into line
// and split into fields.
bool WorkingLine(std::string_view raw, std::string& line, std::vector<std::string_view>& fields);

}  // namespace kavu
