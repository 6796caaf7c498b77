#include "ui/nhapsdo.h"

#include <QCloseEvent>
#include <QDate>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

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
  for (int i = 0; i < 7; ++i) {
    auto* label = new QLabel(Q(kHeaderLabels[i]), this);
    label->setObjectName(QStringLiteral("Label%1").arg(i + 1));
    // The survey date defaults to today, in the 10 characters of its field.
    const QString fallback = i == 6 ? QDate::currentDate().toString(QStringLiteral("dd/MM/yyyy"))
                                    : Q(kHeaderDefaults[i]);
    auto* box = new QLineEdit(this);
    box->setObjectName(QStringLiteral("nhap%1").arg(i + 1));
    // No more than the sketch's field shows: nothing is cut unseen.
    box->setMaxLength(kHeaderWidths[i]);
    box->setText(store.read(kKeys[i], fallback));
    box->setMinimumWidth(280);
    label->setBuddy(box);
    grid->addWidget(label, i, 0);
    grid->addWidget(box, i, 1);
    boxes_[i] = box;
  }
  auto* buttons = new QHBoxLayout;
  auto* nhap = MakeButton(this, "nhap", Q(kEnter));
  nhap->setDefault(true);
  auto* thoat = MakeButton(this, "thoat", Q(kExit));
  buttons->addStretch();
  buttons->addWidget(nhap);
  buttons->addWidget(thoat);
  buttons->addStretch();
  grid->addLayout(buttons, 7, 0, 1, 2);
  connect(nhap, &QPushButton::clicked, this, &Nhapsdo::nhap_Click);
  connect(thoat, &QPushButton::clicked, this, &Nhapsdo::thoat_Click);
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
