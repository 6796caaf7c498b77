// Input check and conversion dispatch: the first stage of every run.
#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "core/host.h"
#include "core/state.h"
#include "import/formats.h"

namespace kavu {

// Sets filesl, tentm, daufile, duoifile, tentmbd and filesl1 from a path.
// daufile and duoifile use the first and second "." of the file name.
void DeriveFileSelection(FileSelection& sel, std::string_view path);

// KTraFileSoLieu and the dispatch: checks the chosen file, derives the names,
// selects the kind from the extension (unless kindOverride), copies the header
// texts when the field sketch is wanted, converts an instrument file, and
// switches the run to the field book. Only data files are read, and a
// converted field book never replaces a file the run reads (st.inputs lists
// them). With a jobLock, the job's lock is taken before anything is written
// (a second run of the job is refused) and the temporary files of a killed
// run are removed. Returns the field book's bytes, or nothing when the run
// must end.
std::optional<std::string> CheckAndConvert(RunState& st, Host& host, FileLock* jobLock = nullptr);

}  // namespace kavu
