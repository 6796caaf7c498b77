// Find and replace: each find step searches from one character past the start
// of the selection; replace works on the match the user sees, replace all on
// every match from the caret on; the not-found question.
#include "ui/timthay.h"

#include <QCheckBox>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QtTest>

#include "support.h"

using namespace kavu;
using namespace kavu::ui;
using namespace kavu::ui::test;

class TimthayTest : public QObject {
  Q_OBJECT

  // A find window on one text box with the caret at its start, answered by a
  // person.
  struct Bench {
    Person person;
    Asker ask;
    QPlainTextEdit text;
    Timthay find{ask, [this](int) { return &text; }};

    explicit Bench(const QString& content, const QString& needle = {},
                   const QString& replacement = {}) {
      ask.setHook(person.hook());
      text.setPlainText(content);
      find.open(1);
      select(0, 0);
      type("txttim", needle);
      type("txtthay", replacement);
    }
    void select(int start, int length) {
      QTextCursor cursor = text.textCursor();
      cursor.setPosition(start);
      cursor.setPosition(start + length, QTextCursor::KeepAnchor);
      text.setTextCursor(cursor);
    }
    int selStart() const { return text.textCursor().selectionStart(); }
    int selLength() const {
      return text.textCursor().selectionEnd() - text.textCursor().selectionStart();
    }
    void type(const char* name, const QString& value) {
      Child<QLineEdit>(find, name)->setText(value);
    }
    void press(const char* name) { button(name)->click(); }
    QPushButton* button(const char* name) { return Child<QPushButton>(find, name); }
    QCheckBox* box(const char* name) { return Child<QCheckBox>(find, name); }
  };

 private slots:
  void buttonsWaitForASearchText() {
    Bench bench(QStringLiteral("abc"));
    for (const char* name : {"tim", "thay1", "thay2"}) QVERIFY(!bench.button(name)->isEnabled());
    bench.type("txttim", QStringLiteral("b"));
    for (const char* name : {"tim", "thay1", "thay2"}) QVERIFY(bench.button(name)->isEnabled());
    QVERIFY(bench.button("tim")->isDefault());
  }

  void aStepSelectsTheNextMatch() {
    struct Case {
      const char *text, *needle;
      int start, length;  // the selection before the step
      bool matchCase, wholeWord;
      int found;  // 1-based, 0 when the question is asked
    };
    for (const Case& c : {
             // The search starts one past the caret: the second abc, position 5.
             Case{"abc abc", "abc", 0, 0, false, false, 5},
             // Overlapping matches are found one character apart.
             Case{"xaaa", "aa", 1, 2, false, false, 3},
             // Case is folded, Vietnamese letters too, unless asked.
             Case{"x ABC", "abc", 0, 0, false, false, 3},
             Case{"x ABC", "abc", 0, 0, true, false, 0},
             Case{"x ĐƯỜNG làng", "đường", 0, 0, false, false, 3},
             // A whole word skips the end of "concat".
             Case{"x concat cat", "cat", 0, 0, false, true, 10},
             Case{"x concat cat", "cat", 0, 0, false, false, 6},
         }) {
      Bench bench(Q(c.text), Q(c.needle));
      bench.select(c.start, c.length);
      bench.box("chon2")->setChecked(c.matchCase);
      bench.box("chon1")->setChecked(c.wholeWord);
      bench.press("tim");
      QCOMPARE(bench.person.asked.size(), c.found == 0 ? 1u : 0u);
      if (c.found == 0) continue;
      QCOMPARE(bench.selStart(), c.found - 1);
      QCOMPARE(bench.selLength(), static_cast<int>(Q(c.needle).size()));
    }
  }

  void notFoundAsksAndYesGoesBackToTheTop() {
    Bench bench(QStringLiteral("abc abc"), QStringLiteral("abc"));
    bench.select(5, 0);
    QCOMPARE(bench.find.funtim(), 0);
    QCOMPARE(bench.person.asked.size(), 1u);
    QCOMPARE(bench.person.asked[0].text, Q(kNotFoundAgain));
    QCOMPARE(bench.person.asked[0].icon, MsgIcon::Question);
    QCOMPARE(bench.person.asked[0].buttons, MsgButtons::YesNo);
    QCOMPARE(bench.selStart(), 0);
    QCOMPARE(bench.selLength(), 0);
    QCOMPARE(bench.find.funtim(), 5);  // from the top: the second abc again
  }

