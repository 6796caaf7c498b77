// The text windows as a surveyor uses them: TCVN3 files shown in Unicode and
// saved back byte for byte with their backups; unsaved edits never dropped
// unasked and marked in the title; a double click on a line of the run's
// error report opens the record it is about, its whole line selected; Esc
// closes each window; the find and replace steps; the header form counts the
// characters of its boxes and the sketch prints what it shows; every button
// has a tip and an access key of its own.
#include <QtTest>
#include <string_view>

#include "core/host.h"
#include "core/messages.h"
#include "core/tcvn3.h"
#include "products/reports.h"
#include "run/run.h"
#include "support.h"
#include "ui/dialog.h"
#include "ui/nhapsdo.h"
#include "ui/timthay.h"

using namespace kavu;
using namespace kavu::ui;
using namespace kavu::ui::test;

namespace {

int BlockStarting(const QPlainTextEdit* box, const char* lead) {
  for (QTextBlock b = box->document()->firstBlock(); b.isValid(); b = b.next()) {
    if (b.text().startsWith(QLatin1String(lead))) return b.blockNumber();
  }
  return -1;
}

// A station on KC1 whose orientation distance to KC2 is 6 cm off (line 5),
// and a detail point that happens to be named KC1 (line 7, a tab after it).
const QByteArray kBook =
    "TR KC1 1000 1000 10\r\nTR KC2 900 1000 12\r\nTR KC1 1.5\r\nDKD KC2\r\n"
    "X1 0 100.06 900000 1.5 KC2\r\nP1 900000 10 900000 1.5\r\nKC1\t1800000 10 900000 1.5\r\n";

// The run of the book in the desk's folder: the field-book line of each line
// of the error report it writes beside it.
std::vector<std::uint32_t> RunBook(const Desk& desk) {
  RunState st;
  st.txtfile = desk.path("job.asc").toStdString();
  st.seed = 1;
  QuietHost host;
  return ErrorReportBookLines(tinh_Click(st, host).survey);
}

// A find window on one text box, the given text selected, answered by a
// person; presses its buttons in turn: f "Tìm tiếp", r "Thay thế", a "Thay
// tất cả", and ticks c "match case" and w "whole words".
struct Bench {
  Person person;
  Asker ask;
  QPlainTextEdit text;
  Timthay find{ask, [this](int) { return &text; }};

  Bench(const char* content, const char* needle, int start, int length, const char* presses,
        const char* replacement = "X") {
    ask.setHook(person.hook());
    text.setPlainText(Q(content));
    find.open(1);
    QTextCursor cursor = text.textCursor();
    cursor.setPosition(start);
    cursor.setPosition(start + length, QTextCursor::KeepAnchor);
    text.setTextCursor(cursor);
    Child<QLineEdit>(find, "txttim")->setText(Q(needle));
    Child<QLineEdit>(find, "txtthay")->setText(Q(replacement));
    for (const char* key = presses; *key != 0; ++key) {
      if (*key == 'c' || *key == 'w') {  // match case, whole words
        Child<QCheckBox>(find, *key == 'c' ? "chon2" : "chon1")->setChecked(true);
      } else {
        Child<QPushButton>(find, *key == 'f' ? "tim" : *key == 'r' ? "thay1" : "thay2")->click();
      }
    }
  }
  int selStart() const { return text.textCursor().selectionStart(); }
  int selLength() const { return text.textCursor().selectionEnd() - selStart(); }
};

}  // namespace

class EditorTest : public QObject {
  Q_OBJECT

  QTemporaryDir store_;

 private slots:
  void init() { UseScratchSettings(store_); }

