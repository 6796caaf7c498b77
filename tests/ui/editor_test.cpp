// The data editor and the viewer: TCVN3 files shown in Unicode, saved back
// byte for byte with their backups, and the saves that cannot be made.
#include "ui/editor.h"

#include <QDir>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QtTest>

#include "core/messages.h"
#include "support.h"
#include "ui/lists.h"
#include "ui/mainwindow.h"
#include "ui/timthay.h"

using namespace kavu;
using namespace kavu::ui;
using namespace kavu::ui::test;

namespace {
// "TR Ba Đình 1.45" and "P1 ... Nhà" in TCVN3: Đ is 0xA7, ì 0xD7, à 0xB5.
const QByteArray kBook = "TR Ba \xA7\xD7nh 1.45\r\nDKD DC02\r\nP1 0 10.000 0900000 1.50 Nh\xB5\r\n";
}  // namespace

class EditorTest : public QObject {
  Q_OBJECT

  QTemporaryDir store_;

  template <typename T>
  static T* Child(QWidget& window, const char* name) {
    T* child = window.findChild<T*>(QLatin1String(name));
    if (child == nullptr) qFatal("no control %s", name);
    return child;
  }

  // The main window with a file clicked and the editor opened on it.
  static void OpenInEditor(MainWindow& w, const QString& folder, const QString& name) {
    Child<FolderList>(w, "lsttm")->setPath(folder);
    auto* list = Child<FileList>(w, "lstfile");
    emit list->itemClicked(list->findItems(name, Qt::MatchExactly).value(0));
    Child<QPushButton>(w, "suasolieu")->click();
  }

 private slots:
  void init() { UseScratchSettings(store_); }

  void textsAreUnicodeOnScreenAndTcvn3InTheFile() {
    const QString text = DecodeForScreen(kBook);
    QCOMPARE(text, Q("TR Ba Đình 1.45\nDKD DC02\nP1 0 10.000 0900000 1.50 Nhà\n"));
    QCOMPARE(EncodeForFile(text), kBook);
    // A final line break is added only when missing; lone CRs become CR LF.
    QCOMPARE(EncodeForFile(QStringLiteral("a\nb")), QByteArray("a\r\nb\r\n"));
    QCOMPARE(EncodeForFile(DecodeForScreen("a\rb\r")), QByteArray("a\r\nb\r\n"));
    // Bytes that are no TCVN3 letter survive the round trip.
    const QByteArray odd("x\x80\x9F\xFF\r\n", 6);
    QCOMPARE(EncodeForFile(DecodeForScreen(odd)), odd);
  }

  void editorSaveKeepsTheOldContentAsBackup() {
    QTemporaryDir work;
    const QString asc = work.filePath("job1.asc");
    const QString bak = work.filePath("job1.bak");
    WriteAll(asc, kBook);
    Person person;
    MainWindow w;
    w.asker().setHook(person.hook());
    OpenInEditor(w, work.path(), QStringLiteral("job1.asc"));
    Suasl& editor = w.editor();
    QVERIFY(editor.isVisible());
    QCOMPARE(editor.windowTitle(), Q(kDataOfFile) + QDir::toNativeSeparators(asc));
    QCOMPARE(editor.txtsuasl()->toPlainText(), DecodeForScreen(kBook));

    // Saved unchanged: the file stays byte for byte the same.
    Child<QPushButton>(editor, "ghi")->click();
    QCOMPARE(person.asked.size(), 1u);
    QCOMPARE(person.asked[0].text, Q(kOverwrite));
    QVERIFY(person.asked[0].defaultNo);
    QCOMPARE(ReadAll(asc), kBook);
    QCOMPARE(ReadAll(bak), kBook);

    // An edit: the backup now holds the first save.
    editor.txtsuasl()->setPlainText(Q("TR Ba Đình 1.50\nDKD DC02"));
    Child<QPushButton>(editor, "ghi")->click();
    QCOMPARE(ReadAll(asc), QByteArray("TR Ba \xA7\xD7nh 1.50\r\nDKD DC02\r\n"));
    QCOMPARE(ReadAll(bak), kBook);

    // No leaves the file, the backup and the text as they are.
    person.answers = {MsgAnswer::No};
    editor.txtsuasl()->setPlainText(QStringLiteral("gone"));
    Child<QPushButton>(editor, "ghi")->click();
    QCOMPARE(ReadAll(asc), QByteArray("TR Ba \xA7\xD7nh 1.50\r\nDKD DC02\r\n"));
    QCOMPARE(ReadAll(bak), kBook);
    QCOMPARE(editor.txtsuasl()->toPlainText(), QStringLiteral("gone"));
  }

