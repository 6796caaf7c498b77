// The data editor and the viewer: TCVN3 files shown in Unicode, saved back
// byte for byte with their backups, and the saves that cannot be made.
#include "ui/editor.h"

#include <QDesktopServices>
#include <QDir>
#include <QFileDialog>
#include <QLineEdit>
#include <QMenu>
#include <QMessageBox>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QTextBlock>
#include <QtTest>
#include <functional>
#include <memory>

#include "core/messages.h"
#include "support.h"
#include "ui/lists.h"
#include "ui/timthay.h"

using namespace kavu;
using namespace kavu::ui;
using namespace kavu::ui::test;

namespace {
// "TR Ba Đình 1.45" and "P1 ... Nhà" in TCVN3: Đ is 0xA7, ì 0xD7, à 0xB5.
const QByteArray kBook = "TR Ba \xA7\xD7nh 1.45\r\nDKD DC02\r\nP1 0 10.000 0900000 1.50 Nh\xB5\r\n";

// The main window with the files of its folder listed as the kind asks, a
// file clicked and the editor opened on it.
struct Editing : Desk {
  Editing(std::initializer_list<std::pair<const char*, QByteArray>> files, const char* name,
          int kind = 0) {
    for (const auto& [file, bytes] : files) write(file, bytes);
    w.SelectKind(kind);
    Child<FolderList>(w, "lsttm")->setPath(work.path());
    click(name);
    Child<QPushButton>(w, "suasolieu")->click();
  }
  void click(const char* name) {
    auto* list = Child<FileList>(w, "lstfile");
    emit list->itemClicked(list->findItems(QLatin1String(name), Qt::MatchExactly).value(0));
  }
  Suasl& editor() { return w.editor(); }
  Xem& viewer() { return w.viewer(); }
  void press(QWidget& window, const char* button) { Child<QPushButton>(window, button)->click(); }
  // The editor's text replaced and saved.
  void save(const QString& text) {
    editor().txtsuasl()->setPlainText(text);
    press(editor(), "ghi");
  }
  // The viewer opened from the editor on a file of the folder.
  void view(const char* name) {
    editor().setChooser([this, name](const QString&, const QString&) { return path(name); });
    press(editor(), "xemfile");
  }
};
}  // namespace

class EditorTest : public QObject {
  Q_OBJECT

  QTemporaryDir store_;
  QUrl opened_;

 public slots:
  void opened(const QUrl& url) { opened_ = url; }

 private slots:
  void init() { UseScratchSettings(store_); }

  void textsAreUnicodeOnScreenAndTcvn3InTheFile() {
    // Back to TCVN3, a missing final line break and every other byte are the
    // saves' business below.
    QCOMPARE(DecodeForScreen(kBook),
             Q("TR Ba Đình 1.45\nDKD DC02\nP1 0 10.000 0900000 1.50 Nhà\n"));
    // Lone CRs end lines too, and become CR LF.
    QCOMPARE(EncodeForFile(DecodeForScreen("a\rb\r")), QByteArray("a\r\nb\r\n"));
  }

  void editorSaveKeepsTheOldContentAsBackup() {
    Editing desk({{"job1.asc", kBook}}, "job1.asc");
    Suasl& editor = desk.editor();
    QVERIFY(editor.isVisible());
    QCOMPARE(editor.windowTitle(),
             Q(kDataOfFile) + QDir::toNativeSeparators(desk.path("job1.asc")));
    QCOMPARE(editor.txtsuasl()->toPlainText(), DecodeForScreen(kBook));

    // Saved unchanged: the file stays byte for byte the same.
    desk.press(editor, "ghi");
    QCOMPARE(desk.person.asked.size(), 1u);
    QCOMPARE(desk.person.asked[0].text, Q(kOverwrite));
    QVERIFY(desk.person.asked[0].defaultNo);
    QCOMPARE(desk.read("job1.asc"), kBook);
    QCOMPARE(desk.read("job1.bak"), kBook);

    // An edit: the backup now holds the first save.
    const QByteArray edited("TR Ba \xA7\xD7nh 1.50\r\nDKD DC02\r\n");
    desk.save(Q("TR Ba Đình 1.50\nDKD DC02"));
    QCOMPARE(desk.read("job1.asc"), edited);
    QCOMPARE(desk.read("job1.bak"), kBook);

    // No leaves the file, the backup and the text as they are.
    desk.person.answers = {MsgAnswer::No};
    desk.save(QStringLiteral("gone"));
    QCOMPARE(desk.read("job1.asc"), edited);
    QCOMPARE(desk.read("job1.bak"), kBook);
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
    Editing desk({{"all.asc", bytes}, {"all.err", bytes}}, "all.asc");
    desk.press(desk.editor(), "ghi");
    QCOMPARE(desk.read("all.asc"), bytes);
    desk.view("all.err");
    desk.press(desk.viewer(), "ghixem");
    QCOMPARE(desk.read("all.err"), bytes);
    // A line break typed as Shift+Enter is an ordinary line end in the file.
    QPlainTextEdit* box = desk.viewer().txtxem();
    box->setPlainText(QStringLiteral("a"));
    box->moveCursor(QTextCursor::End);
    QTest::keyClick(box, Qt::Key_Return, Qt::ShiftModifier);
    QTest::keyClicks(box, QStringLiteral("b"));
    desk.press(desk.viewer(), "ghixem");
    QCOMPARE(desk.read("all.err"), QByteArray("a\r\nb\r\n"));
  }

