// The main window driven as a surveyor would: choosing a file in the lists,
// computing it to the summary, the edit, help and control-file buttons.
#include "ui/mainwindow.h"

#include <QCheckBox>
#include <QComboBox>
#include <QDir>
#include <QDirIterator>
#include <QLineEdit>
#include <QMimeData>
#include <QPushButton>
#include <QScreen>
#include <QTextBrowser>
#include <QtTest>
#include <functional>
#include <map>

#include "core/messages.h"
#include "core/tcvn3.h"
#include "support.h"
#include "tests/generated_book.h"
#include "ui/editor.h"
#include "ui/lists.h"
#include "ui/nhapsdo.h"
#include "ui/openfile.h"
#include "ui/runthread.h"
#include "ui/timthay.h"

using namespace kavu;
using namespace kavu::ui;
using namespace kavu::ui::test;

class MainWindowTest : public QObject {
  Q_OBJECT

  QTemporaryDir store_;

  // Clicks (or double-clicks) a file of the file list as the mouse would.
  static bool ClickFile(MainWindow& w, const QString& name, bool twice = false) {
    auto* list = Child<FileList>(w, "lstfile");
    const QList<QListWidgetItem*> items = list->findItems(name, Qt::MatchExactly);
    if (items.isEmpty()) return false;
    const QPoint at = list->visualItemRect(items.first()).center();
    QTest::mouseClick(list->viewport(), Qt::LeftButton, {}, at);
    if (twice) QTest::mouseDClick(list->viewport(), Qt::LeftButton, {}, at);
    return true;
  }

  // The example field book in the desk's folder, shown in the lists.
  static bool ShowExample(Desk& desk) {
    return QFile::copy(QStringLiteral(KAVU_EXAMPLES "/job1.asc"), desk.path("job1.asc")) &&
           Child<FolderList>(desk.w, "lsttm")->setPath(desk.work.path());
  }

  static QString Native(const QString& path) { return QDir::toNativeSeparators(path); }
  // Every file of the folder and below by its path, with its bytes.
  static std::map<QString, QByteArray> Files(const QString& folder) {
    std::map<QString, QByteArray> files;
    for (QDirIterator it(folder, QDir::Files | QDir::Hidden, QDirIterator::Subdirectories);
         it.hasNext();) {
      const QString path = it.next();
      files[path] = ReadAll(path);
    }
    return files;
  }
  static QString Sep() { return QString(QDir::separator()); }

 private slots:
  void init() { UseScratchSettings(store_); }

  void clickingAFileSetsTheSelectionAndTheTridoPath() {
    QTemporaryDir root;
    QVERIFY(QDir(root.path()).mkpath(QStringLiteral("Data/Survey")));
    const QString survey = Native(root.path() + QStringLiteral("/Data/Survey"));
    for (const char* name : {"/job1.sdr", "/job1.asc", "/README"}) WriteAll(survey + name, "x");

    MainWindow w;
    w.show();
    QVERIFY(Child<FolderList>(w, "lsttm")->setPath(survey));
    auto* kinds = Child<QComboBox>(w, "cbkieu");
    kinds->setFocus();
    QTest::keyClick(kinds, Qt::Key_Down);  // the user picks the SDR kind
    QCOMPARE(kinds->currentIndex(), 1);
    auto* files = Child<FileList>(w, "lstfile");
    QCOMPARE(files->count(), 1);
    QVERIFY(ClickFile(w, QStringLiteral("job1.sdr")));

    const RunState& st = w.state();
    const QString trido = Native(root.path() + QStringLiteral("/Data/TRIDO")) + Sep();
    QCOMPARE(Q(st.filesl), survey + Sep() + QStringLiteral("job1.sdr"));
    QCOMPARE(Q(st.tentm), survey + Sep());
    QCOMPARE(Q(st.daufile), survey + Sep() + QStringLiteral("job1"));
    QCOMPARE(Q(st.duoifile), QStringLiteral("sdr"));
    QCOMPARE(Q(st.tentmbd), trido);
    QCOMPARE(Q(st.filesl1), trido + "job1.asc");
    QCOMPARE(Child<QLineEdit>(w, "txtfile")->text(), Q(st.filesl));

    // The last kind lists every file, also one without a dot.
    kinds->setCurrentIndex(8);
    QTest::keyClick(kinds, Qt::Key_Down);
    QCOMPARE(files->pattern(), QStringLiteral("*.*"));
    QCOMPARE(files->count(), 3);
  }

