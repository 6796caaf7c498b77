#include "core/typed_numbers.h"

#include <algorithm>
#include <charconv>
#include <cmath>

#include "core/messages.h"
#include "core/numbers.h"

namespace kavu {
namespace {

bool IsBlank(char c) { return c == ' ' || c == '\t'; }

std::string_view TrimBlanks(std::string_view text) {
  while (!text.empty() && IsBlank(text.front())) text.remove_prefix(1);
  while (!text.empty() && IsBlank(text.back())) text.remove_suffix(1);
  return text;
}

bool IsDigit(char c) { return c >= '0' && c <= '9'; }

// Digits after the separator of a typed number, or -1 when it has none.
int FractionDigits(std::string_view text) {
  const std::size_t at = text.find_first_of(".,");
  if (at == std::string_view::npos) return -1;
  return static_cast<int>(text.size() - at - 1);
}

}  // namespace

std::optional<double> ReadTypedNumber(std::string_view text) {
  text = TrimBlanks(text);
  bool negative = false;
  if (!text.empty() && (text.front() == '+' || text.front() == '-')) {
    negative = text.front() == '-';
    text.remove_prefix(1);
  }
  // The text from_chars reads: the digits, the separator made a point.
  std::string plain;
  plain.reserve(text.size());
  bool separator = false, digit = false;
  for (const char c : text) {
    if (IsDigit(c)) {
      digit = true;
      plain += c;
    } else if ((c == '.' || c == ',') && !separator) {
      separator = true;
      plain += '.';
    } else {
      return std::nullopt;
    }
  }
  if (!digit) return std::nullopt;
  double value = 0;
  const auto [end, ec] = std::from_chars(plain.data(), plain.data() + plain.size(), value);
  if (ec != std::errc{} || end != plain.data() + plain.size() || !std::isfinite(value)) {
    return std::nullopt;
  }
  return negative ? -value : value;
}

std::optional<double> ReadTypedScale(std::string_view text) {
  text = TrimBlanks(text);
  const std::size_t ratio = text.find_first_of(":/");
  if (ratio != std::string_view::npos) {
    if (TrimBlanks(text.substr(0, ratio)) != "1") return std::nullopt;
    text = TrimBlanks(text.substr(ratio + 1));
  }
  if (FractionDigits(text) == 3) return std::nullopt;
  const std::optional<double> scale = ReadTypedNumber(text);
  if (!scale || !(*scale > 0)) return std::nullopt;
  return scale;
}

TypedRunNumbersRead ReadRunNumbers(std::string_view scale, std::string_view textHeight,
                                   std::string_view heightDecimals) {
  TypedRunNumbersRead read;
  const auto refuse = [&read](TypedBox box, std::string_view text) {
    read.refused = box;
    read.text = std::string(text);
    return read;
  };
  TypedRunNumbers numbers;
  const std::optional<double> denominator = ReadTypedScale(scale);
  if (!denominator) return refuse(TypedBox::Scale, scale);
  numbers.scale = *denominator;
  const std::optional<double> height = ReadTypedNumber(textHeight);
  if (!height || !(*height > 0)) return refuse(TypedBox::TextHeight, textHeight);
  numbers.textHeight = *height;
  const std::optional<double> decimals = ReadTypedNumber(heightDecimals);
  if (!decimals) return refuse(TypedBox::HeightDecimals, heightDecimals);
  numbers.heightDecimals = static_cast<int>(std::clamp(RoundEvenWhole(*decimals), 0.0, 10.0));
  read.numbers = numbers;
  return read;
}

std::string TypedRefusalMessage(const TypedRunNumbersRead& read) {
  std::string_view box = msg::kScaleBox;
  if (read.refused == TypedBox::TextHeight) box = msg::kTextHeightBox;
  if (read.refused == TypedBox::HeightDecimals) box = msg::kHeightDecimalsBox;
  return std::string(box) + std::string(msg::kCannotReadTyped) + read.text;
}

}  // namespace kavu
