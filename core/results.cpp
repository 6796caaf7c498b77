#include "core/results.h"

#include "core/angles.h"
#include "core/numbers.h"
#include "core/text.h"

namespace kavu {
namespace {

std::string PrismText(double ccg) { return Mask(ccg, "####.000"); }

}  // namespace

bool DescriptiveWords(RunState& st) {
  if (st.stp < 6 || st.MangTruong.size() < 6) return false;
  std::string& code = st.MangTruong[5];
  return KTraCCG(code) == 0 || code.size() <= 2;
}

std::pair<std::string, std::string> CodeAndNote(RunState& st) {
  const bool words = (st.stp == 6 || st.stp == 7) && DescriptiveWords(st);
  return {words ? st.Field(5) : std::string(), words && st.stp == 7 ? st.Field(6) : std::string()};
}

void GhiMangSoLieuToaDo(RunState& st) {
  st.MangSoLieuToaDo.resize(st.MangSoLieuASC.size());
  std::string line;
  if (st.stp >= 5 && st.stp <= 7 && (st.stp == 5 || DescriptiveWords(st))) {
    line = LString(Trim(st.TenDiem.str()), 5) + NumberColumn(st.StX.str(), 12) +
           NumberColumn(st.StY.str(), 12) + NumberColumn(st.StZ.str(), 12) +
           NumberColumn(PrismText(st.ccg), 10);
    if (st.stp >= 6) line += " " + st.Field(5);
    if (st.stp == 7) line += " " + st.Field(6);
  }
  if (!st.MangSoLieuToaDo.empty()) st.MangSoLieuToaDo.back() = line;
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
