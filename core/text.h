// Text rules: fixed-width fields, column alignment, the field splitter.
// Every text here is TCVN3 bytes, one byte per character.
#pragma once

#include <array>
#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace kavu {

// Removes leading and trailing spaces (code 32 only, never tabs).
std::string_view TrimView(std::string_view text);
std::string Trim(std::string_view text);

// ASCII upper case; bytes >= 0x80 pass unchanged.
std::string Upper(std::string_view text);

// Assignment to a fixed-width field: left-aligned, padded with spaces, cut to
// the width.
std::string FixedWidth(std::string_view text, std::size_t width);

// A number in a fixed-width field: left-aligned and padded like FixedWidth,
// but a longer number is kept whole (a number is never cut to fit).
std::string NumberWidth(std::string_view text, std::size_t width);

// A number right-aligned in a column of a record line (RString of the trimmed
// text); one that fills or exceeds the column gets one space in front, so it
// never runs into the value before it and the line still splits into fields.
std::string NumberColumn(std::string_view text, int width);

// The text from `from` to the end of out, padded behind (PadBehind) or in
// front (PadInFront) to width; a longer text stays whole. For a text without
// surrounding spaces, these are NumberWidth and RString in place; NumberColumn
// in place is PadInFront to width - 1 after a space.
void PadBehind(std::string& out, std::size_t from, std::size_t width);
void PadInFront(std::string& out, std::size_t from, std::size_t width);
// text appended cut to width and padded behind to it (FixedWidth in place).
void AppendFixed(std::string& out, std::string_view text, std::size_t width);

// RString / LString: when text is shorter than width, the trimmed text padded
// to exactly width (spaces in front / behind); otherwise text unchanged.
std::string RString(std::string_view text, int width);
std::string LString(std::string_view text, int width);

// KTraCCG: 1 when the trimmed text holds a character other than the digits
// and ".", otherwise 0.
int KTraCCG(std::string_view text);

// A point name: its significant characters, and its column in the products.
inline constexpr std::size_t kNameWidth = 12;

// A fixed-width text field of the computation state (names 12, X 11, Y 10...).
// A name is cut to the width; a number (Cut = false) is only padded.
template <std::size_t N, bool Cut = true>
class FixedText {
 public:
  static constexpr std::size_t kWidth = N;
  FixedText() : value_(N, ' ') {}
  FixedText& operator=(std::string_view text) {
    value_ = Cut ? FixedWidth(text, N) : NumberWidth(text, N);
    return *this;
  }
  const std::string& str() const { return value_; }
  operator const std::string&() const { return value_; }
  bool operator==(const FixedText& other) const = default;

 private:
  std::string value_;
};

template <std::size_t N>
using FixedNumber = FixedText<N, false>;

// tachdong: every tab turned into a space, runs of spaces reduced to one; the
// normalised text written back into line; the fields returned. The caller has
// already removed the surrounding spaces.
std::vector<std::string> SplitFields(std::string& line);
// The same as views into line.
void SplitFields(std::string& line, std::vector<std::string_view>& fields);

// Field k (from 0) of a line whose fields are set off by single spaces, or the
// empty text past its last field.
std::string_view RecordField(std::string_view record, std::size_t k);
// The first fields of such a line, up to its line end (CR or LF) if it has
// one, the empty text past its last; the number of its fields.
template <std::size_t N>
std::size_t RecordFields(std::string_view record, std::array<std::string_view, N>& fields) {
  fields = {};
  std::size_t count = 0;
  std::size_t start = 0;
  std::size_t end = 0;
  for (; end < record.size() && record[end] != '\r' && record[end] != '\n'; ++end) {
    if (record[end] != ' ') continue;
    if (count < N) fields[count] = record.substr(start, end - start);
    ++count;
    start = end + 1;
  }
  if (end == 0) return 0;
  if (count < N) fields[count] = record.substr(start, end - start);
  return count + 1;
}

}  // namespace kavu
