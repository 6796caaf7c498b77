#include "core/records.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <functional>
#include <string>
#include <vector>

#include "import/converters.h"
#include "support.h"

namespace kavu {
namespace {

namespace fs = std::filesystem;
using testing::FileBytes;

// One letter a line: _ blank, C control, S station, O orientation, D detail,
// P peg, d orientation distance, K check, M malformed, I ignored, U unread.
std::string Kinds(const std::vector<Record>& records) {
  std::string kinds;
  for (const Record& r : records) kinds += "_CSODPdKMIU"[static_cast<int>(r.kind)];
  return kinds;
}

// Every line of the book whose products were checked by hand, with the
// fields the products take from it.
TEST(Records, KindsAndFieldsOfTheHandCheckedBook) {
  const std::string book = FileBytes(fs::path(KAVU_TEST_DATA) / "run/every-record/job.asc");
  const std::vector<Record> records = ReadRecords(book);
  EXPECT_EQ(Kinds(records), "CCCMCCCSODDD_PPddKKMMIIDDDDDSODSODSODDSODSOKSO");
  struct Field {
    std::size_t line;
    std::string_view TypedRecord::*field;
    std::string_view text;
  };
  const Field fields[] = {
      {4, &TypedRecord::name, "JUNK"},         {6, &TypedRecord::note, "extra"},
      {8, &TypedRecord::word, "TR"},           {8, &TypedRecord::instrumentHeight, "1.5"},
      {11, &TypedRecord::name, "2"},           {11, &TypedRecord::code, "N"},
      {12, &TypedRecord::reading, "450000"},   {12, &TypedRecord::zenith, "0900000"},
      {12, &TypedRecord::code, "12"},          {12, &TypedRecord::note, "COT"},
      {14, &TypedRecord::peg, "CP1"},          {16, &TypedRecord::peg, "KC2"},
      {18, &TypedRecord::checkPoint, "KC3"},   {18, &TypedRecord::note, "kt"},
      {21, &TypedRecord::name, "TR1"},         {33, &TypedRecord::name, "LONGNAME1234"},
      {39, &TypedRecord::instrumentHeight, ""}};
  for (const Field& f : fields) EXPECT_EQ(records[f.line - 1].*f.field, f.text) << f.line;
  EXPECT_EQ(records[0].xValue, 1000);
  EXPECT_EQ(records[11].distanceValue, 30.5);
  EXPECT_FALSE(records[38].instrumentHeightValue);
  // Views into the book: the line where it stands, its fields within it.
  EXPECT_EQ(records[11].bytes, book.substr(records[11].place, 34));
  EXPECT_EQ(records[11].reading.data(), records[11].bytes.data() + 2);
}

TEST(Records, StationBlocksAsTheRunWalksThem) {
  const std::string shot = " 0 1 900000 1.5\r\n";
  struct Case {
    std::string book, kinds;
  };
  const Case cases[] = {
      {"TR ST1 1.45 X\r\nTR ST1 1.45\r\nDKD A\r\n   \r\n", "CSO_"},
      // Field 5: a code of two characters, a peg, a number, the station, the
      // orientation point, a check ("kt").
      {"TR STA 1\r\nDKD ORI\r\nP" + shot +
           "P 0 1 9 1 12\r\nP 0 1 9 1 M12\r\nP 0 1 9 1 1.25\r\n"
           "P 0 1 9 1 STA\r\nP 0 1 9 1 ORI N\r\nK 0 1 9 1 DC05 kt\r\n",
       "SODDPDddK"},
      // A station record where the orientation should stand starts the next
      // block; on the last line it is only the missing orientation.
      {"TR A 1\r\nTR B 2\r\nDKD C\r\nP" + shot + "TR D 1\r\nTR E 1\r\n", "SSODSM"},
      // A station record on the last line is never handled.
      {"TR A 1\r\nDKD B\r\nP" + shot + "TR C 1\r\n", "SODU"},
      {"TR1 A 1\r\nDKDX B\r\n", "SO"},
      // Names compare by their first 12 characters.
      {"TR STATION_NAME_1 1\r\nDKD B\r\nP 0 1 9 1 STATION_NAME_2\r\n", "SOd"},
      // No station record that a line follows: the run reads nothing.
      {"P" + shot + "TR A 1 2 3\r\nTR A 1\r\n", "UCU"},
      // Codes are case-sensitive; a block that cannot be computed keeps its
      // body's kinds.
      {"tr S 1\r\nDKD A\r\nP" + shot + "TR A 1\r\nX\r\nQ" + shot, "MODSMD"},
      // Body lines: too few fields (TR1 does not end the body), a short DKD,
      // more than 7 fields, a tab before the name (an empty field 0).
      {"TR A 1\r\nDKD B\r\nBAD 1 2\r\nTR1 X 1\r\nDKD 1 2\r\na b c d e f g h\r\n\tP" + shot,
       "SOMMIID"},
  };
  for (const Case& c : cases) EXPECT_EQ(Kinds(ReadRecords(c.book)), c.kinds) << c.book;
  EXPECT_EQ(ReadRecords(cases[8].book)[6].reading, "P");
}

TEST(RecordLines, ColumnsOfTheLayouts) {
  struct Case {
    std::string line;
    const BookLayout& layout;
    std::string written;
  };
  const Case cases[] = {
      // Empty first and last fields are set off by a tab; runs of blanks go.
      {"\t0  0 1 900000 1.5 C", kPlainBook, "\t0 0 1 900000 1.5 C"},
      {"TR P 1\t", kPlainBook, "TR P 1\t"},
      {"TR P 1 2 3 N\tE  F", kPlainBook, "TR P 1 2 3 N E  F"},
      {"TR S -.5", kIdxBook, "TR S -.5 "},
      {"P 0 1 900000 1.5 LONGER_THAN_12", kSetBook,
       "P             0        1   900000    1.5 LONGER_THAN_"},
      // A body record with a value that is no number is kept as read.
      {"P  x 1 900000 1.5", kTcmBook, "P  x 1 900000 1.5"},
  };
  for (const Case& c : cases) {
    // Body lines after an orientation record, station records before one.
    const std::string book = "TR S 1\r\nDKD A\r\n" + c.line + "\r\nDKD X\r\n";
    EXPECT_EQ(FormatRecord(ReadRecords(book)[2], c.layout), c.written) << c.line;
  }
  // A record made, not read, is laid out whatever it holds.
  Record made;
  made.kind = RecordKind::Detail;
  made.name = "5";
  made.reading = "100";
  made.prismHeight = "0.0";
  EXPECT_EQ(FormatRecord(made, kTcmBook), "5            100                         0.0 ");
}

using Convert = std::function<Conversion(std::string_view)>;
const Convert kSdr = [](std::string_view file) { return ConvertSdr(file, 1); };
const Convert kObs = [](std::string_view file) { return ConvertObs(file, 2); };
struct Reader {
  const char* extension;
  Convert convert;
  const BookLayout& layout;
};
const Reader kReaders[] = {{".asc", nullptr, kPlainBook},  {".sdr", kSdr, kSdrBook},
                           {".gre", kSdr, kSdrBook},       {".obs", kObs, kSokkiaBook},
                           {".set", ConvertSet, kSetBook}, {".idx", ConvertIdx, kIdxBook},
                           {".tcm", ConvertTcm, kTcmBook}};

const Reader* ReaderOf(const fs::path& file) {
  for (const Reader& reader : kReaders) {
    if (file.extension() == reader.extension) return &reader;
  }
  return nullptr;
}

// Every field book and instrument file of a folder, read, written and read
// again: the same records, in the plain layout and in its converter's; a
// converter's book of the project written in its layout is its bytes again
// (the layout made them, not the lines as read). The number of books read.
std::size_t ReadBackAfterFormatting(const fs::path& folder, bool ours = true) {
  std::size_t books = 0;
  for (const auto& entry : fs::recursive_directory_iterator(folder)) {
    const Reader* reader = ReaderOf(entry.path());
    if (reader == nullptr || !entry.is_regular_file()) continue;
    ++books;
    const std::string file = FileBytes(entry.path());
    const std::string book = reader->convert ? reader->convert(file).book : file;
    const std::vector<Record> records = ReadRecords(book);
    if (reader->convert && ours) {
      EXPECT_EQ(FormatBook(records, reader->layout), book) << entry.path();
      EXPECT_NE(FormatBook(records, kPlainBook), book) << entry.path();
    }
    for (const BookLayout* layout : {&kPlainBook, &reader->layout}) {
      const std::string written = FormatBook(records, *layout);
      const std::vector<Record> again = ReadRecords(written);
      EXPECT_EQ(again.size(), records.size()) << entry.path();
      for (std::size_t k = 0; k < std::min(records.size(), again.size()); ++k) {
        EXPECT_TRUE(static_cast<const TypedRecord&>(again[k]) == records[k])
            << entry.path() << " line " << k + 1 << ": " << records[k].bytes;
      }
    }
  }
  return books;
}

TEST(Records, EveryBookOfTheProjectReadsBackAfterFormatting) {
  EXPECT_EQ(ReadBackAfterFormatting(fs::path(KAVU_TEST_DATA).parent_path()) +
                ReadBackAfterFormatting(KAVU_EXAMPLES),
            19u);
}

TEST(Records, EveryRealRecordingReadsBackAfterFormatting) {
  if (!fs::is_directory(KAVU_REALDATA)) GTEST_SKIP() << "no real recordings at " << KAVU_REALDATA;
  EXPECT_GE(ReadBackAfterFormatting(KAVU_REALDATA, false), 10u);
}

}  // namespace
}  // namespace kavu
