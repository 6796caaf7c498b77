#include "ui/timthay.h"

#include <QCheckBox>
#include <QCloseEvent>
#include <QGridLayout>
#include <QGuiApplication>
#include <QLabel>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QScreen>
#include <QTextCursor>
#include <QVBoxLayout>
#include <vector>

#include "ui/ask.h"
#include "ui/texts.h"

namespace kavu::ui {
namespace {

bool IsWordChar(QChar c) { return c.isLetterOrNumber() || c == QLatin1Char('_'); }

// The box's text, its lines separated by one character each, so that its
// positions are those of the box's cursor.
QString BoxText(const QPlainTextEdit* box) { return box->document()->toRawText(); }

void Select(QPlainTextEdit* box, qsizetype start, qsizetype length) {
  QTextCursor cursor = box->textCursor();
  cursor.setPosition(static_cast<int>(start));
  cursor.setPosition(static_cast<int>(start + length), QTextCursor::KeepAnchor);
  box->setTextCursor(cursor);
}

}  // namespace

qsizetype FindText(const QString& text, const QString& needle, qsizetype from, bool matchCase,
                   bool wholeWord) {
  if (needle.isEmpty() || from < 0 || from >= text.size()) return -1;
  const Qt::CaseSensitivity cs = matchCase ? Qt::CaseSensitive : Qt::CaseInsensitive;
  for (qsizetype at = text.indexOf(needle, from, cs); at >= 0;
       at = text.indexOf(needle, at + 1, cs)) {
    if (!wholeWord) return at;
    const qsizetype end = at + needle.size();
    const bool startOk = at == 0 || !IsWordChar(text[at - 1]);
    const bool endOk = end >= text.size() || !IsWordChar(text[end]);
    if (startOk && endOk) return at;
  }
  return -1;
}

Timthay::Timthay(const Asker& ask, std::function<QPlainTextEdit*(int)> target, QWidget* parent)
    : Window(parent), ask_(ask), target_(std::move(target)) {
  setObjectName(QStringLiteral("timthay"));
  setWindowTitle(Q(kFindCaption));
  auto* grid = new QGridLayout(this);
  auto* label1 = new QLabel(Q(kFindWhat), this);
  label1->setObjectName(QStringLiteral("Label1"));
  txttim_ = new QLineEdit(this);
  txttim_->setObjectName(QStringLiteral("txttim"));
  auto* label2 = new QLabel(Q(kReplaceWith), this);
  label2->setObjectName(QStringLiteral("Label2"));
  txtthay_ = new QLineEdit(this);
  txtthay_->setObjectName(QStringLiteral("txtthay"));
  chon2_ = new QCheckBox(Q(kMatchCase), this);
  chon2_->setObjectName(QStringLiteral("chon2"));
  chon1_ = new QCheckBox(Q(kWholeWord), this);
  chon1_->setObjectName(QStringLiteral("chon1"));
  label1->setBuddy(txttim_);
  label2->setBuddy(txtthay_);
  grid->addWidget(label1, 0, 0);
  grid->addWidget(txttim_, 0, 1);
  grid->addWidget(label2, 1, 0);
  grid->addWidget(txtthay_, 1, 1);
  grid->addWidget(chon2_, 2, 0, 1, 2);
  grid->addWidget(chon1_, 3, 0, 1, 2);

  tim_ = MakeButton(this, "tim", Q(kFindNext));
  tim_->setToolTip(Q(kFindNextTip));
  tim_->setDefault(true);
  thay1_ = MakeButton(this, "thay1", Q(kReplace));
  thay1_->setToolTip(Q(kReplaceTip));
  thay2_ = MakeButton(this, "thay2", Q(kReplaceAll));
  thay2_->setToolTip(Q(kReplaceAllTip));
  auto* thoat = MakeButton(this, "thoat", Q(kExitButton));
  thoat->setToolTip(Q(kFindExitTip));
  setCancelButton(thoat);
  auto* column = new QVBoxLayout;
  for (QPushButton* button : {tim_, thay1_, thay2_, thoat}) column->addWidget(button);
  column->addStretch();
  grid->addLayout(column, 0, 2, 4, 1);
  txttim_Change();

  connect(txttim_, &QLineEdit::textChanged, this, &Timthay::txttim_Change);
  connect(tim_, &QPushButton::clicked, this, &Timthay::tim_Click);
  connect(thay1_, &QPushButton::clicked, this, &Timthay::thay1_Click);
  connect(thay2_, &QPushButton::clicked, this, &Timthay::thay2_Click);
  connect(thoat, &QPushButton::clicked, this, &Timthay::thoat_Click);
}

void Timthay::open(int ktra) {
  adjustSize();
  if (const QScreen* screen = QGuiApplication::primaryScreen()) {
    const QRect area = screen->availableGeometry();
    move(area.right() + 1 - frameGeometry().width(), area.top());
  }
  show();
  raise();
  ktra_ = ktra;
}

void Timthay::txttim_Change() {
  const bool any = !txttim_->text().isEmpty();
  tim_->setEnabled(any);
  thay1_->setEnabled(any);
  thay2_->setEnabled(any);
}

QPlainTextEdit* Timthay::target() const { return target_ ? target_(ktra_) : nullptr; }

qsizetype Timthay::search(const QString& text, qsizetype from) const {
  return FindText(text, txttim_->text(), from, chon2_->isChecked(), chon1_->isChecked());
}

int Timthay::funtim() {
  const QString chuoitim = txttim_->text();
  QPlainTextEdit* box = target();
  if (box == nullptr || chuoitim.isEmpty()) return 0;
  QTextCursor cursor = box->textCursor();
  const qsizetype vttim = cursor.selectionStart() + 1;
  // The search starts at 1-based position vttim + 1: one character past the
  // selection's start, so "Tìm tiếp" moves on from the match it showed.
  const qsizetype found = search(BoxText(box), vttim);
  if (found >= 0) {
    Select(box, found, chuoitim.size());
    return static_cast<int>(found + 1);
  }
  notFound(box);
  return 0;
}

void Timthay::notFound(QPlainTextEdit* box) {
  if (ask_(Q(kNotFoundAgain), MsgIcon::Question, MsgButtons::YesNo) == MsgAnswer::Yes) {
    QTextCursor cursor = box->textCursor();
    cursor.setPosition(0);
    box->setTextCursor(cursor);
  } else {
    unload();
  }
}

void Timthay::tim_Click() { funtim(); }

void Timthay::findNext(int ktra) {
  ktra_ = ktra;
  if (txttim_->text().isEmpty() || !isVisible()) {
    open(ktra);
    txttim_->setFocus();
    return;
  }
  funtim();
}

void Timthay::thay1_Click() {
  QPlainTextEdit* box = target();
  const QString chuoitim = txttim_->text();
  if (box == nullptr || chuoitim.isEmpty()) return;
  QTextCursor cursor = box->textCursor();
  const qsizetype start = cursor.selectionStart();
  const qsizetype found = search(BoxText(box), start);
  if (found < 0) {
    notFound(box);
    return;
  }
  // Only the match the user sees is replaced: one that is not selected yet
  // is shown first.
  if (found != start || cursor.selectionEnd() != found + chuoitim.size()) {
    Select(box, found, chuoitim.size());
    return;
  }
  cursor.insertText(txtthay_->text());
  box->setTextCursor(cursor);
  const qsizetype next = search(BoxText(box), cursor.position());
  if (next >= 0) Select(box, next, chuoitim.size());
}

void Timthay::thay2_Click() {
  QPlainTextEdit* box = target();
  const QString chuoitim = txttim_->text();
  if (box == nullptr || chuoitim.isEmpty()) return;
  // Every match from the caret on, the one at the caret included, found in
  // one pass over the text and replaced as one step of undo.
  const QString text = BoxText(box);
  std::vector<qsizetype> matches;
  for (qsizetype at = search(text, box->textCursor().selectionStart()); at >= 0;
       at = search(text, at + chuoitim.size())) {
    matches.push_back(at);
  }
  if (matches.empty()) {
    ask_(Q(kReplacedNone), MsgIcon::Information, MsgButtons::Ok);
    return;
  }
  const QString chuoithay = txtthay_->text();
  QTextCursor cursor(box->document());
  cursor.beginEditBlock();
  // From the end back, so the positions found stay valid.
  for (auto at = matches.rbegin(); at != matches.rend(); ++at) {
    cursor.setPosition(static_cast<int>(*at));
    cursor.setPosition(static_cast<int>(*at + chuoitim.size()), QTextCursor::KeepAnchor);
    cursor.insertText(chuoithay);
  }
  cursor.endEditBlock();
  const qsizetype behind =
      matches.back() +
      static_cast<qsizetype>(matches.size() - 1) * (chuoithay.size() - chuoitim.size()) +
      chuoithay.size();
  cursor.setPosition(static_cast<int>(behind));
  box->setTextCursor(cursor);
  // How many were replaced, in place of the question of a step that finds
  // nothing more: the caret stays behind the last replacement.
  ask_(Q(kReplacedCount) + QString::number(matches.size()) + Q(kReplacedPlaces),
       MsgIcon::Information, MsgButtons::Ok);
}

void Timthay::thoat_Click() { close(); }

void Timthay::unload() {
  hide();
  ktra_ = 0;
}

void Timthay::closeEvent(QCloseEvent* event) {
  ktra_ = 0;
  event->accept();
}

}  // namespace kavu::ui
