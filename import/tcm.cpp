// Topcom 226 column files (.tcm): a header line, then one record per line.
// A name in columns 1-10 is a set-up; blank columns 1-10 an observation with
// point number, packed readings split over two column groups, distance,
// prism height and description. Each record is written knowing the record
// after it: that tells where a station ends and which observation orients it.
#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "core/angles.h"
#include "core/lines.h"
#include "core/numbers.h"
#include "core/text.h"
#include "import/converters.h"
#include "import/instrument_common.h"

namespace kavu {
namespace {

// Characters first..last (from 1) of a line, trimmed; "" past its end.
std::string Field(std::string_view line, std::size_t first, std::size_t last) {
  return Trim(Columns(line, first, last));
}

std::string OrDefault(std::string text) { return text.empty() ? "0.0" : text; }

// A packed angle split as "DDD" and "MMSS"; zero reads "0". A blank one
// reads "0" too, unless it must stay blank (a zenith: a height from nothing
// would look real, while a blank field makes the run report the record).
std::string PackedAngle(std::string_view line, std::size_t degrees_from, std::size_t rest_from,
                        bool blank_stays = false) {
  std::string text =
      Field(line, degrees_from, degrees_from + 3) + Field(line, rest_from, rest_from + 3);
  if (blank_stays && text.empty()) return text;
  return Val(text) == 0 ? "0" : text;
}

struct Record {
  bool station = false;
  std::string number;   // the station name for a set-up
  std::string reading;  // the instrument height for a set-up
  std::string distance;
  std::string zenith;
  std::string prism;
  std::string description;
};

Record ReadRecord(std::string_view line) {
  Record record;
  record.number = Field(line, 1, 10);
  if (!record.number.empty()) {
    record.station = true;
    record.reading = OrDefault(Field(line, 11, 16));
    return record;
  }
  record.number = FixedWidth(Field(line, 26, 31), 6);
  record.reading = PackedAngle(line, 32, 37);
  record.zenith = PackedAngle(line, 41, 46, true);
  record.distance = OrDefault(Field(line, 59, 67));
  record.prism = OrDefault(Field(line, 68, 73));
  std::string description = Field(line, 75, 84);
  if (description.size() > 2) record.description = std::move(description);
  return record;
}

bool IsNumberZero(const Record& record) { return !record.station && record.number == "0     "; }

class Walk {
 public:
  // Writes record r, whose successor is next (nullptr after the last one).
  void Step(const Record& r, const Record* next) {
    if (r.station) {
      // Of several set-ups in a row only the last counts.
      if (next == nullptr || !next->station) {
        Put("TR " + r.number + " " + r.reading);
        reference_ = 0;
      }
      return;
    }
    const bool next_is_zero = next != nullptr && IsNumberZero(*next);
    std::string reading;
    if ((IsNumberZero(r) || Val(r.reading) <= 5) && !next_is_zero) {
      Put("DKD " + r.description);
      reference_ = CvGocDbl(r.reading);
      reading = RString(r.reading, 9);  // as recorded
    } else if (IsNumberZero(r)) {
      return;
    } else {
      double turned = CvGocDbl(r.reading) - reference_;
      if (turned >= 360) {
        turned -= 360;
      } else if (turned < 0) {
        turned += 360;
      }
      reading = RString(GocSt(turned), 9);
    }
    Put(r.number + " " + reading + " " + RString(r.distance, 9) + " " + RString(r.zenith, 9) + " " +
        RString(r.prism, 7) + " " + r.description);
  }

  std::string Take() { return std::move(book_); }

 private:
  void Put(std::string_view line) { AppendLine(book_, line); }

  std::string book_;
  double reference_ = 0;  // decimal degrees
};

}  // namespace

Conversion ConvertTcm(std::string_view content) {
  const std::vector<std::string> lines = SplitLines(content);
  Walk walk;
  // Records stream through a one-record look-ahead: no table, no limit.
  Record pending;
  bool has_pending = false;
  for (std::size_t i = 1; i < lines.size(); ++i) {  // line 1 is the header
    if (TrimView(lines[i]).empty()) continue;
    Record record = ReadRecord(lines[i]);
    if (has_pending) walk.Step(pending, &record);
    pending = std::move(record);
    has_pending = true;
  }
  if (has_pending) walk.Step(pending, nullptr);
  return {walk.Take(), {}};
}

}  // namespace kavu
