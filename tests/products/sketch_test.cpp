#include "products/sketch.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "core/tcvn3.h"
#include "core/text.h"

namespace kavu {
namespace {

// The header lines of a sketch with one station, in UTF-8, from the sketch
// number's line to the surveyor's.
std::vector<std::string> HeaderLines(const std::array<std::string, 7>& utf8) {
  std::array<std::string, 7> header;
  for (std::size_t i = 0; i < header.size(); ++i) header[i] = Utf8ToTcvn3(utf8[i]);
  Survey survey;
  StationResult station;
  station.station.name = "KC1";
  survey.stations.push_back(station);
  TextOut out;
  WriteSketch(out, survey, header);
  std::vector<std::string> lines;
  const std::string& bytes = out.Buffer();
  for (std::size_t at = 0; at < bytes.size();) {
    const std::size_t end = bytes.find("\r\n", at);
    lines.push_back(Tcvn3ToUtf8(bytes.substr(at, end - at)));
    at = end + 2;
  }
  return {lines.begin() + 1, lines.begin() + 6};
}

// The header texts of the batch command, longer than the form lets them be,
// cut as the form cuts them: a text that a label follows keeps a space before
// the label, every label keeps its column (the lengths count characters, one
// TCVN3 byte each).
TEST(Sketch, HeaderTextsAreCutToTheirWidthsAndASpaceBeforeTheNextLabel) {
  const std::vector<std::string> lines = HeaderLines(
      {"Xã Tân Phú, huyện Đông Sơn, tỉnh Thanh Hoá", "0123456", "LEICA TS06 PLUS R500",
       "123456789012345678901", "Trần Thị Bình Minh", "Trần Thị Bình Minh", "12/05/2004 sáng"});
  const std::vector<std::string> expected = {
      "Lược đồ số:012345               SO DO CHI TIET", "",
      "Điểm trạm đo: KC1             Khu đo: Xã Tân Phú, huyện Đông Sơn, tỉnh Thanh ",
      "1. Máy đo: LEICA TS06 PLUS R5 Số máy: 12345678901234567890",
      "2. Người đo: Trần Thị Bình Mi Người ghi: Trần Thị Bình Min Ngày đo:12/05/2004"};
  EXPECT_EQ(lines, expected);
}

}  // namespace
}  // namespace kavu
