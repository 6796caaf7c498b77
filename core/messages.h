// Every text the program writes or shows, in one place (UTF-8 here; the
// products get them as TCVN3 through Utf8ToTcvn3).
#pragma once

#include <string_view>

namespace kavu::msg {

// Titles.
inline constexpr std::string_view kProgramTitle = "Hỗ trợ xử lý số liệu đo vẽ bản đồ Địa chính";
inline constexpr std::string_view kStationTitle = "Đang tính trạm: ";
inline constexpr std::string_view kReadingControlFile = "Đang đọc file khống chế ...";
inline constexpr std::string_view kReadingData = "Đang đọc số liệu ...";
inline constexpr std::string_view kFindingControlPoints = "Đang tìm điểm khống chế ...";

// Message boxes (a lone CR separates lines).
inline constexpr std::string_view kNoFileChosen = "Chú ý: Chưa chọn File số liệu!";
inline constexpr std::string_view kFileNotFound = "Không tìm thấy File: ";
inline constexpr std::string_view kEnterNewFile = "Nhập File mới vào! ";
inline constexpr std::string_view kFileSizeZero = "Chú ý: File có độ lớn =0.";
inline constexpr std::string_view kCheckFileAgain = "Kiểm tra lại File !";
inline constexpr std::string_view kCannotOpen = "Không mở được File: ";
inline constexpr std::string_view kNoDetailData =
    "File không có số liệu điểm chi tiết. Kiểm tra lại!";
inline constexpr std::string_view kNoControlFile = "Chưa chọn file khống chế.";
inline constexpr std::string_view kCannotWrite = "Không ghi được File: ";
// Why: in brackets after the file's path.
inline constexpr std::string_view kNoWritePermission = "không có quyền ghi vào thư mục";
inline constexpr std::string_view kReadOnlyDisk = "ổ đĩa chỉ cho đọc";
inline constexpr std::string_view kDiskFull = "đĩa đầy";
inline constexpr std::string_view kNoSuchFolder = "không có thư mục này";
inline constexpr std::string_view kIsAFolder = "trùng tên một thư mục";
inline constexpr std::string_view kWriteFailed = "lỗi ghi đĩa";
// A typed number that cannot be read: the box's name, then this, then the text.
inline constexpr std::string_view kScaleBox = "Tỷ lệ bản đồ";
inline constexpr std::string_view kTextHeightBox = "Chiều cao chữ";
inline constexpr std::string_view kHeightDecimalsBox = "Số lẻ độ cao";
inline constexpr std::string_view kCannotReadTyped = " không đọc được: ";

// The summary.
inline constexpr std::string_view kTotalStations = "Tổng số trạm máy:     ";
inline constexpr std::string_view kTotalPoints = "Tổng số điểm chi tiết: ";
inline constexpr std::string_view kTotalErrors = "Tổng số lỗi: ";
inline constexpr std::string_view kStarted = "Bắt đầu tính: ";
inline constexpr std::string_view kEnded = "Kết thúc tính: ";
inline constexpr std::string_view kContinue = "Bạn có tiếp tục chương trình không ?";
inline constexpr std::string_view kFilesWritten = "Các File đã ghi:";
inline constexpr std::string_view kWrittenIndent = "    ";
inline constexpr std::string_view kStopTooLate =
    "Lệnh dừng tính đến muộn: các File đã được ghi xong.";

// Error report.
inline constexpr std::string_view kErrHeader1 = "        THONG BAO CAC LOI NHAP SO LIEU";
inline constexpr std::string_view kErrHeader2 = "      ----------------------------------";
inline constexpr std::string_view kStationRunTogether = " nhap so lieu bi dinh hoac thiêu diem KC";
inline constexpr std::string_view kOrientationRunTogether =
    " nhap so lieu bi dinh hoac thieu diem KC";
inline constexpr std::string_view kRunTogether = " nhap so lieu bi dinh";
inline constexpr std::string_view kNoInstrumentHeight = " thieu chieu cao may";
inline constexpr std::string_view kNotANumber = " so lieu khong phai so";
inline constexpr std::string_view kNegativeAngle = " nhap goc am";
inline constexpr std::string_view kNegativeDistance = " nhap canh am";
inline constexpr std::string_view kWrongDegrees = " nhap sai phan do";
inline constexpr std::string_view kWrongMinutes = " nhap sai phan phut";
inline constexpr std::string_view kWrongSeconds = " nhap sai phan giay";
inline constexpr std::string_view kDistanceMayBeWrong = " co the nhap sai canh";
inline constexpr std::string_view kWrongCoordinates = " SAI TOA DO!";
inline constexpr std::string_view kOrientation = "Định hướng ";
inline constexpr std::string_view kWrongOrientationDistance = "Sai canh dinh huong";
inline constexpr std::string_view kNoCoordinates = " khong co toa do";
inline constexpr std::string_view kDifferentCoordinates = " KHAC TOA DO:";
inline constexpr std::string_view kAtLine = " Tai dong ";
inline constexpr std::string_view kAnd = " va ";
inline constexpr std::string_view kDX = " DX= ";
inline constexpr std::string_view kDY = " DY= ";
inline constexpr std::string_view kDS = " DS= ";
inline constexpr std::string_view kPoint = "Diem ";
inline constexpr std::string_view kPointColon = "Diem: ";
inline constexpr std::string_view kStation = "Tram ";
inline constexpr std::string_view kOr = " hoac ";
inline constexpr std::string_view kSkippedFrom = "Cac diem mia ";
inline constexpr std::string_view kSkippedTo = " - ";
inline constexpr std::string_view kSkippedEnd = " khong duoc tinh";
inline constexpr std::string_view kUnreadableDeclaration = "Khong hieu khai bao cua File: ";

// Station listing.
inline constexpr std::string_view kCpvHeader[] = {
    "              SO LIEU SO DO SO: ................",
    "   Khu do:................... Xa (Phuong): .................. ",
    "   Huyen (Quan): ............ Tinh (Thanh pho): .............",
    "",
    "Diem TM      Diem DH      Goc P.vi   Canh DH   D.dau   D.cuoi",
    "-------------------------------------------------------------",
};

// Error report: observations and names that cannot be computed as written.
inline constexpr std::string_view kNoDistance = " khong co khoang cach";
inline constexpr std::string_view kWrongZenith = " nhap sai goc dung";
inline constexpr std::string_view kNameTooLong = " ten dai qua 12 ky tu";

// The messages of a report line "Diem " + a point's name in 12 columns + the
// message, which the survey keeps as the name and the message's number.
inline constexpr std::string_view kPointMessages[] = {
    kNotANumber,         kNoDistance,   kWrongZenith,  kNegativeAngle,
    kNegativeDistance,   kWrongDegrees, kWrongMinutes, kWrongSeconds,
    kDistanceMayBeWrong, kRunTogether,  kNameTooLong,
};

// Files that the run must not lose.
inline constexpr std::string_view kProductIsInput = " (trùng File đầu vào)";
inline constexpr std::string_view kConversionOverInput =
    "File số liệu chuyển đổi sẽ ghi đè File đầu vào: ";
inline constexpr std::string_view kBeingComputed = "File đang được tính: ";
inline constexpr std::string_view kNotDataFile = "Không phải File dữ liệu: ";
// A run the user stopped, in place of the summary.
inline constexpr std::string_view kRunCancelled =
    "Đã dừng tính theo yêu cầu: không ghi File kết quả nào, các File cũ giữ nguyên.";

}  // namespace kavu::msg
