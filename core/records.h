// The records of a field book, typed, and the one writer of record lines.
//
// Reading a field book gives one record per line, classified as the station
// loop sees it: control points anywhere, then station blocks (a station
// record, the orientation record on the next line, the body up to the next
// line whose first field is "TR"). Every text of a record is a view into the
// book's bytes, which must outlive the records: a field never holds a blank,
// and normalising a line only touches blanks, so each field stands in the
// book exactly as the run reads it.
//
// The writer lays a record out in the columns of a layout. Each converter
// has its own layout (name widths, alignment, spaces between columns, the
// code left out); the plain layout sets the fields off by single spaces.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <initializer_list>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace kavu {

// What a line is to the run.
enum class RecordKind : std::uint8_t {
  Blank,                // nothing but spaces
  Control,              // "TR" name X Y [H [note]]: a point of known coordinates
  Station,              // "TR..." name [instrument height]: starts a station block
  Orientation,          // "DKD..." name, on the line after the station record
  Detail,               // point reading distance zenith prism-height [code [note]]
  Peg,                  // a detail whose sixth field names a new auxiliary peg
  OrientationDistance,  // ... names the station or its orientation point
  Check,                // 7 fields, the last "KT" in any case: a sight on a known point
  // Reported as run together: a body line of fewer than 5 fields, or a line
  // where the station or the orientation record should stand.
  Malformed,
  Ignored,  // a body line passed over without a word: over 7 fields, or a short "DKD" line
  // A line the station loop never handles: a book without a station record
  // that another line follows, or a station record on the last line.
  Unread,
};

// The typed fields of a record; empty where its kind has none. A station
// record where the orientation record should stand is the next block's
// station record (the run reports the missing orientation and goes on).
struct TypedRecord {
  RecordKind kind = RecordKind::Blank;
  std::string_view word;  // field 0 of a control, station or orientation record
  // The point, station or orientation point; field 0 of a body line (a
  // check's label) and of a malformed, ignored or unread line.
  std::string_view name;
  std::string_view x, y, h;  // of a control point, as written
  std::string_view instrumentHeight;
  std::string_view reading, zenith;  // packed angles, as written
  std::string_view distance, prismHeight;
  std::string_view code;        // of a detail
  std::string_view peg;         // the new peg; the point an orientation distance names
  std::string_view checkPoint;  // the known point a check sights
  std::string_view note;        // field 5 of a control point, field 6 of a body record
  // The fields after those of a control, station or orientation record, as
  // they stand in the line; the run reads none of them.
  std::string_view extra;
  // The numbers the run reads, none when the text holds no number.
  std::optional<double> xValue, yValue, hValue, instrumentHeightValue, distanceValue,
      prismHeightValue;
  // Field 5 of a body record is the name of its block's station or
  // orientation point (as 12-character names), a number or not.
  bool namesBlockPoint = false;

  bool operator==(const TypedRecord&) const = default;
};

struct Record : TypedRecord {
  std::size_t line = 0;        // in the field book, from 1
  std::size_t place = 0;       // byte offset of the line in the book
  std::string_view bytes;      // the line as it stands, without its line end
  std::size_t fieldCount = 0;  // after normalising
};

std::vector<Record> ReadRecords(std::string_view book);
// The records would outlive a book that is a temporary.
std::vector<Record> ReadRecords(std::string&& book) = delete;

// How a column writes its text.
enum class Fit : std::uint8_t {
  AsIs,
  Left,    // padded behind to the width; a longer text whole
  Right,   // padded in front to the width; a longer text whole
  Apart,   // as Right, with a space in front of a text that fills the width
  Cut,     // cut to the width, padded behind
  Signed,  // the number form of report lines: a space (or the minus), the text, a space
};

struct Column {
  std::string_view before;  // written in front of the text
  Fit fit = Fit::AsIs;
  std::uint8_t width = 0;
  // Left out, with what stands before it, when it and every later field are
  // empty.
  bool optional = false;
  // Holds its field and every later one, set off by single spaces.
  bool rest = false;
};

// The columns of a record line, one per field in field order: control point
// "TR" name X Y H note extra; station "TR" name height extra; orientation
// "DKD" name extra; body records name reading distance zenith prism-height,
// then the code (peg, check point) and the note.
struct RecordLayout {
  std::array<Column, 7> columns{};
  std::size_t count = 0;
};

constexpr RecordLayout MakeRecordLayout(std::initializer_list<Column> columns) {
  RecordLayout layout;
  for (const Column& column : columns) layout.columns[layout.count++] = column;
  return layout;
}

struct BookLayout {
  RecordLayout control, station, orientation, body;
  // A body record whose field 5 names its station or orientation point.
  RecordLayout shotOnBlockPoint;
  // An empty first or last field is set off by a tab, so that it reads back.
  bool tabsAtEmptyEnds = false;
};

