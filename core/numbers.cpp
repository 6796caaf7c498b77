#include "core/numbers.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <cstddef>
#include <cstdint>
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

// The characters of a number as it is scanned: on the stack, unless the text
// is longer than any number the files hold.
class NumberBuffer {
 public:
  void push_back(char c) {
    if (large_.empty() && size_ < sizeof small_) {
      small_[size_++] = c;
      return;
    }
    if (large_.empty()) large_.assign(small_, size_);
    large_.push_back(c);
    ++size_;
  }
  void resize(std::size_t size) {
    size_ = size;
    if (!large_.empty()) large_.resize(size);
  }
  const char* data() const { return large_.empty() ? small_ : large_.data(); }
  std::size_t size() const { return size_; }

 private:
  char small_[64];
  std::size_t size_ = 0;
  std::string large_;
};

// Reads the numeric prefix of a text into a clean buffer ("-12.5e1") and
// converts it. Blanks inside the number are skipped wherever they stand.
Scan ScanNumber(std::string_view text) {
  std::size_t i = 0;
  const std::size_t n = text.size();
  auto skip_blanks = [&] {
    while (i < n && IsBlank(text[i])) ++i;
  };

  NumberBuffer buf;
  skip_blanks();
  if (i < n && (text[i] == '+' || text[i] == '-')) {
    if (text[i] == '-') buf.push_back('-');
    ++i;
  }
  bool point = false;
  bool digit = false;
  for (skip_blanks(); i < n; ++i, skip_blanks()) {
    const char c = text[i];
    if (IsDigit(c)) {
      buf.push_back(c);
      digit = true;
    } else if (c == '.' && !point) {
      buf.push_back('.');
      point = true;
    } else {
      break;
    }
  }
  if (!digit) return {};

  if (i < n && (text[i] == 'E' || text[i] == 'e' || text[i] == 'D' || text[i] == 'd')) {
    const std::size_t mantissa = buf.size();
    ++i;
    skip_blanks();
    buf.push_back('e');
    if (i < n && (text[i] == '+' || text[i] == '-')) {
      buf.push_back(text[i]);
      ++i;
    }
    bool exp_digit = false;
    for (skip_blanks(); i < n && IsDigit(text[i]); ++i, skip_blanks()) {
      buf.push_back(text[i]);
      exp_digit = true;
    }
    if (!exp_digit) buf.resize(mantissa);
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
  // The products of tens, each exact up to 10^22.
  static constexpr auto kPowers = [] {
    std::array<double, 23> powers{};
    double p = 1;
    for (double& power : powers) {
      power = p;
      p *= 10;
    }
    return powers;
  }();
  const int magnitude = n < 0 ? -n : n;
  if (magnitude < static_cast<int>(kPowers.size()))
    return kPowers[static_cast<std::size_t>(magnitude)];
  double p = 1;
  for (int k = 0; k < magnitude; ++k) p *= 10;
  return p;
}

constexpr double kTwoTo52 = 4503599627370496.0;
constexpr double kTwoTo53 = 9007199254740992.0;

// The common number of the field book, signed digits with at most one point
// and at most 15 digits, ended by the text's end or by a character that ends
// every number: its value is the whole number of its digits divided by a
// power of ten, both exact, so the one rounding of the division gives the
// nearest double, as the full conversion does. False for any other text.
bool ScanPlainNumber(std::string_view text, Scan& scan) {
  std::size_t i = 0;
  const bool negative = !text.empty() && text[0] == '-';
  if (!text.empty() && (text[0] == '-' || text[0] == '+')) ++i;
  std::uint64_t whole = 0;
  int digits = 0;
  int decimals = -1;
  for (; i < text.size(); ++i) {
    const char c = text[i];
    if (IsDigit(c)) {
      if (++digits > 15) return false;
      whole = whole * 10 + static_cast<std::uint64_t>(c - '0');
      if (decimals >= 0) ++decimals;
    } else if (c == '.' && decimals < 0) {
      decimals = 0;
    } else {
      break;
    }
  }
  if (digits == 0) return false;
  if (i < text.size()) {
    const char c = text[i];
    if (IsBlank(c) || c == 'E' || c == 'e' || c == 'D' || c == 'd') return false;
  }
  double value = static_cast<double>(whole);
  if (decimals > 0) value /= PowerOfTen(decimals);
  scan.value = negative ? -value : value;
  scan.has_digit = true;
  return true;
}

Scan ScanAny(std::string_view text) {
  Scan scan;
  if (ScanPlainNumber(text, scan)) return scan;
  return ScanNumber(text);
}

}  // namespace

