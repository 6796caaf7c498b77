<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<!-- The texts of Qt's own dialogs, menus and buttons in Vietnamese. -->
<TS version="2.1" language="vi_VN">
<context>
    <name>QPlatformTheme</name>
    <message>
        <source>OK</source>
        <translation>Đồng ý</translation>
    </message>
    <message>
        <source>Save</source>
        <translation>Ghi</translation>
    </message>
    <message>
        <source>Save All</source>
        <translation>Ghi tất cả</translation>
    </message>
    <message>
        <source>Open</source>
        <translation>Mở</translation>
    </message>
    <message>
        <source>&amp;Yes</source>
        <translation>&amp;Có</translation>
    </message>
    <message>
        <source>Yes to &amp;All</source>
        <translation>Có với &amp;tất cả</translation>
    </message>
    <message>
        <source>&amp;No</source>
        <translation>&amp;Không</translation>
    </message>
    <message>
        <source>N&amp;o to All</source>
        <translation>Không với tất &amp;cả</translation>
    </message>
    <message>
        <source>Abort</source>
        <translation>Bỏ</translation>
    </message>
    <message>
        <source>Retry</source>
        <translation>Thử lại</translation>
    </message>
    <message>
        <source>Ignore</source>
        <translation>Bỏ qua</translation>
    </message>
    <message>
        <source>Close</source>
        <translation>Đóng</translation>
    </message>
    <message>
        <source>Cancel</source>
        <translation>Hủy</translation>
    </message>
    <message>
        <source>Discard</source>
        <translation>Không ghi</translation>
    </message>
    <message>
        <source>Help</source>
        <translation>Trợ giúp</translation>
    </message>
    <message>
        <source>Apply</source>
        <translation>Áp dụng</translation>
    </message>
    <message>
        <source>Reset</source>
        <translation>Đặt lại</translation>
    </message>
    <message>
        <source>Restore Defaults</source>
        <translation>Trở về mặc định</translation>
    </message>
</context>
<context>
    <name>QWidgetTextControl</name>
    <message>
        <source>&amp;Undo</source>
        <translation>&amp;Hoàn tác</translation>
    </message>
    <message>
        <source>&amp;Redo</source>
        <translation>&amp;Làm lại</translation>
    </message>
    <message>
        <source>Cu&amp;t</source>
        <translation>&amp;Cắt</translation>
    </message>
    <message>
        <source>&amp;Copy</source>
        <translation>Ch&amp;ép</translation>
    </message>
    <message>
        <source>Copy &amp;Link Location</source>
        <translation>Chép địa chỉ &amp;liên kết</translation>
    </message>
    <message>
        <source>&amp;Paste</source>
        <translation>&amp;Dán</translation>
    </message>
    <message>
        <source>Delete</source>
        <translation>Xoá</translation>
    </message>
    <message>
        <source>Select All</source>
        <translation>Chọn tất cả</translation>
    </message>
</context>
<context>
    <name>QLineEdit</name>
    <message>
        <source>&amp;Undo</source>
        <translation>&amp;Hoàn tác</translation>
    </message>
    <message>
        <source>&amp;Redo</source>
        <translation>&amp;Làm lại</translation>
    </message>
    <message>
        <source>Cu&amp;t</source>
        <translation>&amp;Cắt</translation>
    </message>
    <message>
        <source>&amp;Copy</source>
        <translation>Ch&amp;ép</translation>
    </message>
    <message>
        <source>&amp;Paste</source>
        <translation>&amp;Dán</translation>
    </message>
    <message>
        <source>Delete</source>
        <translation>Xoá</translation>
    </message>
    <message>
        <source>Select All</source>
        <translation>Chọn tất cả</translation>
    </message>
