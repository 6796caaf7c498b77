#include "products/reports.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <vector>

#include "core/host.h"
#include "core/text.h"
#include "run/run.h"
#include "support.h"

namespace kavu {
namespace {

namespace fs = std::filesystem;

// The lines of a text as a text window shows them: CR LF, a lone CR and a
// lone LF each end one.
std::vector<std::string> ScreenLines(const std::string& text) {
  std::vector<std::string> lines(1);
  for (std::size_t i = 0; i < text.size(); ++i) {
    if (text[i] == '\r' || text[i] == '\n') {
      if (text[i] == '\r' && i + 1 < text.size() && text[i + 1] == '\n') ++i;
      lines.emplace_back();
    } else {
      lines.back().push_back(text[i]);
    }
  }
  if (lines.back().empty()) lines.pop_back();  // the last line's end
  return lines;
}

std::string ErrorReport(const Survey& survey) {
  TextOut out;
  WriteErrorReport(out, survey);
  return out.Buffer();
}

// The head and the empty lines concern no record; a line that goes with the
// one before it has no empty line of its own; a message holding line breaks
// takes a line of the report for each of its lines.
TEST(ErrorReportBookLines, OneForEachLineOfTheReport) {
  Survey survey;
  survey.AddReport("Diem: A nhap so lieu bi dinh", "A", 5);
  survey.AddReport("Cac diem mia 1     - 9     khong duoc tinh", "", 9, false);
  survey.AddReport("Diem B two\r\nlines", "B", 12);
  survey.AddReport("lone\rCR\nand LF", "C", 0);
  survey.AddReport("Diem D last", "D", 40);
  const std::string report = ErrorReport(survey);
  const std::vector<std::uint32_t> expected = {0, 0, 0, 5, 9, 0, 12, 12, 0, 0, 0, 0, 0, 40};
  EXPECT_EQ(ErrorReportBookLines(survey), expected);
  EXPECT_EQ(ScreenLines(report).size(), expected.size()) << report;
  EXPECT_EQ(ErrorReportBookLines(Survey{}), (std::vector<std::uint32_t>{0, 0}));
}

// A run over a field book with every kind of report line: each line of the
// report it wrote leads to the record it is about, also where the name it
// reads is not that record's first field ("Tram KC1 ... Sai canh dinh huong"
// is about the station record "TR KC1 1.5", a later station than CP1's).
TEST(ErrorReportBookLines, EveryLineOfARunsReportLeadsToItsRecord) {
  const fs::path folder = testing::FreshFolder();
  const fs::path book = fs::path(KAVU_TEST_DATA) / "run" / "every-record" / "job.asc";
  fs::copy_file(book, folder / "job.asc");
  RunState st;
  st.txtfile = (folder / "job.asc").string();
  st.seed = 7;
  testing::RecordingHost host;
  const RunResult run = tinh_Click(st, host);
  ASSERT_EQ(run.outcome, RunOutcome::Completed);
  const std::vector<std::string> report = ScreenLines(testing::FileBytes(folder / "job.err"));
  const std::vector<std::string> records = ScreenLines(testing::FileBytes(book));
  const std::vector<std::uint32_t> lines = ErrorReportBookLines(run.survey);
  ASSERT_EQ(lines.size(), report.size());
  EXPECT_EQ(ErrorReport(run.survey), testing::FileBytes(folder / "job.err"));
  // The report's lines about a record, in order, and the record each leads to.
  const std::pair<const char*, const char*> expected[] = {
      {"Diem: JUNK ", "JUNK 1 2"},
      {"Diem: TR ", "TR KC1 1.5"},  // a station record where an orientation was due
      {"Cac diem mia       -  ", "JUNK 1 2"},
      {"Tram KC1 ", "X1 0 100.06 900000 1.5 KC2"},  // the orientation distance's record
      {"Diem KC3 ", "K1 0 52.3 900000 1.5 KC3 kt"},
      {"Diem: ZZZ ", "K2 1234530 60 900000 1.5 ZZZ KT"},
      {"Diem BAD ", "BAD 123 45"},
      {"Diem TR1 ", "TR1 ST1 1.45"},
      {"Diem N1 ", "N1 abc 10 900000 1.5"},
      {"Diem N2 ", "N2 -900000 -10 900000 1.5"},
      {"Diem N2 ", "N2 -900000 -10 900000 1.5"},
      {"Diem N3 ", "N3 1237000 2500 900000 1.5"},
      {"Diem N3 ", "N3 1237000 2500 900000 1.5"},
      {"Diem N3 ", "N3 1237000 2500 900000 1.5"},
      {"Diem LONGPOINTNAME99 ", "LONGPOINTNAME99 900000 10 900000 1.5"},
      {"Diem: NOPE ", "DKD NOPE"},
      {"Cac diem mia 41 ", "TR KC1 1.5"},  // the station of the block not computed
      {"Diem KC2 ", "TR KC2"},
  };
  std::size_t next = 0;
  for (std::size_t i = 0; i < report.size(); ++i) {
    if (lines[i] == 0) {
      EXPECT_TRUE(i < 2 || report[i].empty()) << report[i];
      continue;
    }
    ASSERT_LT(next, std::size(expected)) << report[i];
    ASSERT_LE(lines[i], records.size()) << report[i];
    EXPECT_TRUE(report[i].starts_with(expected[next].first)) << report[i];
    EXPECT_EQ(records[lines[i] - 1], expected[next].second) << report[i];
    ++next;
  }
  EXPECT_EQ(next, std::size(expected));
}

}  // namespace
}  // namespace kavu
