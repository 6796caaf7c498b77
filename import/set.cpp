// SET raw files: the SDR record codes with 16-character fields; every set-up
// carries its station's coordinates, and the first observation after a set-up
// is the one on the orientation point. The first pass writes the stations as
// control points and keeps the set-ups and observations with the prism height
// in force; the second writes the station blocks from them.

#include <string>
#include <string_view>
#include <vector>

#include "core/angles.h"
#include "core/lines.h"
#include "core/numbers.h"
#include "core/text.h"
#include "import/converters.h"
#include "import/instrument_common.h"

namespace kavu {
namespace {

// A set-up or an observation of the first pass, with the prism height in
// force when it was recorded.
struct Entry {
  std::string_view line;
  bool setup = false;
  std::string prism_height;
};

std::string StationLabel(std::string_view setup) {
  const std::string_view description = TrimView(Columns(setup, 85, 100));
  if (description.size() < 3) {
    return FixedWidth("DKC" + FixedWidth(TrimView(Columns(setup, 5, 20)), 5), 12);
  }
  return FixedWidth(description, 12);
}

std::string InstrumentHeight(std::string_view setup) {
  std::string height = Trim(Columns(setup, 69, 84));
  return height.empty() ? "0.0" : height;
}

}  // namespace

std::string ConvertSet(std::string_view content) {
  const std::vector<std::string> lines = SplitLines(content);
  std::string out;

  // Pass 1.
  std::vector<Entry> entries;
  std::string prism_height;
  for (const std::string& line : lines) {
    const std::string_view code = RecordCode(line);
    if (code == "02TP") {
      const std::string_view x = TrimView(Columns(line, 21, 36));
      const std::string_view y = TrimView(Columns(line, 37, 52));
      // Without both coordinates the record would read back as a station.
      if (!x.empty() && !y.empty()) {
        AppendLine(out, "TR " + StationLabel(line) + " " + FixedWidth(x, 11) + " " +
                            FixedWidth(y, 10) + " " +
                            FixedWidth(TrimView(Columns(line, 53, 68)), 10));
      }
      entries.push_back({line, true, {}});
    } else if (code == "03NM") {
      prism_height = Trim(Columns(line, 5, 20));
    } else if (code == "09F1") {
      entries.push_back({line, false, prism_height});
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

    const std::string station_label = StationLabel(setup);
    const Entry& orientation = entries[i];
    const std::string_view ol = orientation.line;
    const std::string orientation_id = FixedWidth(TrimView(Columns(ol, 32, 36)), 5);
    std::string orientation_label = FixedWidth(TrimView(Columns(ol, 85, 100)), 12);
    if (orientation_label == station_label || TrimView(orientation_label).size() < 3) {
      orientation_label = FixedWidth("DKC" + orientation_id, 12);
    }
    const double reference = Val(Columns(ol, 69, 84));
    const double zenith = Val(Columns(ol, 53, 68));
    const double distance = HorizontalDistance(Val(Columns(ol, 37, 52)), zenith);

    AppendLine(out, "TR " + station_label + " " + InstrumentHeight(setup));
    AppendLine(out, "DKD " + orientation_label);
    // An orientation shot before any prism height gets a blank one (its
    // label then stands in that place); the other points get 0.0.
    AppendLine(out, LString(FixedWidth(PointNumberText(orientation_id), 4), 6) + RString("0", 9) +
                        DistanceText(distance) + GocSt(zenith) +
                        PrismHeightText(Trim(orientation.prism_height)) + " " + orientation_label);
    ++i;

    for (; i < entries.size() && !entries[i].setup; ++i) {
      const std::string_view line = entries[i].line;
      const std::string name = FixedWidth(TrimView(Columns(line, 21, 36)), 5);
      const double z = Val(Columns(line, 53, 68));
      const double hd = HorizontalDistance(Val(Columns(line, 37, 52)), z);
      const double reading = TurnReading(Val(Columns(line, 69, 84)), reference);
      std::string height = Trim(entries[i].prism_height);
      if (height.empty()) height = "0.0";
      AppendLine(out, LString(name, 6) + GocSt(reading) + DistanceText(hd) + GocSt(z) +
                          PrismHeightText(height) + " " +
                          FixedWidth(TrimView(Columns(line, 85, 100)), 12));
    }
  }
  return out;
}

}  // namespace kavu
