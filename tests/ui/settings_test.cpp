// The settings store: defaults on a first start, every key written once on the
// way out and read back, values that cannot be applied, the header form.
#include <QCheckBox>
#include <QComboBox>
#include <QDir>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QtTest>

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

  template <typename T>
  static T* Child(QWidget& window, const char* name) {
    T* child = window.findChild<T*>(QLatin1String(name));
    if (child == nullptr) qFatal("no control %s", name);
    return child;
  }

 private slots:
  void init() { UseScratchSettings(store_); }

  void firstStartShowsTheDefaults() {
    MainWindow w;
    QCOMPARE(Child<QLineEdit>(w, "txtFKC")->text(), QString());
    QCOMPARE(Child<QCheckBox>(w, "ckKC")->checkState(), Qt::Unchecked);
    QCOMPARE(Child<QComboBox>(w, "cbkieu")->currentIndex(), 0);
    QCOMPARE(Child<FileList>(w, "lstfile")->pattern(), QStringLiteral("*.asc"));
    auto* drives = Child<DriveList>(w, "lstdia");
    QCOMPARE(drives->currentIndex(), drives->count() > 1 ? 1 : 0);
    QCOMPARE(Child<FolderList>(w, "lsttm")->path(), QDir::toNativeSeparators(QDir::homePath()));
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
    {
      MainWindow w;
      w.setEndHook([] {});
      Child<QLineEdit>(w, "txtFKC")->setText(QStringLiteral("/data/kc, chung.txt"));
      Child<QCheckBox>(w, "ckKC")->setCheckState(Qt::Checked);
      w.SelectKind(5);
      Child<FolderList>(w, "lsttm")->setPath(path);
      Child<QComboBox>(w, "TyleTXT")->setCurrentText(QStringLiteral("2000"));
      Child<QLineEdit>(w, "Htxt")->setText(QStringLiteral("1.5"));
      Child<QLineEdit>(w, "txtSoleDC")->setText(QStringLiteral("3"));
      for (const char* name : {"fkc", "fasc", "fcp"}) {
        Child<QCheckBox>(w, name)->setCheckState(Qt::Checked);
      }
      for (const char* name : {"ftd", "fdc"}) {
        Child<QCheckBox>(w, name)->setCheckState(Qt::Unchecked);
      }
      Child<QCheckBox>(w, "fsdo")->click();
      w.show();
      w.close();
    }
    const std::vector<std::pair<const char*, QString>> expected = {
        {"KAVU_txtFKC", QStringLiteral("/data/kc, chung.txt")},
        {"KAVU_ckKC", QStringLiteral("1")},
        {"KAVU_cbkieu", QStringLiteral("5")},
        {"KAVU_LstTM", path},
        {"KAVU_TyleTXT", QStringLiteral("2000")},
        {"KAVU_HTXT", QStringLiteral("1.5")},
        {"KAVU_SoleDC", QStringLiteral("3")},
        {"KAVU_Fkc", QStringLiteral("1")},
        {"KAVU_Fasc", QStringLiteral("1")},
        {"KAVU_Ftd", QStringLiteral("0")},
        {"KAVU_Fcp", QStringLiteral("1")},
        {"KAVU_Fdc", QStringLiteral("0")}};
    for (const auto& [key, value] : expected) QCOMPARE(Stored(key), value);
    QVERIFY(IsStored("KAVU_LstDia"));
    QVERIFY(!IsStored("KAVU_Fsdo"));

    MainWindow again;
    QCOMPARE(Child<QLineEdit>(again, "txtFKC")->text(), QStringLiteral("/data/kc, chung.txt"));
    QCOMPARE(Child<QCheckBox>(again, "ckKC")->checkState(), Qt::Checked);
    QCOMPARE(Child<QComboBox>(again, "cbkieu")->currentIndex(), 5);
    QCOMPARE(Child<FileList>(again, "lstfile")->pattern(), QStringLiteral("*.idx"));
    QCOMPARE(Child<FolderList>(again, "lsttm")->path(), path);
    QCOMPARE(Child<FileList>(again, "lstfile")->path(), path);
    QCOMPARE(Child<QLabel>(again, "txttm")->text(), ShortFolderText(path));
    QCOMPARE(Child<QComboBox>(again, "TyleTXT")->currentText(), QStringLiteral("2000"));
    QCOMPARE(Child<QLineEdit>(again, "Htxt")->text(), QStringLiteral("1.5"));
    QCOMPARE(Child<QLineEdit>(again, "txtSoleDC")->text(), QStringLiteral("3"));
    QCOMPARE(Child<QCheckBox>(again, "fkc")->checkState(), Qt::Checked);
    QCOMPARE(Child<QCheckBox>(again, "ftd")->checkState(), Qt::Unchecked);
    QCOMPARE(Child<QCheckBox>(again, "fdc")->checkState(), Qt::Unchecked);
    QCOMPARE(Child<QCheckBox>(again, "fsdo")->checkState(), Qt::PartiallyChecked);
  }

  void valuesThatCannotBeAppliedAreSkipped() {
    {
      QSettings store(QSettings::IniFormat, QSettings::UserScope, Q(kAppTitle), Q(kAppTitle));
      store.setValue("Settings/KAVU_cbkieu", "x");
      store.setValue("Settings/KAVU_ckKC", "yes");
      store.setValue("Settings/KAVU_LstDia", "999");
      store.setValue("Settings/KAVU_LstTM", "/no/such/folder/anywhere");
      store.setValue("Settings/KAVU_TyleTXT", "500");
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
    Person person;
    person.answers = {MsgAnswer::No};
    MainWindow w;
    bool ended = false;
    w.setEndHook([&ended] { ended = true; });
    w.asker().setHook(person.hook());
    w.show();
    QTest::keyClick(&w, Qt::Key_Escape);  // the cancel button is thoat
    QCOMPARE(person.asked.size(), 1u);
    QCOMPARE(person.asked[0].text, Q(kExitQuestion));
    QCOMPARE(person.asked[0].icon, MsgIcon::Question);
    QCOMPARE(person.asked[0].buttons, MsgButtons::YesNo);
    QVERIFY(!ended);
    QVERIFY(w.isVisible());
    QVERIFY(!IsStored("KAVU_Ftd"));

    Child<QComboBox>(w, "TyleTXT")->setCurrentText(QStringLiteral("200"));
    Child<QPushButton>(w, "thoat")->click();  // Yes this time
    QVERIFY(ended);
    QCOMPARE(Stored("KAVU_TyleTXT"), QStringLiteral("200"));
    // Written once: a change after the save is not written by the close.
    QSettings store(QSettings::IniFormat, QSettings::UserScope, Q(kAppTitle), Q(kAppTitle));
    store.setValue("Settings/KAVU_TyleTXT", "touched");
    store.sync();
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

  void headerFormKeepsItsTexts() {
    {
      Nhapsdo form;
      QCOMPARE(Child<QLineEdit>(form, "nhap4")->text(), QStringLiteral("23756"));
      QCOMPARE(Child<QLineEdit>(form, "nhap7")->text(), Q("Ngày  tháng năm 2003"));
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
    Child<QLineEdit>(form, "nhap7")->setText(QStringLiteral("12/05/2024 sáng"));
    form.close();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    QVERIFY(!w.headerFormLoaded());
    QCOMPARE(Stored("NhapSDO7"), QStringLiteral("12/05/2024 sáng"));
    QCOMPARE(Child<QLineEdit>(w.headerForm(), "nhap5")->text(), Q("Lê Thị Hoa"));
  }
};

QTEST_MAIN(SettingsTest)
#include "settings_test.moc"
