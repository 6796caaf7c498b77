// The windows driven as a surveyor would: the settings kept between sessions,
// choosing a file in the lists, computing it to the summary, a run stopped
// underway; the data editor and the viewer, TCVN3 files shown in Unicode and
// saved back byte for byte with their backups, unsaved edits never dropped
// unasked; the find and replace steps.
#include <QCheckBox>
#include <QComboBox>
#include <QFileDialog>
#include <QLineEdit>
#include <QMessageBox>
#include <QMimeData>
#include <QPlainTextEdit>
#include <QtTest>
#include <tuple>

#include "core/messages.h"
#include "support.h"
#include "tests/generated_book.h"
#include "ui/dialog.h"
#include "ui/openfile.h"
#include "ui/runthread.h"
#include "ui/timthay.h"

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
};

QTEST_MAIN(WindowTest)
#include "window_test.moc"
