#include "ui/dialog.h"

#include <QCloseEvent>
#include <QFileDialog>
#include <QKeyEvent>
#include <QPushButton>

#include "ui/ask.h"
#include "ui/texts.h"

namespace kavu::ui {

Window::Window(QWidget* parent) : QDialog(parent) {
  setWindowFlag(Qt::WindowContextHelpButtonHint, false);
  setWindowFlag(Qt::WindowMinMaxButtonsHint, true);
}

void Window::keyPressEvent(QKeyEvent* event) {
  if (event->key() == Qt::Key_Escape && event->modifiers() == Qt::NoModifier) {
    if (cancel_ != nullptr && cancel_->isEnabled()) cancel_->click();
    event->accept();
    return;
  }
  QDialog::keyPressEvent(event);
}

void Window::reject() { close(); }

void Window::closeEvent(QCloseEvent* event) { event->accept(); }

QString ChooseFile(QWidget* parent, const QString& caption, const QString& folder,
                   const QStringList& filters) {
  QFileDialog dialog(parent, caption, folder);
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
  dialog.resize(760, 460);
  if (dialog.exec() != QDialog::Accepted || dialog.selectedFiles().isEmpty()) return {};
  return dialog.selectedFiles().first();
}

QPushButton* MakeButton(QWidget* parent, const char* name, const QString& caption) {
  auto* button = new QPushButton(caption, parent);
  button->setObjectName(QLatin1String(name));
  button->setAutoDefault(false);
  return button;
}

}  // namespace kavu::ui