  // The file given on the command line is chosen as a click would choose it,
  // in a folder with Vietnamese letters, and nothing is computed.
  void theFileOfTheCommandLineIsChosenNotComputed() {
    Desk desk;
    const QString folder = Native(desk.work.path() + QStringLiteral("/Khảo sát"));
    QVERIFY(QDir().mkpath(folder));
    const QString sdr = folder + Sep() + QStringLiteral("job1.sdr");
    QVERIFY(QFile::copy(QStringLiteral(KAVU_EXAMPLES "/instruments/job-sdr.sdr"), sdr));
    desk.w.show();
    ChooseFile(desk.w, sdr);

    const RunState& st = desk.w.state();
    QCOMPARE(Q(st.filesl), sdr);
    QCOMPARE(Q(st.daufile), folder + Sep() + QStringLiteral("job1"));
    QCOMPARE(Child<QLineEdit>(desk.w, "txtfile")->text(), sdr);
    QCOMPARE(Child<QComboBox>(desk.w, "cbkieu")->currentIndex(), 1);
    auto* files = Child<FileList>(desk.w, "lstfile");
    QCOMPARE(Native(files->path()), folder);
    QCOMPARE(files->currentItem()->text(), QStringLiteral("job1.sdr"));
    QVERIFY(desk.person.asked.empty());
    QCOMPARE(QDir(folder).entryList(QDir::Files), QStringList{QStringLiteral("job1.sdr")});

    // A file that does not exist only fills the file box.
    const QString missing = folder + Sep() + QStringLiteral("none.asc");
    ChooseFile(desk.w, missing);
    QCOMPARE(Child<QLineEdit>(desk.w, "txtfile")->text(), missing);
    QVERIFY(desk.person.asked.empty());
  }

  void theCurrentFileIsTheChosenOne() {
    // However the list's current file changes, it is the chosen file.
    struct Way {
      const char* name;
      std::function<void(MainWindow&, FileList*)> move;
    };
    const std::vector<Way> ways = {
        {"mouse", [](MainWindow& w, FileList*) { ClickFile(w, QStringLiteral("b.asc")); }},
        {"keys",
         [](MainWindow& w, FileList* list) {
           ClickFile(w, QStringLiteral("a.asc"));
           QTest::keyClick(list, Qt::Key_Down);
         }},
        {"program", [](MainWindow&, FileList* list) { list->setCurrentRow(1); }},
        {"dropped",
         [](MainWindow& w, FileList* list) {
           QMimeData data;
           data.setUrls({QUrl::fromLocalFile(list->path() + "/b.asc")});
           QDropEvent drop(QPointF(10, 10), Qt::CopyAction, &data, Qt::LeftButton, {});
           // Straight to the window: the application passes on only drops of
           // a drag it runs itself.
           static_cast<QObject&>(w).event(&drop);
         }},
    };
    for (const Way& way : ways) {
      Desk desk;
      for (const char* name : {"a.asc", "b.asc", "c.asc"}) desk.write(name, "x\r\n");
      desk.w.show();
      QVERIFY(Child<FolderList>(desk.w, "lsttm")->setPath(desk.work.path()));
      way.move(desk.w, Child<FileList>(desk.w, "lstfile"));
      QVERIFY2(Q(desk.w.state().filesl) == Native(desk.path("b.asc")), way.name);
      QCOMPARE(Child<QLineEdit>(desk.w, "txtfile")->text(), Native(desk.path("b.asc")));
      QCOMPARE(desk.w.recentFiles().value(0), Native(desk.path("b.asc")));
    }
  }

