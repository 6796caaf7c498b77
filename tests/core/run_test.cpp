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
    while (k < survey.points.size() && survey.points[k].kind != PointKind::Detail) ++k;
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
    if (point.kind == PointKind::Peg) pegs.emplace_back(survey.Name(point));
  }
  EXPECT_EQ(pegs, (std::vector<std::string>{"CP1", "CP2"}));
}

TEST(Run, CleanRunRemovesItsReportsAndTheEditorBackup) {
  const fs::path folder = FreshFolder();
  WriteBytes(
      folder / "job.asc",
      "TR A 1000 1000 10\r\nTR B 900 1000 12\r\nTR A 1.5\r\nDKD B\r\n1 900000 100 900000 1.5\r\n");
  WriteBytes(folder / "job.bak", "old\r\n");
  RunState st = StateFor(folder / "job.asc");
  RecordingHost host;
  const RunResult result = tinh_Click(st, host);
  EXPECT_EQ(result.outcome, RunOutcome::Completed);
  EXPECT_EQ(result.err, 0);
  for (const char* name : {"job.err", "job.cpv", "job.bak"}) {
    EXPECT_FALSE(fs::exists(folder / name)) << name;
  }
  EXPECT_EQ(FileBytes(folder / "job.txt"), "1     1000.000    900.000            10  \r\n");
}

// A refused file leaves the file box empty with the focus in it; a book of
// control points only stops the run, which writes nothing.
TEST(Run, UserErrorsStopTheRunWithTheirMessage) {
  const fs::path folder = FreshFolder();
  RecordingHost host;
  WriteBytes(folder / "empty.asc", "");
  RunState empty = StateFor(folder / "empty.asc");
  host.fileBox = "typed";
  EXPECT_EQ(tinh_Click(empty, host).outcome, RunOutcome::NotStarted);
  EXPECT_EQ(host.messages.back(),
            std::string(msg::kFileSizeZero) + "\r" + std::string(msg::kCheckFileAgain));
  EXPECT_EQ(host.fileBox, "");
  EXPECT_EQ(host.focused, 1);

  WriteBytes(folder / "kc.asc", "TR A 1 2 3\r\n\r\n   \r\n");
  RunState onlyControl = StateFor(folder / "kc.asc");
  EXPECT_EQ(tinh_Click(onlyControl, host).outcome, RunOutcome::StoppedEarly);
  EXPECT_EQ(host.messages.back(), msg::kNoDetailData);
  EXPECT_FALSE(fs::exists(folder / "kc.err"));
}

TEST(Run, CommonControlFileReplacesTheFieldBooksControlPoints) {
  const fs::path folder = FreshFolder();
  WriteBytes(folder / "job.asc",
             "TR A 5 5 5\r\nTR B 6 6 6\r\nTR A 1.5\r\nDKD B\r\n1 900000 100 900000 1.5\r\n");
  WriteBytes(folder / "common.kc", "header line\r\nTR A 1000 1000 10\r\nTR B 900 1000\r\n");
  RecordingHost host;

  RunState st = StateFor(folder / "job.asc");
  st.ckKC = 1;
  st.txtFKC = "  " + (folder / "common.kc").string() + " ";
  EXPECT_EQ(tinh_Click(st, host).outcome, RunOutcome::Completed);
  EXPECT_EQ(FileBytes(folder / "job.txt"), "1     1000.000    900.000            10  \r\n");

  RunState unnamed = StateFor(folder / "job.asc");
  unnamed.ckKC = 1;
  unnamed.txtFKC = "   ";
  EXPECT_EQ(tinh_Click(unnamed, host).outcome, RunOutcome::StoppedEarly);
  EXPECT_EQ(host.messages.back(), msg::kNoControlFile);

  RunState unreadable = StateFor(folder / "job.asc");
  unreadable.ckKC = 1;
  unreadable.txtFKC = (folder / "gone.kc").string();
  EXPECT_EQ(tinh_Click(unreadable, host).outcome, RunOutcome::StoppedEarly);
  EXPECT_EQ(host.messages.back(), std::string(msg::kCannotOpen) + (folder / "gone.kc").string());
}

// Whatever the bytes, the run ends with its summary.
TEST(Run, HostileBytesEndWithASummary) {
  const fs::path folder = FreshFolder();
  const std::string head = "TR A 1000 1000 10\nTR B 900 1000 12\rTR A 1.5\r\nDKD B\n";
  std::string binary;
  for (int i = 0; i < 4096; ++i) binary += static_cast<char>((i * 131 + 7) % 256);
  const std::string cases[] = {
      head + "1 900000 100 900000 1.5",                              // no final line end
      head + std::string("1 9\0 100 900000 1.5\r\n", 21),            // NUL inside a number
      head + "2 0 1 90 1 " + std::string(10'000'000, 'x') + "\r\n",  // a 10 MB word
      head + binary,                                                 // binary data
      head + "\xa7\x81\xff 0 1 900000 1 \x80\r\n1e999 1e999 1e999 1e999 1e999\r\n",
      head + "TR 1e308 1e308 1e308 1e308\r\nTR 1e308 1.5\r\nDKD B\r\n3 1e300 1e300 1e300 1\r\n",
  };
  RecordingHost host;
  for (const std::string& bytes : cases) {
    WriteBytes(folder / "job.asc", bytes);
    RunState st = StateFor(folder / "job.asc");
    st.fasc = st.ftd = st.fkc = 1;
    const RunResult result = tinh_Click(st, host);
    EXPECT_EQ(result.outcome, RunOutcome::Completed) << bytes.substr(0, 80);
  }
}

}  // namespace
}  // namespace kavu
