#include "ui/dialog.h"

#include <QCloseEvent>
#include <QKeyEvent>
#include <QPushButton>

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

QPushButton* MakeButton(QWidget* parent, const char* name, const QString& caption) {
  auto* button = new QPushButton(caption, parent);
  button->setObjectName(QLatin1String(name));
  button->setAutoDefault(false);
  return button;
}

}  // namespace kavu::ui
