// The main window driven as a surveyor would: the settings kept between
// sessions; choosing a file in the lists; computing it to the summary, which
// leads to the error report; a run stopped underway; the numbers typed read
// as the batch command reads them; unsaved edits of the field book never
// computed unasked; files that fail or cannot be written; the keyboard.
#include <QtTest>
#include <sstream>
#include <tuple>

#include "cli/cli.h"
#include "core/messages.h"
#include "core/typed_numbers.h"
#include "support.h"
#include "tests/generated_book.h"
#include "ui/nhapsdo.h"
#include "ui/openfile.h"
#include "ui/runthread.h"

using namespace kavu;
using namespace kavu::ui;
using namespace kavu::ui::test;

namespace {

// Clicks (or double-clicks) a file of the file list as the mouse would.
void ClickFile(MainWindow& w, const char* name, bool twice = false) {
  auto* list = Child<FileList>(w, "lstfile");
  const QPoint at = list->visualItemRect(list->findItems(name, Qt::MatchExactly).value(0)).center();
  QTest::mouseClick(list->viewport(), Qt::LeftButton, {}, at);
  if (twice) QTest::mouseDClick(list->viewport(), Qt::LeftButton, {}, at);
}

int BatchExit(const std::vector<std::string>& args) {
  const std::vector<std::string_view> views(args.begin(), args.end());
  std::ostringstream out, err;
  return RunCli(views, out, err, false);
}

bool IsSummary(const Question& question) {
  return question.text.startsWith(Q(msg::kTotalStations));
}

}  // namespace

class WindowTest : public QObject {
  Q_OBJECT

  QTemporaryDir store_;

 private slots:
  void init() { UseScratchSettings(store_); }

  // The exit question; every key written on the way out and read back by
  // the next session.
  void settingsAreKeptBetweenSessions() {
    const std::vector<std::tuple<const char*, const char*, QString>> texts = {
        {"txtFKC", "KAVU_txtFKC", QStringLiteral("/data/kc, chung.txt")},
        {"Htxt", "KAVU_HTXT", QStringLiteral("1.5")},
        {"txtSoleDC", "KAVU_SoleDC", QStringLiteral("3")}};
    const std::vector<std::tuple<const char*, const char*, Qt::CheckState>> boxes = {
        {"ckKC", "KAVU_ckKC", Qt::Checked}, {"fkc", "KAVU_Fkc", Qt::Checked},
        {"fasc", "KAVU_Fasc", Qt::Checked}, {"fcp", "KAVU_Fcp", Qt::Checked},
        {"ftd", "KAVU_Ftd", Qt::Unchecked}, {"fdc", "KAVU_Fdc", Qt::Unchecked}};
    {
      Desk desk;
      QCOMPARE(BoxState(Child<QCheckBox>(desk.w, "fdxf")), 2);  // grayed, never stored
      for (const auto& [name, key, text] : texts) Child<QLineEdit>(desk.w, name)->setText(text);
      for (const auto& [name, key, on] : boxes) Child<QCheckBox>(desk.w, name)->setCheckState(on);
      desk.w.SelectKind(5);
      desk.w.show();
      desk.person.answers = {MsgAnswer::No};
      QTest::keyClick(&desk.w, Qt::Key_Escape);  // the cancel button is thoat
      QCOMPARE(desk.person.asked.back().text, Q(kExitQuestion));
      QVERIFY(!desk.ended && !IsStored("KAVU_Ftd"));
      Child<QPushButton>(desk.w, "thoat")->click();  // Yes this time
      QVERIFY(desk.ended);
    }
    MainWindow again;
    for (const auto& [name, key, text] : texts) {
      QCOMPARE(Stored(key), text);
      QCOMPARE(Child<QLineEdit>(again, name)->text(), text);
    }
    for (const auto& [name, key, on] : boxes) {
      QCOMPARE(Stored(key), on == Qt::Checked ? QStringLiteral("1") : QStringLiteral("0"));
      QCOMPARE(Child<QCheckBox>(again, name)->checkState(), on);
    }
    QCOMPARE(Child<FileList>(again, "lstfile")->pattern(), QStringLiteral("*.idx"));
    // The folder label keeps the last 24 characters.
    for (const QString path : {"/home/surveyor/data/2024", "/home/surveyor/data/2024x"})
      QCOMPARE(ShortFolderText(path), (path.size() < 25 ? "" : "...") + path.right(24));
  }

