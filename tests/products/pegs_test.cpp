#include "products/pegs.h"

#include <gtest/gtest.h>

#include "core/host.h"
#include "core/station.h"
#include "core/tcvn3.h"
#include "run/run.h"
#include "tests/products/product_files.h"

namespace kavu {
namespace {

using testing::Expected;
using testing::FileBytes;
using testing::FreshFolder;

// Control points: a name, X and Y longer than their columns (the name cut to
// 12, the numbers kept whole), a TCVN3 name, an empty and a negative height.
const std::vector<KnownPoint> kControl = {
    {"P1", "2345678.123", "567890.456", "12.5"},
    {"ABCDEFGHIJKLMN", "12345678.1234", "1234567.1234", ""},
    {"\xa7\xd3i1", "2345600", "567800.5", "-1.25"},
};

// A peg's record: point, reading, distance, zenith, prism height, peg name,
// note.
std::string Peg(const std::string& name, const std::string& angle, const std::string& distance,
                const std::string& zenith, const std::string& prism, const std::string& note) {
  std::string record = "1 " + angle + " " + distance + " " + zenith + " " + prism + " " + name;
  return note.empty() ? record : record + " " + note;
}

void Station(RunState& st, const std::string& tram, const std::string& dinhHuong,
             const std::string& dong2, const std::vector<std::string>& pegs) {
  StationResult station;
  station.station.name = tram;
  station.orientation.name = dinhHuong;
  station.checkRecord = dong2;
  st.survey.stations.push_back(station);
  const std::size_t first = st.survey.points.size();
  for (const std::string& record : pegs) {
    st.survey.AddPoint(record, PointKind::Peg, 0, 0).station =
        static_cast<std::uint32_t>(st.survey.stations.size() - 1);
  }
  CheckPegReadings(st, first);
}

// A state whose peg file is open, with the control points read.
RunState PegState(const std::filesystem::path& folder, int fcp, int fdc) {
  RunState st;
  st.fcp = fcp;
  st.fdc = fdc;
  st.survey.known = kControl;
  st.survey.knownRead = kControl.size();
  st.cpFile.open(folder / "JOB1.cp");
  return st;
}

// The head with heights; stations with and without pegs and check records, a
// long peg name, distance and zenith each still set off by a space, readings
// of 8 characters reported; station lines without instrument height.
TEST(Pegs, HeadAndStationBlocks) {
  const auto folder = FreshFolder();
  RunState st = PegState(folder, 1, 1);

  WritePegFileHead(st.cpFile, st.survey, true);
  Station(st, "ST1", "DH1", "",
          {Peg("M5", "1234530", "45.6", "900000", "1.5", ""),
           Peg("CP1234567890123", "0", "1234.567", "0895959.5", "1.45", "COCGO")});
  Station(st, "ST1", "M5", "", {});
  EXPECT_EQ(st.err, 0);
  Station(
      st, "M5", "ST1", "DKD2 KT2          1234530 100.25",
      {Peg("M6", "45", "10.000", "0900000", "1.500", "N"),
       Peg("M7", "12345305", "12", "900000", "1.5", ""), Peg("M8", "1", "1", "900000", "1.5", "")});
  EXPECT_EQ(st.err, 1);
  Station(st, "M6", "M5", "DKD2 ST1          3595958 24.41",
          {Peg("M9", "123453.5", "12", "900000", "1.5", "")});
  EXPECT_EQ(st.err, 2);

  WritePegBlocks(st.cpFile, st.survey);
  ASSERT_TRUE(st.cpFile.close());
  EXPECT_EQ(FileBytes(folder / "JOB1.cp"), Expected("pegs/stations.cp"));
  ASSERT_EQ(st.survey.report.size(), 2u);
  EXPECT_EQ(st.survey.TextOf(st.survey.report[0]), "Diem M7           nhap sai phan do");
  EXPECT_EQ(st.survey.TextOf(st.survey.report[1]), "Diem M9           nhap sai phan do");
}

// A seeded run writes the sketch, pegs and drawing of a book with every line
// form: details of 5, 6 and 7 fields, pegs, check records with and without a
// reading (made up from the draw), a station with only an orientation
// distance record.
TEST(ProductsRun, SeededRunWritesSketchPegsAndDrawing) {
  const auto folder = FreshFolder();
  std::filesystem::copy_file(std::filesystem::path(KAVU_TEST_DATA) / "products/run/job.asc",
                             folder / "JOB.asc");
  RunState st;
  st.txtfile = (folder / "JOB.asc").string();
  st.ftd = 0;
  st.fdc = 1;
  st.fsdo = 1;
  st.fcp = 1;
  st.fdxf = 1;
  st.seed = 7;
  st.nhapsdo = {Utf8ToTcvn3("Xã Hòa Bình, huyện Đông Anh"),
                "05",
                "SET 2C",
                "123456",
                Utf8ToTcvn3("Nguyễn Văn A"),
                Utf8ToTcvn3("Trần Thị B"),
                "06/12/2026"};
  QuietHost host;
  ASSERT_EQ(tinh_Click(st, host).outcome, RunOutcome::Completed);
  EXPECT_EQ(st.err, 1);  // the 13-character point name
  EXPECT_TRUE(st.unwritable.empty());
  for (const char* extension : {".sdo", ".cp", ".dxf"}) {
    EXPECT_EQ(FileBytes(folder / (std::string("JOB") + extension)),
              Expected(std::string("run/job") + extension))
        << extension;
  }
}

}  // namespace
}  // namespace kavu