  void replaceAllFromTheCaretInOneStep() {
    struct Case {
      const char *text, *needle, *replacement;
      int start, length;  // the selection before
      const char* result;
    };
    for (const Case& c :
         {Case{"xaxa", "a", "b", 0, 0, "xbxb"},
          // Adjacent matches, and the one at the very start.
          Case{"aa-a", "a", "bb", 0, 0, "bbbb-bb"},
          // From the caret on, the match at the caret included.
          Case{"a-a-a", "a", "b", 2, 0, "a-b-b"},
          // ... and the match that "Tìm tiếp" showed.
          Case{"a-a-a", "a", "b", 2, 1, "a-b-b"}, Case{"x ABC abc", "abc", "d", 0, 0, "x d d"},
          // Nothing to find: the text stays as it was.
          Case{"abc", "z", "y", 0, 0, "abc"}}) {
      Bench bench(QLatin1String(c.text), QLatin1String(c.needle), QLatin1String(c.replacement));
      bench.select(c.start, c.length);
      bench.press("thay2");
      QCOMPARE(bench.text.toPlainText(), QLatin1String(c.result));
      QCOMPARE(bench.person.asked.size(), 1u);  // the not-found question, once
      // One step of undo takes every replacement back.
      bench.text.undo();
      QCOMPARE(bench.text.toPlainText(), QLatin1String(c.text));
    }
  }

  void replaceShowsBeforeItReplaces() {
    struct Case {
      const char *text, *needle;
      int start, length;    // the selection before
      const char* presses;  // f "Tìm tiếp", r "Thay thế"
      const char* result;
      int selStart, selLength;  // the selection after
    };
    for (const Case& c : {
             // The match at the caret is shown first, then replaced, then the
             // next one shown.
             Case{"a-a-a", "a", 0, 0, "r", "a-a-a", 0, 1},
             Case{"a-a-a", "a", 0, 0, "rr", "X-a-a", 2, 1},
             // After "Tìm tiếp": the match it showed is the one replaced.
             Case{"abc abc", "abc", 0, 0, "fr", "abc X", 5, 0},
             // Selected at the start of the file.
             Case{"abc abc", "abc", 0, 3, "r", "X abc", 2, 3},
             // A selection that is no match: the next match is shown.
             Case{"abc abc", "abc", 1, 2, "r", "abc abc", 4, 3},
         }) {
      Bench bench(QLatin1String(c.text), QLatin1String(c.needle), QStringLiteral("X"));
      bench.select(c.start, c.length);
      for (const char* key = c.presses; *key != 0; ++key)
        bench.press(*key == 'f' ? "tim" : "thay1");
      QCOMPARE(bench.text.toPlainText(), QLatin1String(c.result));
      QCOMPARE(bench.selStart(), c.selStart);
      QCOMPARE(bench.selLength(), c.selLength);
      QCOMPARE(bench.person.asked.size(), 0u);
    }
    // Replaced by nothing at the start: the next match, now at the start too,
    // is shown.
    Bench empty(QStringLiteral("aab"), QStringLiteral("a"));
    empty.select(0, 1);
    empty.press("thay1");
    QCOMPARE(empty.text.toPlainText(), QStringLiteral("ab"));
    QCOMPARE(empty.selStart(), 0);
    QCOMPARE(empty.selLength(), 1);

    // Nothing found: the question, the text unchanged on either answer; No
    // closes the window.
    Bench bench(QStringLiteral("a-a"), QStringLiteral("z"), QStringLiteral("X"));
    bench.person.answers = {MsgAnswer::No};
    bench.press("thay1");
    QCOMPARE(bench.text.toPlainText(), QStringLiteral("a-a"));
    QCOMPARE(bench.person.asked.size(), 1u);
    QVERIFY(!bench.find.isVisible());
    QCOMPARE(bench.find.ktra(), 0);
  }
};

QTEST_MAIN(TimthayTest)
#include "timthay_test.moc"
