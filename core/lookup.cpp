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

// A line of the control-point listing for the point looked up: a known point
// with its coordinate texts, or (point) a point of this run.
void AppendControlLine(RunState& st, std::string_view name,
                       std::optional<std::size_t> point = std::nullopt) {
  ControlListing entry{std::string(name), point, {}, {}, {}, Ticked(st.fdc)};
  if (!point) {
    entry.x = st.StX.str();
    entry.y = st.StY.str();
    entry.z = st.StZ.str();
  }
  st.listedNames.emplace(name);
  st.survey.controlListing.push_back(std::move(entry));
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
    if (!st.listedNames.contains(wanted)) AppendControlLine(st, name);
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
  const auto detailName = [&st](const ComputedPoint& point) {
    return point.kind() == PointKind::Detail
               ? std::optional<std::string_view>(st.survey.Name(point))
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
    AppendControlLine(st, name, position);
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
