// The desktop program. Started with a file (from the desktop entry or a file
// manager), it chooses that file as a click in the file list does and computes
// nothing until asked:
//   kavu [FILE]
// Besides the ordinary start it can compute one file on its own and save
// pictures of the window (for the smoke test and the manual):
//   kavu --compute FILE [--screenshot PICTURE.png]
// answers every question with its default, saves the main window after the
// run (and the summary box, the editor on the field book and the find window
// as PICTURE-summary.png, -editor.png, -find.png) and ends without touching
// the settings store. The exit code is 0 when the run reached its summary.
#include <QApplication>
#include <QCommandLineParser>
#include <QFileInfo>
#include <QMessageBox>
#include <QPixmap>
#include <QTimer>
#include <cstdio>

#include "ui/ask.h"
#include "ui/dialog.h"
#include "ui/editor.h"
#include "ui/mainwindow.h"
#include "ui/openfile.h"
#include "ui/texts.h"
#include "ui/timthay.h"

namespace {

using kavu::MsgAnswer;
using kavu::MsgButtons;
using kavu::MsgIcon;
using kavu::ui::Q;

// PICTURE.png -> PICTURE-what.png
QString Picture(const QString& picture, const char* what) {
  const QFileInfo info(picture);
  return info.path() + QStringLiteral("/") + info.completeBaseName() + QStringLiteral("-") +
         QLatin1String(what) + QStringLiteral(".") + info.suffix();
}

int ComputeAlone(kavu::ui::MainWindow& window, const QString& file, const QString& picture) {
  window.asker().setHook([&window, picture](const kavu::ui::Question& question) {
    std::fputs(question.text.toLocal8Bit().replace('\r', '\n').constData(), stderr);
    std::fputs("\n", stderr);
    if (!picture.isEmpty() && question.icon == MsgIcon::Information) {
      // The summary: shown for a moment so that its picture can be taken.
      QMessageBox box(&window);
      kavu::ui::SetUpMessageBox(box, question);
      box.show();
      QApplication::processEvents();
      box.grab().save(Picture(picture, "summary"));
    }
    return question.buttons == MsgButtons::YesNo ? MsgAnswer::Yes : MsgAnswer::Ok;
  });
  window.SetFileBox(file.toStdString());
  window.tinh_Click();
  QApplication::processEvents();
  if (!picture.isEmpty()) {
    if (!window.grab().save(picture)) {
      std::fprintf(stderr, "cannot save %s\n", picture.toLocal8Bit().constData());
      return 3;
    }
    // The field book in the editor, with the find window over it.
    window.suasolieu_Click();
    window.editor().timkiem_Click();
    QApplication::processEvents();
    window.editor().grab().save(Picture(picture, "editor"));
    window.finder().grab().save(Picture(picture, "find"));
  }
  return window.lastRun().outcome == kavu::RunOutcome::Completed ? 0 : 1;
}

}  // namespace

int main(int argc, char** argv) {
  QApplication app(argc, argv);
  QApplication::setApplicationName(Q(kavu::ui::kAppTitle));
  kavu::ui::UseVietnamese(
      QFileInfo(kavu::ui::ProgramDataFile(QStringLiteral("kavu_vi.qm"))).path());
  QCommandLineParser parser;
  parser.addHelpOption();
  const QCommandLineOption compute(QStringLiteral("compute"),
                                   QStringLiteral("Compute FILE and end."), QStringLiteral("FILE"));
  const QCommandLineOption screenshot(QStringLiteral("screenshot"),
                                      QStringLiteral("Save the main window as PICTURE."),
                                      QStringLiteral("PICTURE"));
  parser.addOption(compute);
  parser.addOption(screenshot);
  parser.addPositionalArgument(QStringLiteral("FILE"),
                               QStringLiteral("The data file to choose (nothing is computed)."),
                               QStringLiteral("[FILE]"));
  parser.process(app);

  kavu::ui::MainWindow window;
  window.show();
  if (!parser.positionalArguments().isEmpty())
    kavu::ui::ChooseFile(window, parser.positionalArguments().front());
  if (!parser.isSet(compute)) {
    if (parser.isSet(screenshot)) {
      QTimer::singleShot(200, &window, [&window, &parser, &screenshot] {
        window.grab().save(parser.value(screenshot));
        QApplication::exit(0);
      });
    }
    return QApplication::exec();
  }
  int code = 0;
  QTimer::singleShot(200, &window, [&] {
    code = ComputeAlone(window, parser.value(compute), parser.value(screenshot));
    window.setEndHook({});
    QApplication::exit(code);
  });
  QApplication::exec();
  return code;
}
