// Topcom keyword files (.idx): SETUP sections with STN_ID and the instrument
// height, then SLOPE observation lines "no, "name", cfg, Hz, Vz, SDist, RefHt,
// ..." closed by END SLOPE. Angles are decimal degrees unless the file's
// UNITS declare "ANGULAR DMS" (D.MMSSss) or "ANGULAR GON", lengths metres
// unless "LINEAR FEET" (or FT, FOOT); distances are slope distances, reduced
// to horizontal here, and readings are turned so that the orientation shot
// reads 0.
#include <array>
#include <cmath>
#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
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

enum class AngleUnit { kDegrees, kDms, kGon };

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

// An observation as read, and reduced to face 1.
struct Pointing {
  std::string name;
  double reading = 0, zenith = 0, slope = 0, prism = 0;
  bool face2 = false;
  // The horizontal distance of the one face of a pair that has a distance.
  std::optional<double> horizontal;
};

struct Declarations {
  AngleUnit angle = AngleUnit::kDegrees;
  Units units;
};

Pointing ReadPointing(const CommaLine& obs, const Declarations& declared) {
  auto angle = [&declared](std::string_view text) {
    switch (declared.angle) {
      case AngleUnit::kDms:
        return DmsDegrees(text);
      case AngleUnit::kGon:
        return Val(text) * 0.9;
      default:
        return Val(text);
    }
  };
  Pointing shot;
  shot.name = BlankFreeName(Unquote(obs.field[1]));
  shot.reading = angle(obs.field[3]);
  shot.zenith = angle(obs.field[4]);
  shot.slope = declared.units.Length(Val(obs.field[5]));
  shot.prism = declared.units.Length(std::fabs(Val(obs.field[6])));
  // Face 2: the telescope transited, the circle read half a turn on.
  if (shot.zenith > 180) {
    shot.face2 = true;
    shot.reading = std::fmod(shot.reading + 180, 360.0);
    shot.zenith = 360 - shot.zenith;
  }
  return shot;
}

// The mean of the two faces of one pointing.
Pointing MeanOfFaces(const Pointing& a, const Pointing& b) {
  Pointing mean = a;
  double gap = b.reading - a.reading;
  if (gap > 180) gap -= 360;
  if (gap < -180) gap += 360;
  mean.reading = std::fmod(a.reading + gap / 2 + 360, 360.0);
  mean.zenith = (a.zenith + b.zenith) / 2;
  // Distances count by their size, as a lone shot's do. A face without a
  // distance does not halve the other's: the pair then has the distance of
  // the face that has one, as that face alone gives it.
  if (a.slope != 0 && b.slope != 0) {
    mean.slope = (std::fabs(a.slope) + std::fabs(b.slope)) / 2;
  } else if (a.slope != 0 || b.slope != 0) {
    const Pointing& measured = a.slope != 0 ? a : b;
    mean.slope = std::fabs(measured.slope);
    mean.horizontal = std::fabs(HorizontalDistance(measured.slope, measured.zenith));
  }
  return mean;
}

std::string DetailRecord(const Pointing& shot, double reference) {
  const double horizontal =
      shot.horizontal.value_or(std::fabs(HorizontalDistance(shot.slope, shot.zenith)));
  // The name is padded to 5 columns but never cut: 8-digit point numbers are
  // common and cutting them would merge different points.
  return LString(shot.name, 5) + GocSt(TurnReading(shot.reading, reference)) +
         DistanceText(horizontal) + GocSt(shot.zenith) + PrismHeightText(NumberText(shot.prism));
}

// A text without the blanks and tabs around it.
std::string_view TrimBlanks(std::string_view text) {
  while (!text.empty() && (text.front() == ' ' || text.front() == '\t')) text.remove_prefix(1);
  while (!text.empty() && (text.back() == ' ' || text.back() == '\t')) text.remove_suffix(1);
  return text;
}

// The text after a line's first word, without its quotes: a quoted name
// with blanks inside stays one name.
std::string_view QuotedRest(std::string_view line, std::string_view first) {
  std::string_view rest = TrimBlanks(line.substr(line.find(first) + first.size()));
  if (rest.size() >= 2 && rest.front() == '"' && rest.back() == '"') {
    rest = rest.substr(1, rest.size() - 2);
  }
  return rest;
}

// Reads a UNITS declaration; false when the unit is not one the program
// knows.
bool Declare(const Words& words, Declarations& declared) {
  const std::string_view unit = words.count > 1 ? words.word[1] : std::string_view();
  if (words.word[0] == "ANGULAR") {
    if (unit == "DMS") {
      declared.angle = AngleUnit::kDms;
    } else if (unit == "DEG") {
      declared.angle = AngleUnit::kDegrees;
    } else if (unit == "GON") {
      declared.angle = AngleUnit::kGon;
    } else {
      return false;
    }
  } else if (words.word[0] == "LINEAR") {
    if (unit == "METRE" || unit == "METER") {
      declared.units.metres_per_unit = 1;
    } else if (unit == "FEET" || unit == "FOOT" || unit == "FT") {
      declared.units.metres_per_unit = 0.3048;
    } else {
      return false;
    }
  }
  return true;
}

}  // namespace

Conversion ConvertIdx(std::string_view content) {
  const std::vector<std::string> lines = SplitLines(content);
  const std::size_t n = lines.size();
  Conversion result;
  auto put = [&result](std::string_view record) { AppendLine(result.book, record); };

  // A height line without a value keeps the height of the station before.
  double height = 0;
  Declarations declared;
  std::size_t i = 0;
  while (i < n) {
    const std::string_view line = lines[i++];
    const Words station = FirstWords(line);
    if (station.count > 0 && !Declare(station, declared)) {
      result.report.push_back(UnreadableDeclaration(TrimBlanks(line)));
    }
    if (station.count == 0 || station.word[0] != "STN_ID") continue;
    const std::string label = BlankFreeName(QuotedRest(line, "STN_ID"));
    if (i >= n) break;  // the file ends right after STN_ID: nothing to write

    // The height with or without the ";" after it.
    const Words height_line = FirstWords(lines[i++]);
    if (height_line.count > 1) height = declared.units.Length(Val(height_line.word[1]));
    put("TR " + label + " " + ReportNumber(height));

    i += 2;  // two lines of the set-up that carry nothing we use
    if (i >= n) break;
    // A new STN_ID before any observation: this station has none.
    if (IsStationLine(lines[i])) continue;

    // The set-up's observations, each reduced to face 1; the two faces of
    // one pointing, shot one after the other, become their mean.
    std::vector<Pointing> shots;
    bool paired = false;
    for (; i < n; ++i) {
      // A STN_ID line starts the next set-up even when END SLOPE is missing.
      if (IsStationLine(lines[i])) break;
      const CommaLine obs = CommaForm(lines[i]);
      if (obs.field[0] == "ENDSLOPE") {
        ++i;
        break;
      }
      if (obs.count < 7) continue;  // not an observation: skipped
      Pointing shot = ReadPointing(obs, declared);
      if (!shots.empty() && !paired && shots.back().name == shot.name &&
          shots.back().face2 != shot.face2) {
        shots.back() = MeanOfFaces(shots.back(), shot);
        paired = true;
      } else {
        shots.push_back(std::move(shot));
        paired = false;
      }
    }
    // The first observation is the orientation: readings turn so that it
    // reads 0.
    put("DKD " + (shots.empty() ? std::string() : shots.front().name));
    const double reference = shots.empty() ? 0 : shots.front().reading;
    for (const Pointing& shot : shots) put(DetailRecord(shot, reference));
  }
  return result;
}

}  // namespace kavu
