// Number rules shared by the engine, the converters and every product.
// Nothing here looks at the locale: a Vietnamese desktop writes decimal commas,
// our files never do.
#pragma once

#include <string>
#include <string_view>

namespace kavu {

// Numeric value of a text: leading blanks skipped; spaces, tabs and LF inside
// the number ignored; optional sign, digits, one ".", optional exponent
// E/e/D/d with its sign; stops at the first other character. No digit gives 0;
// a value beyond double range gives 0.
double Val(std::string_view text);

// True when Val finds at least one digit in the text's numeric prefix.
bool HasNumber(std::string_view text);
// Both at once: value = Val(text); HasNumber(text) returned.
bool ReadNumber(std::string_view text, double& value);

// Nearest whole number, ties to the even neighbour (2.5 -> 2, 3.5 -> 4).
double RoundEvenWhole(double x);

// Round(x, n): x·10^n rounded to even, divided by 10^n; x unchanged when
// |x·10^n| >= 2^52.
double RoundEven(double x, int n);

// The value of the text Mask(x, "#.000") writes (x to the millimetre, ties
// away from zero), without the text.
double MillimetreValue(double x);

// Fix: the fraction dropped toward zero.
double Fix(double x);

// Number masks ("##0", "00", "0000000", "####0.000", "#######.000"...):
// x·10^d rounded half away from zero; "0" digits always written, "#" digits
// only when significant; no minus sign on a zero result. Where x·10^d is not
// below 2^53 the exact decimal text of x itself is written, to d decimals; a
// value that is not finite gives stars as wide as the mask.
std::string Mask(double x, std::string_view mask);

// A number mask read once, for writing many numbers with it.
struct NumberMask {
  std::string_view text;
  int decimals = 0;    // digits after the point
  int wholeZeros = 0;  // "0" digits before it
  int optional = 0;    // "#" digits at the end of the fraction
  bool point = false;
  double scale = 1;  // 10^decimals
};
constexpr NumberMask ReadMask(std::string_view text) {
  NumberMask mask{text};
  bool fraction = false;
  for (const char c : text) {
    if (c == '.') {
      fraction = mask.point = true;
    } else if (fraction) {
      ++mask.decimals;
      mask.optional = c == '#' ? mask.optional + 1 : 0;
      mask.scale *= 10;
    } else if (c == '0') {
      ++mask.wholeZeros;
    }
  }
  return mask;
}
// Mask(x, mask.text) appended to out, without a text of its own.
void AppendMask(std::string& out, double x, const NumberMask& mask);

// Ordinary number text: at most 15 significant digits, exponent form below
// 1E-4 or from 1E+15 ("1E+15", "1E-05", "1.5E+20"), "0." shortened to ".",
// zero is "0".
std::string NumberText(double x);

// Number form of report lines: a space (or the minus), the number text of the
// magnitude, one space (' 3 ', '-.12 ', ' 0 ').
std::string ReportNumber(double x);
// NumberText(x) and ReportNumber(x) appended to out.
void AppendNumberText(std::string& out, double x);
void AppendReportNumber(std::string& out, double x);

// Whole number written as its decimal text with a space in the sign position
// (the summary's counts: ' 12').
std::string SignedCount(long long value);

}  // namespace kavu
