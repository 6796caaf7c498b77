#include "import/instrument_common.h"

#include <cmath>

#include "core/angles.h"
#include "core/numbers.h"
#include "core/text.h"

namespace kavu {

std::string_view Columns(std::string_view line, std::size_t from, std::size_t to) {
  if (from == 0 || to < from || from > line.size()) return {};
  return line.substr(from - 1, to - from + 1);
}

std::string_view ColumnsFrom(std::string_view line, std::size_t from) {
  if (from == 0 || from > line.size()) return {};
  return line.substr(from - 1);
}

std::string_view RecordCode(std::string_view line) {
  if (TrimView(line).empty()) return "AAAA";
  return line.substr(0, 4);
}

double HorizontalDistance(double slope, double zenith_degrees) {
  return RoundEven(slope * std::sin(zenith_degrees * kPi / 180.0000001), 3);
}

double TurnReading(double reading, double backsight_reading) {
  if (backsight_reading == 0) return reading;
  double turned = reading - backsight_reading;
  if (turned < 0) turned += 360;
  return turned;
}

std::string DistanceText(double distance) { return RString(Mask(distance, "####0.000"), 9); }

std::string PrismHeightText(std::string_view height) {
  if (height.size() >= 7) return " " + std::string(height);
  return RString(height, 7);
}

std::string PointNumberText(std::string_view identifier) { return NumberText(Val(identifier)); }

std::string ControlPointRecord(std::string_view name, std::string_view x, std::string_view y,
                               std::string_view h) {
  return "TR " + std::string(name) + " " + RString(TrimView(x), 11) + " " +
         RString(TrimView(y), 11) + " " + LString(h, 10);
}

void AppendLine(std::string& out, std::string_view line) {
  out += line;
  out += "\r\n";
}

}  // namespace kavu
