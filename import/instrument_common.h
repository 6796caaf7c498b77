// Pieces shared by the converters of fixed-column instrument files: column
// access that never reads past a line, the record code, the reduction of a
// slope distance, readings turned to the backsight, the observations that wait
// for their backsight, and the column texts of a detail record.
#pragma once

#include <cstddef>
#include <functional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace kavu {

// Characters `from` to `to` of a line (counted from 1, both included); the
// part past the end of the line is simply missing, so a short line gives a
// short or empty field.
std::string_view Columns(std::string_view line, std::size_t from, std::size_t to);

// Characters `from` to the end of the line.
std::string_view ColumnsFrom(std::string_view line, std::size_t from);

// The record code: characters 1 to 4, or "AAAA" (which matches no code) for
// a line that holds nothing but spaces.
std::string_view RecordCode(std::string_view line);

// Horizontal distance from a slope distance and a zenith angle in decimal
// degrees, rounded to millimetres with ties to even. The recorders' divisor
// is 180.0000001, not 180.
double HorizontalDistance(double slope, double zenith_degrees);

// A horizontal reading turned so that the backsight reads zero: nothing
// happens while no backsight reading is known (0); a negative difference gets
// 360 added once.
double TurnReading(double reading, double backsight_reading);

// Observations shot after a set-up's backsight record but before the
// backsight itself was read. They were read on the same circle, so they wait
// for the backsight reading and are then written turned like the rest; a
// set-up that ends without it releases them with their circle readings.
template <typename Observation>
class HeldObservations {
 public:
  explicit HeldObservations(std::function<void(const Observation&)> write)
      : write_(std::move(write)) {}
  // The writer is bound to its owner: never copied with it.
  HeldObservations(const HeldObservations&) = delete;
  HeldObservations& operator=(const HeldObservations&) = delete;

  // A backsight record was read: observations wait until it is observed.
  void Await() { awaiting_ = true; }
  bool awaiting() const { return awaiting_; }
  void Hold(Observation observation) { held_.push_back(std::move(observation)); }

  // Writes the held observations in file order and stops waiting.
  void Release() {
    for (const Observation& observation : held_) write_(observation);
    held_.clear();
    awaiting_ = false;
  }

 private:
  std::function<void(const Observation&)> write_;
  bool awaiting_ = false;
  std::vector<Observation> held_;
};

// A computed horizontal distance in its 9 columns ("####0.000").
std::string DistanceText(double distance);

// A prism height in its 7 columns. A text of 7 characters or more (recorders
// write "1.47400000") gets one space in front, so it never runs into the
// zenith angle before it.
std::string PrismHeightText(std::string_view height);

// The point number of an identifier: the ordinary number text of its value
// (0012 -> 12, A7 -> 0, 0.5 -> .5).
std::string PointNumberText(std::string_view identifier);

// A control-point record: "TR " + name, then X and Y right-aligned in 11
// columns after a blank each, and H in 10; a longer text is written whole.
std::string ControlPointRecord(std::string_view name, std::string_view x, std::string_view y,
                               std::string_view h);

// Appends a field-book line with its CR LF.
void AppendLine(std::string& out, std::string_view line);

}  // namespace kavu
