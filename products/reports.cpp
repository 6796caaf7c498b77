#include "products/reports.h"

#include <algorithm>
#include <array>
#include <filesystem>
#include <optional>
#include <string>

#include "core/angles.h"
#include "core/lookup.h"
#include "core/messages.h"
#include "core/numbers.h"
#include "core/paths.h"
#include "core/results.h"
#include "core/station.h"
#include "core/text.h"

namespace kavu {

void WriteErrorReport(TextOut& out, const Survey& survey) {
  out.Line(msg::kErrHeader1);
  out.Line(msg::kErrHeader2);
  for (const ReportEntry& entry : survey.report) {
    if (entry.counted) out.EndLine();
    survey.AppendText(out.Buffer(), entry);
    out.EndLine();
  }
}

std::vector<std::uint32_t> ErrorReportBookLines(const Survey& survey) {
  std::vector<std::uint32_t> lines(2, 0);  // the two lines of the head
  lines.reserve(2 + 2 * survey.report.size());
  std::string text;
  for (const ReportEntry& entry : survey.report) {
    if (entry.counted) lines.push_back(0);
    text.clear();
    survey.AppendText(text, entry);
    // CR LF, a lone CR and a lone LF each end a line of the text.
    std::size_t breaks = 0;
    for (std::size_t i = 0; i < text.size(); ++i) {
      if (text[i] == '\r' && i + 1 < text.size() && text[i + 1] == '\n') ++i;
      if (text[i] == '\r' || text[i] == '\n') ++breaks;
    }
    lines.insert(lines.end(), breaks + 1, entry.line);
  }
  return lines;
}

void WriteStationListingHeader(TextOut& out) {
  for (std::string_view line : msg::kCpvHeader) out.Line(line);
}

std::string OrientationDistanceText(double distance) {
  return NumberWidth(RString(Mask(distance, "####.000"), 8), 8);
}

void WriteStationListing(TextOut& out, const Survey& survey) {
  // The first and last detail point of each station.
  struct Ends {
    const ComputedPoint* first = nullptr;
    const ComputedPoint* last = nullptr;
  };
  std::vector<Ends> ends(survey.stations.size());
  for (const ComputedPoint& point : survey.points) {
    if (point.kind() != PointKind::Detail) continue;
    Ends& e = ends[point.station];
    if (e.first == nullptr) e.first = &point;
    e.last = &point;
  }
  const auto name = [&](const ComputedPoint* point) {
    return FixedWidth(point != nullptr ? survey.Name(*point) : std::string_view(), 5);
  };
  for (std::size_t i = 0; i < survey.stations.size(); ++i) {
    const StationResult& s = survey.stations[i];
    out.Line(FixedWidth(s.station.name, kNameWidth) + FixedWidth(s.orientation.name, kNameWidth) + " " +
             GocStringText(s.backBearing) + " " + OrientationDistanceText(s.orientationDistance) +
             "    " + name(ends[i].first) + " -  " + name(ends[i].last));
  }
}

namespace {

// A number of its mask in a column of width, set off by at least one space.
void AppendColumn(std::string& out, double x, const NumberMask& mask, std::size_t width) {
  out.push_back(' ');
  const std::size_t from = out.size();
  AppendMask(out, x, mask);
  PadInFront(out, from, width - 1);
}

}  // namespace

void AppendCoordinateTextLine(std::string& out, const Survey& survey, const ComputedPoint& p,
                              int decimals) {
  const Survey::PointTexts texts = survey.Texts(p);
  AppendFixed(out, texts.name, 5);
  out.push_back(' ');
  std::size_t from = out.size();
  AppendMask(out, p.x, kNorthingMask);
  PadBehind(out, from, 11);
  out.push_back(' ');
  from = out.size();
  AppendMask(out, p.y, kEastingMask);
  PadBehind(out, from, 10);
  out.append("  ");
  from = out.size();
  AppendNumberText(out, RoundEven(MillimetreValue(p.z), decimals));
  PadInFront(out, from, 9);
  out.push_back(' ');
  out.append(texts.code);
  out.push_back(' ');
  out.append(texts.note);
}

std::string ControlListingLine(const Survey& survey, const ControlListing& entry) {
  if (!entry.point) {
    return ControlLine(FixedWidth(entry.name, kNameWidth), entry.x, entry.y,
                       entry.height ? &entry.z : nullptr);
  }
  const ComputedPoint& point = survey.points[*entry.point];
  const std::string z = NumberWidth(HeightText(point.z), 10);
  std::string line =
      ControlLine(FixedWidth(entry.name, kNameWidth), NumberWidth(NorthingText(point.x), 11),
                  NumberWidth(EastingText(point.y), 10), entry.height ? &z : nullptr);
  if (point.kind() == PointKind::Peg && !survey.Note(point).empty()) {
    line += " ";
    line += survey.Note(point);
  }
  return line;
}

void AppendCoordinateListingLine(std::string& out, const Survey& survey, const ComputedPoint& p) {
  // The detail record's fields: name, reading, distance, zenith, prism
  // height, then its words.
  std::array<std::string_view, 7> f;
  const std::size_t fields = RecordFields(survey.Text(p.record, std::string_view::npos), f);
  const std::size_t from = out.size();
  out.append(f[0].substr(0, kNameWidth));
  PadBehind(out, from, 5);
  AppendColumn(out, p.x, kNorthingMask, 12);
  AppendColumn(out, p.y, kEastingMask, 12);
  AppendColumn(out, p.z, kHeightMask, 12);
  AppendColumn(out, Val(f[4]), kPrismMask, 10);
  if (!p.words) return;
  // Each word keeps its blank, an empty one too: a record whose line ended in
  // a tab has an empty last field.
  out.append(" ").append(f[5]);
  if (fields == 7) out.append(" ").append(f[6]);
}

void WriteControlListing(TextOut& out, const Survey& survey) {
  for (const ControlListing& entry : survey.controlListing) {
    out.Line(ControlListingLine(survey, entry));
  }
  out.Line("");
}

void WriteStationRecords(TextOut& out, const Survey& survey, bool coordinates) {
  std::optional<std::size_t> station;
  for (const ComputedPoint& point : survey.points) {
    if (point.station != station) {
      station = point.station;
      const StationResult& s = survey.stations[point.station];
      out.Line("TR " + FixedWidth(s.station.name, kNameWidth) + " " + s.instrumentHeight);
      out.Line("DKD " + FixedWidth(s.orientation.name, kNameWidth));
    }
    if (!coordinates) {
      out.Line(survey.Record(point));
    } else if (point.listed) {
      AppendCoordinateListingLine(out.Buffer(), survey, point);
      out.EndLine();
    }
  }
}

void WriteCoordinateText(TextOut& out, const Survey& survey, int decimals) {
  for (const ComputedPoint& point : survey.points) {
    if (point.kind() != PointKind::Detail) continue;
    AppendCoordinateTextLine(out.Buffer(), survey, point, decimals);
    out.EndLine();
  }
}

}  // namespace kavu
