// The main window driven as a surveyor would: choosing a file in the lists,
// computing it to the summary, the edit, help and control-file buttons.
#include "ui/mainwindow.h"

#include <QCheckBox>
#include <QComboBox>
#include <QDir>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTextBrowser>
#include <QtTest>

#include "core/messages.h"
#include "core/tcvn3.h"
#include "support.h"
#include "ui/editor.h"
#include "ui/lists.h"
#include "ui/nhapsdo.h"

using namespace kavu;
using namespace kavu::ui;
using namespace kavu::ui::test;

class MainWindowTest : public QObject {
  Q_OBJECT

  QTemporaryDir store_;

  template <typename T>
  static T* Child(QWidget& window, const char* name) {
    T* child = window.findChild<T*>(QLatin1String(name));
    if (child == nullptr) qFatal("no control %s", name);
    return child;
  }

  // Clicks (or double-clicks) a file of the file list as the mouse would.
  static bool ClickFile(MainWindow& w, const QString& name, bool twice = false) {
    auto* list = Child<FileList>(w, "lstfile");
    const QList<QListWidgetItem*> items = list->findItems(name, Qt::MatchExactly);
    if (items.isEmpty()) return false;
    const QPoint at = list->visualItemRect(items.first()).center();
    if (twice) {
      QTest::mouseClick(list->viewport(), Qt::LeftButton, {}, at);
      QTest::mouseDClick(list->viewport(), Qt::LeftButton, {}, at);
    } else {
      QTest::mouseClick(list->viewport(), Qt::LeftButton, {}, at);
    }
    return true;
  }

  static QString Native(const QString& path) { return QDir::toNativeSeparators(path); }

  static QString Sep() { return QString(QDir::separator()); }

 private slots:
  void init() { UseScratchSettings(store_); }

  void clickingAFileSetsTheSelectionAndTheTridoPath() {
    QTemporaryDir root;
    QVERIFY(QDir(root.path()).mkpath(QStringLiteral("Data/Survey")));
    const QString survey = Native(root.path() + QStringLiteral("/Data/Survey"));
    WriteAll(survey + QStringLiteral("/job1.sdr"), "x");
    WriteAll(survey + QStringLiteral("/job1.asc"), "x");
    WriteAll(survey + QStringLiteral("/README"), "x");

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
    const QString data = Native(root.path() + QStringLiteral("/Data"));
    QCOMPARE(Q(st.filesl), survey + Sep() + QStringLiteral("job1.sdr"));
    QCOMPARE(Q(st.tentm), survey + Sep());
    QCOMPARE(Q(st.daufile), survey + Sep() + QStringLiteral("job1"));
    QCOMPARE(Q(st.duoifile), QStringLiteral("sdr"));
    QCOMPARE(Q(st.tentmbd), data + Sep() + QStringLiteral("TRIDO") + Sep());
    QCOMPARE(Q(st.filesl1), data + Sep() + QStringLiteral("TRIDO") + Sep() + "job1.asc");
    QCOMPARE(Child<QLineEdit>(w, "txtfile")->text(), Q(st.filesl));

    // The last kind lists every file, also one without a dot.
    kinds->setCurrentIndex(8);
    QTest::keyClick(kinds, Qt::Key_Down);
    QCOMPARE(files->pattern(), QStringLiteral("*.*"));
    QCOMPARE(files->count(), 3);
  }

  void aDotInAFolderNameDoesNotRenameTheProducts() {
    QTemporaryDir root;
    QVERIFY(QDir(root.path()).mkpath(QStringLiteral("My.Data")));
    const QString folder = Native(root.path() + QStringLiteral("/My.Data"));
    WriteAll(folder + QStringLiteral("/job1.asc"), "x");
    MainWindow w;
    w.show();
    QVERIFY(Child<FolderList>(w, "lsttm")->setPath(folder));
    QVERIFY(ClickFile(w, QStringLiteral("job1.asc")));
    QCOMPARE(Q(w.state().daufile), folder + Sep() + QStringLiteral("job1"));
    QCOMPARE(Q(w.state().duoifile), QStringLiteral("asc"));
  }

