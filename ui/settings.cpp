#include "ui/settings.h"

#include "ui/ask.h"
#include "ui/texts.h"

namespace kavu::ui {

SettingsStore::SettingsStore()
    : settings_(std::make_unique<QSettings>(QSettings::IniFormat, QSettings::UserScope,
                                            Q(kAppTitle), Q(kAppTitle))) {
  settings_->beginGroup(Q(kSettingsGroup));
}

SettingsStore::~SettingsStore() = default;

QString SettingsStore::read(const char* key, const QString& fallback) const {
  return settings_->value(QLatin1String(key), fallback).toString();
}

void SettingsStore::write(const char* key, const QString& value) {
  settings_->setValue(QLatin1String(key), value);
  settings_->sync();
}

}  // namespace kavu::ui
