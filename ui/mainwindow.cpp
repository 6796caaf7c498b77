#include "ui/mainwindow.h"

#include <QAbstractButton>
#include <QApplication>
#include <QCheckBox>
#include <QCloseEvent>
#include <QComboBox>
#include <QDir>
#include <QDragEnterEvent>
#include <QDropEvent>
#include <QFile>
#include <QFileDialog>
#include <QFileInfo>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QMenu>
#include <QMimeData>
#include <QPlainTextEdit>
#include <QProgressBar>
#include <QPushButton>
#include <QTextBrowser>
#include <QToolButton>
#include <QUrl>
#include <QVBoxLayout>
#include <utility>

#include "core/messages.h"
#include "core/tcvn3.h"
#include "core/typed_numbers.h"
#include "import/dispatch.h"
#include "products/reports.h"
#include "ui/editor.h"
#include "ui/lists.h"
#include "ui/map_window.h"
#include "ui/nhapsdo.h"
#include "ui/runthread.h"
#include "ui/settings.h"
#include "ui/texts.h"
#include "ui/timthay.h"

namespace kavu::ui {
namespace {

// fsdo and fdxf start grayed; a click makes them ordinary boxes, the first
// click ticking them.
class ThreeStateBox : public QCheckBox {
 public:
  using QCheckBox::QCheckBox;