  // However the list's current file changes, it is the chosen file, and it
  // names the products; the last files chosen are there in the next session.
  void theChosenFileNamesTheProducts() {
    Desk desk;
    QVERIFY(QDir(desk.work.path()).mkpath(QStringLiteral("Data/Khảo sát")));
    const QString survey = Native(desk.work.path() + QStringLiteral("/Data/Khảo sát"));
    for (const char* name : {"/job1.sdr", "/job2.sdr", "/job1.asc"}) WriteAll(survey + name, "x");
    MainWindow& w = desk.w;
    w.show();
    QVERIFY(Child<FolderList>(w, "lsttm")->setPath(survey));
    auto* kinds = Child<QComboBox>(w, "cbkieu");
    kinds->setFocus();
    QTest::keyClick(kinds, Qt::Key_Down);  // the user picks the SDR kind
    ClickFile(w, "job1.sdr");
    QCOMPARE(Q(w.state().filesl1), Native(desk.work.path() + "/Data/TRIDO/job1.asc"));
    QTest::keyClick(Child<FileList>(w, "lstfile"), Qt::Key_Down);
    QCOMPARE(Child<QLineEdit>(w, "txtfile")->text(), survey + Native("/job2.sdr"));
    QMimeData data;
    data.setUrls({QUrl::fromLocalFile(survey + "/job1.sdr")});
    QDropEvent drop(QPointF(10, 10), Qt::CopyAction, &data, Qt::LeftButton, {});
    static_cast<QObject&>(w).event(&drop);  // only drops of its own drags reach it otherwise
    QCOMPARE(Q(w.state().daufile), survey + Native("/job1"));
    w.close();
    MainWindow again;
    QCOMPARE(again.recentFiles(),
             QStringList({survey + Native("/job1.sdr"), survey + Native("/job2.sdr")}));

    // The file of the command line is chosen as a click would choose it, and
    // nothing is computed.
    ChooseFile(again, survey + Native("/job1.asc"));
    QCOMPARE(Child<QComboBox>(again, "cbkieu")->currentIndex(), 0);
    QCOMPARE(Child<FileList>(again, "lstfile")->currentItem()->text(), QStringLiteral("job1.asc"));
    QCOMPARE(QDir(survey).count(), 5u);
  }

  // A double click computes to the summary; a run is not closed underway
  // and its stop button writes nothing; no to "continue?" ends the program.
  void aComputeAndAStoppedRun() {
    Desk desk;
    MainWindow& w = desk.w;
    w.show();
    QVERIFY(desk.example());
    ClickFile(w, "job1.asc", true);
    const QString summary = desk.person.asked.at(0).text;
    QVERIFY(summary.startsWith(Q(msg::kTotalStations) + " 4\r") &&
            summary.endsWith(Q(msg::kContinue)));

    // The same job grown large, so that the run is in its station loop when
    // the stop button is pressed.
    desk.write("job1.asc", QByteArray::fromStdString(testing::GeneratedFieldBook(400, 100)));
    const QStringList files = QDir(desk.work.path()).entryList(QDir::Files);
    const QByteArray points = desk.read("job1.td1");
    auto* stop = Child<QPushButton>(w, "dung");
    bool pressed = false;
    const auto underway = [&] {
      if (pressed) return;
      pressed = true;
      QVERIFY(stop->isVisible());
      w.tinh_Click();  // no second run
      w.close();       // nor closing
      QTest::mouseClick(stop, Qt::LeftButton);
    };
    // The first progress of the loop waits for this on the window's thread.
    const auto* run = w.findChild<RunThread*>();
    connect(run, &RunThread::progressed, &w, underway, Qt::BlockingQueuedConnection);
    Child<QPushButton>(w, "tinh")->click();
    QVERIFY(pressed && w.isVisible() && !desk.ended);
    QCOMPARE(desk.person.asked.back().text, Q(msg::kRunCancelled));  // in place of the summary
    QCOMPARE(QDir(desk.work.path()).entryList(QDir::Files), files);
    QCOMPARE(desk.read("job1.td1"), points);

    desk.write("job1.asc", ReadAll(QStringLiteral(KAVU_EXAMPLES "/job1.asc")));
    desk.person.answers = {MsgAnswer::No};
    QTest::keyClick(Child<QLineEdit>(w, "txtfile"), Qt::Key_Return);  // tinh is the default
    QVERIFY(desk.ended);
  }

