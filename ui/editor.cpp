#include "ui/editor.h"

#include <QDir>
#include <QFile>
#include <QFileDialog>
#include <QFileInfo>
#include <QFontDatabase>
#include <QGuiApplication>
#include <QMouseEvent>
#include <QPainter>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QScreen>
#include <QShortcut>
#include <QTextBlock>
#include <QTextDocument>
#include <array>
#include <cstring>
#include <filesystem>
#include <string>
#include <system_error>
#ifdef _WIN32
#include <io.h>
#else
#include <unistd.h>
#endif

#include "core/messages.h"
#include "core/tcvn3.h"
#include "ui/ask.h"
#include "ui/texts.h"
#include "ui/timthay.h"

namespace kavu::ui {
namespace {

// The layouts are given in twips; at 96 dots per inch a pixel is 15 twips.
int Px(double twips) { return static_cast<int>(twips / 15.0); }

// Placement on load: the editor the right two fifths of the screen, the
// viewer the left three fifths, both as high as the screen less a button.
void Place(QWidget* window, bool rightPart, int buttonHeight) {
  const QScreen* screen = QGuiApplication::primaryScreen();
  if (screen == nullptr) return;
  const QRect area = screen->availableGeometry();
  const int fifth = area.width() / 5;
  const int width = rightPart ? fifth * 2 : fifth * 3;
  window->resize(width, area.height() - buttonHeight);
  window->move(area.left() + (rightPart ? fifth * 3 : 0), area.top());
}

// The text box's text as it stands: toPlainText would turn a no-break space
// (the TCVN3 byte 0xA0) into an ordinary one, so a file saved unchanged would
// change.
QString BoxText(const QPlainTextEdit* box) { return box->document()->toRawText(); }

// The written bytes on the disk before the file takes the place of the old.
bool SyncToDisk(int handle) {
#ifdef _WIN32
  return _commit(handle) == 0;
#else
  return ::fsync(handle) == 0;
#endif
}

void Tell(const Asker& ask, const QString& path) {
  ask(Q(msg::kCannotWrite) + QDir::toNativeSeparators(path), MsgIcon::Critical, MsgButtons::Ok);
}

}  // namespace

QString DecodeForScreen(const QByteArray& bytes) {
  // Every TCVN3 byte is one character of the screen's text: a table of the
  // 256, then one pass over the file (a field book may have 20 MB).
  static const std::array<char16_t, 256> kScreen = [] {
    std::array<char16_t, 256> table{};
    for (int b = 0; b < 256; ++b) {
      const QString one = Q(Tcvn3ToUtf8(std::string(1, static_cast<char>(b))));
      table[static_cast<std::size_t>(b)] = one.size() == 1 ? one[0].unicode() : u'?';
    }
    return table;
  }();
  QString text(bytes.size(), Qt::Uninitialized);
  QChar* out = text.data();
  qsizetype n = 0;
  const qsizetype size = bytes.size();
  for (qsizetype i = 0; i < size; ++i) {
    const auto b = static_cast<unsigned char>(bytes[i]);
    if (b == '\r') {
      // CR LF and a lone CR each end a line.
      if (i + 1 < size && bytes[i + 1] == '\n') ++i;
      out[n++] = QLatin1Char('\n');
    } else {
      out[n++] = QChar(kScreen[b]);
    }
  }
  text.truncate(n);
  return text;
}

std::optional<QString> ReadScreenText(const QString& path) {
  QFile file(path);
  if (!file.open(QIODevice::ReadOnly)) return std::nullopt;
  const QByteArray bytes = file.readAll();
  if (file.error() != QFileDevice::NoError) return std::nullopt;
  return DecodeForScreen(bytes);
}

QByteArray EncodeForFile(const QString& text) {
  QString lines = text;
  lines.replace(QChar::ParagraphSeparator, QLatin1Char('\n'));
  lines.replace(QChar::LineSeparator, QLatin1Char('\n'));
  lines.replace(QLatin1Char('\n'), QStringLiteral("\r\n"));
  if (!lines.endsWith(QStringLiteral("\r\n"))) lines += QStringLiteral("\r\n");
  const QByteArray utf8 = lines.toUtf8();
  const std::string bytes = Utf8ToTcvn3(std::string_view(utf8.constData(), utf8.size()));
  return QByteArray(bytes.data(), static_cast<qsizetype>(bytes.size()));
}

bool SaveWithBackup(const Asker& ask, const QString& target, const QString& wantedBackup,
                    const QString& text, bool confirmed) {
  if (!confirmed &&
      ask(Q(kOverwrite), MsgIcon::Question, MsgButtons::YesNo, true) != MsgAnswer::Yes) {
    return false;
  }
  // A backup named like the file itself ("job1.bak" opened in the editor)
  // would delete the very content it is to keep: it takes the whole name then.
  const QString backup =
      QFileInfo(wantedBackup) == QFileInfo(target) ? target + QStringLiteral(".bak") : wantedBackup;
  const QString scratch = target + QStringLiteral(".kavu-new");
  {
    QFile out(scratch);
    const QByteArray bytes = EncodeForFile(text);
    const bool written = out.open(QIODevice::WriteOnly | QIODevice::Truncate) &&
                         out.write(bytes) == bytes.size() && out.flush() &&
                         SyncToDisk(out.handle());
    out.close();
    if (!written || out.error() != QFileDevice::NoError) {
      QFile::remove(scratch);
      Tell(ask, target);
      return false;
    }
  }
  if (QFile::exists(backup) && !QFile::remove(backup)) {
    QFile::remove(scratch);
    Tell(ask, backup);
    return false;
  }
  // The old content is copied, not moved, to the backup: the file itself is
  // there at every moment, then replaced by the new text in one step.
  if (QFile::exists(target) && !QFile::copy(target, backup)) {
    QFile::remove(scratch);
    Tell(ask, backup);
    return false;
  }
  std::error_code failed;
  std::filesystem::rename(scratch.toStdU16String(), target.toStdU16String(), failed);
  if (failed) {
    QFile::remove(scratch);
    Tell(ask, target);
    return false;
  }
  return true;
}

QString PointOfReportLine(const QString& line) {
  const QString trimmed = line.trimmed();
  for (const char* lead : {"Diem: ", "Diem ", "Tram ", "Cac diem mia "}) {
    if (!trimmed.startsWith(QLatin1String(lead))) continue;
    return trimmed.mid(qsizetype(std::strlen(lead)))
        .section(QLatin1Char(' '), 0, 0, QString::SectionSkipEmpty);
  }
  return {};
}

QString FirstField(const QString& line) {
  // As the field splitter reads a record: tabs are blanks, runs of blanks one.
  return line.simplified().section(QLatin1Char(' '), 0, 0);
}

class LineNumbers : public QWidget {
 public:
  explicit LineNumbers(NumberedText* text) : QWidget(text), text_(text) {}
  QSize sizeHint() const override { return {text_->marginWidth(), 0}; }

