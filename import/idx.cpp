// Topcom keyword files (.idx): SETUP sections with STN_ID and the instrument
// height, then SLOPE observation lines "no, "name", cfg, Hz, Vz, SDist, RefHt,
// ..." closed by END SLOPE. Angles are decimal degrees unless the file's
// UNITS declare "ANGULAR DMS" (D.MMSSss); distances are slope distances,
// reduced to horizontal here.
#include <array>
#include <cmath>
#include <cstddef>
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

// The first two words of a line: tabs count as blanks, and a run of blanks
// separates like one (recorders align their keywords with several blanks).
struct Words {
  std::array<std::string_view, 2> word;
  std::size_t count = 0;
};

Words FirstWords(std::string_view line) {
  Words words;
  std::size_t i = 0;
  auto blank = [&](std::size_t k) { return line[k] == ' ' || line[k] == '\t'; };
  while (words.count < words.word.size()) {
    while (i < line.size() && blank(i)) ++i;
    if (i == line.size()) break;
    const std::size_t start = i;
    while (i < line.size() && !blank(i)) ++i;
    words.word[words.count++] = line.substr(start, i - start);
  }
  return words;
}

bool IsStationLine(std::string_view line) {
  const Words words = FirstWords(line);
  return words.count > 0 && words.word[0] == "STN_ID";
}

// Comma form: blanks and tabs dropped, fields split at ",". Only the seven
// fields an observation uses are kept; count is the line's full field count.
struct CommaLine {
  std::array<std::string, 7> field;
  std::size_t count = 1;
};

CommaLine CommaForm(std::string_view line) {
  CommaLine comma;
  for (const char c : line) {
    if (c == ' ' || c == '\t') continue;
    if (c == ',') {
      ++comma.count;
    } else if (comma.count <= comma.field.size()) {
      comma.field[comma.count - 1].push_back(c);
    }
  }
  return comma;
}

// A quoted name without its first and last characters ("" when too short).
std::string_view Unquote(std::string_view text) {
  return text.size() < 2 ? std::string_view() : text.substr(1, text.size() - 2);
}

// An angle written D.MMSSss: 17.573160 is 17 57 31.60.
double DmsDegrees(std::string_view text) {
  const double value = Val(text);
  const std::string digits = Mask(std::fabs(value), "0.00000000");
  const std::string_view view(digits);
  const std::size_t point = view.find('.');
  const double degrees =
      Val(view.substr(0, point)) + Val(view.substr(point + 1, 2)) / 60 +
      Val(std::string(view.substr(point + 3, 2)) + "." + std::string(view.substr(point + 5))) /
          3600;
  return value < 0 ? -degrees : degrees;
}

std::string DetailRecord(const CommaLine& obs, bool dms) {
  auto angle = [dms](std::string_view text) { return dms ? DmsDegrees(text) : Val(text); };
  const double reading = angle(obs.field[3]);
  const double zenith = angle(obs.field[4]);
  const double slope = Val(obs.field[5]);
  const double prism = std::fabs(Val(obs.field[6]));
  const double horizontal = std::fabs(HorizontalDistance(slope, zenith));
  // The name is padded to 5 columns but never cut: 8-digit point numbers are
  // common and cutting them would merge different points.
  return LString(Unquote(obs.field[1]), 5) + GocSt(reading) + DistanceText(horizontal) +
         GocSt(zenith) + PrismHeightText(NumberText(prism));
}

}  // namespace

std::string ConvertIdx(std::string_view content) {
  const std::vector<std::string> lines = SplitLines(content);
  const std::size_t n = lines.size();
  std::string book;
  auto put = [&book](std::string_view record) { AppendLine(book, record); };

  // A height line without a value keeps the height of the station before.
  double height = 0;
  bool dms = false;
  std::size_t i = 0;
  while (i < n) {
    const Words station = FirstWords(lines[i++]);
    if (station.count > 0 && station.word[0] == "ANGULAR") {
      dms = station.count > 1 && station.word[1] == "DMS";
    }
    if (station.count == 0 || station.word[0] != "STN_ID") continue;
    const std::string label =
        Trim(FixedWidth(station.count > 1 ? Unquote(station.word[1]) : "", 12));
    if (i >= n) break;  // the file ends right after STN_ID: nothing to write

    const Words height_line = FirstWords(lines[i++]);
    if (height_line.count > 1) {
      const std::string_view text = height_line.word[1];
      height = Val(text.substr(0, text.size() - 1));  // drops the ";" after it
    }
    put("TR " + label + " " + ReportNumber(height));

    i += 2;  // two lines of the set-up that carry nothing we use
    if (i >= n) break;
    // A new STN_ID before any observation: this station has none.
    if (IsStationLine(lines[i])) continue;

    // The first observation names the orientation point.
    const CommaLine first = CommaForm(lines[i]);
    put("DKD " + Trim(first.count > 1 ? Unquote(first.field[1]) : ""));

    for (; i < n; ++i) {
      // A STN_ID line starts the next set-up even when END SLOPE is missing.
      if (IsStationLine(lines[i])) break;
      const CommaLine obs = CommaForm(lines[i]);
      if (obs.field[0] == "ENDSLOPE") {
        ++i;
        break;
      }
      if (obs.count < 7) continue;  // not an observation: skipped
      put(DetailRecord(obs, dms));
    }
  }
  return book;
}

}  // namespace kavu