</context>
<context>
    <name>QFileDialog</name>
    <message>
        <source>Look in:</source>
        <translation>Tìm trong:</translation>
    </message>
    <message>
        <source>File &amp;name:</source>
        <translation>&amp;Tên File:</translation>
    </message>
    <message>
        <source>Files of type:</source>
        <translation>Kiểu File:</translation>
    </message>
    <message>
        <source>Back</source>
        <translation>Lùi</translation>
    </message>
    <message>
        <source>Forward</source>
        <translation>Tới</translation>
    </message>
    <message>
        <source>Parent Directory</source>
        <translation>Thư mục cha</translation>
    </message>
    <message>
        <source>Create New Folder</source>
        <translation>Tạo thư mục mới</translation>
    </message>
    <message>
        <source>List View</source>
        <translation>Xem dạng danh sách</translation>
    </message>
    <message>
        <source>Detail View</source>
        <translation>Xem chi tiết</translation>
    </message>
    <message>
        <source>Sidebar</source>
        <translation>Thanh bên</translation>
    </message>
    <message>
        <source>&amp;Rename</source>
        <translation>Đổi &amp;tên</translation>
    </message>
    <message>
        <source>&amp;Delete</source>
        <translation>&amp;Xoá</translation>
    </message>
    <message>
        <source>Show &amp;hidden files</source>
        <translation>Hiện các File ẩ&amp;n</translation>
    </message>
    <message>
        <source>&amp;New Folder</source>
        <translation>Thư mục &amp;mới</translation>
    </message>
    <message>
        <source>Recent Places</source>
        <translation>Nơi mở gần đây</translation>
    </message>
    <message>
        <source>&amp;Open</source>
        <translation>&amp;Mở</translation>
    </message>
    <message>
        <source>&amp;Choose</source>
        <translation>&amp;Chọn</translation>
    </message>
    <message>
        <source>Open</source>
        <translation>Mở</translation>
    </message>
    <message>
        <source>Save As</source>
        <translation>Ghi thành</translation>
    </message>
    <message>
        <source>New Folder</source>
        <translation>Thư mục mới</translation>
    </message>
    <message>
        <source>Are you sure you want to delete &apos;%1&apos;?</source>
        <translation>Có chắc muốn xoá &apos;%1&apos; không?</translation>
    </message>
    <message>
        <source>Delete</source>
        <translation>Xoá</translation>
    </message>
    <message>
        <source>All Files (*)</source>
        <translation>Mọi File (*)</translation>
    </message>
    <message>
        <source>Directory:</source>
        <translation>Thư mục:</translation>
    </message>
    <message>
        <source>File</source>
        <translation>File</translation>
    </message>
    <message>
        <source>File Folder</source>
        <translation>Thư mục</translation>
    </message>
    <message>
        <source>Folder</source>
        <translation>Thư mục</translation>
    </message>
    <message>
        <source>Alias</source>
        <translation>Bí danh</translation>
    </message>
    <message>
        <source>Shortcut</source>
        <translation>Lối tắt</translation>
    </message>
    <message>
        <source>Unknown</source>
        <translation>Không rõ</translation>
    </message>
    <message>
        <source>Find Directory</source>
        <translation>Tìm thư mục</translation>
    </message>
    <message>
        <source>&amp;Save</source>
        <translation>&amp;Ghi</translation>
    </message>
    <message>
        <source>Go back</source>
        <translation>Lùi lại</translation>
    </message>
    <message>
        <source>Go forward</source>
        <translation>Tới trước</translation>
    </message>
    <message>
        <source>Go to the parent directory</source>
        <translation>Lên thư mục cha</translation>
    </message>
    <message>
        <source>Create a New Folder</source>
        <translation>Tạo một thư mục mới</translation>
    </message>
    <message>
        <source>Change to list view mode</source>
        <translation>Xem dạng danh sách</translation>
    </message>
    <message>
        <source>Change to detail view mode</source>
        <translation>Xem chi tiết từng File</translation>
    </message>
    <message>
        <source>List of places and bookmarks</source>
        <translation>Các nơi hay dùng</translation>
    </message>
    <message>
        <source>Files</source>
        <translation>Các File</translation>
    </message>
    <message>
        <source>Show </source>
        <translation>Hiện </translation>
    </message>
    <message>
        <source>Alt+Left</source>
        <translation>Alt+Left</translation>
    </message>
    <message>
        <source>Alt+Right</source>
        <translation>Alt+Right</translation>
    </message>
    <message>
        <source>Alt+Up</source>
        <translation>Alt+Up</translation>
    </message>
    <message>
        <source>%1 already exists.
Do you want to replace it?</source>
        <translation>File %1 đã có.
Có ghi đè lên không?</translation>
    </message>
    <message>
        <source>%1
Directory not found.
Please verify the correct directory name was given.</source>
        <translation>%1
Không tìm thấy thư mục.
Hãy xem lại tên thư mục.</translation>
    </message>
    <message>
        <source>%1
File not found.
Please verify the correct file name was given.</source>
        <translation>%1
Không tìm thấy File.
Hãy xem lại tên File.</translation>
    </message>
    <message>
        <source>&apos;%1&apos; is write protected.
Do you want to delete it anyway?</source>
        <translation>&apos;%1&apos; đang được chống ghi.
Vẫn xoá nó chứ?</translation>
    </message>
    <message>
        <source>Could not delete directory.</source>
        <translation>Không xoá được thư mục.</translation>
    </message>
</context>
<context>
    <name>QFileSystemModel</name>
    <message>
        <source>Name</source>
        <translation>Tên</translation>
    </message>
    <message>
        <source>Size</source>
        <translation>Cỡ</translation>
    </message>
    <message>
        <source>Type</source>
        <translation>Kiểu</translation>
    </message>
    <message>
        <source>Kind</source>
        <translation>Kiểu</translation>
    </message>
    <message>
        <source>Date Modified</source>
        <translation>Ngày sửa</translation>
    </message>
    <message>
        <source>Computer</source>
        <translation>Máy tính</translation>
    </message>
    <message>
        <source>My Computer</source>
        <translation>Máy tính</translation>
    </message>
    <message>
        <source>%1 bytes</source>
        <translation>%1 byte</translation>
    </message>
    <message>
        <source>%1 KB</source>
        <translation>%1 KB</translation>
    </message>
    <message>
        <source>%1 MB</source>
        <translation>%1 MB</translation>
    </message>
    <message>
        <source>%1 GB</source>
        <translation>%1 GB</translation>
    </message>
    <message>
        <source>%1 TB</source>
        <translation>%1 TB</translation>
    </message>
</context>
<context>
    <name>QLocale</name>
    <message>
        <source>%1 bytes</source>
        <translation>%1 byte</translation>
    </message>
</context>
<context>
    <name>QMessageBox</name>
    <message>
        <source>Show Details...</source>
        <translation>Xem chi tiết...</translation>
    </message>
    <message>
        <source>Hide Details...</source>
        <translation>Ẩn chi tiết...</translation>
    </message>
    <message>
        <source>OK</source>
        <translation>Đồng ý</translation>
    </message>
