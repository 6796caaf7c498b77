#include "ui/ask.h"

#include <QMessageBox>

#include "ui/texts.h"

namespace kavu::ui {

MsgAnswer Asker::operator()(const Question& question) const {
  if (hook_) return hook_(question);
  return ShowMessageBox(parent_, question);
}

MsgAnswer ShowMessageBox(QWidget* parent, const Question& question) {
  QMessageBox box(parent);
  box.setWindowTitle(Q(kAppTitle));
  QString text = question.text;
  text.replace(QStringLiteral("\r\n"), QStringLiteral("\n"));
  text.replace(QLatin1Char('\r'), QLatin1Char('\n'));
  box.setText(text);
  switch (question.icon) {
    case MsgIcon::Critical:
      box.setIcon(QMessageBox::Critical);
      break;
    case MsgIcon::Question:
      box.setIcon(QMessageBox::Question);
      break;
    case MsgIcon::Exclamation:
      box.setIcon(QMessageBox::Warning);
      break;
    case MsgIcon::Information:
      box.setIcon(QMessageBox::Information);
      break;
    case MsgIcon::None:
      break;
  }
  if (question.buttons == MsgButtons::YesNo) {
    box.setStandardButtons(QMessageBox::Yes | QMessageBox::No);
    box.setDefaultButton(question.defaultNo ? QMessageBox::No : QMessageBox::Yes);
    box.setEscapeButton(QMessageBox::No);
    // Closing the box counts as No.
    return box.exec() == QMessageBox::Yes ? MsgAnswer::Yes : MsgAnswer::No;
  }
  box.setStandardButtons(QMessageBox::Ok);
  box.exec();
  return MsgAnswer::Ok;
}

}  // namespace kavu::ui
