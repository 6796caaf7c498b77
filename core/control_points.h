// Control points and the working copy of the field book.
#pragma once

#include <string>
#include <vector>

#include "core/host.h"
#include "core/state.h"

namespace kavu {

// DocFileKhongChe: fills MangKhongChe from the field book's bytes or from the
// common control-point file and the working copy tamsl from the rest of the
// field book. A working copy without a station record that the station loop
// can reach is left empty. False when the run must end (message box shown).
bool DocFileKhongChe(RunState& st, Host& host, std::string_view fieldBook);

}  // namespace kavu
