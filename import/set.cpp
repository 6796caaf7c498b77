// SET raw files: the SDR record codes with 16-character fields; every set-up
// carries its station's coordinates, and the first observation after a set-up
// is the one on the orientation point. The first pass writes every point of
// known coordinates as a control point and keeps the set-ups and observations
// with the prism height in force; the second writes the station blocks from
// them. A point is named by its identifier throughout.

#include <string>
#include <string_view>
#include <vector>

#include "core/angles.h"
#include "core/lines.h"
#include "core/numbers.h"
#include "core/text.h"
#include "import/converters.h"
#include "import/instrument_common.h"
#include "import/sdr_records.h"

namespace kavu {
namespace {

// A set-up or an observation of the first pass, with the prism height in
// force when it was recorded.
struct Entry {
  std::string_view line;
  bool setup = false;
  std::string prism_height;
};

// A set-up without identifier keeps the label of its description, or "DKC".
std::string StationName(std::string_view setup) {
  const std::string_view id = TrimView(Columns(setup, 5, 20));
  if (!id.empty()) return BlankFreeName(id);
  const std::string_view description = TrimView(Columns(setup, 85, 100));
  return BlankFreeName(description.size() < 3 ? "DKC" : Trim(FixedWidth(description, kNameWidth)));
}

// The target of an observation; one without identifier keeps its code.
std::string TargetName(std::string_view observation) {
  const std::string_view id = TrimView(Columns(observation, 21, 36));
  return BlankFreeName(id.empty() ? Trim(FixedWidth(TrimView(Columns(observation, 85, 100)), kNameWidth))
                                  : id);
}

}  // namespace

Conversion ConvertSet(std::string_view content) {
  const std::vector<std::string> lines = SplitLines(content);
  Conversion result;
  const SdrHeader header = ReadSdrHeader(lines, 16);
  result.report = header.report;
  const Units& units = header.units;
  auto put = [&result](std::string_view record) { AppendLine(result.book, record); };

  // Pass 1: coordinates of set-ups and of every coordinate record.
  std::vector<Entry> entries;
  std::string prism_height;
  for (const std::string& line : lines) {
    const std::string_view code = RecordCode(line);
    const bool setup = code == "02TP";
    if (setup || (IsCoordinateCode(code) && !IsSetUpCode(code))) {
      const std::string record = KnownPointRecord(StationName(line), line, kWideLayout, header);
      if (!record.empty()) put(record);
      if (setup) entries.push_back({line, true, {}});
    } else if (code == "03NM") {
      prism_height = units.LengthText(Trim(Columns(line, 5, 20)));
    } else if (code == "09F1") {
      entries.push_back({line, false, prism_height.empty() ? "0.0" : prism_height});
    }
  }

  // Pass 2. Observations before the first set-up belong to no station and
  // are skipped; a set-up with no observation after it writes nothing here.
  std::size_t i = 0;
  while (i < entries.size() && !entries[i].setup) ++i;
  while (i < entries.size()) {
    // Of consecutive set-ups the last one counts.
    while (i + 1 < entries.size() && entries[i + 1].setup) ++i;
    const std::string_view setup = entries[i].line;
    ++i;
    if (i >= entries.size()) break;

    const Entry& orientation = entries[i];
    const std::string orientation_name = TargetName(orientation.line);
    const Shot first = ReadShot(orientation.line, kWideLayout, units);
    std::string instrument_height = units.LengthText(Trim(Columns(setup, 69, 84)));
    if (instrument_height.empty()) instrument_height = "0.0";

    put("TR " + StationName(setup) + " " + instrument_height);
    put("DKD " + orientation_name);
    // The orientation shot names its point once more as its code: the run
    // checks the orientation distance with it.
    put(LString(orientation_name, 6) + RString("0", 9) + DistanceText(first.distance) +
        GocSt(first.zenith) + PrismHeightText(orientation.prism_height) + " " + orientation_name);
    ++i;

    for (; i < entries.size() && !entries[i].setup; ++i) {
      const std::string_view line = entries[i].line;
      const Shot shot = ReadShot(line, kWideLayout, units);
      put(LString(TargetName(line), 6) + GocSt(TurnReading(shot.reading, first.reading)) +
          DistanceText(shot.distance) + GocSt(shot.zenith) +
          PrismHeightText(entries[i].prism_height) + " " +
          FixedWidth(TrimView(Columns(line, 85, 100)), kNameWidth));
    }
  }
  return result;
}

}  // namespace kavu
