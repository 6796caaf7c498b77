#include "ui/ask.h"

#include <QAbstractButton>
#include <QApplication>
#include <QDesktopServices>
#include <QDialogButtonBox>
#include <QMessageBox>
#include <QPushButton>
#include <QUrl>
#include <utility>

#include "ui/texts.h"

namespace kavu::ui {

MsgAnswer Asker::operator()(const Question& question) const {
  if (hook_) return hook_(question);
  // Over the window the user works in (the editor, the find window), not over
  // the main window, which may be hidden behind them.
  QWidget* active = QApplication::activeWindow();
  return ShowMessageBox(active != nullptr ? active : parent_, question);
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
  switch (question.buttons) {
    case MsgButtons::Ok:
      box.setStandardButtons(QMessageBox::Ok);
      break;
    case MsgButtons::YesNo:
      box.setStandardButtons(QMessageBox::Yes | QMessageBox::No);
      box.setDefaultButton(question.defaultNo ? QMessageBox::No : QMessageBox::Yes);
      box.setEscapeButton(QMessageBox::No);
      break;
    case MsgButtons::YesNoCancel:
      box.setStandardButtons(QMessageBox::Yes | QMessageBox::No | QMessageBox::Cancel);
      box.setDefaultButton(QMessageBox::Yes);
      box.setEscapeButton(QMessageBox::Cancel);
      break;
  }
  // Each with its access key (the box takes the letter alone too).
  for (const auto& [button, caption] :
       {std::pair{QMessageBox::Yes, kYesKeyed}, std::pair{QMessageBox::No, kNoKeyed},
        std::pair{QMessageBox::Ok, kOkKeyed}, std::pair{QMessageBox::Cancel, kCancelKeyed}}) {
    if (QAbstractButton* shown = box.button(button)) shown->setText(Q(caption));
  }
  if (question.viewReport) {
    // Answers Yes: the error report opens once the box is gone.
    QPushButton* view = box.addButton(Q(kViewReportKeyed), QMessageBox::YesRole);
    view->setObjectName(QStringLiteral("viewReport"));
    const std::function<void()> viewReport = question.viewReport;
    QObject::connect(view, &QPushButton::clicked, &box, [viewReport] { viewReport(); });
  }
  if (!question.folder.isEmpty()) {
    // Opens the products' folder; the box stays for its answer.
    QPushButton* open = box.addButton(Q(kOpenFolderKeyed), QMessageBox::ActionRole);
    open->setObjectName(QStringLiteral("openFolder"));
    open->disconnect(&box);
    if (auto* buttons = box.findChild<QDialogButtonBox*>()) open->disconnect(buttons);
    const QString folder = question.folder;
    QObject::connect(open, &QPushButton::clicked, &box,
                     [folder] { QDesktopServices::openUrl(QUrl::fromLocalFile(folder)); });
  }
}

MsgAnswer ShowMessageBox(QWidget* parent, const Question& question) {
  QMessageBox box(parent);
  SetUpMessageBox(box, question);
  const int answer = box.exec();
  if (box.clickedButton() != nullptr &&
      box.clickedButton()->objectName() == QLatin1String("viewReport")) {
    return question.buttons == MsgButtons::Ok ? MsgAnswer::Ok : MsgAnswer::Yes;
  }
  switch (question.buttons) {
    case MsgButtons::Ok:
      return MsgAnswer::Ok;
    case MsgButtons::YesNo:
      // Closing the box counts as No.
      return answer == QMessageBox::Yes ? MsgAnswer::Yes : MsgAnswer::No;
    case MsgButtons::YesNoCancel:
      break;
  }
  // Closing the box counts as Cancel: nothing is lost.
  if (answer == QMessageBox::Yes) return MsgAnswer::Yes;
  return answer == QMessageBox::No ? MsgAnswer::No : MsgAnswer::Cancel;
}

}  // namespace kavu::ui