  void savesKeepEveryByteAndABackup() {
    // "TR Ba Đình" in TCVN3: Đ is 0xA7, ì 0xD7; lone CRs end lines too.
    QCOMPARE(DecodeForScreen("TR Ba \xA7\xD7nh\r\nx\ry"), Q("TR Ba Đình\nx\ny"));
    // Every byte but the line ends (0xA0, the no-break space, among them).
    QByteArray bytes;
    for (int b = 1; b < 256; ++b) {
      if (b != '\r' && b != '\n') bytes.append(static_cast<char>(b));
      if (b % 32 == 0) bytes.append("\r\n");
    }
    bytes.append("\r\n");
    const QByteArray report = "report\r\n" + bytes;
    Editing desk({{"job1.asc", bytes}, {"job2.asc", "two\r\n"}, {"job1.err", report}}, "job1.asc");
    desk.press(desk.w.editor(), "ghi");  // saved unchanged: byte for byte the same
    QCOMPARE(desk.person.asked.back().text, Q(kOverwrite));
    QVERIFY(desk.person.asked.back().defaultNo);
    QCOMPARE(desk.read("job1.asc"), bytes);
    // An edit, another file clicked meanwhile: the file opened gets it, with
    // its last line ended; the backup holds the first save.
    desk.click("job2.asc");
    desk.save(Q("TR Ba Đình 1.50\nDKD DC02"));
    QCOMPARE(desk.read("job1.asc"), QByteArray("TR Ba \xA7\xD7nh 1.50\r\nDKD DC02\r\n"));
    QCOMPARE(desk.read("job1.bak"), bytes);
    desk.person.answers = {MsgAnswer::No};  // No leaves the file as it is
    desk.save(QStringLiteral("gone"));
    QCOMPARE(desk.read("job1.asc"), QByteArray("TR Ba \xA7\xD7nh 1.50\r\nDKD DC02\r\n"));
    // The viewer's backup keeps the whole name, beside the editor's.
    desk.view("job1.err");
    desk.press(desk.w.viewer(), "ghixem");
    QCOMPARE(desk.read("job1.err"), report);
    QCOMPARE(desk.read("job1.err.bak"), report);
    QCOMPARE(desk.read("job1.bak"), bytes);
  }

  // A backup opened in the editor keeps its old content; a save that cannot
  // be made (its scratch name taken by a folder) leaves the files.
  void backupsOfBackupsAndSavesThatCannotBeMade() {
    Editing desk({{"job1.bak", "old\r\n"}}, "job1.bak");
    desk.save(QStringLiteral("new"));
    QCOMPARE(desk.read("job1.bak"), QByteArray("new\r\n"));
    QCOMPARE(desk.read("job1.bak.bak"), QByteArray("old\r\n"));
    QVERIFY(QDir(desk.work.path()).mkpath("job1.bak.kavu-new/keep"));
    desk.save(QStringLiteral("newer"));
    QCOMPARE(desk.person.asked.back().icon, MsgIcon::Critical);
    QVERIFY(desk.person.asked.back().text.startsWith(Q(msg::kCannotWrite)));
    QCOMPARE(desk.read("job1.bak"), QByteArray("new\r\n"));
    QCOMPARE(desk.read("job1.bak.bak"), QByteArray("old\r\n"));
  }

  // Every way out of the editor and of the viewer (Esc, its Thoat button,
  // its close box, the program's exit), with each answer.
  void unsavedEditsAreNeverDroppedUnasked() {
    for (int k = 0; k < 24; ++k) {
      const bool viewer = k >= 12;
      const int way = k / 3 % 4;
      const MsgAnswer answer = std::array{MsgAnswer::Yes, MsgAnswer::No, MsgAnswer::Cancel}[k % 3];
      Editing desk({{"job1.asc", "book\r\n"}, {"job1.err", "report\r\n"}}, "job1.asc");
      TextWindow& window = desk.window(viewer, "job1.err");
      const char* name = viewer ? "job1.err" : "job1.asc";
      window.findChild<QPlainTextEdit*>()->appendPlainText(QStringLiteral("edited"));
      desk.person.answers = {answer};
      if (way == 3) desk.person.answers.push_front(MsgAnswer::Yes);  // the program's own question
      const QByteArray before = desk.read(name), what = QByteArray::number(k);
      if (way == 0) QTest::keyClick(&window, Qt::Key_Escape);
      if (way == 1) desk.press(window, "thoat");
      if (way == 2) window.close();
      if (way == 3) desk.press(desk.w, "thoat");
      const QString question = Q(kSaveChanges) + Native(desk.path(name)) + "?";
      QVERIFY2(!desk.person.asked.empty() && desk.person.asked.back().text == question, what);
      const bool stays = answer == MsgAnswer::Cancel;
      QVERIFY2(window.isVisible() == stays && (way < 3 || desk.ended != stays), what);
      QVERIFY2((desk.read(name) == before) != (answer == MsgAnswer::Yes), what);
    }
  }

