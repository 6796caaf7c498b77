#include "ui/lists.h"

#include <QDir>
#include <QFileInfo>
#include <QKeyEvent>
#include <QStorageInfo>

namespace kavu::ui {

QStringList DriveRoots() {
  QStringList roots;
  const auto add = [&roots](const QString& path) {
    const QString native = QDir::toNativeSeparators(path);
    // Files mounted on their own (as containers do) are no drives.
    if (!native.isEmpty() && !roots.contains(native) && QFileInfo(path).isDir()) {
      roots.append(native);
    }
  };
  for (const QFileInfo& drive : QDir::drives()) add(drive.absoluteFilePath());
  for (const QStorageInfo& volume : QStorageInfo::mountedVolumes()) {
    if (volume.isValid() && volume.isReady()) add(volume.rootPath());
  }
  return roots;
}

DriveList::DriveList(QWidget* parent) : QComboBox(parent) { addItems(DriveRoots()); }

QString DriveList::root(int index) const { return itemText(index); }

int DriveList::indexOfPath(const QString& path) const {
  const QString native = QDir::toNativeSeparators(path);
  int best = -1;
  qsizetype bestLength = -1;
  for (int i = 0; i < count(); ++i) {
    QString root = itemText(i);
    const bool match =
        native.compare(root, Qt::CaseInsensitive) == 0 ||
        native.startsWith(root.endsWith(QDir::separator()) ? root : root + QDir::separator(),
                          Qt::CaseInsensitive);
    if (match && root.size() > bestLength) {
      best = i;
      bestLength = root.size();
    }
  }
  return best;
}

FolderList::FolderList(QWidget* parent) : QListWidget(parent) {
  connect(this, &QListWidget::itemActivated, this,
          [this](QListWidgetItem* item) { setPath(item->data(Qt::UserRole).toString()); });
}

bool FolderList::setPath(const QString& path) {
  const QFileInfo info(path);
  if (path.isEmpty() || !info.isDir()) return false;
  const QString native = QDir::toNativeSeparators(QDir::cleanPath(info.absoluteFilePath()));
  if (native == path_) return true;
  path_ = native;
  fill();
  emit pathChanged(path_);
  return true;
}

void FolderList::keyPressEvent(QKeyEvent* event) {
  if (event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter) {
    if (QListWidgetItem* item = currentItem()) setPath(item->data(Qt::UserRole).toString());
    event->accept();
    return;
  }
  QListWidget::keyPressEvent(event);
}

void FolderList::fill() {
  clear();
  QStringList chain;
  QDir dir(path_);
  do {
    chain.prepend(QDir::toNativeSeparators(dir.absolutePath()));
  } while (dir.cdUp());
  int depth = 0;
  for (const QString& folder : chain) {
    const QString name = depth == 0 ? folder : QFileInfo(folder).fileName();
    auto* item = new QListWidgetItem(QString(depth * 2, QLatin1Char(' ')) + name, this);
    item->setData(Qt::UserRole, folder);
    ++depth;
  }
  setCurrentRow(count() - 1);
  const QDir current(path_);
  for (const QFileInfo& sub :
       current.entryInfoList(QDir::Dirs | QDir::NoDotAndDotDot, QDir::Name | QDir::IgnoreCase)) {
    auto* item = new QListWidgetItem(QString(depth * 2, QLatin1Char(' ')) + sub.fileName(), this);
    item->setData(Qt::UserRole, QDir::toNativeSeparators(sub.absoluteFilePath()));
  }
}

FileList::FileList(QWidget* parent) : QListWidget(parent) {}

void FileList::setPath(const QString& path) {
  path_ = path;
  refresh();
}

void FileList::setPattern(const QString& pattern) {
  pattern_ = pattern;
  refresh();
}

void FileList::refresh() {
  clear();
  if (path_.isEmpty()) return;
  // Without QDir::CaseSensitive the pattern matches "JOB1.ASC" as well.
  // "*.*" lists every file, also those without a dot in their name.
  const QString filter = pattern_ == QStringLiteral("*.*") ? QStringLiteral("*") : pattern_;
  const QDir dir(path_, filter, QDir::Name | QDir::IgnoreCase, QDir::Files);
  addItems(dir.entryList());
}

QString ShortFolderText(const QString& path) {
  if (path.size() >= 25) return QStringLiteral("...") + path.right(24);
  return path;
}

}  // namespace kavu::ui
