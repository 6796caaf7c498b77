#include <gtest/gtest.h>

#include "core/host.h"
#include "core/tcvn3.h"
#include "run/run.h"
#include "tests/products/product_files.h"

namespace kavu {
namespace {

using testing::Expected;
using testing::FileBytes;
using testing::FreshFolder;

// A seeded run writes the three products of a field book with every line
// form: station 1 has detail points with 5, 6 and 7 fields (0-angle points
// with words, a 13-character name, a note longer than 12), a peg and a check
// record without a reading (made up from the draw); station 2 a check record
// with its reading and two pegs; station 3 only an orientation distance
// record, so no detail rows and no pegs. The draws follow the run order: check
// record, then the station's sketch row.
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
