// A computation run on a thread of its own, so that the window keeps drawing,
// shows how far the run has come and takes the stop button while it works.
#pragma once

#include <QObject>
#include <atomic>
#include <functional>

#include "core/host.h"
#include "core/run.h"
#include "core/state.h"

namespace kavu::ui {

// The host of the run on the worker thread: every call reaches the window's
// own host on the window's thread, in the order the run made them; a question
// waits there for its answer, as the run does.
class RunThread : public QObject, private Host {
  Q_OBJECT
 public:
  explicit RunThread(Host& window, QObject* parent = nullptr);

  // The run of st, with the window behind it; returns once the run has ended,
  // the window's events handled meanwhile. Nothing else may touch st until
  // then.
  RunResult run(RunState& st);
  // The stop button: the run stops before its next station.
  void cancel() { cancelled_.store(true); }

 signals:
  // Emitted on the worker thread, once a thousandth of the working copy more
  // has been read; connected queued, it reaches the window in order.
  void progressed(long long done, long long total);

 private:
  MsgAnswer MessageBox(std::string_view text, MsgIcon icon, MsgButtons buttons) override;
  void SetTitle(std::string_view title) override;
  void Beep() override;
  void SetFileBox(std::string_view text) override;
  void FocusFileBox() override;
  void SelectKind(int index) override;
  void ShowFolder(std::string_view folder, std::string_view pattern) override;
  void Progress(long long done, long long total) override;
  bool Cancelled() override { return cancelled_.load(); }

  // The call made on the window's thread; the worker waits for it to end
  // when wait is true.
  void onWindow(std::function<void()> call, bool wait);

  Host& window_;
  std::atomic<bool> cancelled_{false};
  long long shownPermille_ = -1;  // the worker's own
};

}  // namespace kavu::ui