</context>
<!-- The print preview of the field sketch, the print dialog, its printer's
     properties and the page setup. -->
<context>
    <name>QPrintPreviewDialog</name>
    <message>
        <source>Print Preview</source>
        <translation>Xem trước khi in</translation>
    </message>
    <message>
        <source>First page</source>
        <translation>Trang đầu</translation>
    </message>
    <message>
        <source>Previous page</source>
        <translation>Trang trước</translation>
    </message>
    <message>
        <source>Next page</source>
        <translation>Trang sau</translation>
    </message>
    <message>
        <source>Last page</source>
        <translation>Trang cuối</translation>
    </message>
    <message>
        <source>Fit width</source>
        <translation>Vừa chiều rộng</translation>
    </message>
    <message>
        <source>Fit page</source>
        <translation>Vừa trang</translation>
    </message>
    <message>
        <source>Zoom in</source>
        <translation>Phóng to</translation>
    </message>
    <message>
        <source>Zoom out</source>
        <translation>Thu nhỏ</translation>
    </message>
    <message>
        <source>Portrait</source>
        <translation>Hướng giấy dọc</translation>
    </message>
    <message>
        <source>Landscape</source>
        <translation>Hướng giấy ngang</translation>
    </message>
    <message>
        <source>Show single page</source>
        <translation>Xem từng trang</translation>
    </message>
    <message>
        <source>Show facing pages</source>
        <translation>Xem hai trang đối nhau</translation>
    </message>
    <message>
        <source>Show overview of all pages</source>
        <translation>Xem toàn bộ các trang</translation>
    </message>
    <message>
        <source>Print</source>
        <translation>In</translation>
    </message>
    <message>
        <source>Page setup</source>
        <translation>Thiết lập trang</translation>
    </message>
    <message>
        <source>Page Setup</source>
        <translation>Thiết lập trang</translation>
    </message>
    <message>
        <source>%1%</source>
        <translation>%1%</translation>
    </message>
</context>
<context>
    <name>QPrintDialog</name>
    <message>
        <source>Print</source>
        <translation>In</translation>
    </message>
    <message>
        <source>&amp;Print</source>
        <translation>&amp;In</translation>
    </message>
    <message>
        <source>&amp;Options &gt;&gt;</source>
        <translation>Tùy &amp;chọn &gt;&gt;</translation>
    </message>
    <message>
        <source>&amp;Options &lt;&lt;</source>
        <translation>Tùy &amp;chọn &lt;&lt;</translation>
    </message>
    <message>
        <source>Print to File (PDF)</source>
        <translation>In ra File (PDF)</translation>
    </message>
    <message>
        <source>Local file</source>
        <translation>File trên máy này</translation>
    </message>
    <message>
        <source>Write PDF file</source>
        <translation>Ghi File PDF</translation>
    </message>
    <message>
        <source>Print To File ...</source>
        <translation>In ra File ...</translation>
    </message>
    <message>
        <source>All Pages</source>
        <translation>Mọi trang</translation>
    </message>
    <message>
        <source>Odd Pages</source>
        <translation>Các trang lẻ</translation>
    </message>
    <message>
        <source>Even Pages</source>
        <translation>Các trang chẵn</translation>
    </message>
    <message>
        <source>1 (1x1)</source>
        <translation>1 (1x1)</translation>
    </message>
    <message>
        <source>2 (2x1)</source>
        <translation>2 (2x1)</translation>
    </message>
    <message>
        <source>4 (2x2)</source>
        <translation>4 (2x2)</translation>
    </message>
    <message>
        <source>6 (2x3)</source>
        <translation>6 (2x3)</translation>
    </message>
    <message>
        <source>9 (3x3)</source>
        <translation>9 (3x3)</translation>
    </message>
    <message>
        <source>16 (4x4)</source>
        <translation>16 (4x4)</translation>
    </message>
    <message>
        <source>Left to Right, Top to Bottom</source>
        <translation>Trái sang phải, trên xuống dưới</translation>
    </message>
    <message>
        <source>Left to Right, Bottom to Top</source>
        <translation>Trái sang phải, dưới lên trên</translation>
    </message>
    <message>
        <source>Right to Left, Top to Bottom</source>
        <translation>Phải sang trái, trên xuống dưới</translation>
    </message>
    <message>
        <source>Right to Left, Bottom to Top</source>
        <translation>Phải sang trái, dưới lên trên</translation>
    </message>
    <message>
        <source>Top to Bottom, Left to Right</source>
        <translation>Trên xuống dưới, trái sang phải</translation>
    </message>
    <message>
        <source>Top to Bottom, Right to Left</source>
        <translation>Trên xuống dưới, phải sang trái</translation>
    </message>
    <message>
        <source>Bottom to Top, Left to Right</source>
        <translation>Dưới lên trên, trái sang phải</translation>
    </message>
    <message>
        <source>Bottom to Top, Right to Left</source>
        <translation>Dưới lên trên, phải sang trái</translation>
    </message>
    <message>
        <source>%1 is a directory.
Please choose a different file name.</source>
        <translation>%1 là một thư mục.
Hãy chọn một tên File khác.</translation>
    </message>
    <message>
        <source>File %1 is not writable.
Please choose a different file name.</source>
        <translation>Không ghi được File %1.
Hãy chọn một tên File khác.</translation>
    </message>
    <message>
        <source>%1 already exists.
Do you want to overwrite it?</source>
        <translation>File %1 đã có.
