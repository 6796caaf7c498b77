#include "ui/nhapsdo.h"

#include <QCloseEvent>
#include <QDate>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

#include "core/tcvn3.h"
#include "products/sketch.h"
#include "ui/ask.h"
#include "ui/settings.h"
#include "ui/texts.h"

namespace kavu::ui {
namespace {
constexpr std::array<const char*, 7> kKeys = {"NhapSDO1", "NhapSDO2", "NhapSDO3", "NhapSDO4",
                                              "NhapSDO5", "NhapSDO6", "NhapSDO7"};
}  // namespace

Nhapsdo::Nhapsdo(QWidget* parent) : Window(parent) {
  setObjectName(QStringLiteral("nhapsdo"));
  setWindowTitle(Q(kHeaderCaption));
  setAttribute(Qt::WA_DeleteOnClose);
  auto* grid = new QGridLayout(this);
  const SettingsStore store;
  for (std::size_t i = 0; i < boxes_.size(); ++i) {
    const int row = static_cast<int>(i);
    auto* label = new QLabel(Q(kHeaderLabels[i]), this);
    label->setObjectName(QStringLiteral("Label%1").arg(row + 1));
    // The survey date defaults to today, in the 10 characters of its field.
    const QString fallback = i == 6 ? QDate::currentDate().toString(QStringLiteral("dd/MM/yyyy"))
                                    : Q(kHeaderDefaults[i]);
    auto* box = new QLineEdit(this);
    box->setObjectName(QStringLiteral("nhap%1").arg(row + 1));
    // No more than the sketch prints: nothing is cut unseen.
    box->setMaxLength(static_cast<int>(kSketchHeaderWidths[i]));
    box->setText(store.read(kKeys[i], fallback));
    box->setMinimumWidth(280);
    label->setBuddy(box);
    auto* count = new QLabel(this);
    count->setObjectName(QStringLiteral("dem%1").arg(row + 1));
    count->setToolTip(Q(kHeaderCountTip));
    // Wide enough for "39/39", so the boxes keep their width as the count
    // grows.
    count->setMinimumWidth(count->fontMetrics().horizontalAdvance(QStringLiteral("00/00 ")));
    count->setAlignment(Qt::AlignRight | Qt::AlignVCenter);
    grid->addWidget(label, row, 0);
    grid->addWidget(box, row, 1);
    grid->addWidget(count, row, 2);
    boxes_[i] = box;
    counts_[i] = count;
    showCount(i);
    connect(box, &QLineEdit::textChanged, this, [this, i] { showCount(i); });
  }
  auto* buttons = new QHBoxLayout;
  auto* nhap = MakeButton(this, "nhap", Q(kEnter));
  nhap->setToolTip(Q(kEnterTip));
  nhap->setDefault(true);
  auto* thoat = MakeButton(this, "thoat", Q(kExitButton));
  thoat->setToolTip(Q(kHeaderExitTip));
  setCancelButton(thoat);
  buttons->addStretch();
  buttons->addWidget(nhap);
  buttons->addWidget(thoat);
  buttons->addStretch();
  grid->addLayout(buttons, 7, 0, 1, 3);
  connect(nhap, &QPushButton::clicked, this, &Nhapsdo::nhap_Click);
  connect(thoat, &QPushButton::clicked, this, &Nhapsdo::thoat_Click);
}

void Nhapsdo::showCount(std::size_t i) {
  // Counted as the sketch counts them: one TCVN3 byte a character (a letter
  // typed with its tone mark apart is still one).
  const QByteArray utf8 = boxes_[i]->text().toUtf8();
  const std::size_t held = Utf8ToTcvn3(std::string_view(utf8.constData(), utf8.size())).size();
  counts_[i]->setText(QString::number(held) + QLatin1Char('/') +
                      QString::number(kSketchHeaderWidths[i]));
}

void Nhapsdo::showForm() {
  show();
  raise();
  activateWindow();
  boxes_[0]->setFocus();
}

std::array<QString, 7> Nhapsdo::texts() const {
  std::array<QString, 7> result;
  for (int i = 0; i < 7; ++i) result[i] = boxes_[i]->text();
  return result;
}

void Nhapsdo::GhiThongTinSoDo() {
  SettingsStore store;
  for (int i = 0; i < 7; ++i) store.write(kKeys[i], boxes_[i]->text());
}

void Nhapsdo::nhap_Click() {
  GhiThongTinSoDo();
  hide();
}

void Nhapsdo::thoat_Click() {
  GhiThongTinSoDo();
  close();
}

void Nhapsdo::closeEvent(QCloseEvent* event) {
  GhiThongTinSoDo();
  event->accept();
}

}  // namespace kavu::ui
