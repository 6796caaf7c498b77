#include "ui/ask.h"

#include <QMessageBox>

#include "ui/texts.h"

namespace kavu::ui {

MsgAnswer Asker::operator()(const Question& question) const {
  if (hook_) return hook_(question);
  return ShowMessageBox(parent_, question);
}

QString ScreenLines(QString text) {
  text.replace(QStringLiteral("\r\n"), QStringLiteral("\n"));
  text.replace(QLatin1Char('\r'), QLatin1Char('\n'));
  return text;
}

namespace {

QMessageBox::Icon BoxIcon(MsgIcon icon) {
  switch (icon) {
    case MsgIcon::Critical:
      return QMessageBox::Critical;
    case MsgIcon::Question:
      return QMessageBox::Question;
    case MsgIcon::Exclamation:
      return QMessageBox::Warning;
    case MsgIcon::Information:
      return QMessageBox::Information;
    case MsgIcon::None:
      break;
  }
  return QMessageBox::NoIcon;
}

}  // namespace

void SetUpMessageBox(QMessageBox& box, const Question& question) {
  box.setWindowTitle(Q(kAppTitle));
  box.setText(ScreenLines(question.text));
  box.setIcon(BoxIcon(question.icon));
  if (question.buttons != MsgButtons::YesNo) {
    box.setStandardButtons(QMessageBox::Ok);
    return;
  }
  box.setStandardButtons(QMessageBox::Yes | QMessageBox::No);
  box.setDefaultButton(question.defaultNo ? QMessageBox::No : QMessageBox::Yes);
  box.setEscapeButton(QMessageBox::No);
}

MsgAnswer ShowMessageBox(QWidget* parent, const Question& question) {
  QMessageBox box(parent);
  SetUpMessageBox(box, question);
  const int answer = box.exec();
  if (question.buttons != MsgButtons::YesNo) return MsgAnswer::Ok;
  // Closing the box counts as No.
  return answer == QMessageBox::Yes ? MsgAnswer::Yes : MsgAnswer::No;
}

}  // namespace kavu::ui
