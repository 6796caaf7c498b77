#include "products/pegs.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "core/station.h"
#include "core/text.h"

namespace kavu {

namespace {

// The observation columns of a peg line are 8 characters wide; a value never
// runs into the one before it, so the line can still be read back as a field
// book.
constexpr int kColumn = 8;

}  // namespace

void WritePegFileHead(TextOut& out, const Survey& survey, bool heights) {
  for (std::size_t i = 0; i < survey.knownRead; ++i) {
    const KnownPoint& point = survey.known[i];
    std::string line = "TR " + FixedWidth(point[0], kNameWidth) + " " + NumberWidth(point[1], 11) + " " +
                       NumberWidth(point[2], 10);
    if (heights) line += " " + NumberWidth(point[3], 10);
    out.Line(line);
  }
}

void WritePegBlocks(TextOut& out, const Survey& survey) {
  std::optional<std::size_t> station;
  bool ended = false;
  for (const ComputedPoint& point : survey.points) {
    if (point.kind() != PointKind::Peg) continue;
    if (point.station != station) {
      station = point.station;
      ended = false;
      const StationResult& s = survey.stations[point.station];
      out.Line("TR " + FixedWidth(s.station.name, kNameWidth));
      out.Line("DKD1 " + FixedWidth(s.orientation.name, kNameWidth));
      if (!s.checkRecord.empty()) out.Line(s.checkRecord);
    }
    if (ended) continue;
    // The record's fields: point, reading, distance, zenith, prism height,
    // peg name and the note.
    const std::string_view record = survey.Record(point);
    const auto f = [&](std::size_t k) { return RecordField(record, k); };
    ended = ReadingTooLong(f(1));
    if (ended) continue;
    out.Line(" " + FixedWidth(f(5), kNameWidth) + RString(f(1), kColumn) + NumberColumn(f(2), kColumn) +
             NumberColumn(f(3), kColumn) + " " + std::string(f(4)) + " " + std::string(f(6)));
  }
}

}  // namespace kavu
