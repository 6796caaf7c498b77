#include "core/station.h"

#include <gtest/gtest.h>

#include <cmath>


namespace kavu {
namespace {

// The error report of a state, as the lines after the report's head.
struct Fixture {
  RunState st;
  Fixture() { st.TenDiem = "P7"; }
  std::string Report() const {
    std::string text;
    for (const ReportEntry& entry : st.survey.report) text += "\r\n" + entry.text + "\r\n";
    return text;
  }
};

TEST(Gocdo, DecodesPackedAnglesAndReportsEntryErrorsInOrder) {
  Fixture f;
  f.st.goc = 1234530.5;
  f.st.s = 100;
  gocdo(f.st);
  EXPECT_EQ(f.st.do1, 123);
  EXPECT_EQ(f.st.phut, 45);
  EXPECT_DOUBLE_EQ(f.st.giay, 30.5);
  EXPECT_NEAR(f.st.goc, 123 + 45 / 60.0 + 30.5 / 3600, 1e-12);
  EXPECT_DOUBLE_EQ(f.st.rad, f.st.goc * 3.14159265358979 / 180);

  // A fraction carried into the minutes leaves negative seconds, no error.
  f.st.goc = 1234599.6;
  gocdo(f.st);
  EXPECT_EQ(f.st.phut, 46);
  EXPECT_NEAR(f.st.giay, -0.4, 1e-9);

  f.st.goc = -1234530;
  f.st.s = -2500;
  gocdo(f.st);
  EXPECT_EQ(f.st.s, 2500);
  f.st.goc = 1237000;
  f.st.s = 2000;  // exactly 2000 m is no error
  gocdo(f.st);
  EXPECT_NEAR(f.st.goc, 123 + 70 / 60.0, 1e-12);
  f.st.goc = 3600000;
  gocdo(f.st);
  EXPECT_EQ(f.st.do1, 0);
  EXPECT_EQ(f.st.err, 5);
  EXPECT_EQ(f.Report(),
            "\r\nDiem P7           nhap goc am\r\n"
            "\r\nDiem P7           nhap canh am\r\n"
            "\r\nDiem P7           co the nhap sai canh\r\n"
            "\r\nDiem P7           nhap sai phan phut\r\n"
            "\r\nDiem P7           nhap sai phan do\r\n");
}

// The azimuth is held in single precision, so exact quarter turns come out a
// few millionths of a degree off, as the office's products always showed.
TEST(TinhPhuongViCanh, SinglePrecisionAzimuthsAndDistance) {
  Fixture f;
  f.st.xTR = 1000;
  f.st.yTR = 1000;
  const struct {
    double x, y, gpv;
  } cases[] = {{900, 1000, 0},
               {1000, 900, 90.0000025},
               {1000, 1100, 270.0000007},
               {1100, 1000, 180.000005},
               {900, 900, 45.0000013}};
  for (const auto& c : cases) {
    f.st.xDKD = c.x;
    f.st.yDKD = c.y;
    TinhPhuongViCanh(f.st);
    EXPECT_NEAR(f.st.gpv, c.gpv, 1e-7) << c.x << " " << c.y;
  }
  f.st.xDKD = 900;
  f.st.yDKD = 1000;
  TinhPhuongViCanh(f.st);
  EXPECT_DOUBLE_EQ(f.st.cdh, 100);
  EXPECT_EQ(f.st.StGoc, "   0 00 00");

  f.st.TenTram = "ST";
  f.st.TenDinhHuong = "FAR";
  f.st.xDKD = -20000;
  TinhPhuongViCanh(f.st);
  EXPECT_EQ(f.Report(), "\r\nDiem: ST           hoac FAR          SAI TOA DO!\r\n");
}

TEST(TinhToaDo, ReadingTurnsFromTheOrientationAndHeightsFollowTheZenith) {
  Fixture f;
  f.st.xTR = 1000;
  f.st.yTR = 1000;
  f.st.zTR = 10;
  f.st.ccm = "1.5";
  f.st.pvd = 0;  // orientation point due south

  f.st.s = 100;
  f.st.goc = 900000;
  f.st.ccg = 1.5;
  TinhDoCao(f.st);
  EXPECT_EQ(f.st.dz, 0);
  EXPECT_EQ(f.st.StZ.str(), "10.000    ");
  f.st.goc = 900000;
  TinhToaDo(f.st);
  EXPECT_EQ(f.st.xi, 1000);
  EXPECT_EQ(f.st.yi, 900);
  EXPECT_EQ(f.st.StY.str(), "900.000   ");
  EXPECT_EQ(f.st.StS.str(), "100.000 ");

  f.st.goc = 850000;
  TinhDoCao(f.st);
  EXPECT_NEAR(f.st.dz, 8.749, 5e-4);

  f.st.zTR = -11.25;
  f.st.goc = 900000;
  TinhDoCao(f.st);
  EXPECT_EQ(f.st.StZ.str(), "-11.250   ");
  f.st.zTR = -1;
  f.st.goc = 900000;
  TinhDoCao(f.st);
  EXPECT_EQ(f.st.StZ.str(), "-1.000    ");
  EXPECT_EQ(f.Report(), "");
}

}  // namespace
}  // namespace kavu