  void aTypedPathCountsForEveryButton() {
    Desk desk;
    desk.write("typed.asc", "TR A 1.5\r\n");
    desk.w.show();
    Child<QLineEdit>(desk.w, "txtfile")->setText(Native(desk.path("typed.asc")));
    Child<QPushButton>(desk.w, "suasolieu")->click();
    QVERIFY(desk.w.editor().isVisible());
    QCOMPARE(desk.w.editor().file(), Native(desk.path("typed.asc")));
    QCOMPARE(Q(desk.w.state().daufile), Native(desk.path("typed")));
    // A typed path that is not there is named in the message.
    Child<QLineEdit>(desk.w, "txtfile")->setText(Native(desk.path("gone.asc")));
    Child<QPushButton>(desk.w, "suasolieu")->click();
    QCOMPARE(desk.person.asked.back().text, Q(kFileNotFoundShort) + Native(desk.path("gone.asc")));
  }

  void theLastFilesAreRemembered() {
    QString first;
    {
      Desk desk;
      desk.write("a.asc", "x\r\n");
      desk.write("b.asc", "x\r\n");
      desk.w.chooseFile(desk.path("a.asc"));
      desk.w.chooseFile(desk.path("b.asc"));
      desk.w.chooseFile(desk.path("a.asc"));
      QCOMPARE(desk.w.recentFiles(),
               QStringList({Native(desk.path("a.asc")), Native(desk.path("b.asc"))}));
      desk.w.close();
      MainWindow again;
      QCOMPARE(again.recentFiles(), desk.w.recentFiles());
      QCOMPARE(Child<QLineEdit>(again, "txtfile")->text(), Native(desk.path("a.asc")));
      QCOMPARE(Q(again.state().filesl), Native(desk.path("a.asc")));
    }
  }

  void aComputeEndsWithTheSummary() {
    Desk desk;
    MainWindow& w = desk.w;
    QStringList titles;
    connect(&w, &QWidget::windowTitleChanged, this,
            [&titles](const QString& title) { titles.append(title); });
    w.show();
    QVERIFY(ShowExample(desk));
    Child<QCheckBox>(w, "fdxf")->click();  // grayed -> ticked
    QVERIFY(ClickFile(w, QStringLiteral("job1.asc")));
    QTest::mouseClick(Child<QPushButton>(w, "tinh"), Qt::LeftButton);

    QCOMPARE(desk.person.asked.size(), 1u);
    const Question& summary = desk.person.asked[0];
    QCOMPARE(summary.icon, MsgIcon::Information);
    QCOMPARE(summary.buttons, MsgButtons::YesNo);
    const QStringList lines = summary.text.split(QLatin1Char('\r'));
    QCOMPARE(lines.size(), 7);
    // The example has four stations and 110 body lines, without errors.
    QCOMPARE(lines[0], Q(msg::kTotalStations) + QStringLiteral(" 4"));
    QCOMPARE(lines[1], Q(msg::kTotalPoints) + QStringLiteral(" 110"));
    QCOMPARE(lines[2], Q(msg::kTotalErrors) + QStringLiteral(" 0"));
    QCOMPARE(lines[6], Q(msg::kContinue));
    QCOMPARE(QDir::cleanPath(summary.folder), QDir::cleanPath(desk.work.path()));

    QVERIFY(titles.contains(Q(msg::kStationTitle) + QStringLiteral("DC01        ")));
    QCOMPARE(w.windowTitle(), Q(msg::kProgramTitle));
    QVERIFY(QFile::exists(desk.path("job1.txt")));
    QVERIFY(QFile::exists(desk.path("job1.dxf")));
    QVERIFY(!QFile::exists(desk.path("job1.err")));  // no errors, no report
    QVERIFY(!desk.ended);
    QCOMPARE(Child<QLineEdit>(w, "txtfile")->text(), Native(desk.path("job1.asc")));
    QCOMPARE(Child<QComboBox>(w, "cbkieu")->currentIndex(), 0);
    QCOMPARE(Child<FileList>(w, "lstfile")->findItems("job1.asc", Qt::MatchExactly).size(), 1);

    // No to "continue?" ends the program, and the session's choices are kept.
    desk.person.answers = {MsgAnswer::No};
    Child<QComboBox>(w, "TyleTXT")->setCurrentText(QStringLiteral("500"));
    QTest::keyClick(Child<QLineEdit>(w, "txtfile"), Qt::Key_Return);  // tinh is the default
    QCOMPARE(desk.person.asked.size(), 2u);
    QVERIFY(desk.ended);
    QCOMPARE(Stored("KAVU_TyleTXT"), QStringLiteral("500"));
  }

