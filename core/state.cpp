#include "core/state.h"

#include "core/text.h"

namespace kavu {

const std::string& ComputationFields::Field(std::size_t i) const {
  static const std::string kNone;
  return i < MangTruong.size() ? MangTruong[i] : kNone;
}

void ReportError(RunState& st, std::string_view line, std::string_view point) {
  ++st.err;
  st.survey.report.push_back({std::string(line), Trim(point), st.line});
}

}  // namespace kavu
