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

// A stop asked for at the n-th time the run asks (from 1; 0 never).
class StoppingHost : public RecordingHost {
 public:
  explicit StoppingHost(int at) : at_(at) {}
  bool Cancelled() override { return at_ > 0 && ++asked_ >= at_; }
  int asked() const { return asked_; }

 private:
  int at_;
  int asked_ = 0;
};

// The stop works until the products are put in place: asked for while they
// are written, it leaves every earlier product as it was; once they stand,
// the summary says it came too late. The summary lists the files written.
TEST(Run, StopWorksUntilTheProductsAreInPlace) {
  const fs::path folder = FreshFolder();
  fs::create_directories(folder / "data");
  fs::copy_file(kEveryRecord / "job.asc", folder / "data" / "job.asc");
  const fs::path txt = folder / "data" / "job.txt";
  WriteBytes(txt, "earlier\r\n");

  // How often a whole run asks, counted by a host that never stops it.
  struct Counter : StoppingHost {
    Counter() : StoppingHost(0) {}
    int calls = 0;
    bool Cancelled() override { return ++calls, false; }
  } counter;
  RunState st = StateFor(folder / "data" / "job.asc");
  ASSERT_EQ(tinh_Click(st, counter).outcome, RunOutcome::Completed);
  ASSERT_GE(counter.calls, 3);
  EXPECT_NE(FileBytes(txt), "earlier\r\n");

  for (const int stopAt : {counter.calls - 1, counter.calls}) {
    WriteBytes(txt, "earlier\r\n");
    fs::remove(folder / "data" / "job.err");
    StoppingHost host(stopAt);
    RunState again = StateFor(folder / "data" / "job.asc");
    const RunResult result = tinh_Click(again, host);
    ASSERT_FALSE(host.messages.empty());
    if (stopAt == counter.calls - 1) {  // the products written, not yet in place
      EXPECT_EQ(result.outcome, RunOutcome::Cancelled);
      EXPECT_EQ(FileBytes(txt), "earlier\r\n");
      EXPECT_FALSE(fs::exists(folder / "data" / "job.err"));
      EXPECT_EQ(host.messages.back(), msg::kRunCancelled);
    } else {
      EXPECT_EQ(result.outcome, RunOutcome::Completed);
      EXPECT_TRUE(result.stopTooLate);
      EXPECT_NE(FileBytes(txt), "earlier\r\n");
      const std::string& summary = host.messages.back();
      EXPECT_NE(summary.find(msg::kStopTooLate), std::string::npos) << summary;
      EXPECT_NE(summary.find(std::string(msg::kFilesWritten) + "\r"), std::string::npos);
      for (const char* name : {"job.err", "job.cpv", "job.txt"}) {
        EXPECT_NE(summary.find(std::string(msg::kWrittenIndent) + name + "\r"), std::string::npos)
            << name;
      }
      EXPECT_EQ(result.written.size(), 3u);
    }
    for (const auto& entry : fs::directory_iterator(folder / "data")) {
      EXPECT_FALSE(entry.path().string().ends_with(".kavu-tmp")) << entry.path();
    }
  }
}

// A product that cannot be written is named with its reason under a warning;
// the error report is named only when the run found errors.
TEST(Run, AnUnwritableProductIsNamedWithItsReason) {
  const fs::path folder = FreshFolder();
  fs::create_directories(folder / "data");
  fs::copy_file(fs::path(KAVU_EXAMPLES) / "job1.asc", folder / "data" / "job1.asc");
  fs::create_directories(folder / "data" / "job1.txt");
  struct IconHost : RecordingHost {
    MsgIcon last = MsgIcon::None;
    MsgAnswer MessageBox(std::string_view text, MsgIcon icon, MsgButtons buttons) override {
      last = icon;
      return RecordingHost::MessageBox(text, icon, buttons);
    }
  } host;
  RunState st = StateFor(folder / "data" / "job1.asc");
  const RunResult result = tinh_Click(st, host);
  ASSERT_EQ(result.outcome, RunOutcome::Completed);
  EXPECT_EQ(result.err, 0);
  EXPECT_EQ(host.last, MsgIcon::Exclamation);
  const std::string txt = (folder / "data" / "job1.txt").string();
  EXPECT_EQ(result.unwritable,
            std::vector<std::string>{txt + " (" + std::string(msg::kIsAFolder) + ")"});
  EXPECT_NE(host.messages.back().find(std::string(msg::kCannotWrite) + txt + " ("),
            std::string::npos);
  EXPECT_EQ(host.messages.back().find(".err"), std::string::npos);
}

}  // namespace
}  // namespace kavu
