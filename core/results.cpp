#include "core/results.h"

#include "core/numbers.h"
#include "core/station.h"
#include "core/text.h"

namespace kavu {

std::string PrismText(double ccg) { return Mask(ccg, kPrismMask.text); }

bool DescriptiveWords(const RunState& st) {
  if (st.stp < 6 || st.MangTruong.size() < 6) return false;
  const std::string_view code = TrimView(st.MangTruong[5]);
  return KTraCCG(code) == 0 || code.size() <= 2;
}

}  // namespace kavu
