#include "ui/dialog.h"

#include <QCloseEvent>
#include <QCoreApplication>
#include <QDateTime>
#include <QDir>
#include <QDoubleValidator>
#include <QFileDialog>
#include <QFileInfo>
#include <QFileSystemModel>
#include <QHeaderView>
#include <QIdentityProxyModel>
#include <QKeyEvent>
#include <QLocale>
#include <QPrintPreviewDialog>
#include <QPushButton>
#include <QTranslator>
#include <QTreeView>
#include <algorithm>
#include <memory>
#include <string>

#include "core/numbers.h"
#include "ui/ask.h"
#include "ui/texts.h"

namespace kavu::ui {

Window::Window(QWidget* parent) : QDialog(parent) {
  setWindowFlag(Qt::WindowContextHelpButtonHint, false);
  setWindowFlag(Qt::WindowMinMaxButtonsHint, true);
}

void Window::keyPressEvent(QKeyEvent* event) {
  if (event->key() == Qt::Key_Escape && event->modifiers() == Qt::NoModifier) {
    if (cancel_ == nullptr) {
      close();
    } else if (cancel_->isEnabled()) {
      cancel_->click();
    }
    event->accept();
    return;
  }
  QDialog::keyPressEvent(event);
}

void Window::reject() { close(); }

void Window::closeEvent(QCloseEvent* event) { event->accept(); }

namespace {

// The time a file was changed, as the file list shows it.
constexpr QStringView kDateForm = u"dd/MM/yyyy HH:mm";

// The file list in Vietnamese: Qt names the columns in its own language and
// writes sizes and dates in the system's locale, which on a surveyor's
// desktop is as often English as Vietnamese.
class VietnameseFileList : public QIdentityProxyModel {
 public:
  using QIdentityProxyModel::QIdentityProxyModel;
  QVariant headerData(int section, Qt::Orientation orientation, int role) const override {
    if (orientation == Qt::Horizontal && role == Qt::DisplayRole && section >= 0 &&
        section < static_cast<int>(kFileColumns.size())) {
      return Q(kFileColumns[static_cast<std::size_t>(section)]);
    }
    return QIdentityProxyModel::headerData(section, orientation, role);
  }
  QVariant data(const QModelIndex& index, int role) const override {
    const auto* files = qobject_cast<const QFileSystemModel*>(sourceModel());
    if (files != nullptr && role == Qt::DisplayRole && index.isValid()) {
      const QModelIndex file = mapToSource(index);
      if (index.column() == 1 && !files->isDir(file)) return FileSizeText(files->size(file));
      if (index.column() == 3) return FileDateText(files->lastModified(file));
    }
    return QIdentityProxyModel::data(index, role);
  }
};

// The file list of a file dialog, in detail view, the name taking the room
// the size, kind and date leave.
void ShowFileList(QFileDialog& dialog) {
  dialog.setViewMode(QFileDialog::Detail);
  dialog.setProxyModel(new VietnameseFileList(&dialog));
  if (auto* list = dialog.findChild<QTreeView*>()) {
    list->header()->setStretchLastSection(false);
    list->header()->setSectionResizeMode(QHeaderView::ResizeToContents);
    list->header()->setSectionResizeMode(0, QHeaderView::Stretch);
  }
}

// Qt's dialogs as they are shown: the file dialogs that Qt's static functions
// make (the save dialogs) get the program's file list; the print preview
// reads the zoom typed in as it writes it, with a decimal point, where the
// Vietnamese locale would take the point for a thousands separator.
class QtDialogs : public QObject {
 public:
  using QObject::QObject;
  bool eventFilter(QObject* watched, QEvent* event) override {
    if (event->type() != QEvent::Show) return QObject::eventFilter(watched, event);
    if (auto* files = qobject_cast<QFileDialog*>(watched);
        files != nullptr && dynamic_cast<VietnameseFileList*>(files->proxyModel()) == nullptr) {
      ShowFileList(*files);
      files->resize(files->size().expandedTo(QSize(760, 460)));
    }
    if (auto* preview = qobject_cast<QPrintPreviewDialog*>(watched)) {
      for (auto* zoom : preview->findChildren<QDoubleValidator*>()) zoom->setLocale(QLocale::c());
    }
    return QObject::eventFilter(watched, event);
  }
};

}  // namespace

QString FileDateText(const QDateTime& time) { return time.toString(kDateForm); }

QString FileSizeText(qint64 bytes) {
  if (bytes < 1024) return QString::number(bytes) + QLatin1Char(' ') + Q(kSizeUnits[0]);
  // One decimal: a value that rounds to 1024 is written in the next unit.
  double value = static_cast<double>(bytes);
  std::size_t unit = 0;
  while (value >= 1023.95 && unit + 1 < kSizeUnits.size()) {
    value /= 1024;
    ++unit;
  }
  std::string text = Mask(value, "0.0");
  std::replace(text.begin(), text.end(), '.', ',');
  return Q(text) + QLatin1Char(' ') + Q(kSizeUnits[unit]);
}

void SetUpFileDialog(QFileDialog& dialog, const QStringList& filters) {
  // Qt's own dialog, whose labels the program can set.
  dialog.setOption(QFileDialog::DontUseNativeDialog);
  dialog.setFileMode(QFileDialog::ExistingFile);
  dialog.setNameFilters(filters);
  dialog.setLabelText(QFileDialog::LookIn, Q(kLookIn));
  dialog.setLabelText(QFileDialog::FileName, Q(kFileName));
  dialog.setLabelText(QFileDialog::FileType, Q(kFileType));
  dialog.setLabelText(QFileDialog::Accept, Q(kOpen));
  dialog.setLabelText(QFileDialog::Reject, Q(kCancel));
  ShowFileList(dialog);
  dialog.resize(760, 460);
}

QString ChooseFile(QWidget* parent, const QString& caption, const QString& folder,
                   const QStringList& filters) {
  QFileDialog dialog(parent, caption, folder);
  SetUpFileDialog(dialog, filters);
  if (dialog.exec() != QDialog::Accepted || dialog.selectedFiles().isEmpty()) return {};
  return dialog.selectedFiles().first();
}

bool UseVietnamese(const QString& folder) {
  QCoreApplication* app = QCoreApplication::instance();
  if (app == nullptr) return false;
  // Qt's own dialogs everywhere: a desktop's native ones speak the desktop's
  // language and know nothing of the translation.
  QCoreApplication::setAttribute(Qt::AA_DontUseNativeDialogs);
  QLocale::setDefault(QLocale(QLocale::Vietnamese, QLocale::Vietnam));
  app->installEventFilter(new QtDialogs(app));
  auto translator = std::make_unique<QTranslator>(app);
  if (!translator->load(QStringLiteral("kavu_vi"), folder)) return false;
  // The application owns it from here and keeps it as long as it runs.
  QCoreApplication::installTranslator(translator.release());
  return true;
}

QString ProgramDataFile(const QString& name) {
  const QString folder = QCoreApplication::applicationDirPath();
  const QString beside = QDir::toNativeSeparators(folder + QLatin1Char('/') + name);
  const QString installed = QDir::toNativeSeparators(
      QDir::cleanPath(folder + QStringLiteral("/" KAVU_INSTALLED_DATA_DIR "/") + name));
  return !QFileInfo(beside).isFile() && QFileInfo(installed).isFile() ? installed : beside;
}

QPushButton* MakeButton(QWidget* parent, const char* name, const QString& caption) {
  auto* button = new QPushButton(caption, parent);
  button->setObjectName(QLatin1String(name));
  button->setAutoDefault(false);
  return button;
}

}  // namespace kavu::ui
