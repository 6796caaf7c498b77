#include "core/state.h"

namespace kavu {

const std::string& ComputationFields::Field(std::size_t i) const {
  static const std::string kNone;
  return i < MangTruong.size() ? MangTruong[i] : kNone;
}

void ReportError(RunState& st, std::string_view line) {
  ++st.err;
  st.errFile.Line("");
  st.errFile.Line(line);
}

}  // namespace kavu
