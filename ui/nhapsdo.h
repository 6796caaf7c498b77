// The field-book header form: the seven texts that head the field sketch.
#pragma once

#include <QString>
#include <array>

#include "ui/dialog.h"

class QLineEdit;
class QPushButton;

namespace kavu::ui {

class Nhapsdo : public Window {
  Q_OBJECT
 public:
  // Form_Load: the boxes get their stored texts or the defaults.
  explicit Nhapsdo(QWidget* parent = nullptr);
  std::array<QString, 7> texts() const;

  void GhiThongTinSoDo();
  void nhap_Click();
  void thoat_Click();

 protected:
  void closeEvent(QCloseEvent* event) override;  // Form_Unload

 private:
  std::array<QLineEdit*, 7> boxes_{};
};

}  // namespace kavu::ui
