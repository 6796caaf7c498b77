// Records whose numbers cannot give a true point: each is reported when it is
// read, counted, and kept out of every product; numbers are written whole.
#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <utility>
#include <vector>

#include "core/lines.h"
#include "core/text.h"
#include "run/run.h"
#include "support.h"

namespace kavu {
namespace {

namespace fs = std::filesystem;
using testing::FileBytes;
using testing::FreshFolder;
using testing::RecordingHost;
using testing::WriteBytes;

// Station KC1 oriented on KC2, 100 m due south of it.
const std::string kControl = "TR KC1 1000 1000 10\r\nTR KC2 900 1000 12\r\n";
const std::string kHead = kControl + "TR KC1 1.5\r\nDKD KC2\r\n";
const std::string kGood = "OK1 900000 10 900000 1.5\r\n";

struct Case {
  const char* what;
  std::string book;
  std::vector<std::string> lines;    // message lines of the error report, in order
  std::vector<std::string> present;  // texts some product holds
  std::vector<std::string> absent;   // texts no product holds
  int fdc = 1;
};

std::string Name(const char* name) { return FixedWidth(name, 12); }

const Case kCases[] = {
    {"distance nan",
     kHead + "BADPT 900000 nan 900000 1.5\r\n" + kGood,
     {"Diem BADPT        so lieu khong phai so"},
     {"OK1"},
     {"BADPT"}},
    {"angle-only detail",
     kHead + "BADPT 900000 0 900000 1.5\r\n" + kGood,
     {"Diem BADPT        khong co khoang cach"},
     {"OK1"},
     {"BADPT"}},
    {"angle-only peg",
     kHead + "BADPT 900000 -0.000 900000 1.5 PEGX\r\n" + kGood,
     {"Diem BADPT        khong co khoang cach"},
     {"OK1"},
     {"BADPT", "PEGX"}},
    {"backsight without distance",
     kHead + "X1 0 0 900000 1.5 KC2\r\nX2 0 - 900000 1.5 KC2\r\n" + kGood,
     {},
     {"OK1"},
     {}},
    {"zenith 0",
     kHead + "BADPT 900000 10 0 1.5\r\n" + kGood,
     {"Diem BADPT        nhap sai goc dung"},
     {"OK1"},
     {"BADPT"}},
    {"zenith 0 with heights off", kHead + "ZEN 900000 10 0 1.5\r\n", {}, {"ZEN"}, {}, 0},
    {"instrument height not a number",
     kControl + "TR KC1 abc\r\nDKD KC2\r\n" + kGood,
     {"Diem KC1          thieu chieu cao may"},
     {"TR " + Name("KC1") + " abc", "OK1"},
     {}},
    {"long names of control, station and orientation records",
     "TR CONTROLPOINT1 1000 1000 10\r\n" + kControl +
         "TR STATIONPOINT1 1.5\r\nDKD ORIENTPOINT12\r\n" + kGood,
     {"Diem CONTROLPOINT1 ten dai qua 12 ky tu", "Diem STATIONPOINT1 ten dai qua 12 ky tu",
      "Diem: STATIONPOINT khong co toa do", "Diem ORIENTPOINT12 ten dai qua 12 ky tu",
      "Diem: ORIENTPOINT1 khong co toa do", "Cac diem mia OK1   - OK1   khong duoc tinh"},
     {},
     {"OK1"}},
    {"long names of detail and peg",
     kHead + "DETAILNAME123 900000 10 900000 1.5\r\nP1 900000 20 900000 1.5 PEGNAME123456\r\n",
     {"Diem DETAILNAME123 ten dai qua 12 ky tu", "Diem PEGNAME123456 ten dai qua 12 ky tu"},
     {"DETAILNAME123", "TR PEGNAME12345"},
     {}},
    // The padded name "3" once matched inside the Y field of 1003's line.
    {"a name inside another's line is not taken for it",
     "TR 1003 1000 3\r\nTR 3 900 3\r\nTR 1003 1.5\r\nDKD 3\r\n" + kGood,
     {},
     {"TR " + Name("1003") + "1000", "TR " + Name("3") + "900"},
     {}},
    // An orientation point up to 10 km away is no error; beyond, reported.
    {"orientation 10 km away",
     "TR KC1 1000 1000 10\r\nTR F 11000 1000 10\r\nTR KC1 1.5\r\nDKD F\r\n" + kGood,
     {},
     {"OK1"},
     {}},
    {"orientation beyond 10 km",
     "TR KC1 1000 1000 10\r\nTR F 11000.5 1000 10\r\nTR KC1 1.5\r\nDKD F\r\n" + kGood,
     {"Diem: KC1          hoac F            SAI TOA DO!"},
     {"OK1"},
     {}},
    {"coordinates wider than their columns",
     "TR W1 12345678901.500 1000 12345678.5\r\nTR W2 12345678801.500 1000 12\r\n"
     "TR W1 1.5\r\nDKD W2\r\nOK1 1800000 10 900000 1.5\r\n",
     {},
     {"TR " + Name("W1") + "12345678901.500 1000       12345678.5",  // .kc, TRIDO
      "OK1   12345678911.500 1000.000  ",                            // .txt
      "OK1   12345678911.500    1000.000 12345678.500     1.500"},   // .td1
     {}},
};

// The message lines of the error report, without its head and empty lines.
std::vector<std::string> ReportLines(const fs::path& path) {
  std::vector<std::string> lines = SplitLines(FileBytes(path));
  lines.erase(lines.begin(), lines.begin() + std::min<std::size_t>(2, lines.size()));
  std::erase(lines, std::string());
  return lines;
}

TEST(BadNumbers, AreReportedOnceAndKeptOutOfEveryProduct) {
  for (const Case& c : kCases) {
    SCOPED_TRACE(c.what);
    const fs::path folder = FreshFolder();
    fs::create_directories(folder / "data");
    WriteBytes(folder / "data" / "job.asc", c.book);
    RunState st;
    st.txtfile = (folder / "data" / "job.asc").string();
    st.seed = 7;
    st.fasc = st.ftd = st.fkc = st.fcp = st.fsdo = 1;
    st.fdc = c.fdc;
    RecordingHost host;
    const RunResult result = tinh_Click(st, host);
    ASSERT_EQ(result.outcome, RunOutcome::Completed);

    const std::vector<std::string> lines = ReportLines(folder / "data" / "job.err");
    EXPECT_EQ(lines, c.lines);
    long long skipped = 0;
    for (const std::string& line : lines) skipped += line.starts_with("Cac diem mia ") ? 1 : 0;
    EXPECT_EQ(result.err, static_cast<long long>(lines.size()) - skipped);

    std::string products;
    for (const char* name : {"job.txt", "job.kc", "job.td1", "job.cp", "job.sdo"}) {
      products += FileBytes(folder / "data" / name);
    }
    products += FileBytes(folder / "TRIDO" / "job.asc");
    for (const std::string& text : c.present) {
      EXPECT_NE(products.find(text), std::string::npos) << "missing: " << text;
    }
    for (const std::string& text : c.absent) {
      EXPECT_EQ(products.find(text), std::string::npos) << "present: " << text;
    }
  }
}

}  // namespace
}  // namespace kavu
