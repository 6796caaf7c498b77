// The drive, folder and file lists of the main window.
#pragma once

#include <QComboBox>
#include <QListWidget>
#include <QString>
#include <QStringList>

namespace kavu::ui {

// The file system's roots followed by the mounted volumes, each once.
QStringList DriveRoots();

// The drive list: one entry per root or volume.
class DriveList : public QComboBox {
  Q_OBJECT
 public:
  explicit DriveList(QWidget* parent = nullptr);
  QString root(int index) const;
  // The index of the drive holding a path (the longest root that starts it), or -1.
  int indexOfPath(const QString& path) const;
};

// The folder list: the current folder's ancestors from its root, the folder
// itself, then its subfolders. Opening an entry moves there.
class FolderList : public QListWidget {
  Q_OBJECT
 public:
  explicit FolderList(QWidget* parent = nullptr);
  QString path() const { return path_; }
  // Moves to a folder; false (and no change) when it does not exist.
  bool setPath(const QString& path);

 signals:
  void pathChanged(const QString& path);

 protected:
  // Enter opens the folder and goes no further (not to the compute button).
  void keyPressEvent(QKeyEvent* event) override;

 private:
  void fill();
  QString path_;
};

// The file list: the files of a folder that match a pattern.
class FileList : public QListWidget {
  Q_OBJECT
 public:
  explicit FileList(QWidget* parent = nullptr);
  QString path() const { return path_; }
  QString pattern() const { return pattern_; }
  void setPath(const QString& path);
  void setPattern(const QString& pattern);
  void refresh();

 private:
  QString path_;
  QString pattern_ = QStringLiteral("*.asc");
};

// The folder label: the path, or "..." and its last 24 characters when it is
// 25 characters or longer.
QString ShortFolderText(const QString& path);

}  // namespace kavu::ui
