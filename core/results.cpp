#include "core/results.h"

#include "core/angles.h"
#include "core/numbers.h"
#include "core/text.h"

namespace kavu {
std::string PrismText(double ccg) { return Mask(ccg, "####.000"); }

bool DescriptiveWords(RunState& st) {
  if (st.stp < 6 || st.MangTruong.size() < 6) return false;
  std::string& code = st.MangTruong[5];
  return KTraCCG(code) == 0 || code.size() <= 2;
}

std::pair<std::string, std::string> CodeAndNote(RunState& st) {
  const bool words = (st.stp == 6 || st.stp == 7) && DescriptiveWords(st);
  return {words ? st.Field(5) : std::string(), words && st.stp == 7 ? st.Field(6) : std::string()};
}

void GhiMangSoLieuVaoSoDo(RunState& st) {
  std::string note;
  if (st.stp == 5) {
    note = std::string(12, ' ');
  } else if (st.stp == 6 || st.stp == 7) {
    if (st.goc == 0 || DescriptiveWords(st)) {
      note = st.Field(5);
      if (st.stp == 7) note += " " + st.Field(6);
    }
  }
  st.MangSoLieuSoDo.push_back({st.TenDiem.str(), st.StGoc, st.StS.str(), GocSt1(st.GocD),
                               RString(PrismText(st.ccg), 10), note});
}

}  // namespace kavu
