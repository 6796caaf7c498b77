// Shared by the window tests: a settings store in a scratch folder, a person
// who answers the message boxes, and the main window on a scratch folder.
#pragma once

#include <QByteArray>
#include <QFile>
#include <QSettings>
#include <QString>
#include <QTemporaryDir>
#include <deque>
#include <vector>

#include "ui/ask.h"
#include "ui/mainwindow.h"
#include "ui/texts.h"

namespace kavu::ui::test {

// The program's per-user store.
struct Store : QSettings {
  Store() : QSettings(QSettings::IniFormat, QSettings::UserScope, Q(kAppTitle), Q(kAppTitle)) {}
};

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
};

}  // namespace kavu::ui::test
