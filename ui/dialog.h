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
// for its columns, starting in folder with the first filter.
void SetUpFileDialog(QFileDialog& dialog, const QStringList& filters);
// That dialog shown: the chosen path, or the empty text when cancelled.
QString ChooseFile(QWidget* parent, const QString& caption, const QString& folder,
                   const QStringList& filters);

// Qt's own texts in Vietnamese from the translation "kavu_vi.qm" in folder;
// false when it is not there.
bool InstallTranslation(const QString& folder);

// A file the program ships (the help, the translation): beside the program in
// the build folder, in share/kavu/ once installed. When neither exists, the
// one beside the program, for the message that names it.
QString ProgramDataFile(const QString& name);

// A push button with its object name and caption.
QPushButton* MakeButton(QWidget* parent, const char* name, const QString& caption);

}  // namespace kavu::ui
