// The data editor suasl and the viewer xem: plain texts of TCVN3 files shown
// in Unicode, saved back with a backup.
#pragma once

#include <QByteArray>
#include <QDateTime>
#include <QPlainTextEdit>
#include <QString>
#include <cstdint>
#include <functional>
#include <optional>
#include <string_view>
#include <vector>

#include "ui/dialog.h"

class QPushButton;
class QTextBlock;

namespace kavu::ui {

class Asker;
class Timthay;

// A file's TCVN3 bytes as screen text (every line end becomes LF).
QString DecodeForScreen(const QByteArray& bytes);
// A whole file as screen text; nothing when it cannot be read.
std::optional<QString> ReadScreenText(const QString& path);
// Screen text as the file's TCVN3 bytes with CR LF line ends; a final line
// break is added only when the text does not end with one.
QByteArray EncodeForFile(const QString& text);

// Asks (unless confirmed already), then keeps the old content of target as
// backup (as target + ".bak" when backup names target itself) and writes text
// over target. The new text goes to a scratch file first, flushed, so a
// failing write or rename leaves the original or its backup in place; the
// user is told. True when the text was saved.
bool SaveWithBackup(const Asker& ask, const QString& target, const QString& backup,
                    const QString& text, bool confirmed = false);

// The point a line of the error report names ("Diem P12 ...", "Diem: P12 ...",
// "Tram K3 ..."), or the empty text.
QString PointOfReportLine(const QString& line);
// The first field of a record (the point's name), as the field splitter reads
// it.
QString FirstField(const QString& line);

// A plain-text box with the line numbers in a margin on its left.
class NumberedText : public QPlainTextEdit {
 public:
  explicit NumberedText(QWidget* parent = nullptr);
  int marginWidth() const;

 protected:
  void resizeEvent(QResizeEvent* event) override;

 private:
  friend class LineNumbers;
  void paintMargin(QPaintEvent* event);
  void fitMargin();
  QWidget* margin_;
  int marginShown_ = -1;
};

// Chooses a file to view: the folder to start in and the proposed name; the
// empty text or the proposed name itself when nothing was chosen.
using FileChooser = std::function<QString(const QString& folder, const QString& proposed)>;

// What the viewer and the editor share: a file's text in a box, saved over
// the file with a backup, searched by the find window.
class TextWindow : public Window {
  Q_OBJECT
 public:
  QString file() const { return file_; }
  // Closes the window; unsaved edits are saved or dropped as the user says.
  void thoat_Click() { close(); }
  // Asks whether to save unsaved edits: true when they are saved or may be
  // dropped, false when the user stays (or the save failed).
  bool maySave();
  // The text shown differs from the file's as last read or saved; the title
  // marks it.
  bool hasUnsavedEdits() const;

 protected:
  // Builds the text box, then the save and find buttons (in that tab order);
  // ktra tells the find window which text it works on.
  TextWindow(const Asker& ask, Timthay& finder, int ktra, const char* boxName, const char* saveName,
             const char* findName, QWidget* parent);
  // Shows a file's text, captioned with the file's name behind caption; saves
  // go to path, its old content to backup.
  // False, and nothing changed, when the user keeps unsaved edits.
  bool showText(const QString& path, const QString& backup, std::string_view caption,
                const QString& text);
  bool save(bool confirmed = false);
  void find();
  void closeEvent(QCloseEvent* event) override;
  // The whole line of the text box's block selected and shown.
  void selectLine(const QTextBlock& block);

  const Asker& ask_;
  QPlainTextEdit* text_;
  QPushButton* save_;
  QPushButton* find_;
  QPushButton* thoat_ = nullptr;

 private:
  void showTitle();

  Timthay& finder_;
  int ktra_;
  QString file_, backup_;
  std::string_view caption_;
};

class Xem : public TextWindow {
  Q_OBJECT
 public:
  Xem(const Asker& ask, Timthay& finder, QWidget* parent = nullptr);
  QPlainTextEdit* txtxem() const { return text_; }
  // Shows a file's text; its saves go to that file, the backup beside it.
  void showFile(const QString& path, const QString& text);
  // The error report a run has just written and, for each of its lines, the
  // field-book line of the record it concerns (0 for none), once the report
  // is in place. While the viewer shows that report as the run wrote it, a
  // double click on one of its lines opens the record itself; a viewer that
  // shows the report's file without edits shows the new report.
  void setRunReport(const QString& reportPath, std::vector<std::uint32_t> bookLines);
  // Called with the report's path, the point that a double-clicked line
  // names and the field-book line of its record (0 when not known: the record
  // is found by the point's name).
  using PointOpener =
      std::function<void(const QString& report, const QString& point, std::uint32_t line)>;
  void setPointOpener(PointOpener opener) { openPoint_ = std::move(opener); }

  void ghixem_Click() { save(); }
  void Timxem_Click() { find(); }

 protected:
  void resizeEvent(QResizeEvent* event) override;  // Form_Resize
  bool eventFilter(QObject* watched, QEvent* event) override;

 private:
  // A file's size and time of change: whether it is still as it was.
  struct Stamp {
    qint64 size = -1;
    QDateTime changed;
    bool operator==(const Stamp&) const = default;
  };
  static Stamp StampOf(const QString& path);
  // The record line of the report's block, when the report's map holds.
  std::uint32_t bookLineOf(int block) const;

  PointOpener openPoint_;
  Stamp shown_;  // the file shown, as it was read
  QString runReport_;
  Stamp runReportStamp_;
  std::vector<std::uint32_t> bookLines_;
};

class Suasl : public TextWindow {
  Q_OBJECT
 public:
  Suasl(const Asker& ask, Timthay& finder, Xem& viewer, QWidget* parent = nullptr);
  QPlainTextEdit* txtsuasl() const { return text_; }
  void setChooser(FileChooser chooser) { chooser_ = std::move(chooser); }

  // The main window's file: its path, the base name of its backup, and its
  // folder (where the viewer's dialog starts).
  // False when the user kept the unsaved edits of the file shown.
  bool openFile(const QString& filesl, const QString& daufile, const QString& tentm,
                const QString& text);
  // The field book at the first record of a point (from a line of its error
  // report), that line selected; false when the book or the point is not
  // there.
  bool showPoint(const QString& book, const QString& point);
  // The field book at a line (from 1), that line selected; false when the book
  // or the line is not there.
  bool showLine(const QString& book, std::uint32_t line);
  // The field book an error report is about: the file shown when the report
  // is its own ("job1.err" of "job1.asc"), else the report's name with ".asc".
  QString bookOf(const QString& report) const;

  void ghi_Click() { save(); }
  void timkiem_Click() { find(); }
  void xemfile_Click();

 protected:
  void resizeEvent(QResizeEvent* event) override;  // Form_Resize

 private:
  // The book shown (read first when another file is shown or the editor is
  // closed); false when it could not be or the user kept unsaved edits.
  bool showBook(const QString& book);

  Xem& viewer_;
  FileChooser chooser_;
  QString tentm_, daufile_;
  QPushButton* xemfile_;
};

}  // namespace kavu::ui