  void theEditorSavesTheFileItOpened() {
    Editing desk({{"job1.asc", "one\r\n"}, {"job2.asc", "two\r\n"}}, "job1.asc");
    // Another file clicked meanwhile must not receive job1's text.
    desk.click("job2.asc");
    desk.save(QStringLiteral("one edited"));
    QCOMPARE(desk.read("job1.asc"), QByteArray("one edited\r\n"));
    QCOMPARE(desk.read("job2.asc"), QByteArray("two\r\n"));
  }

  void theViewersBackupKeepsTheWholeName() {
    Editing desk(
        {{"job1.asc", "book\r\n"}, {"job1.bak", "editor backup\r\n"}, {"job1.err", "report\r\n"}},
        "job1.asc");
    // Cancelling the dialog leaves the viewer closed, without a question.
    QString startedIn, proposedName;
    desk.editor().setChooser([&](const QString& folder, const QString& proposed) {
      startedIn = folder;
      proposedName = proposed;
      return proposed;
    });
    desk.press(desk.editor(), "xemfile");
    QCOMPARE(proposedName, QStringLiteral("*.err"));
    QCOMPARE(QDir::cleanPath(startedIn), QDir::cleanPath(desk.work.path()));
    QVERIFY(!desk.viewer().isVisible());
    QCOMPARE(desk.person.asked.size(), 0u);

    desk.view("job1.err");
    Xem& viewer = desk.viewer();
    QVERIFY(viewer.isVisible());
    QCOMPARE(viewer.windowTitle(),
             Q(kMoreAboutFile) + QDir::toNativeSeparators(desk.path("job1.err")));
    viewer.txtxem()->setPlainText(QStringLiteral("report read\n"));
    desk.press(viewer, "ghixem");
    QCOMPARE(desk.read("job1.err"), QByteArray("report read\r\n"));
    QCOMPARE(desk.read("job1.err.bak"), QByteArray("report\r\n"));
    QCOMPARE(desk.read("job1.bak"), QByteArray("editor backup\r\n"));
  }

  void aBackupOpenedInTheEditorKeepsItsOldContent() {
    // "job1.bak" itself edited: its backup base "job1" + ".bak" is the file.
    Editing desk({{"job1.bak", "old\r\n"}}, "job1.bak", 9);  // the kind that lists every file
    desk.save(QStringLiteral("new"));
    QCOMPARE(desk.read("job1.bak"), QByteArray("new\r\n"));
    QCOMPARE(desk.read("job1.bak.bak"), QByteArray("old\r\n"));
  }

  void aSaveThatCannotBeMadeLeavesTheFiles() {
    Editing desk({{"job1.asc", "book\r\n"}, {"job1.bak", "old backup\r\n"}}, "job1.asc");
    const std::vector<Question>& asked = desk.person.asked;
    QDir work(desk.work.path());

    // The new text cannot be written (its scratch name is taken by a folder).
    QVERIFY(work.mkpath("job1.asc.kavu-new/keep"));
    desk.save(QStringLiteral("new"));
    QCOMPARE(asked.size(), 2u);
    QCOMPARE(asked[1].icon, MsgIcon::Critical);
    QVERIFY(asked[1].text.startsWith(Q(msg::kCannotWrite)));
    QCOMPARE(desk.read("job1.asc"), QByteArray("book\r\n"));
    QCOMPARE(desk.read("job1.bak"), QByteArray("old backup\r\n"));
    QVERIFY(QDir(desk.path("job1.asc.kavu-new")).removeRecursively());

    // The old backup cannot be removed (a folder with content stands there).
    QVERIFY(QFile::remove(desk.path("job1.bak")));
    QVERIFY(work.mkpath("job1.bak/keep"));
    desk.press(desk.editor(), "ghi");
    QCOMPARE(asked.size(), 4u);
    QCOMPARE(asked[3].icon, MsgIcon::Critical);
    QCOMPARE(desk.read("job1.asc"), QByteArray("book\r\n"));
    QVERIFY(!QFile::exists(desk.path("job1.asc.kavu-new")));
  }