double Val(std::string_view text) { return ScanAny(text).value; }

bool HasNumber(std::string_view text) { return ScanAny(text).has_digit; }

bool ReadNumber(std::string_view text, double& value) {
  const Scan scan = ScanAny(text);
  value = scan.value;
  return scan.has_digit;
}

double RoundEvenWhole(double x) {
  // From 2^52 on every double is whole (and NaN and the infinities stay).
  if (!(std::fabs(x) < kTwoTo52) || x == 0) return x;
  // Below it, adding 2^52 leaves no fraction: the sum is rounded to a whole
  // number the way the processor rounds, to the nearest, ties to the even
  // one; taking 2^52 away again is exact.
  return x > 0 ? (x + kTwoTo52) - kTwoTo52 : (x - kTwoTo52) + kTwoTo52;
}

double RoundEven(double x, int n) {
  const double p = PowerOfTen(n);
  const double y = n >= 0 ? x * p : x / p;
  if (!(std::fabs(y) < kTwoTo52)) return x;  // nothing left to round
  const double r = RoundEvenWhole(y);
  return n >= 0 ? r / p : r * p;
}

double Fix(double x) { return std::trunc(x); }

double MillimetreValue(double x) {
  const double thousandths = x * 1000;
  // Below 2^53 the text holds the whole number of thousandths, which reads
  // back as that number divided by 1000, rounded once.
  if (std::fabs(thousandths) < kTwoTo53) return std::round(thousandths) / 1000 + 0.0;
  return Val(Mask(x, "#.000"));
}

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

  // The digits of |x| scaled by 10^decimals, rounded, with room in front for
  // the zeros that make at least one integer digit.
  constexpr std::size_t kRoom = 64;
  char buf[kRoom + 400];
  char* const first_digit = buf + kRoom;
  if (decimals + 1 > kRoom) return "0";
  bool negative = false;
  std::to_chars_result written{};
  const double y = x * PowerOfTen(static_cast<int>(decimals));
  if (std::fabs(y) < kTwoTo53) {
    const double whole = std::round(y);  // half away from zero
    negative = whole < 0;
    // Below 2^53 the whole number is exact: its digits are those of the integer.
    written =
        std::to_chars(first_digit, buf + sizeof buf, static_cast<std::uint64_t>(std::fabs(whole)));
  } else {
    // Beyond 2^53 the scaled value is no longer exact: the value's own
    // decimal expansion is written, to the mask's decimals.
    negative = x < 0;
    written = std::to_chars(first_digit, buf + sizeof buf, std::fabs(x), std::chars_format::fixed,
                            static_cast<int>(decimals));
  }
  char* end = written.ptr;
  if (written.ec != std::errc()) {
    first_digit[0] = '0';
    end = first_digit + 1;
  }
  end = std::remove(first_digit, end, '.');
  char* digits = first_digit;
  while (static_cast<std::size_t>(end - digits) < decimals + 1) *--digits = '0';
  char* const frac = end - decimals;

  // The integer digits without leading zeros, then as many zeros as the mask
  // asks for.
  char* int_start = digits;
  while (int_start < frac && *int_start == '0') ++int_start;
  while (static_cast<std::size_t>(frac - int_start) < min_int) {
    if (int_start > buf) {
      *--int_start = '0';
    } else {
      return "0";
    }
  }
  // A "#" at the end of the fraction is written only when its digit counts.
  std::size_t frac_size = decimals;
  while (frac_size > 0 && frac_mask[frac_size - 1] == '#' && frac[frac_size - 1] == '0') {
    --frac_size;
  }

  std::string out;
  out.reserve(static_cast<std::size_t>(frac - int_start) + frac_size + 2);
  if (negative) out.push_back('-');
  out.append(int_start, frac);
  if (point != std::string_view::npos) {
    out.push_back('.');
    out.append(frac, frac_size);
  }
  return out;
}

