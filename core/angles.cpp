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
  const double minutes = RoundEvenWhole(minutes_in_seconds / 60);
  double phut = std::fabs(minutes) < 9007199254740992.0
                    ? static_cast<double>(static_cast<std::int64_t>(minutes) % 60)
                    : std::fmod(minutes, 60.0);
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

void AppendAngle(std::string& out, double degrees, std::string_view separator, std::size_t width,
                 AngleParts* parts) {
  static constexpr NumberMask kDegrees = ReadMask("##0");
  static constexpr NumberMask kTwoDigits = ReadMask("00");
  const AngleParts p = DecomposeAngle(degrees);
  if (parts != nullptr) *parts = p;
  const std::size_t from = out.size();
  if (degrees < 0) out.push_back('-');
  AppendMask(out, p.do1, kDegrees);
  out.append(separator);
  AppendMask(out, p.phut, kTwoDigits);
  out.append(separator);
  AppendMask(out, p.giay, kTwoDigits);
  PadInFront(out, from, width);
}

namespace {

std::string AngleText(double degrees, std::string_view separator, std::size_t width,
                      AngleParts* parts) {
  std::string text;
  AppendAngle(text, degrees, separator, width, parts);
  return text;
}

}  // namespace

std::string GocStringText(double degrees, AngleParts* parts) {
  return AngleText(degrees, " ", 10, parts);
}

std::string GocSt(double degrees, AngleParts* parts) { return AngleText(degrees, "", 9, parts); }

std::string GocSt1(double degrees, AngleParts* parts) { return AngleText(degrees, " ", 9, parts); }

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
