#include "ui/editor.h"

#include <QDir>
#include <QFile>
#include <QFileDialog>
#include <QFileInfo>
#include <QFontDatabase>
#include <QGuiApplication>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QScreen>
#include <QTextDocument>
#include <string>

#include "core/lines.h"
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

void Tell(const Asker& ask, const QString& path) {
  ask(Q(msg::kCannotWrite) + QDir::toNativeSeparators(path), MsgIcon::Critical, MsgButtons::Ok);
}

}  // namespace

QString DecodeForScreen(const QByteArray& bytes) {
  const std::string utf8 = Tcvn3ToUtf8(std::string_view(bytes.constData(), bytes.size()));
  return ScreenLines(Q(utf8));
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
                    const QString& text) {
  if (ask(Q(kOverwrite), MsgIcon::Question, MsgButtons::YesNo, true) != MsgAnswer::Yes) {
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
                         out.write(bytes) == bytes.size() && out.flush();
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
  const bool hadTarget = QFile::exists(target);
  if (hadTarget && !QFile::rename(target, backup)) {
    QFile::remove(scratch);
    Tell(ask, target);
    return false;
  }
  if (!QFile::rename(scratch, target)) {
    if (hadTarget) QFile::rename(backup, target);
    QFile::remove(scratch);
    Tell(ask, target);
    return false;
  }
  return true;
}

TextWindow::TextWindow(const Asker& ask, Timthay& finder, int ktra, const char* boxName,
                       const char* saveName, const char* findName, QWidget* parent)
    : Window(parent), ask_(ask), finder_(finder), ktra_(ktra) {
  text_ = new QPlainTextEdit(this);
  text_->setObjectName(QLatin1String(boxName));
  text_->setFont(QFontDatabase::systemFont(QFontDatabase::FixedFont));
  text_->setLineWrapMode(QPlainTextEdit::NoWrap);
  save_ = MakeButton(this, saveName, Q(kSave));
  find_ = MakeButton(this, findName, Q(kFind));
}

void TextWindow::showText(const QString& path, const QString& backup, std::string_view caption,
                          const QString& text) {
  file_ = path;
  backup_ = backup;
  text_->setPlainText(text);
  setWindowTitle(Q(caption) + QDir::toNativeSeparators(path));
  show();
  raise();
}

void TextWindow::save() {
  if (file_.isEmpty()) return;
  SaveWithBackup(ask_, file_, backup_, BoxText(text_));
}

void TextWindow::find() { finder_.open(ktra_); }

Xem::Xem(const Asker& ask, Timthay& finder, QWidget* parent)
    : TextWindow(ask, finder, 2, "txtxem", "ghixem", "Timxem", parent) {
  setObjectName(QStringLiteral("xem"));
  setWindowTitle(Q(kViewerCaption));
  // No cancel button: Esc must not close the viewer and drop its edits.
  thoat_ = MakeButton(this, "thoat", Q(kExit));
  Place(this, false, thoat_->sizeHint().height());
  connect(save_, &QPushButton::clicked, this, &Xem::ghixem_Click);
  connect(find_, &QPushButton::clicked, this, &Xem::Timxem_Click);
  connect(thoat_, &QPushButton::clicked, this, &Xem::thoat_Click);
}

void Xem::showFile(const QString& path, const QString& text) {
  // The backup keeps the whole name, so a report's backup never replaces the
  // field book's "name.bak".
  showText(path, path + QStringLiteral(".bak"), kMoreAboutFile, text);
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
  xemfile_ = MakeButton(this, "xemfile", Q(kViewFile));
  xemfile_->setDefault(true);
  thoat_ = MakeButton(this, "thoat", Q(kExit));
  setCancelButton(thoat_);
  chooser_ = [this](const QString& folder, const QString& proposed) {
    QFileDialog dialog(this, Q(kViewFile), folder);
    dialog.setFileMode(QFileDialog::ExistingFile);
    dialog.selectFile(proposed);
    if (dialog.exec() != QDialog::Accepted || dialog.selectedFiles().isEmpty()) return proposed;
    return dialog.selectedFiles().first();
  };
  Place(this, true, thoat_->sizeHint().height());
  connect(save_, &QPushButton::clicked, this, &Suasl::ghi_Click);
  connect(find_, &QPushButton::clicked, this, &Suasl::timkiem_Click);
  connect(xemfile_, &QPushButton::clicked, this, &Suasl::xemfile_Click);
  connect(thoat_, &QPushButton::clicked, this, &Suasl::thoat_Click);
}

void Suasl::openFile(const QString& filesl, const QString& daufile, const QString& tentm,
                     const QString& text) {
  // The file is kept as it was opened: a later click in the main window's
  // file list must not send this text over another file.
  tentm_ = tentm;
  showText(filesl, daufile + QStringLiteral(".bak"), kDataOfFile, text);
}

void Suasl::xemfile_Click() {
  const QString proposed = Q(kErrPattern);
  const QString chosen = chooser_ ? chooser_(tentm_, proposed) : QString();
  if (chosen.isEmpty() || chosen == proposed) return;
  const std::optional<std::string> bytes = ReadFileBytes(chosen.toStdString());
  if (!bytes) {
    ask_(Q(msg::kCannotOpen) + QDir::toNativeSeparators(chosen), MsgIcon::Critical, MsgButtons::Ok);
    return;
  }
  viewer_.showFile(chosen, DecodeForScreen(QByteArray(bytes->data(), bytes->size())));
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