  void aComputeEndsWithTheSummary() {
    QTemporaryDir work;
    QVERIFY(QFile::copy(QStringLiteral(KAVU_EXAMPLES "/job1.asc"), work.filePath("job1.asc")));
    Person person;
    MainWindow w;
    w.asker().setHook(person.hook());
    bool ended = false;
    w.setEndHook([&ended] { ended = true; });
    QStringList titles;
    connect(&w, &QWidget::windowTitleChanged, this,
            [&titles](const QString& title) { titles.append(title); });
    w.show();
    QVERIFY(Child<FolderList>(w, "lsttm")->setPath(work.path()));
    Child<QCheckBox>(w, "fdxf")->click();  // grayed -> ticked
    QVERIFY(ClickFile(w, QStringLiteral("job1.asc")));
    QTest::mouseClick(Child<QPushButton>(w, "tinh"), Qt::LeftButton);

    QCOMPARE(person.asked.size(), 1u);
    const Question& summary = person.asked[0];
    QCOMPARE(summary.icon, MsgIcon::Information);
    QCOMPARE(summary.buttons, MsgButtons::YesNo);
    const QStringList lines = summary.text.split(QLatin1Char('\r'));
    QCOMPARE(lines.size(), 7);
    // The example has four stations and 110 body lines, without errors.
    QCOMPARE(lines[0], Q(msg::kTotalStations) + QStringLiteral(" 4"));
    QCOMPARE(lines[1], Q(msg::kTotalPoints) + QStringLiteral(" 110"));
    QCOMPARE(lines[2], Q(msg::kTotalErrors) + QStringLiteral(" 0"));
    QCOMPARE(lines[6], Q(msg::kContinue));

    QVERIFY(titles.contains(Q(msg::kStationTitle) + QStringLiteral("DC01        ")));
    QCOMPARE(w.windowTitle(), Q(msg::kProgramTitle));
    QVERIFY(QFile::exists(work.filePath("job1.txt")));
    QVERIFY(QFile::exists(work.filePath("job1.dxf")));
    QVERIFY(!QFile::exists(work.filePath("job1.err")));  // no errors, no report
    QVERIFY(!ended);
    QCOMPARE(Child<QLineEdit>(w, "txtfile")->text(), Native(work.filePath("job1.asc")));
    QCOMPARE(Child<QComboBox>(w, "cbkieu")->currentIndex(), 0);
    QVERIFY(Child<FileList>(w, "lstfile")->findItems("job1.asc", Qt::MatchExactly).size() == 1);

    // No to "continue?" ends the program, and the session's choices are kept.
    person.answers = {MsgAnswer::No};
    Child<QComboBox>(w, "TyleTXT")->setCurrentText(QStringLiteral("500"));
    QTest::keyClick(Child<QLineEdit>(w, "txtfile"), Qt::Key_Return);  // tinh is the default
    QCOMPARE(person.asked.size(), 2u);
    QVERIFY(ended);
    QCOMPARE(Stored("KAVU_TyleTXT"), QStringLiteral("500"));
  }

  void aRunIsNotClosedUnderway() {
    QTemporaryDir work;
    QVERIFY(QFile::copy(QStringLiteral(KAVU_EXAMPLES "/job1.asc"), work.filePath("job1.asc")));
    Person person;
    MainWindow w;
    w.asker().setHook(person.hook());
    bool ended = false;
    w.setEndHook([&ended] { ended = true; });
    w.show();
    // The close box pressed while the title shows the first station.
    connect(&w, &QWidget::windowTitleChanged, &w, [&w](const QString& title) {
      if (title.startsWith(Q(msg::kStationTitle))) w.close();
    });
    w.SetFileBox(Native(work.filePath("job1.asc")).toStdString());
    w.tinh_Click();
    QCOMPARE(person.asked.size(), 1u);  // the summary, answered Yes
    QVERIFY(!ended);
    QVERIFY(w.isVisible());
    QVERIFY(!IsStored("KAVU_Ftd"));
  }

