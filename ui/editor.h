// The data editor suasl and the viewer xem: plain texts of TCVN3 files shown
// in Unicode, saved back with a backup.
#pragma once

#include <QByteArray>
#include <QString>
#include <functional>

#include "ui/dialog.h"

class QPlainTextEdit;
class QPushButton;

namespace kavu::ui {

class Asker;
class Timthay;

// A file's TCVN3 bytes as screen text (every line end becomes LF).
QString DecodeForScreen(const QByteArray& bytes);
// Screen text as the file's TCVN3 bytes with CR LF line ends; a final line
// break is added only when the text does not end with one.
QByteArray EncodeForFile(const QString& text);

// Asks, then keeps the old content of target as backup (as target + ".bak"
// when backup names target itself) and writes text over target. The new text
// goes to a scratch file first, so a failing write or rename leaves the
// original or its backup in place; the user is told. True when the text was
// saved.
bool SaveWithBackup(const Asker& ask, const QString& target, const QString& backup,
                    const QString& text);

// Chooses a file to view: the folder to start in and the proposed name; the
// empty text or the proposed name itself when nothing was chosen.
using FileChooser = std::function<QString(const QString& folder, const QString& proposed)>;

class Xem : public Window {
  Q_OBJECT
 public:
  Xem(const Asker& ask, Timthay& finder, QWidget* parent = nullptr);
  QPlainTextEdit* txtxem() const { return txtxem_; }
  QString file() const { return file_; }
  // Shows a file's text; its saves go to that file, the backup beside it.
  void showFile(const QString& path, const QString& text);

  void ghixem_Click();
  void Timxem_Click();
  void thoat_Click();

 protected:
  void resizeEvent(QResizeEvent* event) override;  // Form_Resize

 private:
  const Asker& ask_;
  Timthay& finder_;
  QString file_;
  QPlainTextEdit* txtxem_;
  QPushButton* ghixem_;
  QPushButton* timxem_;
  QPushButton* thoat_;
};

class Suasl : public Window {
  Q_OBJECT
 public:
  Suasl(const Asker& ask, Timthay& finder, Xem& viewer, QWidget* parent = nullptr);
  QPlainTextEdit* txtsuasl() const { return txtsuasl_; }
  QString file() const { return filesl_; }
  void setChooser(FileChooser chooser) { chooser_ = std::move(chooser); }

  // The main window's file: its path, the base name of its backup, and its
  // folder (where the viewer's dialog starts).
  void openFile(const QString& filesl, const QString& daufile, const QString& tentm,
                const QString& text);

  void ghi_Click();
  void timkiem_Click();
  void xemfile_Click();
  void thoat_Click();

 protected:
  void resizeEvent(QResizeEvent* event) override;  // Form_Resize

 private:
  const Asker& ask_;
  Timthay& finder_;
  Xem& viewer_;
  FileChooser chooser_;
  QString filesl_, daufile_, tentm_;
  QPlainTextEdit* txtsuasl_;
  QPushButton* ghi_;
  QPushButton* timkiem_;
  QPushButton* xemfile_;
  QPushButton* thoat_;
};

}  // namespace kavu::ui