Có ghi đè lên không?</translation>
    </message>
    <message>
        <source>Options &apos;Pages Per Sheet&apos; and &apos;Page Set&apos; cannot be used together.
Please turn one of those options off.</source>
        <translation>Không dùng được cùng lúc &apos;Số trang mỗi tờ&apos; và &apos;Nhóm trang&apos;.
Hãy bỏ một trong hai.</translation>
    </message>
    <message>
        <source>Invalid Pages Definition</source>
        <translation>Các trang ghi sai</translation>
    </message>
    <message>
        <source>%1 does not follow the correct syntax. Please use &apos;,&apos; to separate ranges and pages, &apos;-&apos; to define ranges and make sure ranges do not intersect with each other.</source>
        <translation>%1 ghi sai. Hãy dùng &apos;,&apos; ngăn cách các trang và các khoảng trang, &apos;-&apos; ghi một khoảng trang, và để các khoảng không chồng lên nhau.</translation>
    </message>
    <message>
        <source>Duplex Settings Conflicts</source>
        <translation>Thiết lập in hai mặt mâu thuẫn</translation>
    </message>
    <message>
        <source>There are conflicts in duplex settings. Do you want to fix them?</source>
        <translation>Thiết lập in hai mặt có chỗ mâu thuẫn. Có sửa lại không?</translation>
    </message>
</context>
<context>
    <name>QPrintWidget</name>
    <message>
        <source>Form</source>
        <translation>Biểu mẫu</translation>
    </message>
    <message>
        <source>Printer</source>
        <translation>Máy in</translation>
    </message>
    <message>
        <source>&amp;Name:</source>
        <translation>Tê&amp;n:</translation>
    </message>
    <message>
        <source>P&amp;roperties</source>
        <translation>&amp;Thuộc tính</translation>
    </message>
    <message>
        <source>Location:</source>
        <translation>Vị trí:</translation>
    </message>
    <message>
        <source>Preview</source>
        <translation>Xem trước</translation>
    </message>
    <message>
        <source>Type:</source>
        <translation>Loại:</translation>
    </message>
    <message>
        <source>Output &amp;file:</source>
        <translation>Ghi ra &amp;File:</translation>
    </message>
    <message>
        <source>...</source>
        <translation>...</translation>
    </message>
</context>
<context>
    <name>QPrintSettingsOutput</name>
    <message>
        <source>Form</source>
        <translation>Biểu mẫu</translation>
    </message>
    <message>
        <source>Copies</source>
        <translation>Số bản</translation>
    </message>
    <message>
        <source>Print range</source>
        <translation>Phạm vi in</translation>
    </message>
    <message>
        <source>Print all</source>
        <translation>In tất cả</translation>
    </message>
    <message>
        <source>Pages from</source>
        <translation>Các trang từ</translation>
    </message>
    <message>
        <source>to</source>
        <translation>đến</translation>
    </message>
    <message>
        <source>Pages</source>
        <translation>Các trang</translation>
    </message>
    <message>
        <source>Specify pages or ranges separated by commas. Ranges are specified by two numbers separated by a hyphen. E.g: 3,5-7,9 prints pages 3, 5, 6, 7 and 9.</source>
        <translation>Ghi các trang hoặc các khoảng trang, ngăn cách bằng dấu phẩy; một khoảng trang là hai số nối bằng dấu gạch ngang. Ví dụ: 3,5-7,9 in các trang 3, 5, 6, 7 và 9.</translation>
    </message>
    <message>
        <source>Current Page</source>
        <translation>Trang hiện tại</translation>
    </message>
    <message>
        <source>Selection</source>
        <translation>Phần đã chọn</translation>
    </message>
    <message>
        <source>Output Settings</source>
        <translation>Thiết lập bản in</translation>
    </message>
    <message>
        <source>Copies:</source>
        <translation>Số bản:</translation>
    </message>
    <message>
        <source>Collate</source>
        <translation>In trọn từng bộ</translation>
    </message>
    <message>
        <source>Reverse</source>
        <translation>In ngược thứ tự</translation>
    </message>
    <message>
        <source>Options</source>
        <translation>Tùy chọn</translation>
    </message>
    <message>
        <source>Color Mode</source>
        <translation>Màu in</translation>
    </message>
    <message>
        <source>Color</source>
        <translation>Màu</translation>
    </message>
    <message>
        <source>Grayscale</source>
        <translation>Đen trắng</translation>
    </message>
    <message>
        <source>Double Sided Printing</source>
        <translation>In hai mặt</translation>
    </message>
    <message>
        <source>Off</source>
        <translation>Không</translation>
    </message>
    <message>
        <source>Long side binding</source>
        <translation>Đóng gáy cạnh dài</translation>
    </message>
    <message>
        <source>Short side binding</source>
        <translation>Đóng gáy cạnh ngắn</translation>
    </message>
    <message>
        <source>Page Set:</source>
        <translation>Nhóm trang:</translation>
    </message>