  // The same texts give the same answer in the window and the batch command;
  // a refused one names its box, takes the focus there and writes nothing;
  // read ones give the same drawing.
  void typedNumbersReadAsTheBatchCommandReadsThem() {
    const struct {
      const char *scale, *height, *decimals;
      const char* box;  // the box refused, or none
    } cases[] = {
        {"1:500", "2,5", "3", nullptr},   {"1/2000", " 1.5 ", "2", nullptr},
        {"1:5OO", "2.0", "2", "TyleTXT"}, {"500", "2,5,0", "2", "Htxt"},
        {"1.000", "2", "2", "TyleTXT"},   {"500", "0", "2", "Htxt"},
        {"500", "2", "hai", "txtSoleDC"},
    };
    for (const auto& c : cases) {
      Desk desk;
      desk.w.show();
      QVERIFY(desk.example());
      Child<QComboBox>(desk.w, "TyleTXT")->setCurrentText(QLatin1String(c.scale));
      Child<QLineEdit>(desk.w, "Htxt")->setText(QLatin1String(c.height));
      Child<QLineEdit>(desk.w, "txtSoleDC")->setText(QLatin1String(c.decimals));
      Child<QCheckBox>(desk.w, "fdxf")->click();
      const QStringList before = QDir(desk.work.path()).entryList(QDir::Files);
      desk.w.tinh_Click();
      const QStringList after = QDir(desk.work.path()).entryList(QDir::Files);
      QVERIFY(QFile::copy(desk.path("job1.asc"), desk.path("batch.asc")));
      QCOMPARE(BatchExit({"--dxf", "--scale", c.scale, "--text-height", c.height,
                          "--height-decimals", c.decimals, desk.path("batch.asc").toStdString()}),
               c.box != nullptr ? kExitUsage : kExitOk);
      if (c.box == nullptr) {
        QVERIFY(IsSummary(desk.person.asked.back()) && !desk.read("job1.dxf").isEmpty());
        QCOMPARE(desk.read("job1.dxf"), desk.read("batch.dxf"));
        continue;
      }
      QCOMPARE(desk.person.asked.size(), std::size_t{1});
      QCOMPARE(desk.person.asked.back().text,
               Q(TypedRefusalMessage(ReadRunNumbers(c.scale, c.height, c.decimals))));
      QCOMPARE(after, before);
      // The box itself, or the text box of the scale's list box.
      const QWidget* focused = desk.w.focusWidget();
      QVERIFY2(
          focused != nullptr && (focused->objectName() == QLatin1String(c.box) ||
                                 focused->parentWidget()->objectName() == QLatin1String(c.box)),
          c.box);
    }
  }

