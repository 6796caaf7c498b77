#include "run/run.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <string>

#include "core/messages.h"
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

// every-record/job.asc holds every record kind and every report line; its
// products were checked line by line by hand, the coordinates against an
// independent single-precision azimuth computation.
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

// A stop asked for at the n-th time the run asks (from 1; 0 never), counting
// how often it asked.
struct StoppingHost : RecordingHost {
  explicit StoppingHost(int stopAt) : at(stopAt) {}
  bool Cancelled() override { return ++asked, at > 0 && asked >= at; }
  int at, asked = 0;
};

// The stop works until the products are put in place: asked for while they
// are written, it leaves every earlier product as it was; once they stand,
// the summary says it came too late. The summary lists the files written.
TEST(Run, StopWorksUntilTheProductsAreInPlace) {
  const fs::path folder = FreshFolder();
  fs::create_directories(folder / "data");
  fs::copy_file(kEveryRecord / "job.asc", folder / "data" / "job.asc");
  const fs::path txt = folder / "data" / "job.txt";
  StoppingHost counter(0);  // how often a whole run asks
  RunState st = StateFor(folder / "data" / "job.asc");
  ASSERT_EQ(tinh_Click(st, counter).outcome, RunOutcome::Completed);
  ASSERT_GE(counter.asked, 3);
  for (const int stopAt : {counter.asked - 1, counter.asked}) {
    const bool late = stopAt == counter.asked;  // else the products written, not yet in place
    WriteBytes(txt, "earlier\r\n");
    fs::remove(folder / "data" / "job.err");
    StoppingHost host(stopAt);
    RunState again = StateFor(folder / "data" / "job.asc");
    const RunResult result = tinh_Click(again, host);
    ASSERT_FALSE(host.messages.empty());
    EXPECT_EQ(result.outcome, late ? RunOutcome::Completed : RunOutcome::Cancelled);
    EXPECT_EQ(FileBytes(txt) == "earlier\r\n", !late);
    EXPECT_EQ(fs::exists(folder / "data" / "job.err"), late);
    const std::string& summary = host.messages.back();
    if (!late) {
      EXPECT_EQ(summary, msg::kRunCancelled);
    } else {
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

// A typed number that cannot be read stops the run before anything is
// converted or written, with the box's refusal.
TEST(Run, AnUnreadableTypedNumberStartsNothing) {
  const fs::path folder = FreshFolder();
  fs::copy_file(kEveryRecord / "job.asc", folder / "job.asc");
  RunState st = StateFor(folder / "job.asc");
  st.TyleTXT = "1:5OO";
  RecordingHost host;
  EXPECT_EQ(tinh_Click(st, host).outcome, RunOutcome::NotStarted);
  ASSERT_FALSE(host.messages.empty());
  EXPECT_EQ(host.messages.back(), "Tỷ lệ bản đồ không đọc được: 1:5OO");
  EXPECT_EQ(std::distance(fs::directory_iterator(folder), fs::directory_iterator{}), 1);
}

}  // namespace
}  // namespace kavu