</context>
<context>
    <name>QPrintPropertiesDialog</name>
    <message>
        <source>Printer Properties</source>
        <translation>Thuộc tính máy in</translation>
    </message>
    <message>
        <source>Job Options</source>
        <translation>Lệnh in</translation>
    </message>
    <message>
        <source>Page Setup Conflicts</source>
        <translation>Thiết lập trang mâu thuẫn</translation>
    </message>
    <message>
        <source>There are conflicts in page setup options. Do you want to fix them?</source>
        <translation>Thiết lập trang có chỗ mâu thuẫn. Có sửa lại không?</translation>
    </message>
    <message>
        <source>Advanced Option Conflicts</source>
        <translation>Tùy chọn nâng cao mâu thuẫn</translation>
    </message>
    <message>
        <source>There are conflicts in some advanced options. Do you want to fix them?</source>
        <translation>Tùy chọn nâng cao có chỗ mâu thuẫn. Có sửa lại không?</translation>
    </message>
</context>
<context>
    <name>QPrintPropertiesWidget</name>
    <message>
        <source>Form</source>
        <translation>Biểu mẫu</translation>
    </message>
    <message>
        <source>Page</source>
        <translation>Trang</translation>
    </message>
    <message>
        <source>Advanced</source>
        <translation>Nâng cao</translation>
    </message>
    <message>
        <source>There are conflicts in some options. Please fix them.</source>
        <translation>Có tùy chọn mâu thuẫn nhau. Hãy sửa lại.</translation>
    </message>
</context>
<context>
    <name>QPageSetupWidget</name>
    <message>
        <source>Form</source>
        <translation>Biểu mẫu</translation>
    </message>
    <message>
        <source>Paper</source>
        <translation>Giấy</translation>
    </message>
    <message>
        <source>Page size:</source>
        <translation>Khổ giấy:</translation>
    </message>
    <message>
        <source>Width:</source>
        <translation>Rộng:</translation>
    </message>
    <message>
        <source>Height:</source>
        <translation>Cao:</translation>
    </message>
    <message>
        <source>Paper source:</source>
        <translation>Khay giấy:</translation>
    </message>
    <message>
        <source>Orientation</source>
        <translation>Hướng giấy</translation>
    </message>
    <message>
        <source>Portrait</source>
        <translation>Dọc</translation>
    </message>
    <message>
        <source>Landscape</source>
        <translation>Ngang</translation>
    </message>
    <message>
        <source>Reverse landscape</source>
        <translation>Ngang, lật ngược</translation>
    </message>
    <message>
        <source>Reverse portrait</source>
        <translation>Dọc, lật ngược</translation>
    </message>
    <message>
        <source>Margins</source>
        <translation>Lề</translation>
    </message>
    <message>
        <source>top margin</source>
        <translation>lề trên</translation>
    </message>
    <message>
        <source>left margin</source>
        <translation>lề trái</translation>
    </message>
    <message>
        <source>right margin</source>
        <translation>lề phải</translation>
    </message>
    <message>
        <source>bottom margin</source>
        <translation>lề dưới</translation>
    </message>
    <message>
        <source>Page Layout</source>
        <translation>Bố trí trang</translation>
    </message>
    <message>
        <source>Page order:</source>
        <translation>Thứ tự trang:</translation>
    </message>
    <message>
        <source>Pages per sheet:</source>
        <translation>Số trang mỗi tờ:</translation>
    </message>
    <message>
        <source>Custom</source>
        <translation>Khổ tự chọn</translation>
    </message>
    <message>
        <source>Millimeters (mm)</source>
        <translation>Milimét (mm)</translation>
    </message>
    <message>
        <source>Points (pt)</source>
        <translation>Point (pt)</translation>
    </message>
    <message>
        <source>Inches (in)</source>
        <translation>Inch (in)</translation>
    </message>
    <message>
        <source>Pica (P̸)</source>
        <translation>Pica (P̸)</translation>
    </message>
    <message>
        <source>Didot (DD)</source>
        <translation>Didot (DD)</translation>
    </message>
    <message>
        <source>Cicero (CC)</source>
        <translation>Cicero (CC)</translation>
    </message>
    <message>
        <source>mm</source>
        <translation>mm</translation>
    </message>
</context>
<context>
    <name>QCupsJobWidget</name>
    <message>
        <source>Job</source>
        <translation>Lệnh in</translation>
    </message>
    <message>
        <source>Job Control</source>
        <translation>Điều khiển lệnh in</translation>
    </message>
    <message>
        <source>Scheduled printing:</source>
        <translation>Hẹn giờ in:</translation>
    </message>
    <message>
        <source>Billing information:</source>
        <translation>Thông tin tính phí:</translation>
    </message>
    <message>
        <source>Job priority:</source>
        <translation>Độ ưu tiên:</translation>
    </message>
    <message>
        <source>Banner Pages</source>
        <translation>Trang bìa</translation>
    </message>
    <message>
        <source>Start:</source>
        <comment>Banner page at start</comment>
        <translation>Đầu:</translation>
    </message>
    <message>
        <source>End:</source>
        <comment>Banner page at end</comment>
        <translation>Cuối:</translation>
    </message>
    <message>
        <source>Print Immediately</source>
        <translation>In ngay</translation>
    </message>
    <message>
        <source>Hold Indefinitely</source>
        <translation>Giữ lại, chưa in</translation>
    </message>
    <message>
        <source>Day (06:00 to 17:59)</source>
        <translation>Ban ngày (06:00 đến 17:59)</translation>
    </message>
    <message>
        <source>Night (18:00 to 05:59)</source>
        <translation>Ban đêm (18:00 đến 05:59)</translation>
    </message>
    <message>
        <source>Second Shift (16:00 to 23:59)</source>
        <translation>Ca hai (16:00 đến 23:59)</translation>
    </message>
    <message>
        <source>Third Shift (00:00 to 07:59)</source>
        <translation>Ca ba (00:00 đến 07:59)</translation>
    </message>
    <message>
        <source>Weekend (Saturday to Sunday)</source>
        <translation>Cuối tuần (thứ Bảy, Chủ nhật)</translation>
    </message>
    <message>
        <source>Specific Time</source>
        <translation>Vào giờ định sẵn</translation>
    </message>
    <message>
        <source>None</source>
        <comment>CUPS Banner page</comment>
        <translation>Không</translation>
    </message>
    <message>
        <source>Standard</source>
        <comment>CUPS Banner page</comment>
        <translation>Thường</translation>
    </message>
    <message>
        <source>Unclassified</source>
        <comment>CUPS Banner page</comment>
        <translation>Không mật</translation>
    </message>
    <message>
        <source>Confidential</source>
        <comment>CUPS Banner page</comment>
        <translation>Lưu hành nội bộ</translation>
    </message>
    <message>
        <source>Classified</source>
        <comment>CUPS Banner page</comment>
        <translation>Mật</translation>
    </message>
    <message>
        <source>Secret</source>
        <comment>CUPS Banner page</comment>
        <translation>Tối mật</translation>
    </message>
    <message>
        <source>Top Secret</source>
        <comment>CUPS Banner page</comment>
        <translation>Tuyệt mật</translation>
    </message>