  void unsavedEditsAreNeverDroppedUnasked() {
    // Every way out of the editor and the viewer, with each answer.
    struct Way {
      const char* name;
      std::function<void(Editing&, TextWindow&)> leave;
    };
    const std::vector<Way> ways = {
        {"Esc", [](Editing&, TextWindow& window) { QTest::keyClick(&window, Qt::Key_Escape); }},
        {"Thoat", [](Editing& desk, TextWindow& window) { desk.press(window, "thoat"); }},
        {"close box", [](Editing&, TextWindow& window) { window.close(); }},
        {"program exit", [](Editing& desk, TextWindow&) { desk.press(desk.w, "thoat"); }},
    };
    for (const bool viewer : {false, true}) {
      for (const Way& way : ways) {
        // The viewer has no cancel button: Esc leaves it open and asks nothing.
        const bool escInViewer = viewer && QByteArray(way.name) == "Esc";
        for (const MsgAnswer answer : {MsgAnswer::Yes, MsgAnswer::No, MsgAnswer::Cancel}) {
          Editing desk({{"job1.asc", "book\r\n"}, {"job1.err", "report\r\n"}}, "job1.asc");
          TextWindow* window = &desk.editor();
          const char* name = "job1.asc";
          if (viewer) {
            desk.view("job1.err");
            window = &desk.viewer();
            name = "job1.err";
          }
          window->findChild<QPlainTextEdit*>()->appendPlainText(QStringLiteral("edited"));
          // The program's exit asks its own question first.
          desk.person.answers = {MsgAnswer::Yes, answer};
          if (way.name != QByteArrayView("program exit")) desk.person.answers.pop_front();
          const QByteArray before = desk.read(name);
          way.leave(desk, *window);
          const QString what =
              QStringLiteral("%1 %2 %3").arg(viewer).arg(way.name).arg(int(answer));
          if (escInViewer) {
            QVERIFY2(window->isVisible() && desk.person.asked.empty(), qPrintable(what));
            continue;
          }
          const Question& asked = desk.person.asked.back();
          QVERIFY2(asked.text == Q(kSaveChanges) + QDir::toNativeSeparators(desk.path(name)) + "?",
                   qPrintable(what));
          QCOMPARE(asked.buttons, MsgButtons::YesNoCancel);
          const bool stays = answer == MsgAnswer::Cancel;
          QVERIFY2(window->isVisible() == stays, qPrintable(what));
          QVERIFY2((desk.read(name) == before) != (answer == MsgAnswer::Yes), qPrintable(what));
          QVERIFY2(desk.ended != stays || way.name != QByteArrayView("program exit"),
                   qPrintable(what));
        }
      }
    }
  }

  void aReportLineOpensTheFieldBookAtItsPoint() {
    struct Case {
      const char *line, *point;
    };
    for (const Case& c :
         {Case{"Diem P2 nhap sai phan do", "P2"}, Case{"  Diem: K1 nhap so lieu bi dinh", "K1"},
          Case{"Tram K3         Dinh huong K2", "K3"},
          Case{"Cac diem mia 12 - 15 khong duoc tinh", "12"}, Case{"Tong so loi", ""}}) {
      QCOMPARE(PointOfReportLine(QLatin1String(c.line)), QLatin1String(c.point));
    }
    Editing desk({{"job1.asc",
                   "TR K1 1.5\r\nDKD K2\r\nP1 0 1 0900000 1.5\r\n"
                   "P2\t10 1 0900000 1.5\r\nP2 20 1 0900000 1.5\r\n"},
                  {"job1.err", "\r\nDiem P2 nhap sai phan do\r\n"},
                  {"other.asc", "x\r\n"}},
                 "other.asc");
    desk.view("job1.err");
    QPlainTextEdit* report = desk.viewer().txtxem();
    const QRect line = report->cursorRect(QTextCursor(report->document()->findBlockByNumber(1)));
    QTest::mouseDClick(report->viewport(), Qt::LeftButton, {}, line.center());
    QCOMPARE(desk.editor().file(), QDir::toNativeSeparators(desk.path("job1.asc")));
    QCOMPARE(desk.editor().txtsuasl()->textCursor().blockNumber(), 3);
  }

