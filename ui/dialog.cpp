#include "ui/dialog.h"

#include <QCloseEvent>
#include <QCoreApplication>
#include <QDir>
#include <QFileDialog>
#include <QFileInfo>
#include <QHeaderView>
#include <QIdentityProxyModel>
#include <QKeyEvent>
#include <QPushButton>
#include <QTranslator>
#include <QTreeView>
#include <memory>

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

// The file list's column headings in Vietnamese.
class VietnameseHeadings : public QIdentityProxyModel {
 public:
  using QIdentityProxyModel::QIdentityProxyModel;
  QVariant headerData(int section, Qt::Orientation orientation, int role) const override {
    if (orientation == Qt::Horizontal && role == Qt::DisplayRole && section >= 0 &&
        section < static_cast<int>(kFileColumns.size())) {
      return Q(kFileColumns[static_cast<std::size_t>(section)]);
    }
    return QIdentityProxyModel::headerData(section, orientation, role);
  }
};

}  // namespace

void SetUpFileDialog(QFileDialog& dialog, const QStringList& filters) {
  // Qt's own dialog, whose labels the program can set.
  dialog.setOption(QFileDialog::DontUseNativeDialog);
  dialog.setFileMode(QFileDialog::ExistingFile);
  dialog.setViewMode(QFileDialog::Detail);
  dialog.setNameFilters(filters);
  dialog.setLabelText(QFileDialog::LookIn, Q(kLookIn));
  dialog.setLabelText(QFileDialog::FileName, Q(kFileName));
  dialog.setLabelText(QFileDialog::FileType, Q(kFileType));
  dialog.setLabelText(QFileDialog::Accept, Q(kOpen));
  dialog.setLabelText(QFileDialog::Reject, Q(kCancel));
  dialog.setProxyModel(new VietnameseHeadings(&dialog));
  // The name takes the room left; the size, kind and date are shown whole.
  if (auto* list = dialog.findChild<QTreeView*>()) {
    list->header()->setStretchLastSection(false);
    list->header()->setSectionResizeMode(QHeaderView::ResizeToContents);
    list->header()->setSectionResizeMode(0, QHeaderView::Stretch);
  }
  dialog.resize(760, 460);
}

QString ChooseFile(QWidget* parent, const QString& caption, const QString& folder,
                   const QStringList& filters) {
  QFileDialog dialog(parent, caption, folder);
  SetUpFileDialog(dialog, filters);
  if (dialog.exec() != QDialog::Accepted || dialog.selectedFiles().isEmpty()) return {};
  return dialog.selectedFiles().first();
}

bool InstallTranslation(const QString& folder) {
  QCoreApplication* app = QCoreApplication::instance();
  auto translator = std::make_unique<QTranslator>(app);
  if (app == nullptr || !translator->load(QStringLiteral("kavu_vi"), folder)) return false;
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
