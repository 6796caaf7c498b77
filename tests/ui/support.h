// Shared by the window tests: a settings store in a scratch folder and a
// person who answers the message boxes.
#pragma once

#include <QByteArray>
#include <QFile>
#include <QSettings>
#include <QString>
#include <QTemporaryDir>
#include <deque>
#include <vector>

#include "ui/ask.h"
#include "ui/texts.h"

namespace kavu::ui::test {

// Points the per-user store at a scratch folder and empties it.
inline void UseScratchSettings(const QTemporaryDir& dir) {
  QSettings::setPath(QSettings::IniFormat, QSettings::UserScope, dir.path());
  QSettings store(QSettings::IniFormat, QSettings::UserScope, Q(kAppTitle), Q(kAppTitle));
  store.clear();
  store.sync();
}

inline QString Stored(const char* key) {
  QSettings store(QSettings::IniFormat, QSettings::UserScope, Q(kAppTitle), Q(kAppTitle));
  return store.value(QStringLiteral("Settings/") + QLatin1String(key)).toString();
}

inline bool IsStored(const char* key) {
  QSettings store(QSettings::IniFormat, QSettings::UserScope, Q(kAppTitle), Q(kAppTitle));
  return store.contains(QStringLiteral("Settings/") + QLatin1String(key));
}

// Records every box and answers with the queued answers, then with Yes / OK.
struct Person {
  std::vector<Question> asked;
  std::deque<MsgAnswer> answers;

  Asker::Hook hook() {
    return [this](const Question& question) {
      asked.push_back(question);
      if (!answers.empty()) {
        const MsgAnswer answer = answers.front();
        answers.pop_front();
        return answer;
      }
      return question.buttons == MsgButtons::YesNo ? MsgAnswer::Yes : MsgAnswer::Ok;
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

}  // namespace kavu::ui::test