  void theEditorShowsLineNumbersAndKnowsItsKeys() {
    QByteArray book;
    for (int i = 1; i <= 120; ++i)
      book += "P" + QByteArray::number(i) + " 0 10.000 0900000 1.50\r\n";
    Editing desk({{"job1.asc", book}}, "job1.asc");
    Suasl& editor = desk.editor();
    editor.resize(560, 420);
    editor.activateWindow();
    QVERIFY(QTest::qWaitForWindowActive(&editor));
    QTest::keyClick(editor.txtsuasl(), Qt::Key_F, Qt::ControlModifier);
    QVERIFY(desk.w.finder().isVisible());
    QCOMPARE(desk.w.finder().ktra(), 1);
    Child<QLineEdit>(desk.w.finder(), "txttim")->setText(QStringLiteral("P12 "));
    QTest::keyClick(editor.txtsuasl(), Qt::Key_F3);
    QCOMPARE(editor.txtsuasl()->textCursor().selectedText(), QStringLiteral("P12 "));
    editor.txtsuasl()->insertPlainText(QStringLiteral("P12a "));
    QTest::keyClick(editor.txtsuasl(), Qt::Key_S, Qt::ControlModifier);
    QCOMPARE(desk.person.asked.back().text, Q(kOverwrite));
    QVERIFY(desk.read("job1.asc").contains("P12a 0 10.000"));
    // The margin with the line numbers, in a picture beside the build.
    auto* numbers = Child<QWidget>(editor, "lineNumbers");
    QVERIFY(numbers->isVisible() && numbers->width() > 0);
    editor.txtsuasl()->centerCursor();
    QVERIFY(editor.grab().save(QStringLiteral(KAVU_PICTURES "/kavu-editor-line-numbers.png")));
  }

  void theStandardDialogsSpeakVietnamese() {
    // Qt's own texts through the project's translation, when it was built.
    if (QFile::exists(QStringLiteral(KAVU_TRANSLATION "/kavu_vi.qm"))) {
      QVERIFY(InstallTranslation(QStringLiteral(KAVU_TRANSLATION)));
      QLineEdit edit;
      const std::unique_ptr<QMenu> menu(edit.createStandardContextMenu());
      QStringList items;
      for (const QAction* action : menu->actions())
        items.append(action->text().section('\t', 0, 0));
      QVERIFY(items.contains(Q("&Dán")));
      QVERIFY(items.contains(Q("Chọn tất cả")));
    }
    QMessageBox box;
    SetUpMessageBox(box, Question{Q(kSaveChanges) + QStringLiteral("/data/job1.asc?"),
                                  MsgIcon::Question,
                                  MsgButtons::YesNoCancel,
                                  false,
                                  {}});
    QStringList captions;
    for (QAbstractButton* button : box.buttons()) captions.append(button->text());
    captions.sort();
    QCOMPARE(captions, QStringList({Q("Có"), Q("Hủy"), Q("Không")}));
    QCOMPARE(box.escapeButton(), box.button(QMessageBox::Cancel));
    box.show();
    QVERIFY(box.grab().save(QStringLiteral(KAVU_PICTURES "/kavu-save-question.png")));
    box.hide();
    SetUpMessageBox(box,
                    Question{QStringLiteral("x"), MsgIcon::Critical, MsgButtons::Ok, false, {}});
    QCOMPARE(box.buttons().size(), 1);
    QCOMPARE(box.buttons().first()->text(), Q("Đồng ý"));

    QTemporaryDir folder;
    WriteAll(folder.filePath(QStringLiteral("job1.err")), "x");
    WriteAll(folder.filePath(QStringLiteral("job1.asc")), "x");
    QFileDialog dialog(nullptr, Q(kViewFile), folder.path());
    SetUpFileDialog(dialog, {Q(kErrFiles), Q(kAllFiles)});
    QCOMPARE(dialog.labelText(QFileDialog::LookIn), Q("Tìm trong:"));
    QCOMPARE(dialog.labelText(QFileDialog::Reject), Q("Hủy"));
    QCOMPARE(dialog.selectedNameFilter(), Q(kErrFiles));
    dialog.show();
    QApplication::processEvents();
    QVERIFY(dialog.grab().save(QStringLiteral(KAVU_PICTURES "/kavu-file-dialog.png")));
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
