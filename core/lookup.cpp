#include "core/lookup.h"

#include <cmath>
#include <optional>

#include "core/messages.h"
#include "core/numbers.h"
#include "core/station.h"
#include "core/text.h"

namespace kavu {

std::string ControlLine(const std::string& name12, const std::string& x11, const std::string& y10,
                        const std::string* z10) {
  std::string line = "TR " + name12;
  // A name that fills its columns would run into X and read back wrongly.
  if (!name12.empty() && name12.back() != ' ') line += ' ';
  line += x11 + " " + y10;
  if (z10 != nullptr) line += " " + *z10;
  return line;
}

namespace {

void AppendControlLine(RunState& st) {
  st.ChuoiKC += ControlLine(st.TenKC, st.StX, st.StY, Ticked(st.fdc) ? &st.StZ.str() : nullptr);
  st.ChuoiKC += "\r\n";
}

// Whether ChuoiKC already holds a line for the point: the name field of each
// line (after "TR "), trimmed, is compared whole, so that "3" is not found in
// the line of "1003". The lines added since the last lookup are read first.
bool ChuoiKCHas(RunState& st, std::string_view name) {
  constexpr std::string_view kHead = "TR ";
  constexpr std::size_t kNameWidth = decltype(RunState::TenKC)::kWidth;
  const std::string_view chuoi = st.ChuoiKC;
  if (st.chuoiKCRead > chuoi.size()) {
    st.chuoiKCNames.clear();
    st.chuoiKCRead = 0;
  }
  std::size_t start = st.chuoiKCRead;
  while (start < chuoi.size()) {
    std::size_t end = chuoi.find("\r\n", start);
    // A line not yet ended is read again with its end.
    if (end == std::string_view::npos) break;
    const std::string_view line = chuoi.substr(start, end - start);
    if (line.starts_with(kHead)) {
      st.chuoiKCNames.emplace(TrimView(line.substr(kHead.size(), kNameWidth)));
    }
    start = end + 2;
  }
  st.chuoiKCRead = start;
  if (st.chuoiKCNames.contains(std::string(name))) return true;
  // The unended last line, if any.
  const std::string_view rest = chuoi.substr(start);
  return rest.starts_with(kHead) && TrimView(rest.substr(kHead.size(), kNameWidth)) == name;
}

// The positions of name in a table, in order; nameOf gives a row's trimmed
// name, or nothing for a row that is not looked up.
template <typename Row, typename NameOf>
const std::vector<std::size_t>& Positions(const std::vector<Row>& table, RunState::NameIndex& index,
                                          std::string_view name, NameOf nameOf) {
  if (index.done > table.size()) index = {};
  for (; index.done < table.size(); ++index.done) {
    const std::optional<std::string_view> key = nameOf(table[index.done]);
    if (key) index.positions[std::string(*key)].push_back(index.done);
  }
  static const std::vector<std::size_t> kNone;
  const auto found = index.positions.find(std::string(name));
  return found == index.positions.end() ? kNone : found->second;
}

void TakeCoordinates(RunState& st) {
  st.X = RoundEven(Val(st.StX.str()), 3);
  st.Y = RoundEven(Val(st.StY.str()), 3);
  st.Z = RoundEven(Val(st.StZ.str()), 3);
  st.hasZ = !TrimView(st.StZ.str()).empty();
}

// The known points the run used, each once, in the order of first use.
void NoteControlPoint(RunState& st, std::string_view name) {
  if (!st.controlNames.emplace(name).second) return;
  SurveyPoint point{std::string(name), st.X, st.Y, std::nullopt};
  if (st.hasZ && Ticked(st.fdc)) point.h = st.Z;
  st.survey.control.push_back(std::move(point));
}

}  // namespace

void TimToaDoDiem(RunState& st) {
  st.n = 0;
  int first = 0;
  st.TenKC = Trim(st.TenKC.str());
  const std::string wanted = Trim(st.TenKC.str());
  const std::string_view name = wanted;
  const auto knownName = [](const KnownPoint& point) {
    return std::optional<std::string_view>(TrimView(point[0]));
  };
  for (const std::size_t position : Positions(st.MangKhongChe, st.knownIndex, name, knownName)) {
    const int k = static_cast<int>(position);
    const KnownPoint& point = st.MangKhongChe[position];
    ++st.n;
    st.StX = point[1];
    st.StY = point[2];
    st.StZ = point[3];
    if (!ChuoiKCHas(st, name)) AppendControlLine(st);
    if (st.n > 1) {
      const double x = RoundEven(Val(st.StX.str()), 3);
      const double y = RoundEven(Val(st.StY.str()), 3);
      if (std::fabs(st.X - x) > st.dscdh || std::fabs(st.Y - y) > st.dscdh) {
        ReportError(st,
                    std::string(msg::kPoint) + st.TenKC.str() + std::string(msg::kAtLine) +
                        ReportNumber(first) + std::string(msg::kAnd) + ReportNumber(k + 1) +
                        std::string(msg::kDifferentCoordinates) + std::string(msg::kDX) +
                        ReportNumber(RoundEven(st.X - x, 2)) + std::string(msg::kDY) +
                        ReportNumber(RoundEven(st.Y - y, 2)),
                    st.TenKC.str());
      }
    } else {
      TakeCoordinates(st);
      first = k + 1;
    }
  }
  // A point computed earlier in the run, named "DKC" + its name.
  const bool computedPoint = name.starts_with("DKC");
  const std::string_view computedName = computedPoint ? name.substr(3) : std::string_view();
  const auto detailName = [](const ComputedPoint& point) {
    return point.kind == PointKind::Detail ? std::optional<std::string_view>(point.name)
                                           : std::nullopt;
  };
  static const std::vector<std::size_t> kNone;
  const std::vector<std::size_t>& computed =
      computedPoint ? Positions(st.survey.points, st.detailIndex, computedName, detailName) : kNone;
  for (const std::size_t position : computed) {
    const ComputedPoint& point = st.survey.points[position];
    ++st.n;
    st.StX = NorthingText(point.x);
    st.StY = EastingText(point.y);
    st.StZ = HeightText(point.z);
    if (st.n == 1) TakeCoordinates(st);
    st.MangKhongChe.push_back({st.TenKC.str(), st.StX.str(), st.StY.str(), st.StZ.str()});
    AppendControlLine(st);
  }
  if (st.n != 0) NoteControlPoint(st, name);
  if (st.n == 0) {
    st.I = 0;
    ReportError(st,
                std::string(msg::kPointColon) + st.TenKC.str() + std::string(msg::kNoCoordinates),
                st.TenKC.str());
  }
}

}  // namespace kavu
