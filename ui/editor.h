// The data editor suasl and the viewer xem: plain texts of TCVN3 files shown
// in Unicode, saved back with a backup.
#pragma once

#include <QByteArray>
#include <QString>
#include <functional>
#include <string_view>

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

// What the viewer and the editor share: a file's text in a box, saved over
// the file with a backup, searched by the find window.
class TextWindow : public Window {
  Q_OBJECT
 public:
  QString file() const { return file_; }
  void thoat_Click() { close(); }

 protected:
  // Builds the text box, then the save and find buttons (in that tab order);
  // ktra tells the find window which text it works on.
  TextWindow(const Asker& ask, Timthay& finder, int ktra, const char* boxName, const char* saveName,
             const char* findName, QWidget* parent);
  // Shows a file's text, captioned with the file's name behind caption; saves
  // go to path, its old content to backup.
  void showText(const QString& path, const QString& backup, std::string_view caption,
                const QString& text);
  void save();
  void find();

  const Asker& ask_;
  QPlainTextEdit* text_;
  QPushButton* save_;
  QPushButton* find_;
  QPushButton* thoat_ = nullptr;

 private:
  Timthay& finder_;
  int ktra_;
  QString file_, backup_;
};

class Xem : public TextWindow {
  Q_OBJECT
 public:
  Xem(const Asker& ask, Timthay& finder, QWidget* parent = nullptr);
  QPlainTextEdit* txtxem() const { return text_; }
  // Shows a file's text; its saves go to that file, the backup beside it.
  void showFile(const QString& path, const QString& text);

  void ghixem_Click() { save(); }
  void Timxem_Click() { find(); }

 protected:
  void resizeEvent(QResizeEvent* event) override;  // Form_Resize
};

class Suasl : public TextWindow {
  Q_OBJECT
 public:
  Suasl(const Asker& ask, Timthay& finder, Xem& viewer, QWidget* parent = nullptr);
  QPlainTextEdit* txtsuasl() const { return text_; }
  void setChooser(FileChooser chooser) { chooser_ = std::move(chooser); }

  // The main window's file: its path, the base name of its backup, and its
  // folder (where the viewer's dialog starts).
  void openFile(const QString& filesl, const QString& daufile, const QString& tentm,
                const QString& text);

  void ghi_Click() { save(); }
  void timkiem_Click() { find(); }
  void xemfile_Click();

 protected:
  void resizeEvent(QResizeEvent* event) override;  // Form_Resize

 private:
  Xem& viewer_;
  FileChooser chooser_;
  QString tentm_;
  QPushButton* xemfile_;
};

}  // namespace kavu::ui
