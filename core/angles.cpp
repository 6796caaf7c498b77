#include "core/angles.h"

#include <cmath>

#include "core/numbers.h"
#include "core/text.h"

namespace kavu {

AngleParts DecomposeAngle(double degrees) {
  // The angle in seconds with one decimal; a half second later goes to the
  // even whole second.
  const double seconds = RoundEven(degrees * 3600, 1);
  double giay = seconds - 60 * Fix(seconds / 60);
  const double minutes_in_seconds = std::fabs(seconds - giay);
  giay = RoundEven(std::fabs(giay), 0);

  AngleParts parts;
  // Whole minutes, reduced mod 60 after rounding to even like every integer
  // remainder of the field book arithmetic.
  double phut = std::fmod(RoundEvenWhole(minutes_in_seconds / 60), 60.0);
  if (!std::isfinite(phut)) phut = 0;
  parts.phut = static_cast<std::int16_t>(phut);
  parts.do1 = Fix(minutes_in_seconds / 3600);
  parts.giay = giay;

  if (parts.giay >= 60) {
    parts.giay -= 60;
    ++parts.phut;
  }
  if (parts.phut >= 60) {
    parts.phut = static_cast<std::int16_t>(parts.phut - 60);
    parts.do1 += 1;
  }
  if (parts.do1 >= 360) parts.do1 -= 360;  // once only: 1000 degrees prints as 640
  return parts;
}

namespace {

std::string AngleBody(double degrees, const char* separator, AngleParts* out) {
  const AngleParts parts = DecomposeAngle(degrees);
  if (out != nullptr) *out = parts;
  std::string text = degrees < 0 ? "-" : "";
  text += Mask(parts.do1, "##0");
  text += separator;
  text += Mask(parts.phut, "00");
  text += separator;
  text += Mask(parts.giay, "00");
  return text;
}

std::string PadFront(std::string text, std::size_t width) {
  if (text.size() < width) text.insert(0, width - text.size(), ' ');
  return text;
}

}  // namespace

std::string GocStringText(double degrees, AngleParts* parts) {
  return PadFront(AngleBody(degrees, " ", parts), 10);
}

std::string GocSt(double degrees, AngleParts* parts) {
  return PadFront(AngleBody(degrees, "", parts), 9);
}

std::string GocSt1(double degrees, AngleParts* parts) {
  return RString(AngleBody(degrees, " ", parts), 9);
}

double CvGocDbl(std::string_view packed) {
  const std::string t = Mask(Val(packed), "0000000");
  const std::string_view view(t);
  auto column = [&](std::size_t from, std::size_t count) {
    return from < view.size() ? Val(view.substr(from, count)) : 0.0;
  };
  const double degrees = column(0, 3);
  const double minutes = column(3, 2);
  const double seconds = column(5, std::string_view::npos);
  return (minutes / 60 + degrees) + seconds / 3600;
}

}  // namespace kavu
