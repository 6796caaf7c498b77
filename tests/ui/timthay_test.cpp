// Find and replace: each step searches from one character past the start of
// the selection; the not-found question, replace and replace all.
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

  void replaceAllAsksOnceAtTheEnd() {
    struct Case {
      const char *text, *needle, *replacement, *result;
    };
    for (const Case& c : {Case{"xaxa", "a", "b", "xbxb"},
                          // A match right behind a replacement is passed over.
                          Case{"xaa", "a", "bb", "xbba"},
                          // Nothing to find: the text stays as it was.
                          Case{"abc", "z", "y", "abc"}}) {
      Bench bench(QLatin1String(c.text), QLatin1String(c.needle), QLatin1String(c.replacement));
      bench.press("thay2");
      QCOMPARE(bench.text.toPlainText(), QLatin1String(c.result));
      QCOMPARE(bench.person.asked.size(), 1u);
    }
  }

  void replaceOne() {
    Bench bench(QStringLiteral("a-a-a"), QStringLiteral("a"), Q("ă"));
    bench.press("thay1");
    QCOMPARE(bench.text.toPlainText(), Q("a-ă-a"));
    QCOMPARE(bench.selStart(), 3);  // the caret behind the new text
    QCOMPARE(bench.selLength(), 0);

    // Nothing found: the question, the text unchanged on either answer; No
    // closes the window.
    bench.type("txttim", QStringLiteral("z"));
    bench.person.answers = {MsgAnswer::No};
    bench.press("thay1");
    QCOMPARE(bench.text.toPlainText(), Q("a-ă-a"));
    QCOMPARE(bench.person.asked.size(), 1u);
    QVERIFY(!bench.find.isVisible());
    QCOMPARE(bench.find.ktra(), 0);
  }
};

QTEST_MAIN(TimthayTest)
#include "timthay_test.moc"
