// The field-book header form: the seven texts that head the field sketch,
// each box holding no more than the sketch prints of it, with the count of
// its characters beside it.
#pragma once

#include <QString>
#include <array>

#include "ui/dialog.h"

class QLabel;
class QLineEdit;
class QPushButton;

namespace kavu::ui {

class Nhapsdo : public Window {
  Q_OBJECT
 public:
  // Form_Load: the boxes get their stored texts or the defaults.
  explicit Nhapsdo(QWidget* parent = nullptr);
  std::array<QString, 7> texts() const;
  // Shown in front and its first box ready to type into, with the texts it
  // holds (from a button of the main window).
  void showForm();

  void GhiThongTinSoDo();
  void nhap_Click();
  void thoat_Click();

 protected:
  void closeEvent(QCloseEvent* event) override;  // Form_Unload

 private:
  void showCount(std::size_t i);

  std::array<QLineEdit*, 7> boxes_{};
  std::array<QLabel*, 7> counts_{};
};

}  // namespace kavu::ui
