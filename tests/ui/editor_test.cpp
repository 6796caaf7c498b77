// The text windows as a surveyor uses them: the title marks unsaved edits; a
// double click on a line of the run's error report opens the record it is
// about, its whole line selected; Esc closes each window; the header form
// counts the characters of its boxes and the sketch prints what it shows;
// every button has a tip and an access key of its own.
#include <QTextBlock>
#include <QtTest>
#include <string_view>

#include "core/host.h"
#include "core/tcvn3.h"
#include "products/reports.h"
#include "run/run.h"
#include "support.h"
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

}  // namespace

class EditorTest : public QObject {
  Q_OBJECT

  QTemporaryDir store_;

 private slots:
  void init() { UseScratchSettings(store_); }

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
