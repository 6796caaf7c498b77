// Find and replace over the editor's or the viewer's text.
#pragma once

#include <QString>
#include <functional>

#include "ui/dialog.h"

class QCheckBox;
class QLineEdit;
class QPlainTextEdit;
class QPushButton;

namespace kavu::ui {

class Asker;

// Where the text holds needle at or after from (0-based), or -1. Without
// matchCase letters match in either case, Vietnamese letters included; with
// wholeWord the match may not touch a letter, digit or "_" on either side.
qsizetype FindText(const QString& text, const QString& needle, qsizetype from, bool matchCase,
                   bool wholeWord);

class Timthay : public Window {
  Q_OBJECT
 public:
  // target(ktra) gives the text box: 1 the editor's, any other the viewer's.
  Timthay(const Asker& ask, std::function<QPlainTextEdit*(int)> target, QWidget* parent = nullptr);

  // Placed at the top right corner of the screen and shown for a text.
  void open(int ktra);
  int ktra() const { return ktra_; }

  // One search step; the 1-based position of the match selected, or 0.
  int funtim();
  void tim_Click();
  void thay1_Click();
  void thay2_Click();
  void thoat_Click();

 protected:
  void closeEvent(QCloseEvent* event) override;

 private:
  void txttim_Change();
  void unload();

  const Asker& ask_;
  std::function<QPlainTextEdit*(int)> target_;
  int ktra_ = 0;
  QLineEdit* txttim_;
  QLineEdit* txtthay_;
  QCheckBox* chon1_;
  QCheckBox* chon2_;
  QPushButton* tim_;
  QPushButton* thay1_;
  QPushButton* thay2_;
};

}  // namespace kavu::ui
