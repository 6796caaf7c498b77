// Modal message boxes of the program's windows. Every question goes through
// one Asker, so a test can answer them instead of a person.
#pragma once

#include <QString>
#include <functional>
#include <string_view>

#include "core/host.h"

class QMessageBox;
class QWidget;

namespace kavu::ui {

inline QString Q(std::string_view text) {
  return QString::fromUtf8(text.data(), static_cast<qsizetype>(text.size()));
}

struct Question {
  QString text;  // lines separated by a lone CR or by LF
  MsgIcon icon = MsgIcon::None;
  MsgButtons buttons = MsgButtons::Ok;
  bool defaultNo = false;  // No is the default button of a Yes/No box
  // A folder that a button of the box opens, the box staying (the run's
  // products); empty for none.
  QString folder;
  // A button "Xem File lỗi": it answers Yes and calls this; none when empty.
  std::function<void()> viewReport;
};

class Asker {
 public:
  using Hook = std::function<MsgAnswer(const Question&)>;

  explicit Asker(QWidget* parent = nullptr) : parent_(parent) {}
  // Shows the box over the window the user works in (or hands it to the
  // hook) and returns the answer.
  MsgAnswer operator()(const Question& question) const;
  MsgAnswer operator()(const QString& text, MsgIcon icon, MsgButtons buttons,
                       bool defaultNo = false) const {
    return (*this)(Question{text, icon, buttons, defaultNo, {}, {}});
  }
  void setHook(Hook hook) { hook_ = std::move(hook); }
  void setParent(QWidget* parent) { parent_ = parent; }

 private:
  QWidget* parent_;
  Hook hook_;
};

// Lines ended by CR LF or by a lone CR as lines ended by LF, as the screen
// shows them.
QString ScreenLines(QString text);

// The box for a question, captioned with the program's title and with
// Vietnamese buttons, not yet shown.
void SetUpMessageBox(QMessageBox& box, const Question& question);
// The message box itself.
MsgAnswer ShowMessageBox(QWidget* parent, const Question& question);

}  // namespace kavu::ui