  // "*" before the file's name from the first edit on; gone when the text is
  // back as it was read, when saved, when dropped for a fresh read; a
  // cancelled reread keeps it.
  void theTitleMarksUnsavedEdits() {
    for (const bool viewer : {false, true}) {
      Editing desk({{"job1.asc", "TR K1 1.5\r\n"}, {"job1.err", "report\r\n"}}, "job1.asc");
      TextWindow& window = desk.window(viewer, "job1.err");
      auto* box = window.findChild<QPlainTextEdit*>();
      const QString name = Native(desk.path(viewer ? "job1.err" : "job1.asc"));
      const QString caption = Q(viewer ? kMoreAboutFile : kDataOfFile);
      QCOMPARE(window.windowTitle(), caption + name);
      // t types, u undoes, s saves; c and n read the file again, the
      // edits kept (Cancel) or dropped (No).
      for (const char step : std::string_view("tutstcn")) {
        if (step == 't') box->insertPlainText(QStringLiteral("x"));
        if (step == 'u') box->undo();
        if (step == 's') desk.press(window, viewer ? "ghixem" : "ghi");
        if (step == 'c' || step == 'n') {
          desk.person.answers = {step == 'c' ? MsgAnswer::Cancel : MsgAnswer::No};
          if (viewer) desk.view("job1.err");
          if (!viewer) desk.press(desk.w, "suasolieu");
        }
        const bool edited = step == 't' || step == 'c';
        const char what[] = {step, viewer ? 'v' : 'e', 0};
        QVERIFY2(window.hasUnsavedEdits() == edited, what);
        QCOMPARE(window.windowTitle(), caption + (edited ? "*" : "") + name);
      }
      QCOMPARE(desk.read(viewer ? "job1.err" : "job1.asc"),
               QByteArray(viewer ? "xreport\r\n" : "xTR K1 1.5\r\n"));
    }
  }

