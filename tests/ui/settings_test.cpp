// The settings store: defaults on a first start, every key written once on the
// way out and read back, values that cannot be applied, the header form.
#include <QCheckBox>
#include <QComboBox>
#include <QDir>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QtTest>
#include <tuple>

#include "support.h"
#include "ui/lists.h"
#include "ui/mainwindow.h"
#include "ui/nhapsdo.h"

using namespace kavu;
using namespace kavu::ui;
using namespace kavu::ui::test;

class SettingsTest : public QObject {
  Q_OBJECT

  QTemporaryDir store_;

 private slots:
  void init() { UseScratchSettings(store_); }

  void firstStartShowsTheDefaults() {
    MainWindow w;
    QCOMPARE(Child<QLineEdit>(w, "txtFKC")->text(), QString());
    QCOMPARE(Child<QCheckBox>(w, "ckKC")->checkState(), Qt::Unchecked);
    QCOMPARE(Child<QComboBox>(w, "cbkieu")->currentIndex(), 0);
    QCOMPARE(Child<FileList>(w, "lstfile")->pattern(), QStringLiteral("*.asc"));
    // The drive list shows the drive of the folder shown.
    QCOMPARE(Child<FolderList>(w, "lsttm")->path(), QDir::toNativeSeparators(QDir::homePath()));
    QCOMPARE(Child<DriveList>(w, "lstdia")->currentIndex(),
             Child<DriveList>(w, "lstdia")->indexOfPath(QDir::homePath()));
    QCOMPARE(Child<QComboBox>(w, "TyleTXT")->currentText(), QStringLiteral("1000"));
    QCOMPARE(Child<QLineEdit>(w, "Htxt")->text(), QStringLiteral("2.0"));
    QCOMPARE(Child<QLineEdit>(w, "txtSoleDC")->text(), QStringLiteral("2"));
    QCOMPARE(Child<QCheckBox>(w, "ftd")->checkState(), Qt::Checked);
    QCOMPARE(Child<QCheckBox>(w, "fdc")->checkState(), Qt::Checked);
    for (const char* name : {"fkc", "fasc", "fcp"}) {
      QCOMPARE(Child<QCheckBox>(w, name)->checkState(), Qt::Unchecked);
    }
    // The two boxes that are never stored start grayed, which is not ticked.
    for (const char* name : {"fsdo", "fdxf"}) {
      QCOMPARE(Child<QCheckBox>(w, name)->checkState(), Qt::PartiallyChecked);
      QCOMPARE(BoxState(Child<QCheckBox>(w, name)), 2);
    }
  }

  void everyKeyIsWrittenOnCloseAndRestored() {
    QTemporaryDir folder;
    const QString path = QDir::toNativeSeparators(folder.path());
    // Text boxes and check boxes with their keys and the values set.
    const std::vector<std::tuple<const char*, const char*, QString>> texts = {
        {"txtFKC", "KAVU_txtFKC", QStringLiteral("/data/kc, chung.txt")},
        {"Htxt", "KAVU_HTXT", QStringLiteral("1.5")},
        {"txtSoleDC", "KAVU_SoleDC", QStringLiteral("3")}};
    const std::vector<std::tuple<const char*, const char*, Qt::CheckState>> boxes = {
        {"ckKC", "KAVU_ckKC", Qt::Checked}, {"fkc", "KAVU_Fkc", Qt::Checked},
        {"fasc", "KAVU_Fasc", Qt::Checked}, {"fcp", "KAVU_Fcp", Qt::Checked},
        {"ftd", "KAVU_Ftd", Qt::Unchecked}, {"fdc", "KAVU_Fdc", Qt::Unchecked}};
    {
      MainWindow w;
      w.setEndHook([] {});
      for (const auto& [name, key, text] : texts) Child<QLineEdit>(w, name)->setText(text);
      for (const auto& [name, key, state] : boxes) Child<QCheckBox>(w, name)->setCheckState(state);
      w.SelectKind(5);
      Child<FolderList>(w, "lsttm")->setPath(path);
      Child<QComboBox>(w, "TyleTXT")->setCurrentText(QStringLiteral("2000"));
      Child<QCheckBox>(w, "fsdo")->click();
      w.show();
      w.close();
    }
    for (const auto& [name, key, text] : texts) QCOMPARE(Stored(key), text);
    for (const auto& [name, key, state] : boxes) {
      QCOMPARE(Stored(key), state == Qt::Checked ? QStringLiteral("1") : QStringLiteral("0"));
    }
    QCOMPARE(Stored("KAVU_cbkieu"), QStringLiteral("5"));
    QCOMPARE(Stored("KAVU_LstTM"), path);
    QCOMPARE(Stored("KAVU_TyleTXT"), QStringLiteral("2000"));
    QVERIFY(IsStored("KAVU_LstDia"));
    QVERIFY(!IsStored("KAVU_Fsdo"));

    MainWindow again;
    for (const auto& [name, key, text] : texts) {
      QCOMPARE(Child<QLineEdit>(again, name)->text(), text);
    }
    for (const auto& [name, key, state] : boxes) {
      QCOMPARE(Child<QCheckBox>(again, name)->checkState(), state);
    }
    QCOMPARE(Child<QComboBox>(again, "cbkieu")->currentIndex(), 5);
    QCOMPARE(Child<FileList>(again, "lstfile")->pattern(), QStringLiteral("*.idx"));
    QCOMPARE(Child<FolderList>(again, "lsttm")->path(), path);
    QCOMPARE(Child<FileList>(again, "lstfile")->path(), path);
    QCOMPARE(Child<QLabel>(again, "txttm")->text(), ShortFolderText(path));
    QCOMPARE(Child<QComboBox>(again, "TyleTXT")->currentText(), QStringLiteral("2000"));
    QCOMPARE(Child<QCheckBox>(again, "fsdo")->checkState(), Qt::PartiallyChecked);
  }