  void aRunIsNotClosedUnderway() {
    Desk desk;
    MainWindow& w = desk.w;
    QVERIFY(ShowExample(desk));
    w.show();
    // The close box and the compute button pressed while the title shows
    // the first station.
    bool pressed = false;
    connect(&w, &QWidget::windowTitleChanged, &w, [&w, &pressed](const QString& title) {
      if (!title.startsWith(Q(msg::kStationTitle)) || pressed) return;
      pressed = true;
      w.close();
      w.tinh_Click();
    });
    w.SetFileBox(Native(desk.path("job1.asc")).toStdString());
    w.tinh_Click();
    QCOMPARE(desk.person.asked.size(), 1u);  // the summary, answered Yes
    QVERIFY(!desk.ended);
    QVERIFY(w.isVisible());
    QVERIFY(!IsStored("KAVU_Ftd"));
  }

  void aRunIsStoppedAndWritesNothing() {
    Desk desk;
    MainWindow& w = desk.w;
    w.show();
    QVERIFY(ShowExample(desk));
    for (const char* product : {"fdxf", "fsdo"}) Child<QCheckBox>(w, product)->click();
    QVERIFY(ClickFile(w, QStringLiteral("job1.asc")));
    Child<QPushButton>(w, "tinh")->click();
    QCOMPARE(desk.person.asked.size(), 1u);  // the summary of the earlier run
    // The same job grown large, so that the run is in its station loop when
    // the stop button is pressed.
    desk.write("job1.asc", QByteArray::fromStdString(testing::GeneratedFieldBook(400, 100)));
    const auto before = Files(desk.work.path());

    // The first progress of the loop waits for this to be handled on the
    // window's thread: the window takes input while the run works.
    auto* stop = Child<QPushButton>(w, "dung");
    bool pressed = false;
    connect(
        w.findChild<RunThread*>(), &RunThread::progressed, &w,
        [&] {
          if (pressed) return;
          pressed = true;
          QVERIFY(w.running());
          QVERIFY(stop->isVisible());
          QVERIFY(!Child<QPushButton>(w, "tinh")->isEnabled());
          w.tinh_Click();  // no second run
          w.close();       // nor closing
          QTest::mouseClick(stop, Qt::LeftButton);
        },
        Qt::BlockingQueuedConnection);
    Child<QPushButton>(w, "tinh")->click();

    QVERIFY(pressed);
    QCOMPARE(w.lastRun().outcome, RunOutcome::Cancelled);
    QCOMPARE(desk.person.asked.size(), 2u);  // the message, in place of the summary
    QCOMPARE(desk.person.asked[1].text, Q(msg::kRunCancelled));
    QCOMPARE(desk.person.asked[1].buttons, MsgButtons::Ok);
    QCOMPARE(Files(desk.work.path()), before);  // nothing written, no temporary file
    QCOMPARE(w.windowTitle(), Q(msg::kProgramTitle));
    QVERIFY(w.isVisible() && !desk.ended);
    QVERIFY(!stop->isVisible());
    QVERIFY(Child<QPushButton>(w, "tinh")->isEnabled());
  }