  // The run's map leads to the record a line is about and selects it whole;
  // without the map, or once the report shown is not the one the run wrote,
  // the first record of the point named, selected too.
  void aReportLineOpensTheRecordItConcerns() {
    enum How { AsWritten, NoMap, EditedHere, SavedSince, ShownBeforeTheRun, ClosedBeforeTheRun };
    const struct {
      How how;
      int line;  // of the field book, from 1
    } cases[] = {{AsWritten, 5},         {NoMap, 7},
                 {EditedHere, 7},        {SavedSince, 7},
                 {ShownBeforeTheRun, 5}, {ClosedBeforeTheRun, 7}};
    for (const auto& c : cases) {
      Editing desk({{"job.asc", kBook}, {"other.asc", "x\r\n"}}, "other.asc");
      std::vector<std::uint32_t> lines = RunBook(desk);
      const QString report = desk.path("job.err");
      // A report of an earlier run shown, then the run writes its own: the
      // viewer shows it, or when shown again holds the earlier one.
      const bool earlier = c.how == ShownBeforeTheRun || c.how == ClosedBeforeTheRun;
      if (earlier) desk.write("job.err", desk.read("job.err") + "Diem Q x\r\n");
      desk.view("job.err");
      if (c.how == ClosedBeforeTheRun) desk.w.viewer().close();
      if (earlier) lines = RunBook(desk);
      Xem& viewer = desk.w.viewer();
      QPlainTextEdit* text = viewer.txtxem();
      if (c.how != NoMap) viewer.setRunReport(report, lines);
      if (c.how == ClosedBeforeTheRun) viewer.show();
      if (c.how == ShownBeforeTheRun)
        QVERIFY(!text->toPlainText().contains(QStringLiteral("Diem Q")));
      if (c.how == EditedHere) QTextCursor(text->document()).insertText(QStringLiteral("\n"));
      if (c.how == SavedSince) {
        text->appendPlainText(QStringLiteral("checked"));
        desk.press(viewer, "ghixem");
      }
      const int tram = BlockStarting(text, "Tram KC1");
      QVERIFY2(tram > 0, qPrintable(text->toPlainText()));
      QTest::mouseDClick(
          text->viewport(), Qt::LeftButton, {},
          text->cursorRect(QTextCursor(text->document()->findBlockByNumber(tram))).center());
      QPlainTextEdit* book = desk.w.editor().txtsuasl();
      const QString what = QString::number(c.how);
      QVERIFY2(desk.w.editor().file() == Native(desk.path("job.asc")), qPrintable(what));
      QVERIFY2(book->textCursor().blockNumber() == c.line - 1, qPrintable(what));
      const QTextBlock block = book->document()->findBlockByNumber(c.line - 1);
      QVERIFY2(book->textCursor().selectedText() == block.text(), qPrintable(what));
      QVERIFY2(book->textCursor().selectionStart() == block.position(), qPrintable(what));
    }
  }

  // Esc closes the editor, the viewer, the find window, the help and the
  // header form (opened as a button of the main window opens it); the form
  // keeps its texts.
  void escClosesEachWindow() {
    Editing desk({{"job1.asc", "TR K1 1.5\r\n"}, {"job1.err", "report\r\n"}}, "job1.asc");
    desk.view("job1.err");
    desk.press(desk.w.viewer(), "Timxem");
    desk.w.trogiup_Click();
    desk.w.headerForm().showForm();
    auto* surveyor = Child<QLineEdit>(desk.w.headerForm(), "nhap5");
    surveyor->setText(Q("Lê Văn Tám"));
    const std::pair<QWidget*, QWidget*> windows[] = {
        {&desk.w.finder(), Child<QLineEdit>(desk.w.finder(), "txttim")},
        {&desk.w.viewer(), desk.w.viewer().txtxem()},
        {&desk.w.editor(), desk.w.editor().txtsuasl()},
        {desk.w.helpWindow(), desk.w.helpWindow()},
        {&desk.w.headerForm(), surveyor},
    };
    for (const auto& [window, focus] : windows) QVERIFY(window->isVisible());
    for (const auto& [window, focus] : windows) {
      QTest::keyClick(focus, Qt::Key_Escape);
      QVERIFY2(!window->isVisible(), qPrintable(window->objectName()));
    }
    QVERIFY(desk.person.asked.empty() && !desk.ended);
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    QVERIFY(!desk.w.headerFormLoaded());
    QCOMPARE(Stored("NhapSDO5"), Q("Lê Văn Tám"));
    QCOMPARE(Child<QLineEdit>(desk.w.headerForm(), "nhap5")->text(), Q("Lê Văn Tám"));
  }

