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

  // One search step from one character past the selection's start; the
  // 1-based position of the match selected, or 0.
  int funtim();
  void tim_Click();
  // Replaces the selected match and selects the next; a match not yet
  // selected (the first one from the caret on) is selected first.
  void thay1_Click();
  // Replaces every match from the caret on, the one at the caret included,
  // and tells how many it replaced.
  void thay2_Click();
  // F3 in the editor or the viewer: the next match, or the window when there
  // is nothing to search for.
  void findNext(int ktra);
  void thoat_Click();

 protected:
  void closeEvent(QCloseEvent* event) override;

 private:
  void txttim_Change();
  void unload();
  QPlainTextEdit* target() const;
  qsizetype search(const QString& text, qsizetype from) const;
  // The not-found question: Yes moves the caret to the top, No unloads.
  void notFound(QPlainTextEdit* box);

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