void AppendMask(std::string& out, double x, const NumberMask& mask) {
  const double y = x * mask.scale;
  // Beyond 2^53, not a number, or a mask wider than the digits below: the
  // full rule.
  constexpr int kDigits = 40;
  if (!(std::fabs(y) < kTwoTo53) || mask.decimals + mask.wholeZeros > kDigits - 20) {
    out += Mask(x, mask.text);
    return;
  }
  const double whole = std::round(y);  // ties away from zero, as Mask rounds
  // The digits of the whole number, right-aligned, with zeros in front up to
  // one integer digit and up to the mask's integer zeros.
  char digits[kDigits];
  char* const end = digits + kDigits;
  char* first = end;
  for (auto n = static_cast<std::uint64_t>(std::fabs(whole)); n != 0; n /= 10) {
    *--first = static_cast<char>('0' + n % 10);
  }
  while (end - first < mask.decimals + 1) *--first = '0';
  char* const fraction = end - mask.decimals;
  while (first < fraction && *first == '0') ++first;
  while (fraction - first < mask.wholeZeros) *--first = '0';
  int fractionSize = mask.decimals;
  for (int optional = mask.optional; optional > 0 && fraction[fractionSize - 1] == '0';
       --optional) {
    --fractionSize;
  }
  if (whole < 0) out.push_back('-');
  out.append(first, fraction);
  if (mask.point) {
    out.push_back('.');
    out.append(fraction, static_cast<std::size_t>(fractionSize));
  }
}

namespace {

// NumberText of a value that is the nearest double to a decimal of at most
// 3 decimals and 15 significant digits (every coordinate the run rounds to the
// millimetre): that decimal, written from the integer of its thousandths.
// False for any other value.
bool MillimetreText(double x, std::string& text) {
  const double y = x * 1000;
  if (!(std::fabs(y) < 1e15) || std::fabs(x) < 1e-4) return false;
  const auto r = static_cast<std::int64_t>(std::llround(y));
  if (static_cast<double>(r) / 1000 != x) return false;
  char digits[24];
  char* end = std::to_chars(digits, digits + sizeof digits, r < 0 ? -r : r).ptr;
  const auto n = static_cast<std::size_t>(end - digits);
  // The integer part (empty below 1, as the shortened "0." is) and the
  // fraction without its trailing zeros.
  const std::size_t whole = n > 3 ? n - 3 : 0;
  char fraction[3] = {'0', '0', '0'};
  std::copy(digits + whole, end, fraction + 3 - (n - whole));
  std::size_t fractionSize = 3;
  while (fractionSize > 0 && fraction[fractionSize - 1] == '0') --fractionSize;
  if (r < 0) text.push_back('-');
  text.append(digits, whole);
  if (fractionSize > 0) text.append(".").append(fraction, fractionSize);
  return true;
}

}  // namespace

void AppendNumberText(std::string& out, double x) {
  if (x != 0 && MillimetreText(x, out)) return;
  out += NumberText(x);
}

void AppendReportNumber(std::string& out, double x) {
  out.push_back(std::signbit(x) && x != 0 ? '-' : ' ');
  AppendNumberText(out, std::fabs(x));
  out.push_back(' ');
}

std::string NumberText(double x) {
  if (x == 0) return "0";
  if (std::string text; MillimetreText(x, text)) return text;
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
  std::string text;
  AppendReportNumber(text, x);
  return text;
}

std::string SignedCount(long long value) {
  std::string text = std::to_string(value);
  if (value >= 0) text.insert(0, 1, ' ');
  return text;
}

}  // namespace kavu