  // Ctrl+F opens the find window on the editor, F3 finds on, Ctrl+S saves; the
  // margin with the line numbers and the standard boxes in Vietnamese, in
  // pictures beside the build.
  void keysLineNumbersAndVietnameseBoxes() {
    QByteArray book;
    for (int i = 1; i <= 120; ++i)
      book += "P" + QByteArray::number(i) + " 0 10.000 0900000 1.50\r\n";
    Editing desk({{"job1.asc", book}}, "job1.asc");
    Suasl& editor = desk.w.editor();
    editor.resize(560, 420);
    editor.activateWindow();
    QVERIFY(QTest::qWaitForWindowActive(&editor));
    QTest::keyClick(editor.txtsuasl(), Qt::Key_F, Qt::ControlModifier);
    Child<QLineEdit>(desk.w.finder(), "txttim")->setText(QStringLiteral("P12 "));
    QTest::keyClick(editor.txtsuasl(), Qt::Key_F3);
    editor.txtsuasl()->insertPlainText(QStringLiteral("P12a "));
    QTest::keyClick(editor.txtsuasl(), Qt::Key_S, Qt::ControlModifier);
    QVERIFY(desk.read("job1.asc").contains("\r\nP12a 0 10.000"));
    editor.txtsuasl()->centerCursor();
    QVERIFY(editor.grab().save(QStringLiteral(KAVU_PICTURES "/kavu-editor-line-numbers.png")));

    QMessageBox box;
    const QString question = Q(kSaveChanges) + QStringLiteral("/data/job1.asc?");
    SetUpMessageBox(box, {question, MsgIcon::Question, MsgButtons::YesNoCancel, false, {}, {}});
    QCOMPARE(box.button(QMessageBox::Cancel)->text(), Q("&Hủy"));
    box.show();
    QVERIFY(box.grab().save(QStringLiteral(KAVU_PICTURES "/kavu-save-question.png")));
    QFileDialog dialog(nullptr, Q(kViewFile), desk.work.path());
    SetUpFileDialog(dialog, {Q(kErrFiles), Q(kAllFiles)});
    QCOMPARE(dialog.labelText(QFileDialog::LookIn), Q("Tìm trong:"));
    dialog.show();
    QApplication::processEvents();
    QVERIFY(dialog.grab().save(QStringLiteral(KAVU_PICTURES "/kavu-file-dialog.png")));
  }

  // A find step searches from one past the start of the selection; replace
  // works on the match the user sees, then shows the next; replace all on
  // every match from the caret on, in one step of undo, the caret behind the
  // last, and tells how many. Not found, Yes to "find on?" goes back to the top.
  void findAndReplace() {
    struct Case {
      const char *text, *needle;
      int start, length;  // the selection before
      const char *presses, *result;
      int selStart, selLength;     // the selection after
      const char* told = nullptr;  // the message shown
      const char* with = "X";
    };
    for (const Case& c : {
             Case{"abc abc", "abc", 0, 0, "f", "abc abc", 4, 3},
             Case{"xaaa", "aa", 1, 2, "f", "xaaa", 2, 2},
             Case{"x ĐƯỜNG làng", "đường", 0, 0, "f", "x ĐƯỜNG làng", 2, 5},  // case folded
             Case{"x ABC", "abc", 0, 0, "cf", "x ABC", 0, 0},                 // unless asked
             Case{"abc abc", "abc", 5, 0, "f", "abc abc", 0, 0},
             Case{"x concat cat", "cat", 0, 0, "wf", "x concat cat", 9, 3},  // whole words
             Case{"a-a-a", "a", 0, 0, "rr", "X-a-a", 2, 1},
             Case{"abc abc", "abc", 0, 0, "fr", "abc X", 5, 0},
             Case{"abc abc", "abc", 1, 2, "r", "abc abc", 4, 3},  // no match selected
             Case{"aab", "a", 0, 1, "r", "ab", 0, 1, nullptr, ""},
             Case{"a-a-a", "a", 2, 1, "a", "a-X-X", 5, 0, "Đã thay 2 chỗ."},
             Case{"a-a-a", "a", 0, 0, "a", "X-X-X", 5, 0, "Đã thay 3 chỗ."},
             Case{"Đường ĐƯỜNG", "đường", 0, 0, "a", "X X", 3, 0, "Đã thay 2 chỗ."},
             Case{"abc abc", "abc", 5, 0, "a", "abc abc", 5, 0, "Không tìm thấy chỗ nào để thay."},
         }) {
      Bench bench(c.text, c.needle, c.start, c.length, c.presses, c.with);
      QCOMPARE(bench.text.toPlainText(), Q(c.result));
      QCOMPARE(bench.selStart(), c.selStart);
      QCOMPARE(bench.selLength(), c.selLength);
      if (c.told != nullptr) {
        QCOMPARE(bench.person.asked.size(), std::size_t{1});
        QCOMPARE(bench.person.asked[0].text, Q(c.told));
        QVERIFY(bench.find.isVisible());
      }
    }
    Bench all("aa-a", "a", 0, 0, "a", "bb");
    QCOMPARE(all.text.toPlainText(), QStringLiteral("bbbb-bb"));
    all.text.undo();
    QCOMPARE(all.text.toPlainText(), QStringLiteral("aa-a"));
  }