 protected:
  void paintEvent(QPaintEvent* event) override { text_->paintMargin(event); }

 private:
  NumberedText* text_;
};

NumberedText::NumberedText(QWidget* parent) : QPlainTextEdit(parent) {
  margin_ = new LineNumbers(this);
  margin_->setObjectName(QStringLiteral("lineNumbers"));
  connect(this, &QPlainTextEdit::blockCountChanged, this, &NumberedText::fitMargin);
  connect(this, &QPlainTextEdit::updateRequest, this, [this](const QRect& rect, int dy) {
    if (dy != 0) {
      margin_->scroll(0, dy);
    } else {
      margin_->update(0, rect.y(), margin_->width(), rect.height());
    }
  });
  fitMargin();
}

void NumberedText::fitMargin() {
  const int width = marginWidth();
  if (width == marginShown_) return;
  marginShown_ = width;
  setViewportMargins(width, 0, 0, 0);
}

int NumberedText::marginWidth() const {
  int digits = 1;
  for (int count = std::max(1, blockCount()); count >= 10; count /= 10) ++digits;
  return 6 + fontMetrics().horizontalAdvance(QLatin1Char('9')) * std::max(digits, 3);
}

void NumberedText::resizeEvent(QResizeEvent* event) {
  QPlainTextEdit::resizeEvent(event);
  const QRect inner = contentsRect();
  margin_->setGeometry(inner.left(), inner.top(), marginWidth(), inner.height());
}

void NumberedText::paintMargin(QPaintEvent* event) {
  QPainter painter(margin_);
  painter.fillRect(event->rect(), palette().color(QPalette::AlternateBase));
  painter.setPen(palette().color(QPalette::PlaceholderText));
  QTextBlock block = firstVisibleBlock();
  int top = qRound(blockBoundingGeometry(block).translated(contentOffset()).top());
  const int right = margin_->width() - 3;
  while (block.isValid() && top <= event->rect().bottom()) {
    const int height = qRound(blockBoundingRect(block).height());
    if (block.isVisible() && top + height >= event->rect().top()) {
      painter.drawText(0, top, right, fontMetrics().height(), Qt::AlignRight,
                       QString::number(block.blockNumber() + 1));
    }
    top += height;
    block = block.next();
  }
}

TextWindow::TextWindow(const Asker& ask, Timthay& finder, int ktra, const char* boxName,
                       const char* saveName, const char* findName, QWidget* parent)
    : Window(parent), ask_(ask), finder_(finder), ktra_(ktra) {
  text_ = new NumberedText(this);
  text_->setObjectName(QLatin1String(boxName));
  text_->setFont(QFontDatabase::systemFont(QFontDatabase::FixedFont));
  text_->setLineWrapMode(QPlainTextEdit::NoWrap);
  save_ = MakeButton(this, saveName, Q(kSave));
  save_->setToolTip(Q(kSaveTip));
  find_ = MakeButton(this, findName, Q(kFind));
  find_->setToolTip(Q(kFindTip));
  connect(text_, &QPlainTextEdit::modificationChanged, this, &TextWindow::showTitle);
  // What a text editor's user presses without thinking.
  const auto key = [this](QKeySequence sequence, auto action) {
    auto* shortcut = new QShortcut(sequence, this);
    shortcut->setContext(Qt::WindowShortcut);
    connect(shortcut, &QShortcut::activated, this, action);
  };
  key(QKeySequence::Save, [this] { save(); });
  key(QKeySequence::Find, [this] { find(); });
  key(QKeySequence(Qt::Key_F3), [this] { finder_.findNext(ktra_); });
}

bool TextWindow::showText(const QString& path, const QString& backup, std::string_view caption,
                          const QString& text) {
  if (!maySave()) {
    show();
    raise();
    return false;
  }
  file_ = path;
  backup_ = backup;
  caption_ = caption;
  text_->setPlainText(text);
  text_->document()->setModified(false);
  showTitle();
  show();
  raise();
  return true;
}

bool TextWindow::save(bool confirmed) {
  if (file_.isEmpty()) return false;
  if (!SaveWithBackup(ask_, file_, backup_, BoxText(text_), confirmed)) return false;
  text_->document()->setModified(false);
  return true;
}

bool TextWindow::hasUnsavedEdits() const {
  return !file_.isEmpty() && text_->document()->isModified();
}

void TextWindow::showTitle() {
  if (file_.isEmpty()) return;
  // As desktop editors mark a file with unsaved edits: "*" before its name.
  const QString mark = hasUnsavedEdits() ? Q(kUnsavedMark) : QString();
  setWindowTitle(Q(caption_) + mark + QDir::toNativeSeparators(file_));
}

void TextWindow::selectLine(const QTextBlock& block) {
  QTextCursor cursor(block);
  cursor.movePosition(QTextCursor::EndOfBlock, QTextCursor::KeepAnchor);
  text_->setTextCursor(cursor);
  text_->centerCursor();
}

bool TextWindow::maySave() {
  if (file_.isEmpty() || !text_->document()->isModified()) return true;
  switch (ask_(Q(kSaveChanges) + QDir::toNativeSeparators(file_) + QStringLiteral("?"),
               MsgIcon::Question, MsgButtons::YesNoCancel)) {
    case MsgAnswer::Yes:
      return save(true);
    case MsgAnswer::No:
      text_->document()->setModified(false);
      return true;
    case MsgAnswer::Ok:
    case MsgAnswer::Cancel:
      break;
  }
  return false;
}

void TextWindow::closeEvent(QCloseEvent* event) {
  if (!isVisible() || maySave()) {
    event->accept();
  } else {
    event->ignore();
  }
}

void TextWindow::find() { finder_.open(ktra_); }

Xem::Xem(const Asker& ask, Timthay& finder, QWidget* parent)
    : TextWindow(ask, finder, 2, "txtxem", "ghixem", "Timxem", parent) {
  setObjectName(QStringLiteral("xem"));
  setWindowTitle(Q(kViewerCaption));
  thoat_ = MakeButton(this, "thoat", Q(kExitButton));
  thoat_->setToolTip(Q(kCloseTip));
  // Esc closes it as it does the editor, asking first about unsaved edits.
  setCancelButton(thoat_);
  setMinimumSize(Px(3800 + 200), Px(2400));
  Place(this, false, thoat_->sizeHint().height());
  text_->viewport()->installEventFilter(this);
  connect(save_, &QPushButton::clicked, this, &Xem::ghixem_Click);
  connect(find_, &QPushButton::clicked, this, &Xem::Timxem_Click);
  connect(thoat_, &QPushButton::clicked, this, &Xem::thoat_Click);
}

void Xem::showFile(const QString& path, const QString& text) {
  // The backup keeps the whole name, so a report's backup never replaces the
  // field book's "name.bak".
  const bool shown = showText(path, path + QStringLiteral(".bak"), kMoreAboutFile, text);
  if (shown) shown_ = StampOf(path);
}

Xem::Stamp Xem::StampOf(const QString& path) {
  const QFileInfo info(path);
  if (!info.exists()) return {};
  return {info.size(), info.lastModified()};
}

void Xem::setRunReport(const QString& reportPath, std::vector<std::uint32_t> bookLines) {
  runReport_ = reportPath;
  runReportStamp_ = StampOf(reportPath);
  bookLines_ = std::move(bookLines);
  // The report on the screen becomes the run's, unless it holds edits of the
  // user's.
  if (!isVisible() || hasUnsavedEdits() || QFileInfo(file()) != QFileInfo(reportPath)) return;
  if (const std::optional<QString> text = ReadScreenText(reportPath)) {
    text_->setPlainText(*text);
    text_->document()->setModified(false);
    shown_ = StampOf(reportPath);
  }
}

std::uint32_t Xem::bookLineOf(int block) const {
  // The map tells the lines of the report the run wrote: of no use once the
  // report shown was edited (here, or saved since), or is an earlier one.
  if (bookLines_.empty() || file().isEmpty() || QFileInfo(file()) != QFileInfo(runReport_) ||
      hasUnsavedEdits() || runReportStamp_.size < 0 || shown_ != runReportStamp_ ||
      StampOf(file()) != runReportStamp_) {
    return 0;
  }
  return block >= 0 && static_cast<std::size_t>(block) < bookLines_.size()
             ? bookLines_[static_cast<std::size_t>(block)]
             : 0;
}

bool Xem::eventFilter(QObject* watched, QEvent* event) {
  // A double click on a line of the error report shows the record it is
  // about; without the run's map, the first record of the point it names.
  if (watched == text_->viewport() && event->type() == QEvent::MouseButtonDblClick && openPoint_) {
    const auto* click = static_cast<QMouseEvent*>(event);
    const QTextBlock block = text_->cursorForPosition(click->position().toPoint()).block();
    const QString point = PointOfReportLine(block.text());
    const std::uint32_t line = bookLineOf(block.blockNumber());
    if (line > 0 || !point.isEmpty()) {
      openPoint_(file(), point, line);
      return true;
    }
  }
  return TextWindow::eventFilter(watched, event);
}

void Xem::resizeEvent(QResizeEvent* event) {
  Window::resizeEvent(event);
  const int w = width();
  const int h = height();
  const int b = thoat_->sizeHint().height();
  text_->setGeometry(0, 0, w, std::max(0, h - 2 * b));
  const int bw = Px(1200);
  save_->setGeometry(w / 2 - Px(1900), h - b * 3 / 2, bw, b);
  find_->setGeometry(w / 2 - Px(600), h - b * 3 / 2, bw, b);
  thoat_->setGeometry(w / 2 + Px(700), h - b * 3 / 2, bw, b);
}

Suasl::Suasl(const Asker& ask, Timthay& finder, Xem& viewer, QWidget* parent)
    : TextWindow(ask, finder, 1, "txtsuasl", "ghi", "timkiem", parent), viewer_(viewer) {
  setObjectName(QStringLiteral("suasl"));
  setWindowTitle(Q(kEditorCaption));
  xemfile_ = MakeButton(this, "xemfile", Q(kViewFileButton));
  xemfile_->setToolTip(Q(kViewFileTip));
  xemfile_->setDefault(true);
  thoat_ = MakeButton(this, "thoat", Q(kExitButton));
  thoat_->setToolTip(Q(kCloseTip));
  setCancelButton(thoat_);
  chooser_ = [this](const QString& folder, const QString& proposed) {
    const QString chosen = ChooseFile(this, Q(kViewFile), folder, {Q(kErrFiles), Q(kAllFiles)});
    return chosen.isEmpty() ? proposed : chosen;
  };
  // The four buttons side by side, with a margin.
  setMinimumSize(Px(4300 + 200), Px(2400));
  Place(this, true, thoat_->sizeHint().height());
  viewer_.setPointOpener([this](const QString& report, const QString& point, std::uint32_t line) {
    const QString book = bookOf(report);
    if (line > 0) {
      showLine(book, line);
    } else {
      showPoint(book, point);
    }
  });
  connect(save_, &QPushButton::clicked, this, &Suasl::ghi_Click);
  connect(find_, &QPushButton::clicked, this, &Suasl::timkiem_Click);
  connect(xemfile_, &QPushButton::clicked, this, &Suasl::xemfile_Click);
  connect(thoat_, &QPushButton::clicked, this, &Suasl::thoat_Click);
}

bool Suasl::openFile(const QString& filesl, const QString& daufile, const QString& tentm,
                     const QString& text) {
  // The file is kept as it was opened: a later click in the main window's
  // file list must not send this text over another file.
  if (!showText(filesl, daufile + QStringLiteral(".bak"), kDataOfFile, text)) return false;
  tentm_ = tentm;
  daufile_ = daufile;
  return true;
}

QString Suasl::bookOf(const QString& report) const {
  // The run of "job1.asc" reports to "job1.err" (the path before its first
  // "." with ".err"); a file of an instrument is computed as the field book
  // made of it, the report's name with ".asc".
  if (!file().isEmpty() && file().endsWith(QStringLiteral(".asc"), Qt::CaseInsensitive) &&
      QFileInfo(daufile_ + QStringLiteral(".err")) == QFileInfo(report)) {
    return file();
  }
  const QFileInfo info(report);
  return QDir::toNativeSeparators(info.path() + QDir::separator() + info.completeBaseName() +
                                  QStringLiteral(".asc"));
}

bool Suasl::showBook(const QString& book) {
  if (QFileInfo(book) == QFileInfo(file()) && isVisible()) return true;
  const std::optional<QString> text = ReadScreenText(book);
  // The backup base is the path before its first ".", as for the main
  // window's file.
  return text &&
         openFile(book, book.section(QLatin1Char('.'), 0, 0), QFileInfo(book).path(), *text);
}

bool Suasl::showPoint(const QString& book, const QString& point) {
  if (!showBook(book)) return false;
  QTextBlock block = text_->document()->firstBlock();
  while (block.isValid() && FirstField(block.text()) != point) block = block.next();
  if (!block.isValid()) return false;
  selectLine(block);
  show();
  raise();
  activateWindow();
  return true;
}

bool Suasl::showLine(const QString& book, std::uint32_t line) {
  if (line == 0 || !showBook(book)) return false;
  const QTextBlock block = text_->document()->findBlockByNumber(static_cast<int>(line - 1));
  if (!block.isValid()) return false;
  selectLine(block);
  show();
  raise();
  activateWindow();
  return true;
}

void Suasl::xemfile_Click() {
  const QString proposed = Q(kErrPattern);
  const QString chosen = chooser_ ? chooser_(tentm_, proposed) : QString();
  if (chosen.isEmpty() || chosen == proposed) return;
  const std::optional<QString> text = ReadScreenText(chosen);
  if (!text) {
    ask_(Q(msg::kCannotOpen) + QDir::toNativeSeparators(chosen), MsgIcon::Critical, MsgButtons::Ok);
    return;
  }
  viewer_.showFile(chosen, *text);
}

void Suasl::resizeEvent(QResizeEvent* event) {
  Window::resizeEvent(event);
  const int w = width();
  const int h = height();
  text_->setGeometry(0, 0, w, std::max(0, h - Px(700)));
  const int top = h - Px(525);
  const int bw = Px(1000);
  const int bh = std::min(thoat_->sizeHint().height(), Px(450));
  save_->setGeometry(w / 2 - Px(2150), top, bw, bh);
  find_->setGeometry(w / 2 - Px(1050), top, bw, bh);
  xemfile_->setGeometry(w / 2 + Px(50), top, bw, bh);
  thoat_->setGeometry(w / 2 + Px(1150), top, bw, bh);
}

}  // namespace kavu::ui
