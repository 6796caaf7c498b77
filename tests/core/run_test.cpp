#include "run/run.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <sstream>
#include <string>

#include "core/messages.h"
#include "core/text.h"
#include "support.h"

namespace kavu {
namespace {

namespace fs = std::filesystem;
using testing::FileBytes;
using testing::FreshFolder;
using testing::RecordingHost;
using testing::WriteBytes;

const fs::path kEveryRecord = fs::path(KAVU_TEST_DATA) / "run" / "every-record";

RunState StateFor(const fs::path& file) {
  RunState st;
  st.txtfile = file.string();
  st.seed = 7;
  return st;
}

// The field book holds every record kind and every report line: duplicate
// control points within (KC1) and beyond (KC3) the tolerance, a 12-character
// name, a line where a station was expected, tabs and runs of spaces, pegs
// (CP1 later occupied as a station), orientation-distance and check records,
// malformed, ignored and non-numeric lines, entry errors, a "DKC" reference,
// a detail name over 12 characters (reported), a skipped block, a station
// record without instrument height, a station with only a check record and an
// orientation record on the last line. Every
// expected file was checked line by line against the layouts, the coordinates
// against an independent single-precision azimuth computation.
TEST(Run, EveryRecordKindGivesTheHandCheckedProducts) {
  const fs::path folder = FreshFolder();
  fs::create_directories(folder / "data");
  fs::copy_file(kEveryRecord / "job.asc", folder / "data" / "job.asc");
  RunState st = StateFor(folder / "data" / "job.asc");
  st.fasc = st.ftd = st.fkc = 1;
  RecordingHost host;
  const RunResult result = tinh_Click(st, host);

  EXPECT_EQ(result.outcome, RunOutcome::Completed);
  EXPECT_EQ(result.stations, 6);
  EXPECT_EQ(result.bodyRecords, 22);
  EXPECT_EQ(result.err, 16);
  EXPECT_TRUE(result.unwritable.empty());
  for (const char* name : {"job.err", "job.cpv", "job.kc", "job.td1", "job.txt"}) {
    EXPECT_EQ(FileBytes(folder / "data" / name), FileBytes(kEveryRecord / "expected" / name))
        << name;
  }
  EXPECT_EQ(FileBytes(folder / "TRIDO" / "job.asc"),
            FileBytes(kEveryRecord / "expected" / "TRIDO-job.asc"));
  // The products are those asked for, and nothing else.
  EXPECT_FALSE(fs::exists(folder / "data" / "job.dxf"));
  EXPECT_FALSE(fs::exists(folder / "data" / "job.sdo"));
  // The window shows the summary, then the program's title, and beeps.
  ASSERT_FALSE(host.messages.empty());
  EXPECT_NE(host.messages.back().find("Tổng số lỗi:  16\r"), std::string::npos);
  EXPECT_EQ(host.titles.back(), msg::kProgramTitle);
  EXPECT_EQ(host.beeps, 1);
  EXPECT_EQ(host.kind, 0);
}

// The typed result holds what the products show: the report's lines in order,
// each detail point at the coordinates of the coordinate text file.
TEST(Run, SurveyHoldsWhatTheProductsShow) {
  const fs::path folder = FreshFolder();
  fs::create_directories(folder / "data");
  fs::copy_file(kEveryRecord / "job.asc", folder / "data" / "job.asc");
  RunState st = StateFor(folder / "data" / "job.asc");
  RecordingHost host;
  const Survey survey = tinh_Click(st, host).survey;

  std::vector<std::string> reportLines;
  std::istringstream err(FileBytes(kEveryRecord / "expected" / "job.err"));
  for (std::string line; std::getline(err, line);) {
    if (line.size() > 1 && !line.starts_with("  "))
      reportLines.push_back(line.substr(0, line.size() - 1));
  }
  std::vector<std::string> entries;
  for (const ReportEntry& entry : survey.report) entries.push_back(survey.TextOf(entry));
  EXPECT_EQ(entries, reportLines);
  ASSERT_FALSE(survey.report.empty());
  EXPECT_EQ(survey.Point(survey.report.front()), "JUNK");
  EXPECT_EQ(survey.report.front().line, 4u);

  // Each detail point at the coordinates of the coordinate text file.
  std::istringstream txt(FileBytes(kEveryRecord / "expected" / "job.txt"));
  std::size_t k = 0;
  for (std::string line; std::getline(txt, line); ++k) {
    while (k < survey.points.size() && survey.points[k].kind() != PointKind::Detail) ++k;
    ASSERT_LT(k, survey.points.size()) << line;
    std::istringstream fields(line.substr(5));
    double x = 0, y = 0;
    fields >> x >> y;
    EXPECT_EQ(survey.Name(survey.points[k]).substr(0, 5), Trim(line.substr(0, 5)));
    EXPECT_EQ(survey.points[k].x, x) << line;
    EXPECT_EQ(survey.points[k].y, y) << line;
  }
  ASSERT_EQ(survey.stations.size(), 6u);
  EXPECT_EQ(survey.stations[0].station.name, "KC1");
  EXPECT_EQ(survey.stations[0].orientation.name, "KC2");
  EXPECT_EQ(survey.stations[0].bearing, 180);
  EXPECT_EQ(survey.stations[0].orientationDistance, 100);
  EXPECT_EQ(survey.stations[0].line, 8u);
  EXPECT_EQ(survey.control.front().name, "KC1");
  // The check sight on KC3, and the pegs among the points, in field-book order.
  ASSERT_TRUE(survey.stations[0].check);
  EXPECT_EQ(survey.stations[0].check->name, "KC3");
  EXPECT_TRUE(survey.stations[0].checkResidual);
  std::vector<std::string> pegs;
  for (const ComputedPoint& point : survey.points) {
    if (point.kind() == PointKind::Peg) pegs.emplace_back(survey.Name(point));
  }
  EXPECT_EQ(pegs, (std::vector<std::string>{"CP1", "CP2"}));
}

}  // namespace
}  // namespace kavu
