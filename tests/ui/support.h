// Shared by the window tests: a settings store in a scratch folder, a person
// who answers the message boxes, the main window on a scratch folder and the
// editor opened from it.
#pragma once

#include <QtTest>
#include <QtWidgets>
#include <deque>
#include <functional>
#include <initializer_list>
#include <memory>
#include <utility>
#include <vector>

#include "ui/ask.h"
#include "ui/editor.h"
#include "ui/lists.h"
#include "ui/mainwindow.h"
#include "ui/texts.h"

namespace kavu::ui::test {

// The program's per-user store.
struct Store : QSettings {
  Store() : QSettings(QSettings::IniFormat, QSettings::UserScope, Q(kAppTitle), Q(kAppTitle)) {}
};

inline QString Native(const QString& path) { return QDir::toNativeSeparators(path); }

inline QString Key(const char* key) { return QStringLiteral("Settings/") + QLatin1String(key); }
inline QString Stored(const char* key) { return Store().value(Key(key)).toString(); }
inline bool IsStored(const char* key) { return Store().contains(Key(key)); }

// Points the per-user store at a scratch folder and empties it.
inline void UseScratchSettings(const QTemporaryDir& dir) {
  QSettings::setPath(QSettings::IniFormat, QSettings::UserScope, dir.path());
  Store store;
  store.clear();
  store.sync();
}

// A control of a window by its name; the test ends when there is none.
template <typename T>
T* Child(QObject& window, const char* name) {
  T* child = window.findChild<T*>(QLatin1String(name));
  if (child == nullptr) qFatal("no control %s", name);
  return child;
}

// Records every box and answers with the queued answers, then with OK or Yes.
struct Person {
  std::vector<Question> asked;
  std::deque<MsgAnswer> answers;

  Asker::Hook hook() {
    return [this](const Question& question) {
      asked.push_back(question);
      if (answers.empty())
        return question.buttons == MsgButtons::Ok ? MsgAnswer::Ok : MsgAnswer::Yes;
      const MsgAnswer answer = answers.front();
      answers.pop_front();
      return answer;
    };
  }
};

// What a window lacks for the keyboard: a push button (or, with options, any
// named button, text box or list box) without a tip, a push button shown
// without an access key, an access key that two controls share; as
// "window/control" lines.
inline QStringList KeyboardFaults(QWidget& window, bool options = false) {
  QStringList faults;
  QSet<QChar> keys;
  for (QWidget* control : window.findChildren<QWidget*>()) {
    const QString what = window.objectName() + QLatin1Char('/') + control->objectName();
    QString text;
    if (auto* button = qobject_cast<QAbstractButton*>(control)) text = button->text();
    if (auto* label = qobject_cast<QLabel*>(control)) text = label->text();
    const qsizetype at = text.indexOf(QLatin1Char('&'));
    const QChar key = at >= 0 && at + 1 < text.size() ? text[at + 1].toLower() : QChar();
    if (!key.isNull() && keys.contains(key)) faults << what + QStringLiteral(" shares its key");
    keys.insert(key);
    if (qobject_cast<QPushButton*>(control) != nullptr && at < 0 && control->isVisibleTo(&window))
      faults << what + QStringLiteral(" has no key");
    const bool option = qobject_cast<QPushButton*>(control) != nullptr ||
                        (options && (qobject_cast<QAbstractButton*>(control) != nullptr ||
                                     qobject_cast<QLineEdit*>(control) != nullptr ||
                                     qobject_cast<QComboBox*>(control) != nullptr));
    if (option && !control->objectName().isEmpty() &&
        qobject_cast<QComboBox*>(control->parent()) == nullptr && control->toolTip().isEmpty())
      faults << what + QStringLiteral(" has no tip");
  }
  return faults;
}

// Runs look on the next dialog shown modally over the one now on top, then
// closes it; the flag tells whether one came within five seconds.
inline std::shared_ptr<const bool> WhenShown(std::function<void(QDialog&)> look) {
  QWidget* below = QApplication::activeModalWidget();
  auto* timer = new QTimer;
  auto seen = std::make_shared<bool>(false);
  const QDeadlineTimer deadline(5000);
  QObject::connect(timer, &QTimer::timeout, [=] {
    auto* dialog = qobject_cast<QDialog*>(QApplication::activeModalWidget());
    const bool came = dialog != nullptr && dialog != below && dialog->isVisible();
    if (!came && !deadline.hasExpired()) return;
    timer->stop();
    timer->deleteLater();
    if (!came) return;
    *seen = true;
    QApplication::processEvents();
    look(*dialog);
    dialog->reject();
  });
  timer->start(20);
  return seen;
}

inline QByteArray ReadAll(const QString& path) {
  QFile file(path);
  return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
}

inline void WriteAll(const QString& path, const QByteArray& bytes) {
  QFile file(path);
  if (file.open(QIODevice::WriteOnly | QIODevice::Truncate)) file.write(bytes);
}

// The main window beside a scratch folder, its questions answered by a
// person; ended tells whether it ended the program.
struct Desk {
  QTemporaryDir work;
  Person person;
  MainWindow w;
  bool ended = false;

  Desk() {
    w.asker().setHook(person.hook());
    w.setEndHook([this] { ended = true; });
  }
  QString path(const char* name) const { return work.filePath(QLatin1String(name)); }
  void write(const char* name, const QByteArray& bytes) const { WriteAll(path(name), bytes); }
  QByteArray read(const char* name) const { return ReadAll(path(name)); }
  void press(QWidget& window, const char* button) { Child<QPushButton>(window, button)->click(); }
  // The example field book (with extra lines) as job1.asc, the folder listed
  // and the book chosen.
  bool example(const QByteArray& extra = {}) {
    write("job1.asc", ReadAll(QStringLiteral(KAVU_EXAMPLES "/job1.asc")) + extra);
    return Child<FolderList>(w, "lsttm")->setPath(work.path()) && w.chooseFile(path("job1.asc"));
  }
};

// The desk's folder holding files, every file listed, one of them clicked in
// the file list and opened in the editor.
struct Editing : Desk {
  Editing(std::initializer_list<std::pair<const char*, QByteArray>> files, const char* name) {
    for (const auto& [file, bytes] : files) write(file, bytes);
    w.SelectKind(9);  // the kind that lists every file
    Child<FolderList>(w, "lsttm")->setPath(work.path());
    click(name);
    press(w, "suasolieu");
  }
  void click(const char* name) {
    auto* list = Child<FileList>(w, "lstfile");
    emit list->itemClicked(list->findItems(QLatin1String(name), Qt::MatchExactly).value(0));
  }
  // The editor's text replaced and saved.
  void save(const QString& text) {
    w.editor().txtsuasl()->setPlainText(text);
    press(w.editor(), "ghi");
  }
  // The viewer opened from the editor on a file of the folder.
  void view(const char* name) {
    w.editor().setChooser([this, name](const QString&, const QString&) { return path(name); });
    press(w.editor(), "xemfile");
  }
  // The viewer on `name`, or the editor.
  TextWindow& window(bool viewer, const char* name = "") {
    if (!viewer) return w.editor();
    view(name);
    return w.viewer();
  }
};

}  // namespace kavu::ui::test
