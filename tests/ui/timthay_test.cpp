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

  // A find window on one text box, answered by a person.
  struct Bench {
    Person person;
    Asker ask;
    QPlainTextEdit text;
    Timthay find{ask, [this](int) { return &text; }};

    explicit Bench(const QString& content) {
      ask.setHook(person.hook());
      text.setPlainText(content);
      find.open(1);
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
      find.findChild<QLineEdit*>(QLatin1String(name))->setText(value);
    }
    void press(const char* name) { find.findChild<QPushButton*>(QLatin1String(name))->click(); }
    QCheckBox* box(const char* name) { return find.findChild<QCheckBox*>(QLatin1String(name)); }
  };

 private slots:
  void buttonsWaitForASearchText() {
    Bench bench(QStringLiteral("abc"));
    for (const char* name : {"tim", "thay1", "thay2"}) {
      QVERIFY(!bench.find.findChild<QPushButton*>(QLatin1String(name))->isEnabled());
    }
    bench.type("txttim", QStringLiteral("b"));
    for (const char* name : {"tim", "thay1", "thay2"}) {
      QVERIFY(bench.find.findChild<QPushButton*>(QLatin1String(name))->isEnabled());
    }
    QVERIFY(bench.find.findChild<QPushButton*>("tim")->isDefault());
  }

  void aMatchAtTheCaretIsPassedOver() {
    Bench bench(QStringLiteral("abc abc"));
    bench.select(0, 0);
    bench.type("txttim", QStringLiteral("abc"));
    bench.press("tim");
    QCOMPARE(bench.selStart(), 4);  // position 5
    QCOMPARE(bench.selLength(), 3);
    QCOMPARE(bench.person.asked.size(), 0u);
  }

  void overlappingMatchesAreOneCharacterApart() {
    Bench bench(QStringLiteral("xaaa"));
    bench.select(1, 2);
    bench.type("txttim", QStringLiteral("aa"));
    QCOMPARE(bench.find.funtim(), 3);
    QCOMPARE(bench.selStart(), 2);
  }

  void caseIsFoldedUnlessAsked() {
    Bench bench(QStringLiteral("x ABC"));
    bench.type("txttim", QStringLiteral("abc"));
    QCOMPARE(bench.find.funtim(), 3);
    bench.select(0, 0);
    bench.box("chon2")->setChecked(true);
    bench.person.answers = {MsgAnswer::Yes};
    QCOMPARE(bench.find.funtim(), 0);
    QCOMPARE(bench.person.asked.size(), 1u);
    // Vietnamese letters fold too.
    Bench vn(Q("x ĐƯỜNG làng"));
    vn.type("txttim", Q("đường"));
    QCOMPARE(vn.find.funtim(), 3);
  }

  void wholeWordSkipsPartsOfWords() {
    Bench bench(QStringLiteral("x concat cat"));
    bench.type("txttim", QStringLiteral("cat"));
    bench.box("chon1")->setChecked(true);
    QCOMPARE(bench.find.funtim(), 10);
    bench.box("chon1")->setChecked(false);
    bench.select(0, 0);
    QCOMPARE(bench.find.funtim(), 6);
  }

  void notFoundAsksAndYesGoesBackToTheTop() {
    Bench bench(QStringLiteral("abc abc"));
    bench.select(5, 0);
    bench.type("txttim", QStringLiteral("abc"));
    QCOMPARE(bench.find.funtim(), 0);
    QCOMPARE(bench.person.asked.size(), 1u);
    QCOMPARE(bench.person.asked[0].text, Q(kNotFoundAgain));
    QCOMPARE(bench.person.asked[0].icon, MsgIcon::Question);
    QCOMPARE(bench.person.asked[0].buttons, MsgButtons::YesNo);
    QCOMPARE(bench.selStart(), 0);
    QCOMPARE(bench.selLength(), 0);
    QCOMPARE(bench.find.funtim(), 5);  // from the top: the second abc again
  }

  void replaceAll() {
    Bench bench(QStringLiteral("xaxa"));
    bench.select(0, 0);
    bench.type("txttim", QStringLiteral("a"));
    bench.type("txtthay", QStringLiteral("b"));
    bench.press("thay2");
    QCOMPARE(bench.text.toPlainText(), QStringLiteral("xbxb"));
    QCOMPARE(bench.person.asked.size(), 1u);

    // A match right behind a replacement is passed over.
    Bench run(QStringLiteral("xaa"));
    run.select(0, 0);
    run.type("txttim", QStringLiteral("a"));
    run.type("txtthay", QStringLiteral("bb"));
    run.press("thay2");
    QCOMPARE(run.text.toPlainText(), QStringLiteral("xbba"));
  }

  void replaceAllWithNothingToFind() {
    Bench bench(QStringLiteral("abc"));
    bench.select(0, 0);
    bench.type("txttim", QStringLiteral("z"));
    bench.type("txtthay", QStringLiteral("y"));
    bench.press("thay2");
    QCOMPARE(bench.text.toPlainText(), QStringLiteral("abc"));
    QCOMPARE(bench.person.asked.size(), 1u);
  }

  void replaceOne() {
    Bench bench(QStringLiteral("a-a-a"));
    bench.select(0, 0);
    bench.type("txttim", QStringLiteral("a"));
    bench.type("txtthay", Q("ă"));
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
