// Times the data editor on a large field book, as a surveyor meets it: open a
// 20 MB field book from the main window, "Tìm tiếp" for a text that is not
// there, and "Thay tất cả" over every "Nhà" of the book. Not a test: run it by
// hand on a quiet machine and read the figures.
//   QT_QPA_PLATFORM=offscreen kavu_editor_timing [MEGABYTES [MATCHES]]
#include <sys/resource.h>

#include <QApplication>
#include <QDir>
#include <QElapsedTimer>
#include <QFile>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QSettings>
#include <QTemporaryDir>
#include <cstdio>

#include "core/tcvn3.h"
#include "ui/ask.h"
#include "ui/editor.h"
#include "ui/lists.h"
#include "ui/mainwindow.h"
#include "ui/timthay.h"

namespace {

using kavu::MsgAnswer;
using kavu::MsgButtons;

// Detail records of about 40 bytes up to the size asked for; evenly spread
// records carry the note "Nhà" (TCVN3), the others "Cay" of the same length.
QByteArray FieldBook(qsizetype bytes, qsizetype matches) {
  const QByteArray house = QByteArray::fromStdString(kavu::Utf8ToTcvn3("Nh\xC3\xA0"));
  QByteArrayList records;
  qsizetype size = 0;
  for (qsizetype i = 0; size < bytes; ++i) {
    records.append("P" + QByteArray::number(i) + " 1234500 " + QByteArray::number(10 + i % 90) +
                   ".125 0893000 1.50 ");
    size += records.back().size() + 5;
  }
  const qsizetype every = std::max<qsizetype>(1, records.size() / std::max<qsizetype>(1, matches));
  QByteArray book = "TR DC01 1.45\r\nDKD DC02\r\n";
  book.reserve(size + 64);
  qsizetype placed = 0;
  for (qsizetype i = 0; i < records.size(); ++i) {
    const bool note = i % every == 0 && placed < matches;
    placed += note ? 1 : 0;
    book += records[i] + (note ? house : QByteArray("Cay")) + "\r\n";
  }
  return book;
}

long PeakMiB() {
  rusage usage{};
  getrusage(RUSAGE_SELF, &usage);
  return usage.ru_maxrss / 1024;
}

// Milliseconds of the processor spent by this program: on a machine shared
// with other work the clock on the wall says more about the others.
double CpuMillis() {
  rusage usage{};
  getrusage(RUSAGE_SELF, &usage);
  return (usage.ru_utime.tv_sec + usage.ru_stime.tv_sec) * 1e3 +
         (usage.ru_utime.tv_usec + usage.ru_stime.tv_usec) / 1e3;
}

struct Figure {
  double wall = 0, cpu = 0;
};

template <typename Step>
Figure Millis(Step step) {
  QElapsedTimer timer;
  const double cpu = CpuMillis();
  timer.start();
  step();
  QApplication::processEvents();  // the window painted again
  return {static_cast<double>(timer.nsecsElapsed()) / 1e6, CpuMillis() - cpu};
}

}  // namespace

int main(int argc, char** argv) {
  QApplication app(argc, argv);
  const qsizetype megabytes = argc > 1 ? QByteArray(argv[1]).toLongLong() : 20;
  const qsizetype matches = argc > 2 ? QByteArray(argv[2]).toLongLong() : 100000;
  QTemporaryDir work;
  const QString path = QDir(work.path()).filePath(QStringLiteral("big.asc"));
  {
    QFile file(path);
    if (!file.open(QIODevice::WriteOnly)) return 2;
    file.write(FieldBook(megabytes * 1000 * 1000, matches));
  }
  QSettings::setPath(QSettings::IniFormat, QSettings::UserScope, work.path());

  kavu::ui::MainWindow window;
  window.asker().setHook([](const kavu::ui::Question& question) {
    // "Không tìm thấy! Có tìm tiếp không": No ends the search.
    return question.buttons == MsgButtons::YesNo ? MsgAnswer::No : MsgAnswer::Ok;
  });
  window.setEndHook({});
  window.show();
  auto* folders = window.findChild<kavu::ui::FolderList*>(QStringLiteral("lsttm"));
  auto* files = window.findChild<kavu::ui::FileList*>(QStringLiteral("lstfile"));
  folders->setPath(work.path());
  emit files->itemClicked(files->item(0));

  QByteArray bytes;
  const Figure read = Millis([&] {
    QFile file(path);
    if (file.open(QIODevice::ReadOnly)) bytes = file.readAll();
  });
  const Figure decode = Millis([&] { (void)kavu::ui::DecodeForScreen(bytes); });
  bytes.clear();
  const Figure open = Millis([&] { window.suasolieu_Click(); });
  kavu::ui::Suasl& editor = window.editor();
  editor.timkiem_Click();
  kavu::ui::Timthay& finder = window.finder();
  auto* needle = finder.findChild<QLineEdit*>(QStringLiteral("txttim"));
  auto* replacement = finder.findChild<QLineEdit*>(QStringLiteral("txtthay"));

  needle->setText(QStringLiteral("no such text"));
  editor.txtsuasl()->moveCursor(QTextCursor::Start);
  const Figure miss = Millis([&] { finder.tim_Click(); });

  finder.open(1);
  needle->setText(QString::fromUtf8("Nh\xC3\xA0"));
  replacement->setText(QString::fromUtf8("Nh\xC3\xA0 \xC4\x91\xC3\xA1"));  // "Nhà đá"
  editor.txtsuasl()->moveCursor(QTextCursor::Start);
  const Figure all = Millis([&] { finder.thay2_Click(); });
  const qsizetype left =
      editor.txtsuasl()->toPlainText().count(QString::fromUtf8("Nh\xC3\xA0 \xC4\x91"));

  std::printf("field book %lld MB, %lld matches; milliseconds on the wall (processor)\n",
              static_cast<long long>(megabytes), static_cast<long long>(matches));
  std::printf(
      "open in the editor      %7.0f (%5.0f), of which reading %.0f (%.0f), decoding %.0f (%.0f)\n",
      open.wall, open.cpu, read.wall, read.cpu, decode.wall, decode.cpu);
  std::printf("find next, no match     %7.0f (%5.0f)\n", miss.wall, miss.cpu);
  std::printf("replace all             %7.0f (%5.0f), %lld replaced\n", all.wall, all.cpu,
              static_cast<long long>(left));
  std::printf("peak memory             %9ld MiB\n", PeakMiB());
  return 0;
}
