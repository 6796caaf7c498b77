#include "products/reports.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <map>
#include <string>
#include <vector>

#include "core/host.h"
#include "core/lines.h"
#include "run/run.h"
#include "support.h"

namespace kavu {
namespace {

namespace fs = std::filesystem;

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
  EXPECT_EQ(SplitLines(report).size(), expected.size()) << report;
  EXPECT_EQ(ErrorReportBookLines(Survey{}), (std::vector<std::uint32_t>{0, 0}));
}

// A run over a field book with every kind of report line: each line of the
// report it wrote leads to the record it is about, also where the name the
// line reads is not that record's first field.
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
  const std::vector<std::string> report = SplitLines(testing::FileBytes(folder / "job.err"));
  const std::vector<std::string> records = SplitLines(testing::FileBytes(book));
  const std::vector<std::uint32_t> lines = ErrorReportBookLines(run.survey);
  ASSERT_EQ(lines.size(), report.size());
  EXPECT_EQ(ErrorReport(run.survey), testing::FileBytes(folder / "job.err"));
  // Some of the report's lines, hand-checked, and the records they lead to.
  const std::map<std::string_view, std::string_view> leads = {
      {"Diem: TR ", "TR KC1 1.5"},                  // a station record where an orientation was due
      {"Tram KC1 ", "X1 0 100.06 900000 1.5 KC2"},  // the orientation distance's record
      {"Diem: ZZZ ", "K2 1234530 60 900000 1.5 ZZZ KT"},
      {"Cac diem mia 41 ", "TR KC1 1.5"}};  // the station of the block not computed
  std::size_t found = 0;
  for (std::size_t i = 0; i < report.size(); ++i) {
    // The head and the empty lines lead nowhere; every other line somewhere.
    EXPECT_EQ(lines[i] == 0, i < 2 || report[i].empty()) << report[i];
    ASSERT_LE(lines[i], records.size()) << report[i];
    for (const auto& [lead, record] : leads) {
      if (!report[i].starts_with(lead)) continue;
      EXPECT_EQ(records[lines[i] - 1], record) << report[i];
      ++found;
    }
  }
  EXPECT_EQ(found, leads.size());
}

}  // namespace
}  // namespace kavu
