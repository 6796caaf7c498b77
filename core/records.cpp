#include "core/records.h"

#include <algorithm>
#include <span>

#include "core/control_points.h"
#include "core/lines.h"
#include "core/numbers.h"
#include "core/station.h"
#include "core/text.h"

namespace kavu {
namespace {

using Fields = std::span<const std::string_view>;

// The fields of a normalised copy of raw, as views into raw: every field
// stands there unchanged, after the one before it.
void IntoLine(std::string_view raw, std::vector<std::string_view>& fields) {
  std::size_t at = 0;
  for (std::string_view& field : fields) {
    at = raw.find(field, at);
    field = raw.substr(at, field.size());
    at += field.size();
  }
}

std::string_view FieldOf(const Fields& fields, std::size_t k) {
  return k < fields.size() ? fields[k] : std::string_view();
}

// Fields k and later as they stand in the line.
std::string_view FieldsFrom(const Fields& fields, std::size_t k) {
  if (k >= fields.size()) return {};
  const char* end = fields.back().data() + fields.back().size();
  return {fields[k].data(), static_cast<std::size_t>(end - fields[k].data())};
}

std::optional<double> NumberOf(std::string_view text) {
  double value = 0;
  if (!ReadNumber(text, value)) return std::nullopt;
  return value;
}

void TypeControl(Record& r, const Fields& f) {
  r.kind = RecordKind::Control;
  r.word = f[0];
  r.name = f[1];
  r.x = f[2];
  r.y = f[3];
  r.h = FieldOf(f, 4);
  r.note = FieldOf(f, 5);
  r.extra = FieldsFrom(f, 6);
  r.xValue = NumberOf(r.x);
  r.yValue = NumberOf(r.y);
  r.hValue = NumberOf(r.h);
}

bool IsStation(const Fields& f) { return f.size() >= 2 && f[0].starts_with("TR"); }
bool IsOrientation(const Fields& f) { return f.size() >= 2 && f[0].starts_with("DKD"); }
// The record that ends a station body.
bool EndsBody(const Fields& f) { return f[0] == "TR"; }

void TypeStation(Record& r, const Fields& f) {
  r.kind = RecordKind::Station;
  r.word = f[0];
  r.name = f[1];
  r.instrumentHeight = FieldOf(f, 2);
  r.instrumentHeightValue = NumberOf(r.instrumentHeight);
  r.extra = FieldsFrom(f, 3);
}

void TypeOrientation(Record& r, const Fields& f) {
  r.kind = RecordKind::Orientation;
  r.word = f[0];
  r.name = f[1];
  r.extra = FieldsFrom(f, 2);
}

void TypeMalformed(Record& r, const Fields& f) {
  r.kind = RecordKind::Malformed;
  r.name = f[0];
}

// Names of a block as the run compares them: their first 12 characters.
bool SameName(std::string_view a, std::string_view b) { return a.substr(0, kNameWidth) == b.substr(0, kNameWidth); }

void TypeBody(Record& r, const Fields& f, std::string_view station, std::string_view orientation) {
  r.name = f[0];
  switch (BodyRecordOf(f)) {
    case BodyRecord::TooFew:
      r.kind = f[0] == "DKD" ? RecordKind::Ignored : RecordKind::Malformed;
      return;
    case BodyRecord::TooMany:
      r.kind = RecordKind::Ignored;
      return;
    case BodyRecord::Detail:
      r.kind = RecordKind::Detail;
      r.code = FieldOf(f, 5);
      break;
    case BodyRecord::Peg:
      r.kind = RecordKind::Peg;
      r.peg = f[5];
      break;
    case BodyRecord::Check:
      r.kind = RecordKind::Check;
      r.checkPoint = f[5];
      break;
  }
  r.reading = f[1];
  r.distance = f[2];
  r.zenith = f[3];
  r.prismHeight = f[4];
  r.note = FieldOf(f, 6);
  r.distanceValue = NumberOf(r.distance);
  r.prismHeightValue = NumberOf(r.prismHeight);
  r.namesBlockPoint =
      f.size() > 5 && !f[5].empty() && (SameName(f[5], station) || SameName(f[5], orientation));
  if (r.kind == RecordKind::Peg && r.namesBlockPoint) r.kind = RecordKind::OrientationDistance;
}

// The station loop over the working copy (the lines that are neither blank
// nor control points), as the run walks it: a station record, the next line
// as its orientation record, then the body up to a line whose field 0 is
// "TR". A block whose station or orientation record is not one is skipped by
// the run up to the same line; its body lines keep their kinds.
class StationWalk {
 public:
  // The fields of working line k are fields[starts[k]] to fields[starts[k + 1]].
  StationWalk(std::vector<Record>& records, const std::vector<std::size_t>& working,
              const std::vector<std::string_view>& fields, const std::vector<std::size_t>& starts)
      : records_(records), working_(working), fields_(fields), starts_(starts) {}

  void Run() {
    std::size_t hand = Read();
    while (!AtEnd()) {
      const Fields station = FieldsOf(hand);
      const bool isStation = IsStation(station);
      if (isStation) {
        TypeStation(At(hand), station);
      } else {
        TypeMalformed(At(hand), station);
      }
      hand = Read();
      const Fields orientation = FieldsOf(hand);
      const bool isOrientation = IsOrientation(orientation);
      if (isOrientation) {
        TypeOrientation(At(hand), orientation);
      } else if (!EndsBody(orientation) || AtEnd()) {
        TypeMalformed(At(hand), orientation);
      }
      // A station record where the orientation should stand starts the next
      // block; on the last line it is only the missing orientation.
      if (EndsBody(orientation)) continue;
      const std::string_view stationName = isStation ? station[1] : std::string_view();
      const std::string_view orientationName = isOrientation ? orientation[1] : std::string_view();
      while (!AtEnd()) {
        hand = Read();
        if (EndsBody(FieldsOf(hand))) break;
        TypeBody(At(hand), FieldsOf(hand), stationName, orientationName);
      }
    }
  }

