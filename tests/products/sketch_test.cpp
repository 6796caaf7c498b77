#include "products/sketch.h"

#include <gtest/gtest.h>

#include "tests/products/product_files.h"

namespace kavu {
namespace {

using testing::Expected;
using testing::FileBytes;
using testing::FreshFolder;

constexpr std::uint64_t kSeed = 20261206;

RunState SketchState(const std::filesystem::path& file) {
  RunState st;
  st.fsdo = 1;
  st.rng = SplitMix64(kSeed);
  // Header copy: TCVN3 texts, an empty one, one longer than its column.
  st.nhap = {"Khu \xae\xe9 x\xb8 A",
             "12",
             "SET 2C",
             "",
             "Nguy\xd6n V\xba n A",
             "Tr\xc7n Th\xde B c\xf3 t\xaan d\xb5i h\xacn m\xad\xeai t\xb8m",
             "06/12/2026"};
  st.sdoFile.open(file);
  return st;
}

// The first station: every row form. The second: no detail rows and no check
// record (its second orientation point and coordinates are blank). The
// orientation rows' seconds come from the draws of seed 20261206, r = .2261
// (20.3") and .8597 (77.4", shown as 17).
TEST(Sketch, StationsWithAndWithoutDetailRows) {
  const auto file = FreshFolder() / "JOB1.sdo";
  RunState st = SketchState(file);

  st.TenTram = "ST1";
  st.StXTram = "2345678.123";
  st.StYTram = "567890.456";
  st.StZTram = "12.500    ";
  st.TenDinhHuong = "DH1";
  st.StXDinhHuong = "2345578.123";
  st.StYDinhHuong = "567890.456";
  st.StZDinhHuong = "10.000";
  st.TenDinhHuong2 = "KT2";
  st.StXDinhHuong2 = "2345600.000";
  st.StYDinhHuong2 = "567950.250";
  st.cdhdau = 100;
  st.MangSoLieuSoDo = {
      // A 5-field record: twelve spaces as its note.
      {"15          ", " 123 45 30", " 123.456", " 89 55 00", "     1.500", "            "},
      // A 6-character name pushes its row one column right.
      {"123456      ", "   1 02 03", "   5.000", " 90 00 00", "      .000", "N"},
      // A note longer than 12 is cut to 12.
      {"ABCDEFGHIJKL", " 359 59 59", "1234.567", "100 00 00", "    10.000", "N COT DIEN CAO"},
      // A 0-angle point keeps its words; TCVN3 note.
      {"7           ", "   0 00 00", "    .250", " 85 00 00", "     1.450",
       "NHA G\xd1"
       "CH"},
      // Empty name and note.
      {"            ", "  10 00 00", "  12.000", " 90 00 00", "     1.500", ""},
  };
  insodo(st);

  st.TenTram = "M5";
  st.StXTram = "2345700.001";
  st.StYTram = "567900.999";
  st.StZTram = "";
  st.TenDinhHuong = "ST1";
  st.StXDinhHuong = "2345678.123";
  st.StYDinhHuong = "567890.456";
  st.StZDinhHuong = "12.500";
  st.TenDinhHuong2 = "";
  st.StXDinhHuong2 = "";
  st.StYDinhHuong2 = "";
  st.cdhdau = 24.41;
  st.MangSoLieuSoDo.clear();
  insodo(st);

  ASSERT_TRUE(st.sdoFile.close());
  EXPECT_EQ(FileBytes(file), Expected("sketch/two_stations.sdo"));
}

// One draw per station while the sketch is wanted, none otherwise, so that a
// seeded run repeats its check-record readings whatever the sketch box says.
TEST(Sketch, DrawsOncePerStationOnlyWhenTicked) {
  const auto folder = FreshFolder();
  for (const int fsdo : {0, 1, 2}) {
    RunState st = SketchState(folder / ("JOB" + std::to_string(fsdo) + ".sdo"));
    st.fsdo = fsdo;
    insodo(st);
    insodo(st);
    SplitMix64 expected(kSeed);
    if (fsdo == 1) {
      expected.Next();
      expected.Next();
    }
    EXPECT_EQ(st.rng.Next(), expected.Next()) << "fsdo " << fsdo;
    ASSERT_TRUE(st.sdoFile.close());
    if (fsdo != 1) {
      EXPECT_EQ(FileBytes(st.sdoFile.path()), "") << "fsdo " << fsdo;
    }
  }
}

}  // namespace
}  // namespace kavu
