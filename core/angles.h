// Packed angles (DDDMMSS with an optional fraction of a second) and their
// text forms.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>

namespace kavu {

// pi as the 15-digit decimal every angle conversion of the field book uses.
inline constexpr double kPi = 3.14159265358979;

// Degrees, minutes and whole seconds of an angle, always non-negative.
struct AngleParts {
  double do1 = 0;
  std::int16_t phut = 0;
  double giay = 0;
};

// The shared decomposition of GocString, GocSt and GocSt1.
AngleParts DecomposeAngle(double degrees);

// ' 123 45 30': D MM SS, "-" in front of a negative angle, spaces in front up
// to 10 characters.
std::string GocStringText(double degrees, AngleParts* parts = nullptr);
// '  1234530': DMMSS together, right-aligned in 9.
std::string GocSt(double degrees, AngleParts* parts = nullptr);
// '  5 04 09': D MM SS, RString to 9.
std::string GocSt1(double degrees, AngleParts* parts = nullptr);

// The angle's text appended to out: D, MM and SS set off by separator, "-" in
// front of a negative angle, spaces in front up to width (GocStringText: " ",
// 10; GocSt: "", 9; GocSt1: " ", 9).
void AppendAngle(std::string& out, double degrees, std::string_view separator, std::size_t width,
                 AngleParts* parts = nullptr);

// Packed angle text to decimal degrees ('1234530' -> 123.758333...).
double CvGocDbl(std::string_view packed);

}  // namespace kavu