  // Each box shows its characters of its most as typed, a letter with its
  // marks typed apart counted once; typing stops at the most; the sketch of
  // a compute prints the texts as the form shows them, a space before each
  // label that follows one.
  void theHeaderFormCountsWhatTheSketchPrints() {
    Desk desk;
    QVERIFY(desk.example());
    Child<QCheckBox>(desk.w, "fsdo")->click();  // grayed -> ticked opens the form
    Nhapsdo& form = desk.w.headerForm();
    const struct {
      const char* box;
      QString typed, holds;
      const char* count;
    } cases[] = {
        {"nhap5", Q("Nguyễn Văn An"), Q("Nguyễn Văn An"), "13/16"},
        {"nhap6", Q("Tra\u0302\u0300n"), Q("Tra\u0302\u0300n"), "4/17"},  // "Trần"
        {"nhap7", Q("12/05/2004 sáng"), Q("12/05/2004"), "10/10"},
        {"nhap2", QString(), QString(), "0/6"},
        {"nhap1", QString(50, 'w'), QString(39, 'w'), "39/39"},
        {"nhap4", QString(50, 'v'), QString(20, 'v'), "20/20"},
        {"nhap3", QString(50, 'z'), QString(18, 'z'), "18/18"},
        {"nhap5", QString(50, 'x'), QString(16, 'x'), "16/16"},
        {"nhap6", QString(50, 'y'), QString(17, 'y'), "17/17"},
    };
    for (const auto& c : cases) {
      auto* box = Child<QLineEdit>(form, c.box);
      box->clear();
      for (const QChar typed : c.typed) box->insert(typed);  // a key at a time
      QCOMPARE(box->text(), c.holds);
      const QString count = QStringLiteral("dem") + QLatin1String(c.box).mid(4);
      QCOMPARE(Child<QLabel>(form, qPrintable(count))->text(), QLatin1String(c.count));
    }
    desk.press(form, "nhap");
    desk.press(desk.w, "tinh");
    const QByteArray sketch = desk.read("job1.sdo");
    for (const char* line :
         {"1. Máy đo: zzzzzzzzzzzzzzzzzz Số máy: ",
          "2. Người đo: xxxxxxxxxxxxxxxx Người ghi: yyyyyyyyyyyyyyyyy Ngày đo:12/05/2004\r\n"}) {
      QVERIFY2(sketch.contains(QByteArray::fromStdString(Utf8ToTcvn3(line))), line);
    }
  }

  // A tip and an access key on every button; no two controls of a window
  // share a key.
  void everyButtonHasATipAndAKeyOfItsOwn() {
    Editing desk({{"job1.asc", "TR K1 1.5\r\n"}, {"job1.err", "report\r\n"}}, "job1.asc");
    for (QWidget* window : std::initializer_list<QWidget*>{
             &desk.w.editor(), &desk.w.viewer(), &desk.w.finder(), &desk.w.headerForm()}) {
      const QStringList faults = KeyboardFaults(*window);
      QVERIFY2(faults.isEmpty(), qPrintable(faults.join(QLatin1Char('\n'))));
    }
  }
};

QTEST_MAIN(EditorTest)
#include "editor_test.moc"
