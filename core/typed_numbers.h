// The numbers of a run that a person types into a box or onto the command
// line: the map scale, the label height and the decimals of heights. A text
// that is not plainly one of them is refused, never read as what its first
// digits happen to say ("1:500" is not the scale 1, "2,5" is not 2).
#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace kavu {

// A decimal number as a person types it: blanks (spaces, tabs) around it,
// an optional sign, digits with at most one separator, "." or ",", and at
// least one digit. Nothing else: no exponent, no grouping, no unit.
std::optional<double> ReadTypedNumber(std::string_view text);

// A map scale as it is labelled: "500", "1:500" or "1/500" (blanks allowed
// around the parts), above 0. A separator followed by exactly three digits
// ("1.000", "2,000") is refused: Vietnamese writes it as a thousands group,
// so the text could as well mean a thousand times more.
std::optional<double> ReadTypedScale(std::string_view text);

// The boxes of the numbers, in the order they are checked.
enum class TypedBox { Scale, TextHeight, HeightDecimals };

// What a run is asked, in numbers.
struct TypedRunNumbers {
  double scale = 1000;     // the map scale's denominator
  double textHeight = 2;   // the drawing's label height, mm on paper
  int heightDecimals = 2;  // decimals of the heights in the coordinate text, 0 to 10
};

// The three texts read at once: the numbers, or the first box whose text
// cannot be read (with that text). The scale and the label height must be
// above 0; the decimals are rounded to the nearest whole number (ties to
// even) and held to 0–10.
struct TypedRunNumbersRead {
  std::optional<TypedRunNumbers> numbers;
  TypedBox refused = TypedBox::Scale;
  std::string text;  // the refused text as it was typed
};
TypedRunNumbersRead ReadRunNumbers(std::string_view scale, std::string_view textHeight,
                                   std::string_view heightDecimals);

// The message for a refused text (UTF-8): "Tỷ lệ bản đồ không đọc được: 1:5OO".
std::string TypedRefusalMessage(const TypedRunNumbersRead& read);

}  // namespace kavu