</context>
<context>
    <name>Print Device Input Slot</name>
    <message>
        <source>Automatic</source>
        <translation>Tự động</translation>
    </message>
</context>
<context>
    <name>Print Device Output Bin</name>
    <message>
        <source>Automatic</source>
        <translation>Tự động</translation>
    </message>
</context>
<!-- Paper sizes keep the names the trade writes (A4, Letter); envelopes and
     cards are named in Vietnamese. -->
<context>
    <name>QPageSize</name>
    <message>
        <source>%1 x %2 in</source>
        <translation>%1 x %2 in</translation>
    </message>
    <message>
        <source>A0</source>
        <translation>A0</translation>
    </message>
    <message>
        <source>A1</source>
        <translation>A1</translation>
    </message>
    <message>
        <source>A10</source>
        <translation>A10</translation>
    </message>
    <message>
        <source>A2</source>
        <translation>A2</translation>
    </message>
    <message>
        <source>A3</source>
        <translation>A3</translation>
    </message>
    <message>
        <source>A3 Extra</source>
        <translation>A3 Extra</translation>
    </message>
    <message>
        <source>A4</source>
        <translation>A4</translation>
    </message>
    <message>
        <source>A4 Extra</source>
        <translation>A4 Extra</translation>
    </message>
    <message>
        <source>A4 Plus</source>
        <translation>A4 Plus</translation>
    </message>
    <message>
        <source>A4 Small</source>
        <translation>A4 Small</translation>
    </message>
    <message>
        <source>A5</source>
        <translation>A5</translation>
    </message>
    <message>
        <source>A5 Extra</source>
        <translation>A5 Extra</translation>
    </message>
    <message>
        <source>A6</source>
        <translation>A6</translation>
    </message>
    <message>
        <source>A7</source>
        <translation>A7</translation>
    </message>
    <message>
        <source>A8</source>
        <translation>A8</translation>
    </message>
    <message>
        <source>A9</source>
        <translation>A9</translation>
    </message>
    <message>
        <source>ANSI C</source>
        <translation>ANSI C</translation>
    </message>
    <message>
        <source>ANSI D</source>
        <translation>ANSI D</translation>
    </message>
    <message>
        <source>ANSI E</source>
        <translation>ANSI E</translation>
    </message>
    <message>
        <source>Architect A</source>
        <translation>Architect A</translation>
    </message>
    <message>
        <source>Architect B</source>
        <translation>Architect B</translation>
    </message>
    <message>
        <source>Architect C</source>
        <translation>Architect C</translation>
    </message>
    <message>
        <source>Architect D</source>
        <translation>Architect D</translation>
    </message>
    <message>
        <source>Architect E</source>
        <translation>Architect E</translation>
    </message>
    <message>
        <source>B0</source>
        <translation>B0</translation>
    </message>
    <message>
        <source>B1</source>
        <translation>B1</translation>
    </message>
    <message>
        <source>B10</source>
        <translation>B10</translation>
    </message>
    <message>
        <source>B2</source>
        <translation>B2</translation>
    </message>
    <message>
        <source>B3</source>
        <translation>B3</translation>
    </message>
    <message>
        <source>B4</source>
        <translation>B4</translation>
    </message>
    <message>
        <source>B5</source>
        <translation>B5</translation>
    </message>
    <message>
        <source>B5 Extra</source>
        <translation>B5 Extra</translation>
    </message>
    <message>
        <source>B6</source>
        <translation>B6</translation>
    </message>
    <message>
        <source>B7</source>
        <translation>B7</translation>
    </message>
    <message>
        <source>B8</source>
        <translation>B8</translation>
    </message>
    <message>
        <source>B9</source>
        <translation>B9</translation>
    </message>
    <message>
        <source>Double Postcard</source>
        <translation>Bưu thiếp đôi</translation>
    </message>
    <message>
        <source>Envelope B4</source>
        <translation>Phong bì B4</translation>
    </message>
    <message>
        <source>Envelope B5</source>
        <translation>Phong bì B5</translation>
    </message>
    <message>
        <source>Envelope B6</source>
        <translation>Phong bì B6</translation>
    </message>
    <message>
        <source>Envelope C0</source>
        <translation>Phong bì C0</translation>
    </message>
    <message>
        <source>Envelope C1</source>
        <translation>Phong bì C1</translation>
    </message>
    <message>
        <source>Envelope C2</source>
        <translation>Phong bì C2</translation>
    </message>
    <message>
        <source>Envelope C3</source>
        <translation>Phong bì C3</translation>
    </message>
    <message>
        <source>Envelope C4</source>
        <translation>Phong bì C4</translation>
    </message>
    <message>
        <source>Envelope C5</source>
        <translation>Phong bì C5</translation>
    </message>
    <message>
        <source>Envelope C6</source>
        <translation>Phong bì C6</translation>
    </message>
    <message>
        <source>Envelope C65</source>
        <translation>Phong bì C65</translation>
    </message>
    <message>
        <source>Envelope C7</source>
        <translation>Phong bì C7</translation>
    </message>
    <message>
        <source>Envelope Chou 3</source>
        <translation>Phong bì Chou 3</translation>
    </message>
    <message>
        <source>Envelope Chou 4</source>
        <translation>Phong bì Chou 4</translation>
    </message>
    <message>
        <source>Envelope DL</source>
        <translation>Phong bì DL</translation>
    </message>
    <message>
        <source>Envelope Invite</source>
        <translation>Phong bì Invite</translation>
    </message>
    <message>
        <source>Envelope Italian</source>
        <translation>Phong bì Italian</translation>
    </message>
    <message>
        <source>Envelope Kaku 2</source>
        <translation>Phong bì Kaku 2</translation>
    </message>
    <message>
        <source>Envelope Kaku 3</source>
        <translation>Phong bì Kaku 3</translation>
    </message>
    <message>
        <source>Envelope Monarch</source>
        <translation>Phong bì Monarch</translation>
    </message>
    <message>
        <source>Envelope PRC 1</source>
        <translation>Phong bì PRC 1</translation>
    </message>
    <message>
        <source>Envelope PRC 10</source>
        <translation>Phong bì PRC 10</translation>
    </message>
    <message>
        <source>Envelope PRC 2</source>
        <translation>Phong bì PRC 2</translation>
    </message>
    <message>
        <source>Envelope PRC 3</source>
        <translation>Phong bì PRC 3</translation>
    </message>
    <message>
        <source>Envelope PRC 4</source>
        <translation>Phong bì PRC 4</translation>
    </message>
    <message>
        <source>Envelope PRC 5</source>
        <translation>Phong bì PRC 5</translation>
    </message>
    <message>
        <source>Envelope PRC 6</source>
        <translation>Phong bì PRC 6</translation>
    </message>
    <message>
        <source>Envelope PRC 7</source>
        <translation>Phong bì PRC 7</translation>
    </message>
    <message>
        <source>Envelope PRC 8</source>
        <translation>Phong bì PRC 8</translation>
    </message>
    <message>
        <source>Envelope PRC 9</source>
        <translation>Phong bì PRC 9</translation>
    </message>
    <message>
        <source>Envelope Personal</source>
        <translation>Phong bì Personal</translation>
    </message>
    <message>
        <source>Envelope US 10</source>
        <translation>Phong bì US 10</translation>
    </message>
    <message>
        <source>Envelope US 11</source>
        <translation>Phong bì US 11</translation>
    </message>
    <message>
        <source>Envelope US 12</source>
        <translation>Phong bì US 12</translation>
    </message>
    <message>
        <source>Envelope US 14</source>
        <translation>Phong bì US 14</translation>
    </message>
    <message>
        <source>Envelope US 9</source>
        <translation>Phong bì US 9</translation>
    </message>
    <message>
        <source>Executive (7.25 x 10.5 in)</source>
        <translation>Executive (7.25 x 10.5 in)</translation>
    </message>
    <message>
        <source>Executive (7.5 x 10 in)</source>
        <translation>Executive (7.5 x 10 in)</translation>
    </message>
    <message>
        <source>Fan-fold German (8.5 x 12 in)</source>
        <translation>Fan-fold German (8.5 x 12 in)</translation>
    </message>
    <message>
        <source>Fan-fold German Legal (8.5 x 13 in)</source>
        <translation>Fan-fold German Legal (8.5 x 13 in)</translation>
    </message>
    <message>
        <source>Fan-fold US (14.875 x 11 in)</source>
        <translation>Fan-fold US (14.875 x 11 in)</translation>
    </message>
    <message>
        <source>Folio (8.27 x 13 in)</source>
        <translation>Folio (8.27 x 13 in)</translation>
    </message>
    <message>
        <source>JIS B0</source>
        <translation>JIS B0</translation>
    </message>
    <message>
        <source>JIS B1</source>
        <translation>JIS B1</translation>
    </message>
    <message>
        <source>JIS B10</source>
        <translation>JIS B10</translation>
    </message>
    <message>
        <source>JIS B2</source>
        <translation>JIS B2</translation>
    </message>
    <message>
        <source>JIS B3</source>
        <translation>JIS B3</translation>
    </message>
    <message>
        <source>JIS B4</source>
        <translation>JIS B4</translation>
    </message>
    <message>
        <source>JIS B5</source>
        <translation>JIS B5</translation>
    </message>
    <message>
        <source>JIS B6</source>
        <translation>JIS B6</translation>
    </message>
    <message>
        <source>JIS B7</source>
        <translation>JIS B7</translation>
    </message>
    <message>
        <source>JIS B8</source>
        <translation>JIS B8</translation>
    </message>
    <message>
        <source>JIS B9</source>
        <translation>JIS B9</translation>
    </message>
    <message>
        <source>Ledger / ANSI B</source>
        <translation>Ledger / ANSI B</translation>
    </message>
    <message>
        <source>Legal</source>
        <translation>Legal</translation>
    </message>
    <message>
        <source>Legal Extra</source>
        <translation>Legal Extra</translation>
    </message>
    <message>
        <source>Letter / ANSI A</source>
        <translation>Letter / ANSI A</translation>
    </message>
    <message>
        <source>Letter Extra</source>
        <translation>Letter Extra</translation>
    </message>
    <message>
        <source>Letter Plus</source>
        <translation>Letter Plus</translation>
    </message>
    <message>
        <source>Letter Small</source>
        <translation>Letter Small</translation>
    </message>
    <message>
        <source>Note</source>
        <translation>Note</translation>
    </message>
    <message>
        <source>PRC 16K</source>
        <translation>PRC 16K</translation>
    </message>
    <message>
        <source>PRC 32K</source>
        <translation>PRC 32K</translation>
    </message>
    <message>
        <source>PRC 32K Big</source>
        <translation>PRC 32K Big</translation>
    </message>
    <message>
        <source>Postcard</source>
        <translation>Bưu thiếp</translation>
    </message>
    <message>
        <source>Quarto</source>
        <translation>Quarto</translation>
    </message>
    <message>
        <source>Statement</source>
        <translation>Statement</translation>
    </message>
    <message>
        <source>Super A</source>
        <translation>Super A</translation>
    </message>
    <message>
        <source>Super B</source>
        <translation>Super B</translation>
    </message>
    <message>
        <source>Tabloid / ANSI B</source>
        <translation>Tabloid / ANSI B</translation>
    </message>
    <message>
        <source>Tabloid Extra</source>
        <translation>Tabloid Extra</translation>
    </message>
