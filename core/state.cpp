#include "core/state.h"

namespace kavu {

void ReportError(RunState& st, std::string_view line) {
  ++st.err;
  st.errFile.Line("");
  st.errFile.Line(line);
}

}  // namespace kavu
