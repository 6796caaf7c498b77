// What the computation run asks of the window. The desktop program and the
// batch command are two hosts; tests are a third. Texts handed to the host
// are UTF-8.
#pragma once

#include <string>
#include <string_view>

namespace kavu {

enum class MsgIcon { None, Critical, Question, Exclamation, Information };
enum class MsgButtons { Ok, YesNo, YesNoCancel };
enum class MsgAnswer { Ok, Yes, No, Cancel };

class Host {
 public:
  virtual ~Host() = default;
  // Modal message box; lines are separated by a lone CR.
  virtual MsgAnswer MessageBox(std::string_view text, MsgIcon icon, MsgButtons buttons) = 0;
  virtual void SetTitle(std::string_view title) = 0;
  virtual void Beep() = 0;
  // The file box txtfile: its text, emptied and focused after a refused file.
  virtual void SetFileBox(std::string_view text) = 0;
  virtual void FocusFileBox() = 0;
  // The kind list cbkieu was set to index (its selection handler runs).
  virtual void SelectKind(int index) = 0;
  // The folder and pattern of the file lists follow the chosen file.
  virtual void ShowFolder(std::string_view folder, std::string_view pattern) {
    (void)folder;
    (void)pattern;
  }
  // How far the station loop has read the working copy: done of total lines.
  virtual void Progress(long long done, long long total) {
    (void)done;
    (void)total;
  }
  // True once the user asked to stop the run; the loop asks before each
  // station. The request may come from another thread (a cancel button, an
  // interrupt), so the answer must be safe to read from the run's thread.
  virtual bool Cancelled() { return false; }
};

// A host that answers every question with its default and shows nothing.
class QuietHost : public Host {
 public:
  MsgAnswer MessageBox(std::string_view, MsgIcon, MsgButtons buttons) override {
    return buttons == MsgButtons::YesNo ? MsgAnswer::Yes : MsgAnswer::Ok;
  }
  void SetTitle(std::string_view) override {}
  void Beep() override {}
  void SetFileBox(std::string_view) override {}
  void FocusFileBox() override {}
  void SelectKind(int) override {}
};

}  // namespace kavu