 protected:
  void nextCheckState() override {
    if (checkState() == Qt::PartiallyChecked) {
      setTristate(false);
      setCheckState(Qt::Checked);
    } else {
      QCheckBox::nextCheckState();
    }
  }
};

QCheckBox* MakeBox(QWidget* parent, const char* name, std::string_view caption) {
  auto* box = new QCheckBox(Q(caption), parent);
  box->setObjectName(QLatin1String(name));
  return box;
}

QLabel* MakeLabel(QWidget* parent, const char* name, std::string_view caption) {
  auto* label = new QLabel(Q(caption), parent);
  label->setObjectName(QLatin1String(name));
  return label;
}

QLineEdit* MakeEdit(QWidget* parent, const char* name, const QString& text) {
  auto* edit = new QLineEdit(text, parent);
  edit->setObjectName(QLatin1String(name));
  return edit;
}

// A whole number stored as text, or nothing.
std::optional<int> StoredInt(const QString& text) {
  bool ok = false;
  const int value = text.trimmed().toInt(&ok);
  if (!ok) return std::nullopt;
  return value;
}

// A stored state applied to a two-state box; other values leave it as it is.
void RestoreBox(QCheckBox* box, const QString& stored) {
  const std::optional<int> state = StoredInt(stored);
  if (state == 0) box->setCheckState(Qt::Unchecked);
  if (state == 1) box->setCheckState(Qt::Checked);
}

std::string Std(const QString& text) { return text.toStdString(); }

// The caption with an access key before the first letter key (the same case
// first, then either).
QString WithAccessKey(QString caption, char key) {
  qsizetype at = caption.indexOf(QLatin1Char(key), 0, Qt::CaseSensitive);
  if (at < 0) at = caption.indexOf(QLatin1Char(key), 0, Qt::CaseInsensitive);
  if (at >= 0) caption.insert(at, QLatin1Char('&'));
  return caption;
}

// The same file, however its path is written.
bool SamePath(const QString& a, const QString& b) {
  if (a.isEmpty() || b.isEmpty()) return false;
  const QFileInfo left(a), right(b);
  if (left.exists() && right.exists()) return left.canonicalFilePath() == right.canonicalFilePath();
  return QDir::cleanPath(left.absoluteFilePath()) == QDir::cleanPath(right.absoluteFilePath());
}

// The help's list of the instrument files the program converts, from the
// table of formats: the kind list's text (or, in English, what the file is)
// and the pattern.
QString FormatsHtml(bool english) {
  QStringList items;
  for (const Format& format : Formats()) {
    if (format.convert == nullptr) continue;
    QString text = Q(english ? format.about : format.listText);
    if (!english) text = text.left(text.indexOf(QLatin1Char('['))).simplified();
    items << text + QStringLiteral(" (<b>") + Q(format.pattern).mid(1) + QStringLiteral("</b>)");
  }
  return items.join(QStringLiteral(", "));
}

// The recent files: a key of their own, the paths one a line.
constexpr const char* kRecentKey = "KAVU_Recent";
constexpr qsizetype kRecentCount = 8;
// Whether the map opens by itself after a run: "1" or "0".
constexpr const char* kOpenMapKey = "KAVU_OpenMap";

#ifdef _WIN32
constexpr const char* kDefaultFolder = "c:\\";
#endif

}  // namespace

int BoxState(const QCheckBox* box) {
  switch (box->checkState()) {
    case Qt::Checked:
      return 1;
    case Qt::PartiallyChecked:
      return 2;
    case Qt::Unchecked:
      break;
  }
  return 0;
}

MainWindow::MainWindow(QWidget* parent) : Window(parent), ask_(this) {
  setObjectName(QStringLiteral("kavu"));
  setWindowTitle(Q(kMainCaption));
  endHook_ = [] { QCoreApplication::quit(); };
  chooseControlFile_ = [this] {
    return ChooseFile(this, Q(kChooseKcFile), lsttm_->path(), {Q(kAllFiles)});
  };
  setAcceptDrops(true);
  buildControls();
  timthay_ = std::make_unique<Timthay>(ask_, [this](int ktra) -> QPlainTextEdit* {
    return ktra == 1 ? suasl_->txtsuasl() : xem_->txtxem();
  });
  xem_ = std::make_unique<Xem>(ask_, *timthay_);
  suasl_ = std::make_unique<Suasl>(ask_, *timthay_, *xem_);
  // Before the settings apply, the lists stand at the working folder.
  {
    const QSignalBlocker block(lstdia_);
    lstdia_->setCurrentIndex(std::max(0, lstdia_->indexOfPath(QDir::currentPath())));
  }
  lsttm_->setPath(QDir::currentPath());
  Form_Load();
  ckBando_->setChecked(SettingsStore().read(kOpenMapKey, QStringLiteral("0")) ==
                       QLatin1String("1"));
}

MainWindow::~MainWindow() { delete nhapsdo_.data(); }

void MainWindow::buildMapControls(QBoxLayout* buttons) {
  bando_ = MakeButton(this, "bando", Q(kMapButton));
  bando_->setEnabled(false);  // until a run has completed
  ckBando_ = MakeBox(this, "ckBando", kOpenMapAfterRun);
  const int compute = buttons->indexOf(findChild<QPushButton*>(QStringLiteral("tinh")));
  buttons->insertWidget(compute + 1, bando_);
  buttons->insertWidget(buttons->count() - 1, ckBando_);
  connect(bando_, &QPushButton::clicked, this, &MainWindow::bando_Click);
}

MapWindow& MainWindow::mapWindow() {
  if (!map_) map_ = std::make_unique<MapWindow>();
  return *map_;
}

void MainWindow::afterRun() {
  if (ending_ || lastRun_.outcome != RunOutcome::Completed) return;
  // A double click on a line of the report opens the record it concerns.
  xem_->setRunReport(QDir::toNativeSeparators(Q(st_.daufile + ".err")),
                     lastRun_.err > 0 ? ErrorReportBookLines(lastRun_.survey)
                                      : std::vector<std::uint32_t>{});
  mapStale_ = true;
  bando_->setEnabled(true);
  if (ckBando_->isChecked() || (map_ && map_->isVisible())) bando_Click();
}

void MainWindow::bando_Click() {
  if (!bando_->isEnabled()) return;
  MapWindow& map = mapWindow();
  if (mapStale_) {
    map.setSurvey(lastRun_.survey, st_.filesl, Ticked(st_.fsdo) ? st_.daufile + ".sdo" : "");
    mapStale_ = false;
  }
  map.show();
  map.raise();
}

void MainWindow::buildControls() {
  auto* lbtieude = MakeLabel(this, "lbtieude", kTitleLabel);
  QFont titleFont = lbtieude->font();
  titleFont.setBold(true);
  titleFont.setPointSizeF(titleFont.pointSizeF() * 1.3);
  lbtieude->setFont(titleFont);
  lbtieude->setAlignment(Qt::AlignCenter);

  auto* lbdia = MakeLabel(this, "lbdia", kDrives);
  lstdia_ = new DriveList(this);
  lstdia_->setObjectName(QStringLiteral("lstdia"));
  auto* lbtm = MakeLabel(this, "lbtm", kDirectory);
  lsttm_ = new FolderList(this);
  lsttm_->setObjectName(QStringLiteral("lsttm"));
  txttm_ = MakeLabel(this, "txttm", "");
  auto* lbkieu = MakeLabel(this, "lbkieu", kFilesOfType);
  cbkieu_ = new QComboBox(this);
  cbkieu_->setObjectName(QStringLiteral("cbkieu"));
  for (const Format& format : Formats()) cbkieu_->addItem(Q(format.listText));
  lstfile_ = new FileList(this);
  lstfile_->setObjectName(QStringLiteral("lstfile"));
  auto* lbfile = MakeLabel(this, "lbfile", kFile);
  txtfile_ = MakeEdit(this, "txtfile", QString());
  auto* recent = new QToolButton(this);
  recent->setObjectName(QStringLiteral("recent"));
  recent->setText(Q(kRecent));
  recent->setPopupMode(QToolButton::InstantPopup);
  recentMenu_ = new QMenu(recent);
  recent->setMenu(recentMenu_);
  connect(recentMenu_, &QMenu::aboutToShow, this, &MainWindow::fillRecentMenu);

  auto* luachon = new QGroupBox(Q(kOptions), this);
  luachon->setObjectName(QStringLiteral("luachon"));
  fasc_ = MakeBox(luachon, "fasc", kMakeAsc);
  ftd_ = MakeBox(luachon, "ftd", kMakeTxt);
  fdc_ = MakeBox(luachon, "fdc", kHeights);
  fsdo_ = new ThreeStateBox(Q(kMakeSketch), luachon);
  fsdo_->setObjectName(QStringLiteral("fsdo"));
  fdxf_ = new ThreeStateBox(Q(kMakeDxf), luachon);
  fdxf_->setObjectName(QStringLiteral("fdxf"));
  for (QCheckBox* box : {fsdo_, fdxf_}) {
    box->setTristate(true);
    box->setCheckState(Qt::PartiallyChecked);
  }
  fcp_ = MakeBox(luachon, "fcp", kMakePegs);
  fkc_ = MakeBox(luachon, "fkc", kMakeKc);
  auto* options = new QVBoxLayout(luachon);
  for (QCheckBox* box : {fasc_, ftd_, fdc_, fsdo_, fdxf_, fcp_, fkc_}) options->addWidget(box);

  auto* frame1 = new QFrame(this);
  frame1->setObjectName(QStringLiteral("Frame1"));
  frame1->setFrameShape(QFrame::HLine);
  frame1->setFrameShadow(QFrame::Sunken);

  auto* label1 = MakeLabel(this, "Label1", kScale);
  TyleTXT_ = new QComboBox(this);
  TyleTXT_->setObjectName(QStringLiteral("TyleTXT"));
  TyleTXT_->setEditable(true);
  TyleTXT_->setInsertPolicy(QComboBox::NoInsert);
  for (std::string_view scale : kScales) TyleTXT_->addItem(Q(scale));
  TyleTXT_->setCurrentText(QStringLiteral("5000"));
  auto* label2 = MakeLabel(this, "Label2", kTextHeight);
  Htxt_ = MakeEdit(this, "Htxt", QStringLiteral("2.0"));
  auto* label3 = MakeLabel(this, "Label3", kHeightDecimals);
  txtSoleDC_ = MakeEdit(this, "txtSoleDC", QStringLiteral("2"));
  ckKC_ = MakeBox(this, "ckKC", kUseCommonKc);
  txtFKC_ = MakeEdit(this, "txtFKC", QString());
  auto* kc = MakeButton(this, "KC", Q(kKcButton));

  auto* tinh = MakeButton(this, "tinh", Q(kCompute));
  tinh->setDefault(true);
  auto* suasolieu = MakeButton(this, "suasolieu", Q(kEditData));
  auto* trogiup = MakeButton(this, "trogiup", Q(kHelp));
  auto* thoat = MakeButton(this, "thoat", Q(kExit));
  setCancelButton(thoat);

  // Layout: the lists on the left, the options on the right, the buttons below.
  auto* grid = new QGridLayout(this);
  grid->addWidget(lbtieude, 0, 0, 1, 3);
  auto* left = new QGridLayout;
  left->addWidget(lbdia, 0, 0);
  left->addWidget(lstdia_, 1, 0);
  left->addWidget(lbtm, 2, 0);
  left->addWidget(lsttm_, 3, 0);
  left->addWidget(txttm_, 4, 0);
  left->addWidget(lbkieu, 0, 1);
  left->addWidget(cbkieu_, 1, 1);
  left->addWidget(lstfile_, 2, 1, 3, 1);
  grid->addLayout(left, 1, 0, 1, 2);
  auto* fileRow = new QHBoxLayout;
  fileRow->addWidget(lbfile);
  fileRow->addWidget(txtfile_);
  fileRow->addWidget(recent);
  grid->addLayout(fileRow, 2, 0, 1, 3);

  auto* right = new QVBoxLayout;
  right->addWidget(luachon);
  right->addWidget(frame1);
  auto* numbers = new QGridLayout;
  numbers->addWidget(label1, 0, 0);
  numbers->addWidget(TyleTXT_, 0, 1);
  numbers->addWidget(label2, 1, 0);
  numbers->addWidget(Htxt_, 1, 1);
  numbers->addWidget(label3, 2, 0);
  numbers->addWidget(txtSoleDC_, 2, 1);
  right->addLayout(numbers);
  right->addStretch();
  grid->addLayout(right, 1, 2);

  auto* kcRow = new QHBoxLayout;
  kcRow->addWidget(ckKC_);
  kcRow->addWidget(txtFKC_, 1);
  kcRow->addWidget(kc);
  grid->addLayout(kcRow, 3, 0, 1, 3);
  auto* buttons = new QHBoxLayout;
  buttons->addStretch();
  for (QPushButton* button : {tinh, suasolieu, trogiup, thoat}) buttons->addWidget(button);
  buttons->addStretch();
  buildMapControls(buttons);
  grid->addLayout(buttons, 4, 0, 1, 3);
  grid->setColumnStretch(0, 1);
  grid->setColumnStretch(1, 1);
  buildRunControls();
  // The header form opens from its own button beside the field-sketch box.
  auto* headerButton = MakeButton(luachon, "nhapsdoButton", Q(kHeaderButton));
  headerButton->setAutoDefault(false);
  const int sketchRow = options->indexOf(fsdo_);
  options->removeWidget(fsdo_);
  auto* sketchLine = new QHBoxLayout;
  sketchLine->addWidget(fsdo_, 1);
  sketchLine->addWidget(headerButton);
  options->insertLayout(sketchRow, sketchLine);
  connect(headerButton, &QPushButton::clicked, this, &MainWindow::nhapsdo_Click);
  label1->setBuddy(TyleTXT_);
  label2->setBuddy(Htxt_);
  label3->setBuddy(txtSoleDC_);
  lbkieu->setBuddy(cbkieu_);
  lbfile->setBuddy(txtfile_);
  for (const auto& [name, key] : kMainAccessKeys) {
    QObject* control = findChild<QObject*>(Q(name));
    if (auto* button = qobject_cast<QAbstractButton*>(control)) {
      button->setText(WithAccessKey(button->text(), key));
    } else if (auto* label = qobject_cast<QLabel*>(control)) {
      label->setText(WithAccessKey(label->text(), key));
    }
  }
  for (const auto& [name, tip] : kMainToolTips) {
    if (auto* control = findChild<QWidget*>(Q(name))) control->setToolTip(Q(tip));
  }
  // The buttons in the order they stand: the map button after the compute
  // button, the exit button last.
  QWidget::setTabOrder(tinh, bando_);
  QWidget::setTabOrder(bando_, suasolieu);
  QWidget::setTabOrder(suasolieu, trogiup);
  QWidget::setTabOrder(trogiup, thoat);
  QWidget::setTabOrder(thoat, ckBando_);
  resize(760, 520);

  connect(cbkieu_, &QComboBox::activated, this, &MainWindow::cbkieu_Click);
  connect(lstdia_, &QComboBox::currentIndexChanged, this, &MainWindow::lstdia_Change);
  connect(lsttm_, &FolderList::pathChanged, this, &MainWindow::lsttm_Change);
  connect(lstfile_, &QListWidget::itemClicked, this, &MainWindow::lstfile_Click);
  // Moving the selection with the keys (or in code) chooses as a click does.
  connect(lstfile_, &QListWidget::itemSelectionChanged, this, [this] {
    const QList<QListWidgetItem*> selected = lstfile_->selectedItems();
    if (!selected.isEmpty()) lstfile_Click(selected.first());
  });
  connect(lstfile_, &QListWidget::itemDoubleClicked, this, &MainWindow::lstfile_DblClick);
  connect(fsdo_, &QCheckBox::clicked, this, &MainWindow::fsdo_Click);
  connect(kc, &QPushButton::clicked, this, &MainWindow::KC_Click);
  connect(tinh, &QPushButton::clicked, this, &MainWindow::tinh_Click);
  connect(suasolieu, &QPushButton::clicked, this, &MainWindow::suasolieu_Click);
  connect(trogiup, &QPushButton::clicked, this, &MainWindow::trogiup_Click);
  connect(thoat, &QPushButton::clicked, this, &MainWindow::thoat_Click);
}

void MainWindow::Form_Load() {
  const SettingsStore store;
  txtFKC_->setText(store.read("KAVU_txtFKC", QString()));
  RestoreBox(ckKC_, store.read("KAVU_ckKC", QStringLiteral("0")));
  if (const std::optional<int> kind = StoredInt(store.read("KAVU_cbkieu", QStringLiteral("0")))) {
    setKind(*kind);
  }
  // From here a stored value that cannot be applied is passed over.
  if (const std::optional<int> drive = StoredInt(store.read("KAVU_LstDia", QStringLiteral("1")))) {
    setDrive(*drive);
  }
#ifdef _WIN32
  const QString defaultFolder = QString::fromLatin1(kDefaultFolder);
#else
  // There is no drive C: here; the user's home folder takes its place.
  const QString defaultFolder = QDir::toNativeSeparators(QDir::homePath());
#endif
  lsttm_->setPath(store.read("KAVU_LstTM", defaultFolder));
  TyleTXT_->setCurrentText(store.read("KAVU_TyleTXT", QStringLiteral("1000")));
  Htxt_->setText(store.read("KAVU_HTXT", QStringLiteral("2.0")));
  txtSoleDC_->setText(store.read("KAVU_SoleDC", QStringLiteral("2")));
  RestoreBox(fkc_, store.read("KAVU_Fkc", QStringLiteral("0")));
  RestoreBox(fasc_, store.read("KAVU_Fasc", QStringLiteral("0")));
  RestoreBox(ftd_, store.read("KAVU_Ftd", QStringLiteral("1")));
  RestoreBox(fcp_, store.read("KAVU_Fcp", QStringLiteral("0")));
  RestoreBox(fdc_, store.read("KAVU_Fdc", QStringLiteral("1")));
  txttm_->setText(ShortFolderText(lsttm_->path()));
  // Beyond the window's thirteen keys: the recent files, the last chosen
  // first, which is chosen again.
  for (const QString& path : store.read(kRecentKey, QString()).split(QLatin1Char('\n'))) {
    if (!path.isEmpty() && recent_.size() < kRecentCount) recent_.append(path);
  }
  if (!recent_.isEmpty() && QFileInfo(recent_.first()).isFile()) {
    DeriveFileSelection(st_, Std(recent_.first()));
    txtfile_->setText(recent_.first());
  }
}

void MainWindow::GhiCaiDat() {
  SettingsStore store;
  store.write("KAVU_txtFKC", txtFKC_->text());
  store.write("KAVU_ckKC", QString::number(BoxState(ckKC_)));
  store.write("KAVU_cbkieu", QString::number(cbkieu_->currentIndex()));
  store.write("KAVU_LstDia", QString::number(lstdia_->currentIndex()));
  store.write("KAVU_LstTM", lsttm_->path());
  store.write("KAVU_TyleTXT", TyleTXT_->currentText());
  store.write("KAVU_HTXT", Htxt_->text());
  store.write("KAVU_SoleDC", txtSoleDC_->text());
  store.write("KAVU_Fkc", QString::number(BoxState(fkc_)));
  store.write("KAVU_Fasc", QString::number(BoxState(fasc_)));
  store.write("KAVU_Ftd", QString::number(BoxState(ftd_)));
  store.write("KAVU_Fcp", QString::number(BoxState(fcp_)));
  store.write("KAVU_Fdc", QString::number(BoxState(fdc_)));
}

void MainWindow::setKind(int index) {
  if (index < 0 || index >= cbkieu_->count()) return;
  {
    const QSignalBlocker block(cbkieu_);
    cbkieu_->setCurrentIndex(index);
  }
  cbkieu_Click(index);
}

void MainWindow::setDrive(int index) {
  if (index < 0 || index >= lstdia_->count()) return;
  {
    const QSignalBlocker block(lstdia_);
    lstdia_->setCurrentIndex(index);
  }
  lstdia_Change();
}

void MainWindow::cbkieu_Click(int index) {
  if (FormatAt(index) == nullptr) return;
  lstfile_->setPattern(Q(PatternOfKind(index)));
}

void MainWindow::lstdia_Change() { lsttm_->setPath(lstdia_->root(lstdia_->currentIndex())); }

void MainWindow::lsttm_Change(const QString& path) {
  lstfile_->setPath(path);
  txttm_->setText(ShortFolderText(path));
  // The drive list shows the drive of the folder shown.
  const int drive = lstdia_->indexOfPath(path);
  if (drive >= 0 && drive != lstdia_->currentIndex()) {
    const QSignalBlocker block(lstdia_);
    lstdia_->setCurrentIndex(drive);
  }
}

void MainWindow::lstfile_Click(QListWidgetItem* item) {
  // The run's file stays chosen until its end, whatever the list shows.
  if (item == nullptr || running_) return;
  const QString path = QDir::toNativeSeparators(QDir(lstfile_->path()).filePath(item->text()));
  DeriveFileSelection(st_, Std(path));
  txtfile_->setText(Q(st_.filesl));
  remember(Q(st_.filesl));
}

bool MainWindow::chooseFile(const QString& path) {
  const QFileInfo info(path);
  if (!info.isFile() || running_) return false;
  const int kind = KindOfExtension(Std(info.suffix().toUpper()));
  if (!QDir::match(lstfile_->pattern(), info.fileName())) setKind(kind);
  if (lsttm_->setPath(info.absolutePath())) {
    const QList<QListWidgetItem*> items = lstfile_->findItems(info.fileName(), Qt::MatchExactly);
    if (!items.isEmpty()) {
      lstfile_->setCurrentItem(items.first());
      lstfile_->scrollToItem(items.first());
      return true;
    }
  }
  // Not listed (a hidden file): chosen all the same.
  DeriveFileSelection(st_, Std(QDir::toNativeSeparators(info.absoluteFilePath())));
  txtfile_->setText(Q(st_.filesl));
  remember(Q(st_.filesl));
  return true;
}

void MainWindow::remember(const QString& path) {
  recent_.removeAll(path);
  recent_.prepend(path);
  while (recent_.size() > kRecentCount) recent_.removeLast();
}

void MainWindow::fillRecentMenu() {
  recentMenu_->clear();
  for (const QString& path : recent_) {
    QAction* action = recentMenu_->addAction(path, this, [this, path] { chooseFile(path); });
    action->setEnabled(QFileInfo(path).isFile());
  }
}

void MainWindow::takeTypedFile() {
  const std::string typed = Std(txtfile_->text());
  if (typed.empty() || typed == st_.filesl) return;
  DeriveFileSelection(st_, typed);
  if (QFileInfo(txtfile_->text()).isFile()) remember(txtfile_->text());
}

void MainWindow::dragEnterEvent(QDragEnterEvent* event) {
  if (running_) return;
  for (const QUrl& url : event->mimeData()->urls()) {
    if (url.isLocalFile() && QFileInfo(url.toLocalFile()).isFile()) {
      event->acceptProposedAction();
      return;
    }
  }
}

void MainWindow::dropEvent(QDropEvent* event) {
  for (const QUrl& url : event->mimeData()->urls()) {
    if (url.isLocalFile() && chooseFile(url.toLocalFile())) {
      event->acceptProposedAction();
      return;
    }
  }
}

void MainWindow::lstfile_DblClick(QListWidgetItem* item) {
  lstfile_Click(item);
  tinh_Click();
}

void MainWindow::collectWindowFields() {
  st_.txtfile = Std(txtfile_->text());
  st_.cbkieu = cbkieu_->currentIndex();
  st_.fasc = BoxState(fasc_);
  st_.ftd = BoxState(ftd_);
  st_.fdc = BoxState(fdc_);
  st_.fsdo = BoxState(fsdo_);
  st_.fdxf = BoxState(fdxf_);
  st_.fcp = BoxState(fcp_);
  st_.fkc = BoxState(fkc_);
  st_.ckKC = BoxState(ckKC_);
  st_.TyleTXT = Std(TyleTXT_->currentText());
  st_.Htxt = Std(Htxt_->text());
  st_.txtSoleDC = Std(txtSoleDC_->text());
  st_.txtFKC = Std(txtFKC_->text());
  // The header texts go to the field sketch only; reading them loads the
  // form (from the store) when it is not loaded.
  if (Ticked(st_.fsdo)) {
    const std::array<QString, 7> texts = headerForm().texts();
    for (std::size_t i = 0; i < texts.size(); ++i) st_.nhapsdo[i] = Utf8ToTcvn3(Std(texts[i]));
  }
}

bool MainWindow::typedNumbersRead() {
  const TypedRunNumbersRead read = ReadRunNumbers(Std(TyleTXT_->currentText()), Std(Htxt_->text()),
                                                  Std(txtSoleDC_->text()));
  if (read.numbers) return true;
  tbao_ = ask_(Q(TypedRefusalMessage(read)), MsgIcon::Critical, MsgButtons::Ok);
  QWidget* box = TyleTXT_;
  if (read.refused == TypedBox::TextHeight) box = Htxt_;
  if (read.refused == TypedBox::HeightDecimals) box = txtSoleDC_;
  box->setFocus();
  if (auto* edit = qobject_cast<QLineEdit*>(box)) edit->selectAll();
  if (box == TyleTXT_ && TyleTXT_->lineEdit() != nullptr) TyleTXT_->lineEdit()->selectAll();
  return false;
}

bool MainWindow::unsavedEditsSettled() {
  // The files the run reads: the chosen one and the common control file.
  QStringList read{Q(st_.filesl)};
  if (Ticked(BoxState(ckKC_))) read.append(txtFKC_->text().trimmed());
  struct Shown {
    TextWindow* window;
    std::function<void()> save;
  };
  for (const Shown& shown : {Shown{suasl_.get(), [this] { suasl_->ghi_Click(); }},
                             Shown{xem_.get(), [this] { xem_->ghixem_Click(); }}}) {
    if (!shown.window->hasUnsavedEdits()) continue;
    bool readByRun = false;
    for (const QString& path : read) readByRun = readByRun || SamePath(shown.window->file(), path);
    if (!readByRun) continue;
    tbao_ = ask_(Q(kSaveChanges) + QDir::toNativeSeparators(shown.window->file()) + QStringLiteral("?"),
                 MsgIcon::Question, MsgButtons::YesNoCancel);
    if (tbao_ == MsgAnswer::Cancel) return false;
    if (tbao_ == MsgAnswer::Yes) {
      shown.save();
      // Not saved: nothing is computed (the save said why).
      if (shown.window->hasUnsavedEdits()) return false;
    }
  }
  return true;
}

void MainWindow::tinh_Click() {
  if (running_ || ending_) return;
  takeTypedFile();
  if (!typedNumbersRead() || !unsavedEditsSettled()) return;
  collectWindowFields();
  viewReportAfterRun_ = false;
  const QString chosen = txtfile_->text();
  lastRun_ = computeOffThread();
  if (lastRun_.outcome != RunOutcome::Completed) {
    // The window is itself again; a file that could not be computed leaves
    // the recent list.
    setWindowTitle(Q(msg::kProgramTitle));
    if (lastRun_.outcome != RunOutcome::Cancelled) {
      recent_.removeAll(chosen);
      recent_.removeAll(Q(st_.filesl));
    }
  }
  if (lastRun_.outcome == RunOutcome::Completed && lastRun_.answer == MsgAnswer::No) {
    // No to "continue?" ends the program; the session's choices are kept.
    if (editsSettled()) {
      writeSettingsOnce();
      endProgram();
      return;
    }
  }
  afterRun();
  if (std::exchange(viewReportAfterRun_, false)) {
    const QString report = Q(st_.daufile + ".err");
    if (const std::optional<QString> text = ReadScreenText(report)) xem_->showFile(report, *text);
  }
}

Nhapsdo& MainWindow::headerForm() {
  if (nhapsdo_.isNull()) nhapsdo_ = new Nhapsdo();
  return *nhapsdo_;
}

void MainWindow::fsdo_Click() {
  if (BoxState(fsdo_) != 1) return;
  nhapsdo_Click();
}

void MainWindow::nhapsdo_Click() { headerForm().showForm(); }

void MainWindow::KC_Click() {
  const QString chosen = chooseControlFile_ ? chooseControlFile_() : QString();
  if (chosen.isEmpty()) return;  // cancelled: the box and the tick stay
  txtFKC_->setText(QDir::toNativeSeparators(chosen));
  if (!txtFKC_->text().trimmed().isEmpty()) ckKC_->setCheckState(Qt::Checked);
}

void MainWindow::suasolieu_Click() {
  // A path typed into the file box counts as a click in the list does.
  takeTypedFile();
  const QString filesl = Q(st_.filesl);
  if (txtfile_->text().isEmpty() || !QFileInfo(filesl).isFile()) {
    tbao_ = ask_(Q(kFileNotFoundShort) + filesl, MsgIcon::Critical, MsgButtons::Ok);
    return;
  }
  const std::optional<QString> text = ReadScreenText(filesl);
  if (!text) {
    tbao_ = ask_(Q(msg::kCannotOpen) + filesl, MsgIcon::Critical, MsgButtons::Ok);
    return;
  }
  suasl_->openFile(filesl, Q(st_.daufile), Q(st_.tentm), *text);
}

void MainWindow::trogiup_Click() {
  const QString path = ProgramDataFile(QStringLiteral("kavu.hlp"));
  QFile file(path);
  if (!QFileInfo(path).isFile() || !file.open(QIODevice::ReadOnly)) {
    tbao_ = ask_(Q(kFileNotFoundShort) + path, MsgIcon::Critical, MsgButtons::Ok);
    return;
  }
  if (!help_) {
    help_ = std::make_unique<Window>();
    help_->setObjectName(QStringLiteral("help"));
    help_->setWindowTitle(Q(kViewerCaption));
    auto* browser = new QTextBrowser(help_.get());
    browser->setObjectName(QStringLiteral("helptext"));
    auto* layout = new QVBoxLayout(help_.get());
    layout->addWidget(browser);
    help_->resize(640, 560);
  }
  auto* browser = help_->findChild<QTextBrowser*>(QStringLiteral("helptext"));
  QString html = QString::fromUtf8(file.readAll());
  html.replace(QStringLiteral("<!--formats-en-->"), FormatsHtml(true));
  html.replace(QStringLiteral("<!--formats-->"), FormatsHtml(false));
  browser->setHtml(html);
  help_->show();
  help_->raise();
}

void MainWindow::thoat_Click() {
  if (running_) return;
  Beep();
  tbao_ = ask_(Q(kExitQuestion), MsgIcon::Question, MsgButtons::YesNo);
  if (tbao_ != MsgAnswer::Yes || !editsSettled()) return;
  writeSettingsOnce();
  endProgram();
}

void MainWindow::writeSettingsOnce() {
  if (settingsWritten_) return;
  settingsWritten_ = true;
  GhiCaiDat();
  SettingsStore().write(kRecentKey, recent_.join(QLatin1Char('\n')));
  SettingsStore().write(kOpenMapKey,
                        ckBando_->isChecked() ? QStringLiteral("1") : QStringLiteral("0"));
}

bool MainWindow::editsSettled() { return suasl_->maySave() && xem_->maySave(); }

void MainWindow::endProgram() {
  if (ending_) return;
  ending_ = true;
  // The other windows close with their own closing steps (the header form
  // keeps its texts).
  if (!nhapsdo_.isNull()) nhapsdo_->close();
  for (QWidget* window : {static_cast<QWidget*>(timthay_.get()), static_cast<QWidget*>(xem_.get()),
                          static_cast<QWidget*>(suasl_.get()), static_cast<QWidget*>(help_.get()),
                          static_cast<QWidget*>(map_.get())}) {
    if (window != nullptr) window->close();
  }
  close();
  if (endHook_) endHook_();
}

void MainWindow::closeEvent(QCloseEvent* event) {
  // The run does not give way to the window until its summary; a request to
  // close that arrives while it redraws the title is refused.
  if (running_ || (!ending_ && !editsSettled())) {
    event->ignore();
    return;
  }
  writeSettingsOnce();
  event->accept();
  if (!ending_) endProgram();
}

MsgAnswer MainWindow::MessageBox(std::string_view text, MsgIcon icon, MsgButtons buttons) {
  Question question{Q(text), icon, buttons, false, {}, {}};
  // The run's summary offers the folder of its products and, when it found
  // errors, the error report; the run is over behind it.
  if (text.starts_with(msg::kTotalStations)) {
    question.folder = Q(st_.tentm);
    if (st_.err > 0 && QFileInfo(Q(st_.daufile + ".err")).isFile()) {
      question.viewReport = [this] { viewReportAfterRun_ = true; };
    }
    tiendo_->hide();
    dung_->hide();
  }
  tbao_ = ask_(question);
  return tbao_;
}

void MainWindow::SetTitle(std::string_view title) { setWindowTitle(Q(title)); }

void MainWindow::Beep() { QApplication::beep(); }

void MainWindow::SetFileBox(std::string_view text) { txtfile_->setText(Q(text)); }

void MainWindow::FocusFileBox() {
  // The box is locked while the run works: it takes the focus at the end.
  if (running_) {
    focusFileBoxAfterRun_ = true;
    return;
  }
  txtfile_->setFocus();
}

void MainWindow::SelectKind(int index) { setKind(index); }

void MainWindow::ShowFolder(std::string_view folder, std::string_view pattern) {
  const QString path = Q(folder);
  const int drive = lstdia_->indexOfPath(path);
  if (drive >= 0) {
    const QSignalBlocker block(lstdia_);
    lstdia_->setCurrentIndex(drive);
  }
  QString clean = path;
  while (clean.size() > 1 && clean.endsWith(QDir::separator()) &&
         !(clean.size() == 3 && clean[1] == QLatin1Char(':'))) {
    clean.chop(1);
  }
  lsttm_->setPath(clean);
  lstfile_->setPattern(Q(pattern));  // lists the new products too
  txttm_->setText(ShortFolderText(lsttm_->path()));
}

void MainWindow::buildRunControls() {
  runner_ = new RunThread(*this, this);
  tiendo_ = new QProgressBar(this);
  tiendo_->setObjectName(QStringLiteral("tiendo"));
  dung_ = MakeButton(this, "dung", Q(kStopRun));
  auto* row = new QHBoxLayout;
  row->addWidget(tiendo_, 1);
  row->addWidget(dung_);
  auto* grid = static_cast<QGridLayout*>(layout());
  grid->addLayout(row, grid->rowCount(), 0, 1, grid->columnCount());
  tiendo_->hide();
  dung_->hide();
  connect(dung_, &QPushButton::clicked, this, &MainWindow::dung_Click);
  connect(runner_, &RunThread::progressed, tiendo_, [this](long long done, long long total) {
    // The bar counts in thousandths: a working copy may exceed its int range.
    tiendo_->setRange(0, 1000);
    tiendo_->setValue(total > 0 ? static_cast<int>(done * 1000 / total) : 0);
  });
}

RunResult MainWindow::computeOffThread() {
  running_ = true;
  const QPointer<QWidget> focused = focusWidget();
  // Only the stop button takes input (Esc presses it); the choices the run
  // has read stay as they are until its end.
  std::vector<QPointer<QWidget>> locked;
  for (QWidget* control : findChildren<QWidget*>(Qt::FindDirectChildrenOnly)) {
    if (control == dung_ || control == tiendo_ || qobject_cast<QLabel*>(control) != nullptr ||
        !control->isEnabled()) {
      continue;
    }
    control->setEnabled(false);
    locked.emplace_back(control);
  }
  auto* thoat = findChild<QPushButton*>(QStringLiteral("thoat"));
  setCancelButton(dung_);
  tiendo_->setRange(0, 0);  // busy until the station loop reports
  tiendo_->show();
  dung_->setEnabled(true);
  dung_->show();
  dung_->setFocus();
  QApplication::setOverrideCursor(Qt::BusyCursor);

  RunResult result = runner_->run(st_);

  QApplication::restoreOverrideCursor();
  tiendo_->hide();
  dung_->hide();
  setCancelButton(thoat);
  for (const QPointer<QWidget>& control : locked) {
    if (control) control->setEnabled(true);
  }
  running_ = false;
  if (std::exchange(focusFileBoxAfterRun_, false)) {
    FocusFileBox();
  } else if (focused) {
    focused->setFocus();
  }
  return result;
}

void MainWindow::dung_Click() {
  if (!running_) return;
  runner_->cancel();
  dung_->setEnabled(false);  // once is enough
}

}  // namespace kavu::ui
