#include "core/numbers.h"

#include <charconv>
#include <cmath>
#include <cstddef>
#include <string>
#include <system_error>

namespace kavu {
namespace {

bool IsBlank(char c) { return c == ' ' || c == '\t' || c == '\n'; }
bool IsDigit(char c) { return c >= '0' && c <= '9'; }

struct Scan {
  double value = 0;
  bool has_digit = false;
};

// Reads the numeric prefix of a text into a clean buffer ("-12.5e1") and
// converts it. Blanks inside the number are skipped wherever they stand.
Scan ScanNumber(std::string_view text) {
  std::size_t i = 0;
  const std::size_t n = text.size();
  auto skip_blanks = [&] {
    while (i < n && IsBlank(text[i])) ++i;
  };

  std::string buf;
  skip_blanks();
  if (i < n && (text[i] == '+' || text[i] == '-')) {
    if (text[i] == '-') buf.push_back('-');
    ++i;
  }
  std::string mantissa;
  bool point = false;
  bool digit = false;
  for (skip_blanks(); i < n; ++i, skip_blanks()) {
    const char c = text[i];
    if (IsDigit(c)) {
      mantissa.push_back(c);
      digit = true;
    } else if (c == '.' && !point) {
      mantissa.push_back('.');
      point = true;
    } else {
      break;
    }
  }
  if (!digit) return {};
  buf += mantissa;

  if (i < n && (text[i] == 'E' || text[i] == 'e' || text[i] == 'D' || text[i] == 'd')) {
    ++i;
    skip_blanks();
    std::string exponent = "e";
    if (i < n && (text[i] == '+' || text[i] == '-')) {
      exponent.push_back(text[i]);
      ++i;
    }
    bool exp_digit = false;
    for (skip_blanks(); i < n && IsDigit(text[i]); ++i, skip_blanks()) {
      exponent.push_back(text[i]);
      exp_digit = true;
    }
    if (exp_digit) buf += exponent;
  }

  Scan scan;
  scan.has_digit = true;
  double value = 0;
  const auto [ptr, ec] = std::from_chars(buf.data(), buf.data() + buf.size(), value);
  (void)ptr;
  if (ec == std::errc()) scan.value = value;
  return scan;
}

double PowerOfTen(int n) {
  double p = 1;
  for (int k = 0; k < (n < 0 ? -n : n); ++k) p *= 10;
  return p;
}

constexpr double kTwoTo53 = 9007199254740992.0;

// The exact decimal text of a finite, non-negative value with the given
// number of decimals.
std::string FixedDigits(double value, int decimals) {
  char buf[400];
  const auto [ptr, ec] =
      std::to_chars(buf, buf + sizeof buf, value, std::chars_format::fixed, decimals);
  if (ec != std::errc()) return "0";
  return std::string(buf, ptr);
}

}  // namespace

double Val(std::string_view text) { return ScanNumber(text).value; }

bool HasNumber(std::string_view text) { return ScanNumber(text).has_digit; }

double RoundEvenWhole(double x) {
  if (!std::isfinite(x)) return x;
  const double f = std::floor(x);
  const double diff = x - f;
  if (diff > 0.5) return f + 1;
  if (diff < 0.5) return f;
  return std::fmod(f, 2.0) == 0 ? f : f + 1;
}

double RoundEven(double x, int n) {
  const double p = PowerOfTen(n);
  const double y = n >= 0 ? x * p : x / p;
  if (!(std::fabs(y) < 4503599627370496.0)) return x;  // 2^52: nothing left to round
  const double r = RoundEvenWhole(y);
  return n >= 0 ? r / p : r * p;
}

double Fix(double x) { return std::trunc(x); }

std::string Mask(double x, std::string_view mask) {
  const std::size_t point = mask.find('.');
  const std::string_view int_mask = mask.substr(0, point);
  const std::string_view frac_mask =
      point == std::string_view::npos ? std::string_view() : mask.substr(point + 1);
  const std::size_t decimals = frac_mask.size();
  // A value that is no number at all must not pass for one: a run of stars
  // as wide as the mask, which reads back as no number.
  if (!std::isfinite(x)) return std::string(mask.size(), '*');

  std::size_t min_int = 0;
  for (const char c : int_mask) min_int += c == '0' ? 1 : 0;

  bool negative = false;
  std::string digits;  // the digits of |x| scaled by 10^decimals, rounded
  const double y = x * PowerOfTen(static_cast<int>(decimals));
  if (std::fabs(y) < kTwoTo53) {
    const double whole = std::round(y);  // half away from zero
    negative = whole < 0;
    digits = FixedDigits(std::fabs(whole), 0);
  } else {
    // Beyond 2^53 the scaled value is no longer exact: the value's own
    // decimal expansion is written, to the mask's decimals.
    negative = x < 0;
    digits = FixedDigits(std::fabs(x), static_cast<int>(decimals));
    std::erase(digits, '.');
  }
  if (digits.size() < decimals + 1) digits.insert(0, decimals + 1 - digits.size(), '0');
  std::string int_part = digits.substr(0, digits.size() - decimals);
  std::string frac_part = digits.substr(digits.size() - decimals);

  const std::size_t first = int_part.find_first_not_of('0');
  int_part = first == std::string::npos ? std::string() : int_part.substr(first);
  if (int_part.size() < min_int) int_part.insert(0, min_int - int_part.size(), '0');
  // A "#" at the end of the fraction is written only when its digit counts.
  while (!frac_part.empty() && frac_mask[frac_part.size() - 1] == '#' && frac_part.back() == '0')
    frac_part.pop_back();

  std::string out;
  if (negative) out.push_back('-');
  out += int_part;
  if (point != std::string_view::npos) out += '.' + frac_part;
  return out;
}

std::string NumberText(double x) {
  if (x == 0) return "0";
  char buf[64];
  const auto [ptr, ec] = std::to_chars(buf, buf + sizeof buf, x, std::chars_format::general, 15);
  std::string text = ec == std::errc() ? std::string(buf, ptr) : std::string("0");
  for (char& c : text) {
    if (c == 'e') c = 'E';
  }
  if (text.starts_with("0.")) {
    text.erase(0, 1);
  } else if (text.starts_with("-0.")) {
    text.erase(1, 1);
  }
  return text;
}

std::string ReportNumber(double x) {
  const bool negative = std::signbit(x) && x != 0;
  return (negative ? "-" : " ") + NumberText(std::fabs(x)) + " ";
}

std::string SignedCount(long long value) {
  std::string text = std::to_string(value);
  if (value >= 0) text.insert(0, 1, ' ');
  return text;
}

}  // namespace kavu