  void theFieldSketchTakesTheStoredHeaderTexts() {
    Store().setValue(Key("NhapSDO5"), Q("Lê Thị Hoa"));
    Desk desk;
    QVERIFY(ShowExample(desk));
    QVERIFY(ClickFile(desk.w, QStringLiteral("job1.asc")));
    desk.w.tinh_Click();
    QVERIFY(!desk.w.headerFormLoaded());  // not wanted, not read
    QVERIFY(!QFile::exists(desk.path("job1.sdo")));

    Child<QCheckBox>(desk.w, "fsdo")->setCheckState(Qt::Checked);
    desk.w.tinh_Click();
    // Read from the store through the form, loaded without being shown.
    QVERIFY(desk.w.headerFormLoaded());
    QVERIFY(!desk.w.headerForm().isVisible());
    const std::string surveyor = Utf8ToTcvn3("Lê Thị Hoa");
    QVERIFY(desk.read("job1.sdo").contains(QByteArray::fromStdString(surveyor)));
  }

  void aDoubleClickComputesAndARefusedFileIsReported() {
    Desk desk;
    desk.w.show();
    QVERIFY(ShowExample(desk));
    QVERIFY(ClickFile(desk.w, QStringLiteral("job1.asc"), true));
    const std::vector<Question>& asked = desk.person.asked;
    QCOMPARE(asked.size(), 1u);
    QCOMPARE(asked[0].icon, MsgIcon::Information);

    Child<QLineEdit>(desk.w, "txtfile")->clear();
    Child<QPushButton>(desk.w, "tinh")->click();
    QCOMPARE(asked.size(), 2u);
    QCOMPARE(asked[1].text, Q(msg::kNoFileChosen));
    QCOMPARE(asked[1].icon, MsgIcon::Critical);
    QCOMPARE(asked[1].buttons, MsgButtons::Ok);
  }

  void editWithoutAFileSaysSoAndHelpOpensTheManual() {
    Desk desk;
    const std::vector<Question>& asked = desk.person.asked;
    Child<QPushButton>(desk.w, "suasolieu")->click();
    QCOMPARE(asked.size(), 1u);
    QCOMPARE(asked[0].text, Q(kFileNotFoundShort));
    QCOMPARE(asked[0].icon, MsgIcon::Critical);
    QVERIFY(!desk.w.editor().isVisible());

    // The manual beside the program, opened without a question.
    Child<QPushButton>(desk.w, "trogiup")->click();
    QCOMPARE(asked.size(), 1u);
    Window* help = desk.w.helpWindow();
    QVERIFY(help != nullptr && help->isVisible());
    QVERIFY(help->findChild<QTextBrowser*>()->toPlainText().contains(QStringLiteral("Inputs")));
  }

  void sideWindowsAreWindowsOfTheirOwn() {
    // Not tied to the main window, so none of them always covers another;
    // the editor on the right two fifths, the viewer on the left three.
    MainWindow w;
    for (QWidget* side :
         std::initializer_list<QWidget*>{&w.editor(), &w.viewer(), &w.finder(), &w.headerForm()}) {
      QVERIFY(side->isWindow());
      QVERIFY(side->parentWidget() == nullptr);
    }
    const QRect area = QGuiApplication::primaryScreen()->availableGeometry();
    QCOMPARE(w.editor().x(), area.left() + area.width() / 5 * 3);
    QCOMPARE(w.viewer().x(), area.left());
    QCOMPARE(w.viewer().width(), area.width() / 5 * 3);
  }

  void controlFileChoice() {
    MainWindow w;
    auto* box = Child<QLineEdit>(w, "txtFKC");
    auto* use = Child<QCheckBox>(w, "ckKC");
    box->setText(QStringLiteral("/old/kc.txt"));
    // Cancelled: the box and the tick stay as they were.
    w.setControlFileChooser([] { return QString(); });
    Child<QPushButton>(w, "KC")->click();
    QCOMPARE(box->text(), QStringLiteral("/old/kc.txt"));
    QCOMPARE(use->checkState(), Qt::Unchecked);
    w.setControlFileChooser([] { return QStringLiteral("/data/kc chung.txt"); });
    Child<QPushButton>(w, "KC")->click();
    QCOMPARE(box->text(), Native(QStringLiteral("/data/kc chung.txt")));
    QCOMPARE(use->checkState(), Qt::Checked);
  }
};

QTEST_MAIN(MainWindowTest)
#include "mainwindow_test.moc"
