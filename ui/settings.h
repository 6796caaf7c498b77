// The per-user settings store: application = the program's title, section
// "Settings", text values.
#pragma once

#include <QSettings>
#include <QString>
#include <memory>

namespace kavu::ui {

class SettingsStore {
 public:
  SettingsStore();
  ~SettingsStore();
  QString read(const char* key, const QString& fallback) const;
  void write(const char* key, const QString& value);

 private:
  std::unique_ptr<QSettings> settings_;
};

}  // namespace kavu::ui
