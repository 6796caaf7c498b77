// A window of the program: Enter presses its default button, Esc its cancel
// button, or closes it when it has none; closing it runs its own closing
// steps.
#pragma once

#include <QDialog>
#include <QString>
#include <QStringList>

class QDateTime;
class QFileDialog;
class QPushButton;

namespace kavu::ui {

class Window : public QDialog {
  Q_OBJECT
 public:
  explicit Window(QWidget* parent = nullptr);

 protected:
  void setCancelButton(QPushButton* button) { cancel_ = button; }
  void keyPressEvent(QKeyEvent* event) override;
  // Closing goes through closeEvent only, never through reject().
  void reject() override;
  void closeEvent(QCloseEvent* event) override;

 private:
  QPushButton* cancel_ = nullptr;
};

// The open-file dialog with Vietnamese labels, in detail view and wide enough
// for its columns, starting in folder with the first filter; the file list's
// headings, sizes and dates in Vietnamese.
void SetUpFileDialog(QFileDialog& dialog, const QStringList& filters);
// That dialog shown: the chosen path, or the empty text when cancelled.
QString ChooseFile(QWidget* parent, const QString& caption, const QString& folder,
                   const QStringList& filters);

// The window program shown in Vietnamese: Qt's own texts from the translation
// "kavu_vi.qm" in folder (false when it is not there), Vietnam's locale as the
// default one (the names of file types), and every file dialog, also those
// Qt's static functions make, Qt's own with the file list as SetUpFileDialog
// shows it. Numbers the program writes never go through the locale.
bool UseVietnamese(const QString& folder);

// The file list's date: day/month/year and the time, as Vietnamese writes it.
QString FileDateText(const QDateTime& time);
// The file list's size: bytes below 1 KB, else one decimal (with a comma)
// of the largest unit of 1024 below it: "512 byte", "1,5 KB", "2,0 MB".
QString FileSizeText(qint64 bytes);

// A file the program ships (the help, the translation): beside the program in
// the build folder, in share/kavu/ once installed. When neither exists, the
// one beside the program, for the message that names it.
QString ProgramDataFile(const QString& name);

// A push button with its object name and caption.
QPushButton* MakeButton(QWidget* parent, const char* name, const QString& caption);

}  // namespace kavu::ui