namespace layout {

inline constexpr Column kFirst{};
inline constexpr Column kSpaced{" "};
inline constexpr Column kSpacedOptional{" ", Fit::AsIs, 0, true};
inline constexpr Column kReading{"", Fit::Right, 9};
inline constexpr Column kCodeAndNote{" ", Fit::AsIs, 0, false, true};

inline constexpr RecordLayout kPlainControl = MakeRecordLayout(
    {kFirst, kSpaced, kSpaced, kSpaced, kSpacedOptional, kSpacedOptional, kSpacedOptional});
// X and Y right-aligned in 11 columns after a blank each, H in 10.
inline constexpr RecordLayout kControl = MakeRecordLayout({kFirst,
                                                           kSpaced,
                                                           {" ", Fit::Right, 11},
                                                           {" ", Fit::Right, 11},
                                                           {" ", Fit::Left, 10},
                                                           kSpacedOptional,
                                                           kSpacedOptional});
inline constexpr RecordLayout kStation =
    MakeRecordLayout({kFirst, kSpaced, kSpaced, kSpacedOptional});
// A name, then readings, distance and zenith right-aligned in 9, the prism
// height in 7 never touching the zenith, then the description when there is
// one.
constexpr RecordLayout Shot(std::uint8_t nameWidth, std::optional<Column> description) {
  RecordLayout shot = MakeRecordLayout(
      {{"", Fit::Left, nameWidth}, kReading, kReading, kReading, {"", Fit::Apart, 7}});
  if (description) shot.columns[shot.count++] = *description;
  return shot;
}
constexpr BookLayout Book(const RecordLayout& control, const RecordLayout& station,
                          const RecordLayout& shot) {
  return {control, station, MakeRecordLayout({kFirst, kSpaced, kSpacedOptional}), shot, shot};
}

}  // namespace layout

// Fields set off by single spaces.
inline constexpr BookLayout kPlainBook = [] {
  using namespace layout;
  BookLayout book =
      Book(kPlainControl, MakeRecordLayout({kFirst, kSpaced, kSpacedOptional, kSpacedOptional}),
           MakeRecordLayout(
               {kFirst, kSpaced, kSpaced, kSpaced, kSpaced, kSpacedOptional, kSpacedOptional}));
  book.tabsAtEmptyEnds = true;
  return book;
}();

// SDR books with 4-character identifiers (.sdr, .gre).
inline constexpr BookLayout kSdrBook =
    layout::Book(layout::kControl, layout::kStation, layout::Shot(4, layout::kCodeAndNote));
// SDR books with 16-character identifiers (.obs): no description, but the
// shot on the backsight names its point.
inline constexpr BookLayout kSokkiaBook = [] {
  using namespace layout;
  BookLayout book = Book(kControl, kStation, Shot(10, std::nullopt));
  book.shotOnBlockPoint = Shot(10, kCodeAndNote);
  return book;
}();
// SET files: the code cut and padded to 12, but the orientation shot names
// its point as it stands.
inline constexpr BookLayout kSetBook = [] {
  using namespace layout;
  BookLayout book = Book(kControl, kStation, Shot(6, Column{" ", Fit::Cut, 12, false, true}));
  book.shotOnBlockPoint = Shot(6, kCodeAndNote);
  return book;
}();
// Topcom keyword files: the instrument height in the number form of report
// lines, no description.
inline constexpr BookLayout kIdxBook = layout::Book(
    layout::kPlainControl,
    MakeRecordLayout(
        {layout::kFirst, layout::kSpaced, {" ", Fit::Signed}, layout::kSpacedOptional}),
    layout::Shot(5, std::nullopt));
// Topcom 226 column files: a space between the columns, the point number cut
// to 6, the prism height right-aligned in 7.
inline constexpr BookLayout kTcmBook = layout::Book(layout::kPlainControl, layout::kStation,
                                                    MakeRecordLayout({{"", Fit::Cut, 6},
                                                                      {" ", Fit::Right, 9},
                                                                      {" ", Fit::Right, 9},
                                                                      {" ", Fit::Right, 9},
                                                                      {" ", Fit::Right, 7},
                                                                      layout::kCodeAndNote}));

// A record as a line of a field book, without its line end. A line the run
// cannot use as written (blank, malformed, ignored, unread, or a body record
// read with a reading, distance, zenith or prism height that is no number)
// does not say which column each value came from: it is written as read.
std::string FormatRecord(const Record& record, const BookLayout& layout);
// Every record, each line ending in CR LF.
std::string FormatBook(std::span<const Record> records, const BookLayout& layout);

}  // namespace kavu