  void everyByteSurvivesASaveUnchanged() {
    // Every byte but the line ends (0xA0, the no-break space, among them),
    // through the real text boxes and back.
    QByteArray bytes;
    for (int b = 1; b < 256; ++b) {
      if (b != '\r' && b != '\n') bytes.append(static_cast<char>(b));
      if (b % 32 == 0) bytes.append("\r\n");
    }
    bytes.append("\r\n");
    QTemporaryDir work;
    WriteAll(work.filePath("all.asc"), bytes);
    WriteAll(work.filePath("all.err"), bytes);
    Person person;
    MainWindow w;
    w.asker().setHook(person.hook());
    OpenInEditor(w, work.path(), QStringLiteral("all.asc"));
    Child<QPushButton>(w.editor(), "ghi")->click();
    QCOMPARE(ReadAll(work.filePath("all.asc")), bytes);
    w.editor().setChooser([&](const QString&, const QString&) { return work.filePath("all.err"); });
    Child<QPushButton>(w.editor(), "xemfile")->click();
    Child<QPushButton>(w.viewer(), "ghixem")->click();
    QCOMPARE(ReadAll(work.filePath("all.err")), bytes);
    // A line break typed as Shift+Enter is an ordinary line end in the file.
    w.viewer().txtxem()->setPlainText(QStringLiteral("a"));
    w.viewer().txtxem()->moveCursor(QTextCursor::End);
    QTest::keyClick(w.viewer().txtxem(), Qt::Key_Return, Qt::ShiftModifier);
    QTest::keyClicks(w.viewer().txtxem(), QStringLiteral("b"));
    Child<QPushButton>(w.viewer(), "ghixem")->click();
    QCOMPARE(ReadAll(work.filePath("all.err")), QByteArray("a\r\nb\r\n"));
  }

  void theEditorSavesTheFileItOpened() {
    QTemporaryDir work;
    WriteAll(work.filePath("job1.asc"), "one\r\n");
    WriteAll(work.filePath("job2.asc"), "two\r\n");
    Person person;
    MainWindow w;
    w.asker().setHook(person.hook());
    OpenInEditor(w, work.path(), QStringLiteral("job1.asc"));
    // Another file clicked meanwhile must not receive job1's text.
    auto* list = Child<FileList>(w, "lstfile");
    emit list->itemClicked(list->findItems("job2.asc", Qt::MatchExactly).value(0));
    w.editor().txtsuasl()->setPlainText(QStringLiteral("one edited"));
    Child<QPushButton>(w.editor(), "ghi")->click();
    QCOMPARE(ReadAll(work.filePath("job1.asc")), QByteArray("one edited\r\n"));
    QCOMPARE(ReadAll(work.filePath("job2.asc")), QByteArray("two\r\n"));
  }

  void theViewersBackupKeepsTheWholeName() {
    QTemporaryDir work;
    WriteAll(work.filePath("job1.asc"), "book\r\n");
    WriteAll(work.filePath("job1.bak"), "editor backup\r\n");
    WriteAll(work.filePath("job1.err"), "report\r\n");
    Person person;
    MainWindow w;
    w.asker().setHook(person.hook());
    OpenInEditor(w, work.path(), QStringLiteral("job1.asc"));
    QString startedIn, proposedName;
    w.editor().setChooser([&](const QString& folder, const QString& proposed) {
      startedIn = folder;
      proposedName = proposed;
      return work.filePath("job1.err");
    });
    Child<QPushButton>(w.editor(), "xemfile")->click();
    QCOMPARE(proposedName, QStringLiteral("*.err"));
    QCOMPARE(QDir::cleanPath(startedIn), QDir::cleanPath(work.path()));
    Xem& viewer = w.viewer();
    QVERIFY(viewer.isVisible());
    QCOMPARE(viewer.windowTitle(),
             Q(kMoreAboutFile) + QDir::toNativeSeparators(work.filePath("job1.err")));
    viewer.txtxem()->setPlainText(QStringLiteral("report read\n"));
    Child<QPushButton>(viewer, "ghixem")->click();
    QCOMPARE(ReadAll(work.filePath("job1.err")), QByteArray("report read\r\n"));
    QCOMPARE(ReadAll(work.filePath("job1.err.bak")), QByteArray("report\r\n"));
    QCOMPARE(ReadAll(work.filePath("job1.bak")), QByteArray("editor backup\r\n"));
  }

