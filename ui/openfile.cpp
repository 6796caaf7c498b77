#include "ui/openfile.h"

#include <QDir>
#include <QFileInfo>

#include "core/text.h"
#include "import/dispatch.h"
#include "ui/lists.h"
#include "ui/mainwindow.h"

namespace kavu::ui {

void ChooseFile(MainWindow& window, const QString& file) {
  const QFileInfo info(file);
  const QString path = QDir::toNativeSeparators(info.absoluteFilePath());
  FileSelection selection;
  DeriveFileSelection(selection, path.toStdString());
  const int kind = KindOfExtension(Upper(selection.duoifile));
  window.SelectKind(kind);
  window.ShowFolder(QDir::toNativeSeparators(info.absolutePath()).toStdString(),
                    PatternOfKind(kind));
  auto* list = window.findChild<FileList*>(QStringLiteral("lstfile"));
  const QList<QListWidgetItem*> items =
      list != nullptr
          ? list->findItems(info.fileName(), Qt::MatchFixedString | Qt::MatchCaseSensitive)
          : QList<QListWidgetItem*>();
  if (items.isEmpty()) {
    window.SetFileBox(path.toStdString());
    return;
  }
  list->setCurrentItem(items.front());
  window.lstfile_Click(items.front());
}

}  // namespace kavu::ui
