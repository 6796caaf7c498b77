// The main window kavu: file choice, options, products, and the computation
// run with the window as its host.
#pragma once

#include <QPointer>
#include <QString>
#include <QStringList>
#include <functional>
#include <memory>

#include "core/host.h"
#include "run/run.h"
#include "core/state.h"
#include "ui/ask.h"
#include "ui/dialog.h"

class QBoxLayout;
class QCheckBox;
class QComboBox;
class QLabel;
class QLineEdit;
class QListWidgetItem;
class QMenu;
class QProgressBar;
class QPushButton;

namespace kavu::ui {

class DriveList;
class FileList;
class FolderList;
class MapWindow;
class Nhapsdo;
class RunThread;
class Suasl;
class Timthay;
class Xem;

// A check box's state as the settings store keeps it: 0 clear, 1 ticked,
// 2 grayed.
int BoxState(const QCheckBox* box);

class MainWindow : public Window, public Host {
  Q_OBJECT
 public:
  // Form_Load: builds the controls and restores the settings.
  explicit MainWindow(QWidget* parent = nullptr);
  ~MainWindow() override;

  // Every question of the program's windows goes through this asker.
  Asker& asker() { return ask_; }
  // Called once the program is to end (after the settings are written);
  // quits the application unless replaced.
  void setEndHook(std::function<void()> hook) { endHook_ = std::move(hook); }
  // Chooses the common control-point file; empty when cancelled.
  void setControlFileChooser(std::function<QString()> chooser) {
    chooseControlFile_ = std::move(chooser);
  }
  const RunState& state() const { return st_; }
  MsgAnswer tbao() const { return tbao_; }
  const RunResult& lastRun() const { return lastRun_; }
  bool ending() const { return ending_; }
  bool running() const { return running_; }

  Suasl& editor() { return *suasl_; }
  Xem& viewer() { return *xem_; }
  Timthay& finder() { return *timthay_; }
  // The help window, once the help was asked for.
  Window* helpWindow() { return help_.get(); }
  // The last files chosen, the latest first (at most eight).
  QStringList recentFiles() const { return recent_; }
  // A file dropped on the window, picked from the recent files or given on
  // the command line becomes the chosen file, as a click in the list makes
  // it; false when it is no file.
  bool chooseFile(const QString& path);
  // The header form, loaded (hidden) when it is not.
  Nhapsdo& headerForm();
  bool headerFormLoaded() const { return !nhapsdo_.isNull(); }

  // Handlers.
  void GhiCaiDat();
  void cbkieu_Click(int index);
  void lstdia_Change();
  void lsttm_Change(const QString& path);
  void lstfile_Click(QListWidgetItem* item);
  void lstfile_DblClick(QListWidgetItem* item);
  void tinh_Click();
  void fsdo_Click();
  // The button beside the field-sketch box: the header form.
  void nhapsdo_Click();
  void KC_Click();
  void suasolieu_Click();
  void trogiup_Click();
  void thoat_Click();
  // The stop button beside the progress of a run.
  void dung_Click();
  // Shows the last completed run on the map.
  void bando_Click();
  MapWindow& mapWindow();

  // Host: what the computation run asks of the window.
  MsgAnswer MessageBox(std::string_view text, MsgIcon icon, MsgButtons buttons) override;
  void SetTitle(std::string_view title) override;
  void Beep() override;
  void SetFileBox(std::string_view text) override;
  void FocusFileBox() override;
  void SelectKind(int index) override;
  void ShowFolder(std::string_view folder, std::string_view pattern) override;

 protected:
  void closeEvent(QCloseEvent* event) override;  // Form_Unload
  void dragEnterEvent(QDragEnterEvent* event) override;
  void dropEvent(QDropEvent* event) override;

 private:
  void buildControls();
  void Form_Load();
  void setKind(int index);
  void setDrive(int index);
  void collectWindowFields();
  // The scale, label height and decimals as typed can be read; otherwise the
  // box is named in a message and takes the focus.
  bool typedNumbersRead();
  // Unsaved edits of a file the run reads saved (Có), left (Không) or the
  // run not made (Hủy: false).
  bool unsavedEditsSettled();
  void writeSettingsOnce();
  void endProgram();
  // Unsaved edits of the editor and the viewer saved or dropped as the user
  // says; false when the user stays.
  bool editsSettled();
  // The file typed into txtfile, when it is not the chosen one, becomes it.
  void takeTypedFile();
  void remember(const QString& path);
  void fillRecentMenu();
  // The progress bar and the stop button of a run, hidden between runs.
  void buildRunControls();
  // The run of st_ on a thread of its own; the window keeps drawing and only
  // the stop button takes input until the run has ended.
  RunResult computeOffThread();
  // The map button beside the compute button and the "open after a run" box.
  void buildMapControls(QBoxLayout* buttons);
  void afterRun();

  RunState st_;
  RunResult lastRun_;
  Asker ask_;
  MsgAnswer tbao_ = MsgAnswer::Ok;
  std::function<void()> endHook_;
  std::function<QString()> chooseControlFile_;
  bool settingsWritten_ = false;
  bool ending_ = false;
  bool running_ = false;
  bool focusFileBoxAfterRun_ = false;
  bool viewReportAfterRun_ = false;  // "Xem File lỗi" pressed in the summary
  QStringList recent_;

  DriveList* lstdia_ = nullptr;
  FolderList* lsttm_ = nullptr;
  QLabel* txttm_ = nullptr;
  QComboBox* cbkieu_ = nullptr;
  FileList* lstfile_ = nullptr;
  QLineEdit* txtfile_ = nullptr;
  QCheckBox *fasc_ = nullptr, *ftd_ = nullptr, *fdc_ = nullptr, *fsdo_ = nullptr;
  QCheckBox *fdxf_ = nullptr, *fcp_ = nullptr, *fkc_ = nullptr, *ckKC_ = nullptr;
  QComboBox* TyleTXT_ = nullptr;
  QLineEdit* Htxt_ = nullptr;
  QLineEdit* txtSoleDC_ = nullptr;
  QLineEdit* txtFKC_ = nullptr;
  QMenu* recentMenu_ = nullptr;
  RunThread* runner_ = nullptr;
  QProgressBar* tiendo_ = nullptr;
  QPushButton* dung_ = nullptr;

  // The side windows are windows of their own, not tied to this one, so that
  // the user stacks them at will.
  std::unique_ptr<Timthay> timthay_;
  std::unique_ptr<Xem> xem_;
  std::unique_ptr<Suasl> suasl_;
  std::unique_ptr<Window> help_;
  QPointer<Nhapsdo> nhapsdo_;
  QPushButton* bando_ = nullptr;
  QCheckBox* ckBando_ = nullptr;
  std::unique_ptr<MapWindow> map_;
  bool mapStale_ = false;  // a run completed since the map was drawn
};

}  // namespace kavu::ui
