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

#include "ui/ask.h"
#include "ui/texts.h"

namespace kavu::ui {
namespace {

bool IsWordChar(QChar c) { return c.isLetterOrNumber() || c == QLatin1Char('_'); }

// The selection becomes the text; the caret stands behind it.
void ReplaceSelection(QPlainTextEdit* target, const QString& text) {
  if (target == nullptr) return;
  QTextCursor cursor = target->textCursor();
  cursor.insertText(text);
  target->setTextCursor(cursor);
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
  grid->addWidget(label1, 0, 0);
  grid->addWidget(txttim_, 0, 1);
  grid->addWidget(label2, 1, 0);
  grid->addWidget(txtthay_, 1, 1);
  grid->addWidget(chon2_, 2, 0, 1, 2);
  grid->addWidget(chon1_, 3, 0, 1, 2);

  tim_ = MakeButton(this, "tim", Q(kFindNext));
  tim_->setDefault(true);
  thay1_ = MakeButton(this, "thay1", Q(kReplace));
  thay2_ = MakeButton(this, "thay2", Q(kReplaceAll));
  auto* thoat = MakeButton(this, "thoat", Q(kExit));
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

int Timthay::funtim() {
  const QString chuoitim = txttim_->text();
  QPlainTextEdit* target = target_ ? target_(ktra_) : nullptr;
  if (target == nullptr || chuoitim.isEmpty()) return 0;
  const QString chuoigoc = target->toPlainText();
  QTextCursor cursor = target->textCursor();
  const qsizetype vttim = cursor.selectionStart() + 1;
  // The search starts at 1-based position vttim + 1: one character past the
  // selection's start, so a match right at the caret is passed over.
  const qsizetype found =
      FindText(chuoigoc, chuoitim, vttim, chon2_->isChecked(), chon1_->isChecked());
  if (found >= 0) {
    cursor.setPosition(static_cast<int>(found));
    cursor.setPosition(static_cast<int>(found + chuoitim.size()), QTextCursor::KeepAnchor);
    target->setTextCursor(cursor);
    return static_cast<int>(found + 1);
  }
  if (ask_(Q(kNotFoundAgain), MsgIcon::Question, MsgButtons::YesNo) == MsgAnswer::Yes) {
    cursor.setPosition(0);
    target->setTextCursor(cursor);
  } else {
    unload();
  }
  return 0;
}

void Timthay::tim_Click() { funtim(); }

void Timthay::thay1_Click() {
  const QString chuoithay = txtthay_->text();
  const int ktra = ktra_;
  if (funtim() == 0) return;
  ReplaceSelection(target_(ktra), chuoithay);
}

void Timthay::thay2_Click() {
  const int ktra = ktra_;
  while (funtim() != 0) ReplaceSelection(target_(ktra), txtthay_->text());
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
