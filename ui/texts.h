// The desktop program's own captions and messages (UTF-8). The engine's texts
// stay in core/messages.h.
#pragma once

#include <array>
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
inline constexpr std::array<std::string_view, 4> kFileColumns = {"Tên", "Cỡ", "Kiểu", "Ngày sửa"};

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
// The kind list; the spaces line the patterns up in the font of the list.
inline constexpr std::array<std::string_view, 10> kKinds = {
    "Số liệu sổ đo                    [*.asc]", "Số liệu FieldBook SDR     [*.sdr]",
    "Số liệu FieldBook Sokki   [*.obs]",        "Số liệu máy SET               [*.set]",
    "Số liệu máy Geodimet      [*.raw]",        "Số liệu máy Topcom         [*.idx]",
    "Số liệu máy Topcom 226  [*.tcm]",          "Số liệu máy LEICA Wid     [*.gre]",
    "Số liệu máy NIKON           [*.dn7]",      "Số liệu khác                      [*.*]"};
inline constexpr std::string_view kFileNotFoundShort = "Không tìm thấy File ";
inline constexpr std::string_view kDataOfFile = "Số liệu của File: ";
inline constexpr std::string_view kExitQuestion = "Bạn có muốn thoát khỏi chương trình không ?";
// Beside the progress of a run: stops it before its next station.
inline constexpr std::string_view kStopRun = "Dừng tính";
inline constexpr std::string_view kChooseKcFile = "File KC";
inline constexpr std::string_view kRecent = "Gần đây";

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

// The map window.
inline constexpr std::string_view kMapTitle = "Bản đồ: ";
inline constexpr std::string_view kFit = "Vừa cửa sổ";
inline constexpr std::string_view kSaveView = "Lưu hình đang xem";
inline constexpr std::string_view kSaveWhole = "Lưu hình cả khu đo";
inline constexpr std::string_view kSaveSketch = "Lưu sổ đo PDF";
inline constexpr std::string_view kPrintSketch = "In sổ đo";
inline constexpr std::string_view kPictureFilter = "Hình PNG (*.png);;Hình SVG (*.svg)";
inline constexpr std::string_view kPdfFilter = "File PDF (*.pdf)";
inline constexpr std::string_view kReportLines = "Báo lỗi:";
inline constexpr std::string_view kRecordAt = "Sổ đo, dòng ";
inline constexpr std::string_view kHint = "Bấm vào một điểm để xem số liệu của nó.";
inline constexpr std::string_view kPointKinds[] = {"Điểm khống chế", "Trạm máy", "Cọc phụ",
                                                   "Điểm chi tiết"};

}  // namespace kavu::ui