  // Unsaved edits of the field book to compute: Có saves and computes them,
  // Không computes the file on disk and keeps the edits, Hủy computes nothing.
  void unsavedEditsAreSavedLeftOrNotComputed() {
    for (const MsgAnswer answer : {MsgAnswer::Yes, MsgAnswer::No, MsgAnswer::Cancel}) {
      Desk desk;
      desk.w.show();
      QVERIFY(desk.example());
      desk.w.suasolieu_Click();
      QPlainTextEdit* text = desk.w.editor().txtsuasl();
      const QByteArray onDisk = desk.read("job1.asc");
      QTextCursor cursor = text->document()->find(QStringLiteral("DC01 1.45"));
      QVERIFY(!cursor.isNull());
      cursor.insertText(QStringLiteral("DC01 1.55"));
      desk.person.answers = {answer};
      desk.w.tinh_Click();
      QCOMPARE(desk.person.asked.at(0).text.startsWith(Q(kSaveChanges)), true);
      QCOMPARE(desk.person.asked.at(0).buttons, MsgButtons::YesNoCancel);
      const bool computed = desk.person.asked.size() > 1 && IsSummary(desk.person.asked.back());
      QCOMPARE(computed, answer != MsgAnswer::Cancel);
      QCOMPARE(desk.read("job1.asc") == onDisk, answer != MsgAnswer::Yes);
      QCOMPARE(text->document()->isModified(), answer != MsgAnswer::Yes);
      QCOMPARE(QFileInfo::exists(desk.path("job1.txt")), computed);
    }
  }

  // A run with errors offers the error report, which opens in the viewer and
  // leads to the record a line concerns (the second P99, not its namesake);
  // behind the summary the run's progress and stop button are gone. A run
  // without errors offers none.
  void theSummaryLeadsToTheErrorReport() {
    for (const bool errors : {true, false}) {
      Desk desk;
      desk.w.show();
      QVERIFY(desk.example(errors ? "P99 0 10 900000 1.5\r\nP99 0901500\r\n" : ""));
      bool offered = false, runControlsShown = true;
      desk.w.asker().setHook([&](const Question& question) {
        desk.person.asked.push_back(question);
        if (!IsSummary(question)) return MsgAnswer::Ok;
        runControlsShown = Child<QProgressBar>(desk.w, "tiendo")->isVisible() ||
                           Child<QPushButton>(desk.w, "dung")->isVisible();
        offered = bool(question.viewReport);
        if (question.viewReport) {
          QMessageBox box;
          SetUpMessageBox(box, question);
          box.show();
          QApplication::processEvents();
          box.grab().save(QStringLiteral(KAVU_PICTURES "/kavu-summary-errors.png"));
          question.viewReport();
        }
        return MsgAnswer::Yes;
      });
      desk.w.tinh_Click();
      QVERIFY(IsSummary(desk.person.asked.back()));
      QVERIFY(!runControlsShown);
      QCOMPARE(offered, errors);
      QCOMPARE(desk.w.viewer().isVisible(), errors);
      if (errors) {
        QCOMPARE(QFileInfo(desk.w.viewer().file()).fileName(), QStringLiteral("job1.err"));
        QPlainTextEdit* report = desk.w.viewer().txtxem();
        const QTextCursor at = report->document()->find(QStringLiteral("P99"));
        QVERIFY(!at.isNull());
        QTest::mouseDClick(report->viewport(), Qt::LeftButton, {}, report->cursorRect(at).center());
        QVERIFY(desk.w.editor().isVisible());
        QCOMPARE(desk.w.editor().txtsuasl()->textCursor().selectedText(),
                 QStringLiteral("P99 0901500"));
      }
      QVERIFY(Child<QPushButton>(desk.w, "bando")->isEnabled());
    }
  }

  // A file that cannot be computed leaves the recent list, and the title
  // says no more that the run is at work.
  void aFailedFileLeavesTheRecentList() {
    Desk desk;
    desk.w.show();
    QVERIFY(desk.example());
    desk.write("empty.asc", "");
    QVERIFY(desk.w.chooseFile(desk.path("empty.asc")));
    QVERIFY(desk.w.recentFiles().contains(Native(desk.path("empty.asc"))));
    desk.w.tinh_Click();
    QCOMPARE(desk.w.lastRun().outcome, RunOutcome::NotStarted);
    QVERIFY(!desk.w.recentFiles().contains(Native(desk.path("empty.asc"))));
    QVERIFY(desk.w.recentFiles().contains(Native(desk.path("job1.asc"))));
    QCOMPARE(desk.w.windowTitle(), Q(msg::kProgramTitle));
  }