  void theFieldSketchTakesTheStoredHeaderTexts() {
    QTemporaryDir work;
    QVERIFY(QFile::copy(QStringLiteral(KAVU_EXAMPLES "/job1.asc"), work.filePath("job1.asc")));
    {
      QSettings store(QSettings::IniFormat, QSettings::UserScope, Q(kAppTitle), Q(kAppTitle));
      store.setValue("Settings/NhapSDO5", Q("Lê Thị Hoa"));
    }
    Person person;
    MainWindow w;
    w.asker().setHook(person.hook());
    w.setEndHook([] {});
    QVERIFY(Child<FolderList>(w, "lsttm")->setPath(work.path()));
    QVERIFY(ClickFile(w, QStringLiteral("job1.asc")));
    w.tinh_Click();
    QVERIFY(!w.headerFormLoaded());  // not wanted, not read
    QVERIFY(!QFile::exists(work.filePath("job1.sdo")));

    Child<QCheckBox>(w, "fsdo")->setCheckState(Qt::Checked);
    w.tinh_Click();
    // Read from the store through the form, loaded without being shown.
    QVERIFY(w.headerFormLoaded());
    QVERIFY(!w.headerForm().isVisible());
    const std::string surveyor = Utf8ToTcvn3("Lê Thị Hoa");
    QVERIFY(ReadAll(work.filePath("job1.sdo")).contains(QByteArray::fromStdString(surveyor)));
  }

  void aDoubleClickComputesAndARefusedFileIsReported() {
    QTemporaryDir work;
    QVERIFY(QFile::copy(QStringLiteral(KAVU_EXAMPLES "/job1.asc"), work.filePath("job1.asc")));
    Person person;
    MainWindow w;
    w.asker().setHook(person.hook());
    w.setEndHook([] {});
    w.show();
    QVERIFY(Child<FolderList>(w, "lsttm")->setPath(work.path()));
    QVERIFY(ClickFile(w, QStringLiteral("job1.asc"), true));
    QCOMPARE(person.asked.size(), 1u);
    QCOMPARE(person.asked[0].icon, MsgIcon::Information);

    Child<QLineEdit>(w, "txtfile")->clear();
    Child<QPushButton>(w, "tinh")->click();
    QCOMPARE(person.asked.size(), 2u);
    QCOMPARE(person.asked[1].text, Q(msg::kNoFileChosen));
    QCOMPARE(person.asked[1].icon, MsgIcon::Critical);
    QCOMPARE(person.asked[1].buttons, MsgButtons::Ok);
  }

  void editWithoutAFileSaysSo() {
    Person person;
    MainWindow w;
    w.asker().setHook(person.hook());
    Child<QPushButton>(w, "suasolieu")->click();
    QCOMPARE(person.asked.size(), 1u);
    QCOMPARE(person.asked[0].text, Q(kFileNotFoundShort));
    QCOMPARE(person.asked[0].icon, MsgIcon::Critical);
    QVERIFY(!w.editor().isVisible());
  }

  void helpOpensTheManualBesideTheProgram() {
    Person person;
    MainWindow w;
    w.asker().setHook(person.hook());
    Child<QPushButton>(w, "trogiup")->click();
    QCOMPARE(person.asked.size(), 0u);
    auto* help = w.findChild<QWidget*>(QStringLiteral("help"));
    QVERIFY(help != nullptr && help->isVisible());
    QVERIFY(help->findChild<QTextBrowser*>()->toPlainText().contains(QStringLiteral("Inputs")));
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

  void everyControlCarriesItsCaption() {
    MainWindow w;
    const std::vector<std::pair<const char*, std::string_view>> buttons = {{"tinh", kCompute},
                                                                           {"suasolieu", kEditData},
                                                                           {"trogiup", kHelp},
                                                                           {"thoat", kExit},
                                                                           {"KC", kKcButton}};
    for (const auto& [name, caption] : buttons) {
      QCOMPARE(Child<QPushButton>(w, name)->text(), Q(caption));
    }
    QVERIFY(Child<QPushButton>(w, "tinh")->isDefault());
    auto* kinds = Child<QComboBox>(w, "cbkieu");
    QCOMPARE(kinds->count(), 10);
    QCOMPARE(kinds->itemText(0), Q("Số liệu sổ đo                    [*.asc]"));
    QCOMPARE(kinds->itemText(9), Q("Số liệu khác                      [*.*]"));
    QCOMPARE(Child<QComboBox>(w, "TyleTXT")->count(), 9);
    for (const char* name :
         {"lbdia", "lbtm", "txttm", "lbkieu", "lbfile", "Label1", "Label2", "Label3", "lbtieude"}) {
      Child<QLabel>(w, name);
    }
    Child<QWidget>(w, "luachon");
    Child<QWidget>(w, "Frame1");
    QCOMPARE(w.windowTitle(), Q(kMainCaption));
  }
};

QTEST_MAIN(MainWindowTest)
#include "mainwindow_test.moc"
