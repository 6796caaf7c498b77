#include "ui/survey_of.h"

#include <cmath>
#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "core/angles.h"
#include "core/lines.h"
#include "core/numbers.h"
#include "core/text.h"

namespace kavu {
namespace {

// The fields of a line, split as the run splits the working copy.
std::vector<std::string> Fields(std::string_view line) {
  std::string normal(TrimView(line));
  return SplitFields(normal);
}

std::string NormalLine(std::string_view line) {
  std::string normal(TrimView(line));
  SplitFields(normal);
  return normal;
}

// A body record whose code is a peg name (as the run dispatches them).
bool IsPegRecord(std::vector<std::string> fields) {
  if (fields.size() < 6) return false;
  const int notDigits = KTraCCG(fields[5]);
  return fields[5].size() > 2 && notDigits == 1;
}

SurveyPoint PointOf(const KnownPoint& known, bool heights) {
  SurveyPoint p{Trim(known[0]), RoundEven(Val(known[1]), 3), RoundEven(Val(known[2]), 3), {}};
  if (heights && HasNumber(known[3])) p.h = RoundEven(Val(known[3]), 3);
  return p;
}

// The first known point of that name, as the lookup takes it.
std::optional<SurveyPoint> Known(const RunState& st, std::string_view name) {
  for (const KnownPoint& known : st.MangKhongChe) {
    if (TrimView(known[0]) == name) return PointOf(known, Ticked(st.fdc));
  }
  return std::nullopt;
}

// Walks the field book forward, finding the lines the run computed in order.
class FieldBookCursor {
 public:
  explicit FieldBookCursor(std::vector<std::string> lines) : lines_(std::move(lines)) {}
  // The line number (from 1) of the next line matching, or 0 (the cursor
  // stays) when none does; every line passed over is given to passed.
  template <typename Match, typename Passed>
  std::size_t Find(Match match, Passed passed) {
    for (std::size_t i = next_; i < lines_.size(); ++i) {
      if (match(lines_[i])) {
        for (std::size_t k = next_; k < i; ++k) passed(lines_[k]);
        next_ = i + 1;
        return i + 1;
      }
    }
    return 0;
  }
  template <typename Passed>
  void Rest(Passed passed) {
    for (; next_ < lines_.size(); ++next_) passed(lines_[next_]);
  }

 private:
  std::vector<std::string> lines_;
  std::size_t next_ = 0;
};

void AddControl(Survey& survey, const SurveyPoint& point) {
  for (const SurveyPoint& known : survey.control) {
    if (known.name == point.name) return;
  }
  survey.control.push_back(point);
}

// The error report's messages; the point a "Diem" line names.
void ReadReport(const RunState& st, Survey& survey) {
  if (st.err == 0) return;
  const auto lines = ReadLines(st.daufile + ".err");
  if (!lines) return;
  for (std::size_t i = 2; i < lines->size(); ++i) {
    const std::string& text = (*lines)[i];
    if (TrimView(text).empty()) continue;
    ReportEntry entry{text, {}, 0};
    for (std::string_view head : {"Diem: ", "Diem "}) {
      if (!std::string_view(text).starts_with(head)) continue;
      const std::vector<std::string> words = Fields(std::string_view(text).substr(head.size()));
      if (!words.empty()) entry.point = words[0];
      break;
    }
    survey.report.push_back(std::move(entry));
  }
  // A message about a point drawn on the map points at that point's record.
  for (ReportEntry& entry : survey.report) {
    for (const ComputedPoint& p : survey.points) {
      if (!entry.point.empty() && p.name == entry.point) {
        entry.line = p.line;
        break;
      }
    }
  }
}

}  // namespace

Survey SurveyOf(const RunState& st) {
  Survey survey;
  const bool heights = Ticked(st.fdc);
  FieldBookCursor book(ReadLines(st.filesl).value_or(std::vector<std::string>{}));
  std::size_t detail = 0;  // next entry of MangToaDoChiTiet
  std::size_t known = 0;   // where the next peg's entry is looked for in MangKhongChe
  // The station being walked: the last one of survey.stations.
  auto station = [&]() -> StationResult* {
    return survey.stations.empty() ? nullptr : &survey.stations.back();
  };

  // A check record passed over in the field book gives the station its check point.
  auto passed = [&](const std::string& line) {
    const std::vector<std::string> f = Fields(line);
    if (station() == nullptr || f.size() != 7 || Upper(f[6]) != "KT") return;
    if (const auto point = Known(st, f[5])) {
      station()->check = *point;
      AddControl(survey, *point);
    }
  };
  for (const std::string& line : st.MangSoLieuASC) {
    const std::vector<std::string> f = Fields(line);
    if (f.empty()) continue;
    if (f[0] == "TR" && f.size() >= 2) {
      StationResult result;
      result.station = Known(st, f[1]).value_or(SurveyPoint{f[1], 0, 0, {}});
      result.line = book.Find(
          [&](const std::string& l) {
            const auto g = Fields(l);
            return g.size() >= 2 && g[0].starts_with("TR") && g[1] == f[1] && g.size() <= 3;
          },
          passed);
      AddControl(survey, result.station);
      survey.stations.push_back(result);
      continue;
    }
    if (f[0] == "DKD" && f.size() >= 2 && station() != nullptr) {
      StationResult& s = *station();
      s.orientation = Known(st, f[1]).value_or(SurveyPoint{f[1], 0, 0, {}});
      const double dx = s.orientation.x - s.station.x, dy = s.orientation.y - s.station.y;
      s.orientationDistance = std::hypot(dx, dy);
      s.bearing = std::atan2(dy, dx) * 180 / kPi;
      if (s.bearing < 0) s.bearing += 360;
      AddControl(survey, s.orientation);
      continue;
    }
    const std::string normal = NormalLine(line);
    ComputedPoint point;
    point.station = survey.stations.empty() ? 0 : survey.stations.size() - 1;
    point.line = book.Find([&](const std::string& l) { return NormalLine(l) == normal; }, passed);
    if (IsPegRecord(f)) {
      point.kind = PointKind::Peg;
      point.name = Trim(f[5]);
      while (known < st.MangKhongChe.size() && TrimView(st.MangKhongChe[known][0]) != point.name) {
        ++known;
      }
      if (known == st.MangKhongChe.size()) continue;
      const SurveyPoint p = PointOf(st.MangKhongChe[known++], heights);
      point.x = p.x;
      point.y = p.y;
      point.h = p.h;
      if (f.size() > 6) point.note = f[6];
    } else {
      if (detail >= st.MangToaDoChiTiet.size()) continue;
      const DetailPoint& d = st.MangToaDoChiTiet[detail++];
      point.name = Trim(d[0]);
      point.x = RoundEven(Val(d[1]), 3);
      point.y = RoundEven(Val(d[2]), 3);
      if (heights) point.h = RoundEven(Val(d[3]), 3);
      point.code = d[4];
      point.note = d[5];
    }
    survey.points.push_back(std::move(point));
  }
  book.Rest(passed);
  ReadReport(st, survey);
  return survey;
}

}  // namespace kavu