 private:
  bool AtEnd() const { return next_ >= working_.size(); }
  // The index of the next working line.
  std::size_t Read() { return next_++; }
  Record& At(std::size_t k) { return records_[working_[k]]; }
  Fields FieldsOf(std::size_t k) const {
    return Fields(fields_).subspan(starts_[k], starts_[k + 1] - starts_[k]);
  }

  std::vector<Record>& records_;
  const std::vector<std::size_t>& working_;
  const std::vector<std::string_view>& fields_;
  const std::vector<std::size_t>& starts_;
  std::size_t next_ = 0;
};

}  // namespace

std::vector<Record> ReadRecords(std::string_view book) {
  std::vector<Record> records;
  records.reserve(static_cast<std::size_t>(std::count(book.begin(), book.end(), '\n')) + 1);
  std::vector<std::size_t> working;      // positions in records
  std::vector<std::string_view> fields;  // of the working lines, one after the other
  std::vector<std::size_t> starts{0};    // where each line's fields start
  // The station loop reads the working copy only when a station record
  // stands on a line of it that another line follows.
  bool stationSeen = false, reachable = false;
  std::string normalised;
  std::vector<std::string_view> split;
  LineReader reader(book);
  for (std::string_view raw; reader.Next(raw);) {
    Record& record = records.emplace_back();
    record.line = records.size();
    record.place = static_cast<std::size_t>(raw.data() - book.data());
    record.bytes = raw;
    if (TrimView(raw).empty()) continue;
    const bool workingLine = WorkingLine(raw, normalised, split);
    IntoLine(raw, split);
    record.fieldCount = split.size();
    if (!workingLine) {
      TypeControl(record, split);
      continue;
    }
    record.kind = RecordKind::Unread;
    record.name = split[0];
    reachable = reachable || stationSeen;
    stationSeen = stationSeen || IsStation(split);
    working.push_back(records.size() - 1);
    fields.insert(fields.end(), split.begin(), split.end());
    starts.push_back(fields.size());
  }
  if (reachable) StationWalk(records, working, fields, starts).Run();
  return records;
}

namespace {

void AppendFitted(std::string& out, std::string_view text, const Column& column) {
  switch (column.fit) {
    case Fit::AsIs:
      out += text;
      break;
    case Fit::Left:
      out += LString(text, column.width);
      break;
    case Fit::Right:
      out += RString(text, column.width);
      break;
    case Fit::Apart:
      out += NumberColumn(text, column.width);
      break;
    case Fit::Cut:
      AppendFixed(out, text, column.width);
      break;
    case Fit::Signed:
      if (!text.starts_with('-')) out += ' ';
      out += text;
      out += ' ';
      break;
  }
}

bool IsBody(RecordKind kind) {
  return kind == RecordKind::Detail || kind == RecordKind::Peg ||
         kind == RecordKind::OrientationDistance || kind == RecordKind::Check;
}

// The code, the peg or the check point.
std::string_view FifthField(const Record& r) {
  if (r.kind == RecordKind::Detail) return r.code;
  return r.kind == RecordKind::Check ? r.checkPoint : r.peg;
}

bool AsRead(const Record& r) {
  if (!IsBody(r.kind)) {
    return r.kind != RecordKind::Control && r.kind != RecordKind::Station &&
           r.kind != RecordKind::Orientation;
  }
  return !r.bytes.empty() &&
         !(HasNumber(r.reading) && r.distanceValue && HasNumber(r.zenith) && r.prismHeightValue);
}

}  // namespace

std::string FormatRecord(const Record& r, const BookLayout& layout) {
  if (AsRead(r)) return std::string(r.bytes);
  std::array<std::string_view, 7> texts{};
  const RecordLayout* columns = &layout.body;
  switch (r.kind) {
    case RecordKind::Control:
      texts = {r.word, r.name, r.x, r.y, r.h, r.note, r.extra};
      columns = &layout.control;
      break;
    case RecordKind::Station:
      texts = {r.word, r.name, r.instrumentHeight, r.extra};
      columns = &layout.station;
      break;
    case RecordKind::Orientation:
      texts = {r.word, r.name, r.extra};
      columns = &layout.orientation;
      break;
    default:
      texts = {r.name, r.reading, r.distance, r.zenith, r.prismHeight, FifthField(r), r.note};
      if (r.namesBlockPoint) columns = &layout.shotOnBlockPoint;
  }
  // Optional columns at the end with nothing to write are left out.
  std::size_t end = columns->count;
  while (end > 0 && columns->columns[end - 1].optional && texts[end - 1].empty()) --end;
  std::string out;
  for (std::size_t k = 0; k < end; ++k) {
    const Column& column = columns->columns[k];
    std::string joined;
    std::string_view text = texts[k];
    if (column.rest) {
      for (std::size_t j = k; j < texts.size(); ++j) {
        if (texts[j].empty()) continue;
        if (!joined.empty()) joined += ' ';
        joined += texts[j];
      }
      text = joined;
    }
    const bool emptyEnd = (k == 1 && texts[0].empty()) || (k + 1 == end && text.empty());
    out += layout.tabsAtEmptyEnds && k > 0 && emptyEnd ? "\t" : column.before;
    AppendFitted(out, text, column);
    if (column.rest) break;
  }
  return out;
}

std::string FormatBook(std::span<const Record> records, const BookLayout& layout) {
  std::string book;
  for (const Record& record : records) {
    book += FormatRecord(record, layout);
    book += "\r\n";
  }
  return book;
}

}  // namespace kavu