</context>
<context>
    <name>QAbstractFileIconProvider</name>
    <message>
        <source>Drive</source>
        <translation>Ổ đĩa</translation>
    </message>
    <message>
        <source>Folder</source>
        <comment>All other platforms</comment>
        <translation>Thư mục</translation>
    </message>
    <message>
        <source>Shortcut</source>
        <comment>All other platforms</comment>
        <translation>Lối tắt</translation>
    </message>
</context>
<context>
    <name>QTabBar</name>
    <message>
        <source>Scroll Left</source>
        <translation>Cuộn sang trái</translation>
    </message>
    <message>
        <source>Scroll Right</source>
        <translation>Cuộn sang phải</translation>
    </message>
</context>
<!-- Key names stay as the keys are labelled: shortcuts written in them are
     read back through these names. -->
<context>
    <name>QShortcut</name>
    <message>
        <source>Alt</source>
        <translation>Alt</translation>
    </message>
    <message>
        <source>Backspace</source>
        <translation>Backspace</translation>
    </message>
    <message>
        <source>Backtab</source>
        <translation>Backtab</translation>
    </message>
    <message>
        <source>Ctrl</source>
        <translation>Ctrl</translation>
    </message>
    <message>
        <source>+</source>
        <translation>+</translation>
    </message>
    <message>
        <source>Del</source>
        <translation>Del</translation>
    </message>
    <message>
        <source>End</source>
        <translation>End</translation>
    </message>
    <message>
        <source>Enter</source>
        <translation>Enter</translation>
    </message>
    <message>
        <source>Esc</source>
        <translation>Esc</translation>
    </message>
    <message>
        <source>Home</source>
        <translation>Home</translation>
    </message>
    <message>
        <source>Ins</source>
        <translation>Ins</translation>
    </message>
    <message>
        <source>Left</source>
        <translation>Left</translation>
    </message>
    <message>
        <source>Meta</source>
        <translation>Meta</translation>
    </message>
    <message>
        <source>Num</source>
        <translation>Num</translation>
    </message>
    <message>
        <source>Pause</source>
        <translation>Pause</translation>
    </message>
    <message>
        <source>Print</source>
        <translation>Print</translation>
    </message>
    <message>
        <source>Return</source>
        <translation>Return</translation>
    </message>
    <message>
        <source>Right</source>
        <translation>Right</translation>
    </message>
    <message>
        <source>Shift</source>
        <translation>Shift</translation>
    </message>
    <message>
        <source>Space</source>
        <translation>Space</translation>
    </message>
    <message>
        <source>SysReq</source>
        <translation>SysReq</translation>
    </message>
    <message>
        <source>Tab</source>
        <translation>Tab</translation>
    </message>
    <message>
        <source>Up</source>
        <translation>Up</translation>
    </message>
</context>
<context>
    <name>QGuiApplication</name>
    <message>
        <source>QT_LAYOUT_DIRECTION</source>
        <comment>Translate this string to the string &apos;LTR&apos; in left-to-right languages or to &apos;RTL&apos; in right-to-left languages (such as Hebrew and Arabic) to get proper widget layout.</comment>
        <translation>LTR</translation>
    </message>
</context>
<context>
    <name>QImageWriter</name>
    <message>
        <source>Unknown error</source>
        <translation>Lỗi không rõ</translation>
    </message>
</context>
</TS>