  // An instrument file whose field book cannot be written is computed all the
  // same, and the file box stays on it: no field book stands beside it.
  void anUnwrittenConversionKeepsTheInstrumentFile() {
    Desk desk;
    desk.w.show();
    QVERIFY(QFile::copy(QStringLiteral(KAVU_EXAMPLES "/instruments/job-sdr.sdr"),
                        desk.path("job.sdr")));
    QVERIFY(QDir(desk.work.path()).mkdir(QStringLiteral("job.asc")));
    QVERIFY(desk.w.chooseFile(desk.path("job.sdr")));
    desk.w.tinh_Click();
    QCOMPARE(desk.w.lastRun().outcome, RunOutcome::Completed);
    QVERIFY(!desk.w.lastRun().unwritable.empty());
    QCOMPARE(Child<QLineEdit>(desk.w, "txtfile")->text(), Native(desk.path("job.sdr")));
    // The summary names it with its reason under a warning, and no error
    // report, since the run found no error.
    const Question& summary = desk.person.asked.back();
    QCOMPARE(summary.icon, MsgIcon::Exclamation);
    QVERIFY2(summary.text.contains(Q(msg::kCannotWrite) + Native(desk.path("job.asc")) + " (" +
                                   Q(msg::kIsAFolder) + ")") &&
                 !summary.text.contains(QLatin1String(".err")),
             qPrintable(summary.text));
  }

  // No to "continue?" and Hủy to saving the editor's edits: the program stays
  // and its map button works.
  void cancellingTheWayOutKeepsTheMap() {
    Desk desk;
    desk.w.show();
    QVERIFY(desk.example());
    desk.write("other.asc", "TR A 1 2 3\r\n");
    desk.w.suasolieu_Click();
    desk.w.editor().openFile(desk.path("other.asc"), desk.path("other"), desk.work.path(),
                             QStringLiteral("TR A 1 2 3\n"));
    desk.w.editor().txtsuasl()->appendPlainText(QStringLiteral("TR B 4 5 6"));
    desk.person.answers = {MsgAnswer::No, MsgAnswer::Cancel};
    desk.w.tinh_Click();
    QVERIFY(!desk.ended);
    QVERIFY(desk.w.isVisible());
    QVERIFY(Child<QPushButton>(desk.w, "bando")->isEnabled());
  }

  // Every option explains itself; no two controls share an access key; the
  // buttons are reached with Tab in the order they stand; the header form
  // opens from its button.
  void theWindowWorksFromTheKeyboard() {
    Desk desk;
    desk.w.show();
    const QStringList faults = KeyboardFaults(desk.w, true);
    QVERIFY2(faults.isEmpty(), qPrintable(faults.join(QLatin1Char('\n'))));
    // The map button comes before the exit button.
    QWidget* at = Child<QPushButton>(desk.w, "tinh");
    QStringList order;
    for (int i = 0; i < 8; ++i, at = at->nextInFocusChain()) order << at->objectName();
    QVERIFY2(order.indexOf(QStringLiteral("bando")) < order.indexOf(QStringLiteral("thoat")),
             qPrintable(order.join(QLatin1Char(' '))));
    Child<QPushButton>(desk.w, "nhapsdoButton")->click();
    QVERIFY(desk.w.headerFormLoaded() && desk.w.headerForm().isVisible());
    QVERIFY(desk.w.headerForm().grab().save(QStringLiteral(KAVU_PICTURES "/kavu-header-form.png")));
    QVERIFY(desk.w.grab().save(QStringLiteral(KAVU_PICTURES "/kavu-main-options.png")));
    // The help lists the instrument files from the table of formats.
    Child<QPushButton>(desk.w, "trogiup")->click();
    QVERIFY(desk.w.helpWindow() != nullptr);
    const QString help = Child<QTextBrowser>(*desk.w.helpWindow(), "helptext")->toPlainText();
    QVERIFY2(help.contains(QStringLiteral("Số liệu FieldBook SDR (.sdr)")), qPrintable(help));
    QVERIFY(help.contains(QStringLiteral("Topcom 226 column file (.tcm)")));
  }
};

QTEST_MAIN(WindowTest)
#include "window_test.moc"
