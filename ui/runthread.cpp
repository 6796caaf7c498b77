#include "ui/runthread.h"

#include <QCoreApplication>
#include <QEventLoop>
#include <exception>
#include <string>
#include <thread>

namespace kavu::ui {

RunThread::RunThread(Host& window, QObject* parent) : QObject(parent), window_(window) {}

RunResult RunThread::run(RunState& st) {
  cancelled_.store(false);
  shownPermille_ = -1;
  RunResult result;
  std::exception_ptr failure;
  std::atomic<bool> finished{false};
  QEventLoop loop;
  std::thread worker([&] {
    try {
      result = kavu::tinh_Click(st, *this);
    } catch (...) {
      failure = std::current_exception();
    }
    finished.store(true);
    QMetaObject::invokeMethod(&loop, &QEventLoop::quit, Qt::QueuedConnection);
  });
  loop.exec();
  // The program was told to end while the run works (the session closes):
  // the run stops at its next station, and its questions are still answered
  // here until it has.
  while (!finished.load()) {
    cancel();
    QCoreApplication::processEvents(QEventLoop::AllEvents | QEventLoop::WaitForMoreEvents);
  }
  worker.join();
  if (failure) std::rethrow_exception(failure);
  return result;
}

void RunThread::onWindow(std::function<void()> call, bool wait) {
  QMetaObject::invokeMethod(this, std::move(call),
                            wait ? Qt::BlockingQueuedConnection : Qt::QueuedConnection);
}

MsgAnswer RunThread::MessageBox(std::string_view text, MsgIcon icon, MsgButtons buttons) {
  MsgAnswer answer = MsgAnswer::Ok;
  onWindow([&] { answer = window_.MessageBox(text, icon, buttons); }, true);
  return answer;
}

void RunThread::SetTitle(std::string_view title) {
  onWindow([this, text = std::string(title)] { window_.SetTitle(text); }, false);
}

void RunThread::Beep() {
  onWindow([this] { window_.Beep(); }, false);
}

void RunThread::SetFileBox(std::string_view text) {
  onWindow([this, copy = std::string(text)] { window_.SetFileBox(copy); }, false);
}

void RunThread::FocusFileBox() {
  onWindow([this] { window_.FocusFileBox(); }, false);
}

void RunThread::SelectKind(int index) {
  onWindow([this, index] { window_.SelectKind(index); }, false);
}

void RunThread::ShowFolder(std::string_view folder, std::string_view pattern) {
  onWindow([this, f = std::string(folder), p = std::string(pattern)] { window_.ShowFolder(f, p); },
           false);
}

void RunThread::Progress(long long done, long long total) {
  const long long permille = total > 0 ? done * 1000 / total : 0;
  if (permille == shownPermille_) return;
  shownPermille_ = permille;
  emit progressed(done, total);
}

}  // namespace kavu::ui
