#include "import/sdr_records.h"

#include <cmath>
#include <utility>

#include "core/messages.h"
#include "core/numbers.h"
#include "core/text.h"

namespace kavu {

std::string UnreadableDeclaration(std::string_view record) {
  return std::string(msg::kUnreadableDeclaration) + Trim(record);
}

double Units::Reading(double value) const {
  const double degrees = Angle(value);
  if (!counter_clockwise) return degrees;
  const double clockwise = std::fmod(360 - degrees, 360.0);
  return clockwise < 0 ? clockwise + 360 : clockwise;
}

std::string Units::LengthText(std::string_view text) const {
  if (metres_per_unit == 1 || TrimView(text).empty()) return std::string(text);
  return Mask(Length(Val(text)), "0.000");
}

namespace {

// The unit digits close the "00NM" record: angle, distance, pressure,
// temperature, coordinate order, direction. False when a digit that matters
// is not one the program knows.
bool ReadUnitDigits(std::string_view digits, SdrHeader& header) {
  const char angle = digits[0], length = digits[1], order = digits[4], direction = digits[5];
  if (angle == '2') header.units.degrees_per_unit = 0.9;
  if (angle == '3') header.units.degrees_per_unit = 360.0 / 6400;
  if (length == '2') header.units.metres_per_unit = 0.3048;
  header.east_north = order == '2';
  header.units.counter_clockwise = direction == '2';
  auto one_of = [](char digit, char last) { return digit >= '1' && digit <= last; };
  return one_of(angle, '3') && one_of(length, '2') && one_of(order, '2') && one_of(direction, '2');
}

}  // namespace

SdrHeader ReadSdrHeader(const std::vector<std::string>& lines, int width_default) {
  SdrHeader header;
  header.width = width_default;
  const std::string* instrument = nullptr;
  const std::string* job = nullptr;
  for (const std::string& line : lines) {
    const std::string_view code = RecordCode(line);
    if (code == "00NM" && instrument == nullptr) instrument = &line;
    if (code == "10NM" && job == nullptr) job = &line;
  }
  if (job != nullptr) {
    header.width = Columns(*job, 21, 21) == "1" ? 16 : 4;
  } else if (instrument != nullptr && instrument->find("SDR33") != std::string::npos) {
    header.width = 16;
  }
  if (instrument != nullptr) {
    std::string_view text = *instrument;
    while (!text.empty() && text.back() == ' ') text.remove_suffix(1);
    if (text.size() >= 10) {
      const std::string_view digits = text.substr(text.size() - 6);
      bool all_digits = true;
      for (const char c : digits) all_digits = all_digits && c >= '0' && c <= '9';
      if (all_digits && !ReadUnitDigits(digits, header)) {
        header.report.push_back(UnreadableDeclaration(*instrument));
      }
    }
  }
  return header;
}

bool IsCoordinateCode(std::string_view code) {
  return code == "08KI" || code == "08CO" || code == "08TP" || IsSetUpCode(code);
}

bool IsSetUpCode(std::string_view code) { return code == "02TP" || code == "02KI"; }

std::string KnownPointRecord(std::string_view name, std::string_view record,
                             const SdrLayout& layout, const SdrHeader& header) {
  std::string_view x = TrimView(layout.x.Of(record));
  std::string_view y = TrimView(layout.y.Of(record));
  if (header.east_north) std::swap(x, y);
  if (name.empty() || x.empty() || y.empty()) return {};
  // The narrow layout keeps its height column as it stands.
  const std::string_view h = layout.h.Of(record);
  const Units& units = header.units;
  return ControlPointRecord(name, units.LengthText(x), units.LengthText(y),
                            units.LengthText(layout.width == 16 ? TrimView(h) : h));
}

Shot ReadShot(std::string_view record, const SdrLayout& layout, const Units& units) {
  Shot shot;
  shot.reading = units.Reading(Val(layout.reading.Of(record)));
  shot.zenith = units.Angle(Val(layout.zenith.Of(record)));
  shot.distance = HorizontalDistance(units.Length(Val(layout.slope.Of(record))), shot.zenith);
  return shot;
}

std::string BlankFreeName(std::string_view name) {
  std::string out = Trim(name);
  for (char& c : out) {
    if (c == ' ') c = '_';
  }
  return out;
}

}  // namespace kavu