  void valuesThatCannotBeAppliedAreSkipped() {
    {
      Store store;
      store.setValue(Key("KAVU_cbkieu"), "x");
      store.setValue(Key("KAVU_ckKC"), "yes");
      store.setValue(Key("KAVU_LstDia"), "999");
      store.setValue(Key("KAVU_LstTM"), "/no/such/folder/anywhere");
      store.setValue(Key("KAVU_TyleTXT"), "500");
    }
    MainWindow w;
    QCOMPARE(Child<QComboBox>(w, "cbkieu")->currentIndex(), 0);
    QCOMPARE(Child<QCheckBox>(w, "ckKC")->checkState(), Qt::Unchecked);
    // The lists stay at the working folder.
    QCOMPARE(Child<FolderList>(w, "lsttm")->path(), QDir::toNativeSeparators(QDir::currentPath()));
    // ... and the later keys are still applied.
    QCOMPARE(Child<QComboBox>(w, "TyleTXT")->currentText(), QStringLiteral("500"));
  }

  void exitAsksAndNoChangesNothing() {
    Desk desk;
    MainWindow& w = desk.w;
    const std::vector<Question>& asked = desk.person.asked;
    desk.person.answers = {MsgAnswer::No};
    w.show();
    QTest::keyClick(&w, Qt::Key_Escape);  // the cancel button is thoat
    QCOMPARE(asked.size(), 1u);
    QCOMPARE(asked[0].text, Q(kExitQuestion));
    QCOMPARE(asked[0].icon, MsgIcon::Question);
    QCOMPARE(asked[0].buttons, MsgButtons::YesNo);
    QVERIFY(!desk.ended);
    QVERIFY(w.isVisible());
    QVERIFY(!IsStored("KAVU_Ftd"));

    Child<QComboBox>(w, "TyleTXT")->setCurrentText(QStringLiteral("200"));
    Child<QPushButton>(w, "thoat")->click();  // Yes this time
    QVERIFY(desk.ended);
    QCOMPARE(Stored("KAVU_TyleTXT"), QStringLiteral("200"));
    // Written once: a change after the save is not written by the close.
    Store().setValue(Key("KAVU_TyleTXT"), "touched");
    w.close();
    QCOMPARE(Stored("KAVU_TyleTXT"), QStringLiteral("touched"));
  }

  void folderLabelKeepsTheLast24Characters() {
    const QString exact24 = QStringLiteral("/home/surveyor/data/2024");
    QCOMPARE(exact24.size(), 24);
    QCOMPARE(ShortFolderText(exact24), exact24);
    const QString long25 = exact24 + QStringLiteral("x");
    QCOMPARE(ShortFolderText(long25), QStringLiteral("...") + long25.right(24));
  }

  void headerBoxesTakeNoMoreThanTheSketchShows() {
    // Typed text stops at the field's width; a longer stored text is shown cut.
    const std::array<int, 7> widths = {39, 6, 19, 20, 17, 18, 10};
    Store().setValue(Key("NhapSDO2"), QStringLiteral("1234567890"));
    Nhapsdo form;
    for (int i = 0; i < 7; ++i) {
      auto* box =
          Child<QLineEdit>(form, QStringLiteral("nhap%1").arg(i + 1).toLatin1().constData());
      box->clear();
      QTest::keyClicks(box, QString(50, QLatin1Char('x')));
      QCOMPARE(box->text().size(), widths[static_cast<std::size_t>(i)]);
    }
    Nhapsdo again;
    QCOMPARE(Child<QLineEdit>(again, "nhap2")->text(), QStringLiteral("123456"));
  }

  void headerFormKeepsItsTexts() {
    {
      Nhapsdo form;
      QCOMPARE(Child<QLineEdit>(form, "nhap4")->text(), QStringLiteral("23756"));
      QCOMPARE(Child<QLineEdit>(form, "nhap7")->text(),
               QDate::currentDate().toString(QStringLiteral("dd/MM/yyyy")));
      QCOMPARE(Child<QLineEdit>(form, "nhap2")->text(), QStringLiteral("01"));
      QCOMPARE(Child<QLineEdit>(form, "nhap3")->text(), QStringLiteral("TOPCOM 226"));
    }
    MainWindow w;
    w.show();
    Child<QCheckBox>(w, "fsdo")->click();  // grayed -> ticked opens the form
    QVERIFY(w.headerFormLoaded());
    Nhapsdo& form = w.headerForm();
    QVERIFY(form.isVisible());
    Child<QLineEdit>(form, "nhap5")->setText(Q("Lê Thị Hoa"));
    QTest::keyClick(Child<QLineEdit>(form, "nhap5"), Qt::Key_Return);  // nhap is the default
    QVERIFY(!form.isVisible());
    QVERIFY(w.headerFormLoaded());  // hidden, still loaded
    QCOMPARE(Stored("NhapSDO5"), Q("Lê Thị Hoa"));
    QCOMPARE(Stored("NhapSDO4"), QStringLiteral("23756"));

    // The close box stores the texts as thoat does; a fresh load reads them.
    form.show();
    Child<QLineEdit>(form, "nhap7")->setText(QStringLiteral("12/05/2024"));
    form.close();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    QVERIFY(!w.headerFormLoaded());
    QCOMPARE(Stored("NhapSDO7"), QStringLiteral("12/05/2024"));
    QCOMPARE(Child<QLineEdit>(w.headerForm(), "nhap5")->text(), Q("Lê Thị Hoa"));
  }
};

QTEST_MAIN(SettingsTest)
#include "settings_test.moc"
