// The desktop program's own captions and messages (UTF-8). The engine's texts
// stay in core/messages.h.
#pragma once

#include <array>
#include <utility>
#include <string_view>

namespace kavu::ui {

// Names the settings store's application and captions every message box.
inline constexpr std::string_view kAppTitle = "KAVU";
inline constexpr std::string_view kSettingsGroup = "Settings";

// Buttons and labels of the standard boxes and file dialogs.
inline constexpr std::string_view kYes = "Có";
inline constexpr std::string_view kNo = "Không";
inline constexpr std::string_view kOk = "Đồng ý";
inline constexpr std::string_view kCancel = "Hủy";
inline constexpr std::string_view kOpen = "Mở";
inline constexpr std::string_view kLookIn = "Tìm trong:";
inline constexpr std::string_view kFileName = "Tên File:";
inline constexpr std::string_view kFileType = "Kiểu File:";
inline constexpr std::string_view kAllFiles = "Mọi File (*)";
inline constexpr std::string_view kErrFiles = "File báo lỗi (*.err)";
inline constexpr std::string_view kOpenFolder = "Mở thư mục";
// The message boxes' buttons with their access keys.
inline constexpr std::string_view kYesKeyed = "&Có";
inline constexpr std::string_view kNoKeyed = "&Không";
inline constexpr std::string_view kOkKeyed = "Đồng &ý";
inline constexpr std::string_view kCancelKeyed = "&Hủy";
inline constexpr std::string_view kOpenFolderKeyed = "&Mở thư mục";
inline constexpr std::string_view kViewReportKeyed = "&Xem File lỗi";
inline constexpr std::array<std::string_view, 4> kFileColumns = {"Tên", "Cỡ", "Kiểu", "Ngày sửa"};
// A file's size in the file list: bytes below 1 KB, then steps of 1024.
inline constexpr std::array<std::string_view, 5> kSizeUnits = {"byte", "KB", "MB", "GB", "TB"};

// Main window.
inline constexpr std::string_view kMainCaption = "Xử lý số liệu đo toạ độ, độ cao chi tiết";
inline constexpr std::string_view kTitleLabel = "chương trình tính toạ độ, độ cao điểm chi tiết";
inline constexpr std::string_view kDrives = "Drivers:";
inline constexpr std::string_view kDirectory = "Directory:";
inline constexpr std::string_view kFilesOfType = "List Files of Type: ";
inline constexpr std::string_view kFile = "File: ";
inline constexpr std::string_view kOptions = "Lựa chọn";
inline constexpr std::string_view kMakeAsc = "Tạo File số liệu ASC";
inline constexpr std::string_view kMakeTxt = "Tạo File toạ độ TXT";
inline constexpr std::string_view kHeights = "Tính độ cao chi tiết";
inline constexpr std::string_view kMakeSketch = "Tạo File sổ đo";
inline constexpr std::string_view kMakeDxf = "Tạo File DXF";
inline constexpr std::string_view kMakePegs = "Tạo File cọc phụ";
inline constexpr std::string_view kMakeKc = "Tạo File toạ độ KC";
inline constexpr std::string_view kScale = "Tỷ lệ BĐ";
inline constexpr std::string_view kTextHeight = "Htext (mm)";
inline constexpr std::string_view kHeightDecimals = "Số lẻ ĐC";
inline constexpr std::string_view kUseCommonKc = "Sử dụng file KC chung";
inline constexpr std::string_view kKcButton = "File KC";
inline constexpr std::string_view kCompute = "Tính toạ độ";
inline constexpr std::string_view kEditData = "Sửa số liệu";
inline constexpr std::string_view kHelp = "Trợ giúp";
inline constexpr std::string_view kExit = "Thoát";
inline constexpr std::array<std::string_view, 9> kScales = {
    "200", "500", "1000", "2000", "5000", "10000", "25000", "50000", "100000"};
inline constexpr std::string_view kFileNotFoundShort = "Không tìm thấy File ";
inline constexpr std::string_view kDataOfFile = "Số liệu của File: ";
inline constexpr std::string_view kExitQuestion = "Bạn có muốn thoát khỏi chương trình không ?";
// Beside the progress of a run: stops it before its next station.
inline constexpr std::string_view kStopRun = "Dừng tính";
inline constexpr std::string_view kChooseKcFile = "File KC";
inline constexpr std::string_view kRecent = "Gần đây";
// Beside the field-sketch box: opens the header form.
inline constexpr std::string_view kHeaderButton = "Nhập...";
// After the run's summary: the error report in the viewer.
inline constexpr std::string_view kViewReport = "Xem File lỗi";
// What each control of the main window is for (its tool tip), by object name.
inline constexpr std::array<std::pair<std::string_view, std::string_view>, 27> kMainToolTips = {{
    {"lstdia", "Ổ đĩa chứa số liệu"},
    {"lsttm", "Thư mục chứa số liệu; bấm đúp để mở"},
    {"cbkieu", "Loại số liệu: sổ đo ASC, hoặc File của máy đo, được chuyển thành sổ đo trước khi tính"},
    {"lstfile", "Bấm để chọn File, bấm đúp để tính ngay"},
    {"txtfile", "File số liệu sẽ tính; có thể gõ đường dẫn vào đây"},
    {"recent", "Các File đã chọn gần đây"},
    {"fasc", "Ghi lại sổ đo vào thư mục TRIDO và File .td1 (trị đo và toạ độ)"},
    {"ftd", "Ghi File toạ độ .txt của các điểm chi tiết"},
    {"fdc", "Tính độ cao các điểm chi tiết; bỏ chọn thì chỉ tính toạ độ"},
    {"fsdo", "Ghi File sổ đo .sdo. Ô màu xám: chưa chọn lần nào trong phiên này, "
             "coi như không chọn; bấm một lần để chọn"},
    {"nhapsdoButton", "Nhập thông tin về sổ đo: khu đo, máy đo, người đo, ngày đo ..."},
    {"fdxf", "Ghi File bản vẽ .dxf. Ô màu xám: chưa chọn lần nào trong phiên này, "
             "coi như không chọn; bấm một lần để chọn"},
    {"fcp", "Ghi File cọc phụ .cp"},
    {"fkc", "Ghi File toạ độ các điểm khống chế đã dùng .kc"},
    {"TyleTXT", "Tỷ lệ bản đồ: 500, 1:500 hoặc 1/500; quyết định hạn sai cạnh định hướng"},
    {"Htxt", "Chiều cao chữ trên bản vẽ DXF, mm trên giấy: 2.5 hoặc 2,5"},
    {"txtSoleDC", "Số chữ số lẻ của độ cao trong File .txt, từ 0 đến 10"},
    {"ckKC", "Lấy điểm khống chế từ File KC chung, không từ sổ đo"},
    {"txtFKC", "File điểm khống chế chung"},
    {"KC", "Chọn File điểm khống chế chung"},
    {"tinh", "Tính toạ độ, độ cao các điểm và ghi các File đã chọn"},
    {"bando", "Xem bản đồ của lần tính gần nhất"},
    {"ckBando", "Mở bản đồ ngay sau mỗi lần tính"},
    {"suasolieu", "Mở File đang chọn để sửa"},
    {"trogiup", "Xem trợ giúp của chương trình"},
    {"thoat", "Thoát khỏi chương trình"},
    {"dung", "Dừng tính: các File đã có được giữ nguyên"},
}};
// The access key of each control (the letter underlined in its caption).
inline constexpr std::array<std::pair<std::string_view, char>, 20> kMainAccessKeys = {{
    {"tinh", 'T'},  {"suasolieu", 'S'}, {"trogiup", 'g'}, {"thoat", 'o'},
    {"bando", 'B'}, {"fasc", 'A'},      {"ftd", 'X'},     {"fdc", 'h'},
    {"fsdo", 'F'},  {"fdxf", 'D'},      {"fcp", 'p'},     {"fkc", 'K'},
    {"ckKC", 'u'},  {"KC", 'i'},        {"Label1", 'l'},  {"Label2", 'm'},
    {"Label3", 'C'}, {"lbkieu", 'y'},   {"lbfile", 'e'},  {"nhapsdoButton", 'N'},
}};

// Field-book header form.
inline constexpr std::string_view kHeaderCaption = "Nhập thông tin về sổ đo";
// The labels' access keys (&) take their boxes.
inline constexpr std::array<std::string_view, 7> kHeaderLabels = {
    "&Khu đo:", "&Lược đồ số:", "&Máy đo:", "&Số máy: ", "Người đ&o:", "Người &ghi:", "Ngà&y đo:"};
inline constexpr std::array<std::string_view, 7> kHeaderDefaults = {
    "Xã Tân Phú, huyện Đông Sơn",
    "01",
    "TOPCOM 226",
    "23756",
    "Nguyễn Văn An",
    "Trần Văn Bình",
    ""};  // the date: today's, as dd/mm/yyyy
inline constexpr std::string_view kEnter = "&Nhập";
inline constexpr std::string_view kEnterTip =
    "Giữ các thông tin này cho sổ đo và ẩn cửa sổ (Enter)";
inline constexpr std::string_view kHeaderExitTip =
    "Giữ các thông tin này cho sổ đo và đóng cửa sổ (Esc)";
// Beside each box: the characters it holds, "/", the most the sketch prints.
inline constexpr std::string_view kHeaderCountTip =
    "Số ký tự đã nhập / số ký tự nhiều nhất sổ đo in được";

// Editor, viewer, help.
inline constexpr std::string_view kEditorCaption = "Sữa chữa số liệu";
inline constexpr std::string_view kViewerCaption =
    "Trợ giúp chương trình tính toạ độ điểm chi tiết";
inline constexpr std::string_view kMoreAboutFile = "Thông tin thêm về File: ";
inline constexpr std::string_view kSave = "&Ghi";
inline constexpr std::string_view kFind = "&Tìm";
inline constexpr std::string_view kViewFile = "Xem File";
inline constexpr std::string_view kViewFileButton = "&Xem File";
// The exit button of the editor, the viewer, the find window and the header
// form.
inline constexpr std::string_view kExitButton = "T&hoát";
inline constexpr std::string_view kSaveTip =
    "Ghi nội dung lên File; nội dung cũ được giữ ở File .bak (Ctrl+S)";
inline constexpr std::string_view kFindTip =
    "Tìm kiếm và thay thế trong nội dung (Ctrl+F, F3 tìm tiếp)";
inline constexpr std::string_view kViewFileTip =
    "Mở một File khác ở cửa sổ xem, thường là File báo lỗi (.err)";
inline constexpr std::string_view kCloseTip =
    "Đóng cửa sổ; hỏi có ghi không khi có sửa đổi chưa ghi (Esc)";
// Put before the file's name in the title while it has unsaved edits.
inline constexpr std::string_view kUnsavedMark = "*";
inline constexpr std::string_view kOverwrite = "Có ghi đè lên File số liệu đã có không ?";
inline constexpr std::string_view kErrPattern = "*.err";
// Asked before unsaved edits are dropped: this text, the path, "?".
inline constexpr std::string_view kSaveChanges = "Lưu thay đổi vào File ";

// Find and replace.
inline constexpr std::string_view kFindCaption = "Tìm kiếm và thay thế";
inline constexpr std::string_view kFindWhat = "Tìm chuỗi &ký tự:";
inline constexpr std::string_view kReplaceWith = "Chuỗi tha&y thế:";
inline constexpr std::string_view kMatchCase = "&Phân biệt chữ viết Hoa";
inline constexpr std::string_view kWholeWord = "Tìm một từ &nguyên vẹn";
inline constexpr std::string_view kFindNext = "&Tìm tiếp";
inline constexpr std::string_view kReplace = "Th&ay thế";
inline constexpr std::string_view kReplaceAll = "Thay tất &cả";
inline constexpr std::string_view kNotFoundAgain = "Không tìm thấy! Có tìm tiếp không";
inline constexpr std::string_view kFindNextTip = "Tìm và chọn chỗ tiếp theo (Enter, F3)";
inline constexpr std::string_view kReplaceTip = "Thay chỗ đang chọn rồi chọn chỗ tiếp theo";
inline constexpr std::string_view kReplaceAllTip = "Thay mọi chỗ từ vị trí con trỏ trở đi";
inline constexpr std::string_view kFindExitTip = "Đóng cửa sổ tìm kiếm (Esc)";
// After "Thay tất cả": this text, the count, the next; or the last when there
// was nothing to replace.
inline constexpr std::string_view kReplacedCount = "Đã thay ";
inline constexpr std::string_view kReplacedPlaces = " chỗ.";
inline constexpr std::string_view kReplacedNone = "Không tìm thấy chỗ nào để thay.";

// The map window. An "&" marks the access key of a menu entry; the captions of
// the save dialogs and of the print preview leave it out.
inline constexpr std::string_view kMapTitle = "Bản đồ: ";
inline constexpr std::string_view kFileMenu = "&File";
inline constexpr std::string_view kViewMenu = "&Xem";
inline constexpr std::string_view kZoomIn = "Phóng &to";
inline constexpr std::string_view kZoomOut = "Thu &nhỏ";
inline constexpr std::string_view kFit = "&Vừa cửa sổ";
inline constexpr std::string_view kSaveView = "Lưu hình đang &xem";
inline constexpr std::string_view kSaveWhole = "Lưu hình cả &khu đo";
inline constexpr std::string_view kSaveSketch = "Lưu sổ đo &PDF";
inline constexpr std::string_view kPrintSketch = "&In sổ đo";
inline constexpr std::string_view kCloseMap = "Đón&g";
// What each action does; its keys follow in brackets.
inline constexpr std::string_view kZoomInTip = "Phóng to quanh giữa bản đồ";
inline constexpr std::string_view kZoomOutTip = "Thu nhỏ quanh giữa bản đồ";
inline constexpr std::string_view kFitTip = "Cả khu đo vừa trong cửa sổ";
inline constexpr std::string_view kSaveViewTip = "Ghi phần bản đồ đang xem thành hình PNG hoặc SVG";
inline constexpr std::string_view kSaveWholeTip = "Ghi cả khu đo thành hình PNG hoặc SVG";
inline constexpr std::string_view kSaveSketchTip = "Ghi sổ đo chi tiết thành File PDF khổ A4";
inline constexpr std::string_view kPrintSketchTip = "Xem trước và in sổ đo chi tiết";
inline constexpr std::string_view kNoSketchTip =
    "Lần tính này không tạo sổ đo: chọn \"Tạo File sổ đo\" rồi tính lại";
inline constexpr std::string_view kCloseMapTip = "Đóng cửa sổ bản đồ";
inline constexpr std::string_view kCanvasTip =
    "Con lăn chuột: phóng to, thu nhỏ; kéo chuột hoặc phím mũi tên: dịch bản đồ; bấm vào một "
    "điểm để xem số liệu của nó";
inline constexpr std::string_view kPictureFilter = "Hình PNG (*.png);;Hình SVG (*.svg)";
inline constexpr std::string_view kPdfFilter = "File PDF (*.pdf)";
inline constexpr std::string_view kReportLines = "Báo lỗi:";
inline constexpr std::string_view kRecordAt = "Sổ đo, dòng ";
inline constexpr std::string_view kHint = "Bấm vào một điểm để xem số liệu của nó.";
// By MapKind: what a point is.
inline constexpr std::string_view kPointKinds[] = {"Điểm khống chế", "Trạm máy", "Cọc phụ",
                                                   "Điểm chi tiết"};
// The legend's entry for a point named in the error report.
inline constexpr std::string_view kFlaggedKind = "Có báo lỗi";

// The field sketch on paper: the line that starts a station's section, the
// line that names its station, and on a page that goes on with a station,
// its name followed by this; the number of each page at its foot.
inline constexpr std::string_view kSketchSection = "Lược đồ số:";
inline constexpr std::string_view kSketchStation = "Điểm trạm đo:";
inline constexpr std::string_view kSketchArea = "Khu đo:";
inline constexpr std::string_view kContinued = " (tiếp)";
inline constexpr std::string_view kPageNumber = "Trang %1/%2";

}  // namespace kavu::ui