  void aBackupOpenedInTheEditorKeepsItsOldContent() {
    // "job1.bak" itself edited: its backup base "job1" + ".bak" is the file.
    QTemporaryDir work;
    WriteAll(work.filePath("job1.bak"), "old\r\n");
    Person person;
    MainWindow w;
    w.asker().setHook(person.hook());
    w.SelectKind(9);
    OpenInEditor(w, work.path(), QStringLiteral("job1.bak"));
    w.editor().txtsuasl()->setPlainText(QStringLiteral("new"));
    Child<QPushButton>(w.editor(), "ghi")->click();
    QCOMPARE(ReadAll(work.filePath("job1.bak")), QByteArray("new\r\n"));
    QCOMPARE(ReadAll(work.filePath("job1.bak.bak")), QByteArray("old\r\n"));
  }

  void cancellingTheViewDialogLeavesTheViewerClosed() {
    QTemporaryDir work;
    WriteAll(work.filePath("job1.asc"), "book\r\n");
    Person person;
    MainWindow w;
    w.asker().setHook(person.hook());
    OpenInEditor(w, work.path(), QStringLiteral("job1.asc"));
    w.editor().setChooser([](const QString&, const QString& proposed) { return proposed; });
    Child<QPushButton>(w.editor(), "xemfile")->click();
    QVERIFY(!w.viewer().isVisible());
    QCOMPARE(person.asked.size(), 0u);
  }

  void aSaveThatCannotBeMadeLeavesTheFiles() {
    QTemporaryDir work;
    const QString asc = work.filePath("job1.asc");
    WriteAll(asc, "book\r\n");
    WriteAll(work.filePath("job1.bak"), "old backup\r\n");
    Person person;
    MainWindow w;
    w.asker().setHook(person.hook());
    OpenInEditor(w, work.path(), QStringLiteral("job1.asc"));
    w.editor().txtsuasl()->setPlainText(QStringLiteral("new"));

    // The new text cannot be written (its scratch name is taken by a folder).
    QVERIFY(QDir(work.path()).mkdir("job1.asc.kavu-new"));
    QVERIFY(QDir(work.path()).mkpath("job1.asc.kavu-new/keep"));
    Child<QPushButton>(w.editor(), "ghi")->click();
    QCOMPARE(person.asked.size(), 2u);
    QCOMPARE(person.asked[1].icon, MsgIcon::Critical);
    QVERIFY(person.asked[1].text.startsWith(Q(msg::kCannotWrite)));
    QCOMPARE(ReadAll(asc), QByteArray("book\r\n"));
    QCOMPARE(ReadAll(work.filePath("job1.bak")), QByteArray("old backup\r\n"));
    QVERIFY(QDir(work.filePath("job1.asc.kavu-new")).removeRecursively());

    // The old backup cannot be removed (a folder with content stands there).
    QVERIFY(QFile::remove(work.filePath("job1.bak")));
    QVERIFY(QDir(work.path()).mkpath("job1.bak/keep"));
    Child<QPushButton>(w.editor(), "ghi")->click();
    QCOMPARE(person.asked.size(), 4u);
    QCOMPARE(person.asked[3].icon, MsgIcon::Critical);
    QCOMPARE(ReadAll(asc), QByteArray("book\r\n"));
    QVERIFY(!QFile::exists(work.filePath("job1.asc.kavu-new")));
  }

  void findOpensOnTheRightTextAndTheWindowsClose() {
    MainWindow w;
    w.editor().show();
    QTest::keyClick(&w.editor(), Qt::Key_Escape);  // thoat is the editor's cancel button
    QVERIFY(!w.editor().isVisible());
    w.viewer().show();
    QTest::keyClick(w.viewer().txtxem(), Qt::Key_Escape);  // the viewer has no cancel button
    QVERIFY(w.viewer().isVisible());
    Child<QPushButton>(w.viewer(), "thoat")->click();
    QVERIFY(!w.viewer().isVisible());
    Child<QPushButton>(w.editor(), "timkiem")->click();
    QCOMPARE(w.finder().ktra(), 1);
    QVERIFY(w.finder().isVisible());
    Child<QPushButton>(w.viewer(), "Timxem")->click();
    QCOMPARE(w.finder().ktra(), 2);
    Child<QPushButton>(w.finder(), "thoat")->click();
    QCOMPARE(w.finder().ktra(), 0);
    QVERIFY(!w.finder().isVisible());
  }
};

QTEST_MAIN(EditorTest)
#include "editor_test.moc"
