// Qt's own dialogs as the program opens them, with the program's translation:
// the print preview of the field sketch with its print and page-setup dialogs,
// the save dialog of the map window and the program's open-file dialog show
// no English text Qt asked to have translated, and the file lists write sizes
// and dates (dd/mm/yyyy) in Vietnamese. Esc closes every side window.
#include <QMimeDatabase>
#include <QTranslator>
#include <QtTest>
#include <functional>
#include <map>
#include <memory>
#include <set>
#include <tuple>

#include "support.h"
#include "ui/dialog.h"
#include "ui/map_window.h"
#include "ui/nhapsdo.h"

using namespace kavu;
using namespace kavu::ui;
using namespace kavu::ui::test;

namespace {

// One text Qt asked to have translated: context, source, disambiguation.
using Request = std::tuple<QByteArray, QByteArray, QByteArray>;

// Installed last, so asked first: records every request and answers none,
// leaving the answer to the program's translation.
class Requests : public QTranslator {
 public:
  QString translate(const char* context, const char* source, const char* disambiguation,
                    int) const override {
    asked_.emplace(context, source, disambiguation);
    return {};
  }
  bool isEmpty() const override { return false; }
  const std::set<Request>& asked() const { return asked_; }

 private:
  mutable std::set<Request> asked_;
};

// A text a dialog shows, and where.
struct Shown {
  QString where, text;
};

void Add(std::vector<Shown>& shown, const QObject& object, const char* what, const QString& text) {
  if (!text.isEmpty()) {
    shown.push_back(
        {QLatin1String(object.metaObject()->className()) + QLatin1Char(' ') + QLatin1String(what),
         text});
  }
}

// The visible texts of a dialog: its title, the texts of its buttons, labels,
// group boxes, tabs, list entries and actions, the tool tips, the headings
// of its lists and the places of a file dialog's side bar.
void VisibleTexts(QWidget& dialog, std::vector<Shown>& shown) {
  Add(shown, dialog, "title", dialog.windowTitle());
  for (QWidget* w : dialog.findChildren<QWidget*>()) {
    if (!w->isVisibleTo(&dialog)) continue;
    Add(shown, *w, "tool tip", w->toolTip());
    if (auto* button = qobject_cast<QAbstractButton*>(w)) Add(shown, *w, "text", button->text());
    if (auto* label = qobject_cast<QLabel*>(w)) Add(shown, *w, "text", label->text());
    if (auto* group = qobject_cast<QGroupBox*>(w)) Add(shown, *w, "title", group->title());
    if (auto* line = qobject_cast<QLineEdit*>(w)) Add(shown, *w, "hint", line->placeholderText());
    if (auto* tabs = qobject_cast<QTabWidget*>(w)) {
      for (int i = 0; i < tabs->count(); ++i) Add(shown, *w, "tab", tabs->tabText(i));
    }
    if (auto* box = qobject_cast<QComboBox*>(w); box != nullptr && box->isEnabled()) {
      for (int i = 0; i < box->count(); ++i) Add(shown, *w, "entry", box->itemText(i));
    }
    if (auto* header = qobject_cast<QHeaderView*>(w); header != nullptr && header->model()) {
      for (int i = 0; i < header->count(); ++i) {
        if (header->isSectionHidden(i)) continue;
        Add(shown, *w, "heading", header->model()->headerData(i, header->orientation()).toString());
      }
    }
    if (w->objectName() == QLatin1String("sidebar")) {
      const QAbstractItemModel& places = *static_cast<QListView*>(w)->model();
      for (int i = 0; i < places.rowCount(); ++i) {
        Add(shown, *w, "place", places.index(i, 0).data().toString());
      }
    }
  }
  for (QAction* action : dialog.findChildren<QAction*>()) {
    if (!action->isVisible()) continue;
    Add(shown, *action, "text", action->text());
    if (action->toolTip() != QString(action->text()).remove(QLatin1Char('&')))
      Add(shown, *action, "tool tip", action->toolTip());
  }
}

// Those texts on every page of the dialog's tabs.
std::vector<Shown> TextsOf(QWidget& dialog) {
  std::vector<Shown> shown;
  VisibleTexts(dialog, shown);
  for (QTabWidget* tabs : dialog.findChildren<QTabWidget*>()) {
    const int current = tabs->currentIndex();
    for (int i = 0; i < tabs->count(); ++i) {
      tabs->setCurrentIndex(i);
      VisibleTexts(dialog, shown);
    }
    tabs->setCurrentIndex(current);
  }
  return shown;
}

// The program's translation, looked up on its own.
QString Vietnamese(const QTranslator& vi, const Request& r) {
  const auto& [context, source, disambiguation] = r;
  return vi.translate(context.constData(), source.constData(),
                      disambiguation.isEmpty() ? nullptr : disambiguation.constData());
}

void Save(QWidget& dialog, const char* name) {
  QVERIFY(dialog.grab().save(QStringLiteral(KAVU_PICTURES "/") + QLatin1String(name)));
}

// The row of a file in a file dialog's list, once the list has it.
QModelIndex Row(QFileDialog& dialog, const QString& name) {
  auto* list = dialog.findChild<QTreeView*>();
  QModelIndex row;
  (void)QTest::qWaitFor(
      [&] {
        const QModelIndex root = list->rootIndex();
        for (int i = 0; i < list->model()->rowCount(root); ++i) {
          const QModelIndex at = list->model()->index(i, 0, root);
          if (at.data().toString() == name) row = at;
        }
        return row.isValid();
      },
      5000);
  return row;
}

// The size, kind and date the file list shows for a file.
QStringList Columns(QFileDialog& dialog, const QString& name) {
  const QModelIndex row = Row(dialog, name);
  return {row.siblingAtColumn(1).data().toString(), row.siblingAtColumn(2).data().toString(),
          row.siblingAtColumn(3).data().toString()};
}

// A side window with or without a cancel button, counting its closes.
struct Side : Window {
  QPushButton* cancel = nullptr;
  int clicks = 0, closes = 0;
  Side(bool hasCancel, bool enabled) {
    if (!hasCancel) return;
    cancel = MakeButton(this, "thoat", QStringLiteral("Thoát"));
    cancel->setEnabled(enabled);
    connect(cancel, &QPushButton::clicked, this, [this] { ++clicks; });
    setCancelButton(cancel);
  }
  void closeEvent(QCloseEvent* event) override {
    ++closes;
    Window::closeEvent(event);
  }
};

}  // namespace

class DialogsTest : public QObject {
  Q_OBJECT

  QTemporaryDir store_, work_;
  Requests requests_;
  QTranslator vi_;
  // The field book and its sketch; with a text file and a picture, changed
  // at a known time.
  QString book_, sketch_;

  // The texts the dialog shows that are English texts Qt asked for and the
  // translation leaves English (or has not), as "where: text" lines.
  QStringList leftovers(QWidget& dialog) const {
    std::map<QString, bool> english;  // source -> the translation keeps it
    for (const Request& r : requests_.asked()) {
      const QString source = QString::fromUtf8(std::get<1>(r));
      const QString vi = Vietnamese(vi_, r);
      bool& kept = english[source];
      kept = kept || vi == source;
    }
    QStringList found;
    for (const Shown& s : TextsOf(dialog)) {
      const auto it = english.find(s.text);
      if (it != english.end() && !it->second) found << s.where + QStringLiteral(": ") + s.text;
    }
    return found;
  }

 private slots:
  void initTestCase() {
    UseScratchSettings(store_);
    if (!UseVietnamese(QStringLiteral(KAVU_TRANSLATION_DIR)))
      QSKIP("no kavu_vi.qm in the build: Qt's translation tools were not found");
    QVERIFY(vi_.load(QStringLiteral("kavu_vi"), QStringLiteral(KAVU_TRANSLATION_DIR)));
    QCoreApplication::installTranslator(&requests_);
    book_ = work_.filePath(QStringLiteral("job1.asc"));
    sketch_ = work_.filePath(QStringLiteral("job1.sdo"));
    WriteAll(book_, QByteArray(1536, 'x'));
    WriteAll(sketch_, "Khu do: Tan Phu\r\n  1   12.50   90 00 00\r\n");
    WriteAll(work_.filePath(QStringLiteral("notes.txt")), "ghi chu\n");
    WriteAll(work_.filePath(QStringLiteral("view.png")), QByteArray(3000, 'p'));
    const QDateTime changed(QDate(2024, 3, 7), QTime(14, 5));
    for (const char* name : {"job1.asc", "job1.sdo", "notes.txt", "view.png"}) {
      QFile file(work_.filePath(QLatin1String(name)));
      QVERIFY(file.open(QIODevice::ReadWrite));
      QVERIFY(file.setFileTime(changed, QFileDevice::FileModificationTime));
    }
  }

  void sizesAndDatesOfTheFileList() {
    const std::pair<qint64, const char*> sizes[] = {{0, "0 byte"},
                                                    {1023, "1023 byte"},
                                                    {1024, "1,0 KB"},
                                                    {1075, "1,0 KB"},
                                                    {1076, "1,1 KB"},
                                                    {1048524, "1023,9 KB"},
                                                    {1048575, "1,0 MB"},
                                                    {5767168, "5,5 MB"},
                                                    {10737418240, "10,0 GB"},
                                                    {1099511627776, "1,0 TB"},
                                                    {2251799813685248, "2048,0 TB"}};
    for (const auto& [bytes, text] : sizes) QCOMPARE(FileSizeText(bytes), QString::fromUtf8(text));
    QCOMPARE(FileDateText(QDateTime(QDate(1999, 12, 31), QTime(0, 0, 59))),
             QStringLiteral("31/12/1999 00:00"));
  }

  // The field sketch printed from the map window: the preview, its print
  // dialog with the options open and the printer's properties, its page setup.
  void printPreviewAndItsDialogs() {
    MapWindow map;
    map.setSurvey(Survey{}, book_.toStdString(), sketch_.toStdString());
    map.show();
    QStringList found;
    int dialogs = 0;
    auto look = [&](QDialog& dialog, const char* picture) {
      ++dialogs;
      dialog.resize(dialog.sizeHint().expandedTo(dialog.size()));
      QApplication::processEvents();
      found << leftovers(dialog);
      if (picture != nullptr) Save(dialog, picture);
    };
    auto action = [](QWidget& dialog, const char* text) {
      const QString caption = QCoreApplication::translate("QPrintPreviewDialog", text);
      for (QAction* a : dialog.findChildren<QAction*>()) {
        if (a->text() == caption) return a;
      }
      qFatal("the preview has no action %s", text);
    };
    QString zoom;
    auto seen = WhenShown([&](QDialog& preview) {
      preview.resize(900, 700);
      look(preview, "kavu-print-preview.png");
      // A zoom typed as the preview writes it, with a decimal point.
      QLineEdit* factor = preview.findChild<QComboBox*>()->lineEdit();
      factor->selectAll();
      QTest::keyClicks(factor, QStringLiteral("150.5"));
      QTest::keyClick(factor, Qt::Key_Return);
      zoom = factor->text();
      WhenShown([&](QDialog& print) {
        look(print, nullptr);
        for (QPushButton* b : print.findChildren<QPushButton*>()) {
          if (b->text() == QCoreApplication::translate("QPrintDialog", "&Options >>")) b->click();
        }
        look(print, "kavu-print-dialog.png");
        auto* properties = print.findChild<QPushButton*>(QStringLiteral("properties"));
        if (properties != nullptr && properties->isEnabled()) {
          WhenShown([&](QDialog& d) { look(d, "kavu-print-properties.png"); });
          properties->click();
        }
      });
      action(preview, "Print")->trigger();
      WhenShown([&](QDialog& setup) { look(setup, "kavu-page-setup.png"); });
      action(preview, "Page setup")->trigger();
    });
    Child<QAction>(map, "printSketch")->trigger();
    QVERIFY(*seen);
    QCOMPARE(zoom, QStringLiteral("150.5%"));
    QVERIFY2(dialogs >= 4, qPrintable(QString::number(dialogs)));
    QVERIFY2(found.isEmpty(), qPrintable(found.join(QLatin1Char('\n'))));
  }

  // The map window's save dialog and the program's own open-file dialog: no
  // English, the file list in Vietnamese. The save dialog proposes the job's
  // name with the extension of the kind chosen, adds it to a bare name typed
  // and asks before that name's file is replaced.
  void fileDialogs() {
    MapWindow map;
    map.setSurvey(Survey{}, book_.toStdString(), sketch_.toStdString());
    map.show();
    const auto kind = [](const char* mime) {
      return QMimeDatabase().mimeTypeForName(QLatin1String(mime)).comment();
    };
    QVERIFY2(kind("text/plain") != QLatin1String("plain text document"),
             qPrintable(kind("text/plain")));
    const QString when = QStringLiteral("07/03/2024 14:05");
    struct File {
      const char* name;
      QStringList columns;  // size, kind, date
    };
    const struct {
      bool own;
      std::vector<File> files;  // those the dialog's filter shows
    } cases[] = {{false, {{"view.png", {"2,9 KB", kind("image/png"), when}}}},
                 {true,
                  {{"notes.txt", {"8 byte", kind("text/plain"), when}},
                   {"job1.asc", {"1,5 KB", {}, when}},
                   {"view.png", {"2,9 KB", kind("image/png"), when}}}}};
    for (const auto& c : cases) {
      QStringList found, question;
      std::vector<QStringList> columns;
      QString accept;
      const auto shown = WhenShown([&](QDialog& d) {
        auto& dialog = static_cast<QFileDialog&>(d);
        for (const File& f : c.files) columns.push_back(Columns(dialog, QLatin1String(f.name)));
        found << leftovers(dialog);
        QAbstractButton* ok = dialog.findChild<QDialogButtonBox*>()->buttons().first();
        accept = ok->text();
        Save(dialog, c.own ? "kavu-open-dialog.png" : "kavu-save-dialog.png");
        if (c.own) return;
        auto* name = dialog.findChild<QLineEdit*>(QStringLiteral("fileNameEdit"));
        auto* kinds = dialog.findChild<QComboBox*>(QStringLiteral("fileTypeCombo"));
        for (const int k : {1, 0}) {
          question << name->text();
          kinds->setCurrentIndex(k);
          emit kinds->activated(k);
        }
        // No to replacing keeps the dialog open.
        const auto asked = WhenShown([&](QDialog& box) {
          found << leftovers(box);
          question << static_cast<QMessageBox&>(box).text();
        });
        name->setText(QStringLiteral("view"));
        ok->click();
        question << (*asked && dialog.isVisible() ? "kept" : "gone");
      });
      if (c.own) {
        ChooseFile(&map, Q(kChooseKcFile), work_.path(), {Q(kAllFiles)});
      } else {
        Child<QAction>(map, "saveView")->trigger();
      }
      QVERIFY(*shown);
      QVERIFY2(found.isEmpty(), qPrintable(found.join(QLatin1Char('\n'))));
      QCOMPARE(QString(accept).remove(QLatin1Char('&')),
               (c.own ? Q(kOpen) : Q(kSave)).remove(QLatin1Char('&')));
      for (std::size_t i = 0; i < c.files.size(); ++i) {
        QStringList expected = c.files[i].columns;
        if (expected[1].isEmpty())
          expected[1] = columns[i].value(1);  // whatever the system names .asc
        QCOMPARE(columns[i], expected);
      }
      if (!c.own) {
        QCOMPARE(question, QStringList({"job1.png", "job1.svg",
                                        "File view.png đã có.\nCó ghi đè lên không?", "kept"}));
      }
    }
  }

  // Every text Qt asked for in those dialogs has its Vietnamese.
  void everyRequestTranslated() {
    QStringList missing;
    for (const Request& r : requests_.asked()) {
      if (Vietnamese(vi_, r).isEmpty()) {
        const auto& [context, source, disambiguation] = r;
        missing << QString::fromUtf8(context + " | " + source + " | " + disambiguation);
      }
    }
    QVERIFY2(missing.isEmpty(), qPrintable(missing.join(QLatin1Char('\n'))));
  }

  // Esc presses the cancel button where there is one and it is enabled, and
  // closes a window that has none, through its closing steps.
  void escapeClosesASideWindow() {
    struct Case {
      bool hasCancel, enabled;
      Qt::KeyboardModifiers modifiers;
      int clicks, closes;
      bool visible;
    } cases[] = {{false, false, Qt::NoModifier, 0, 1, false},
                 {true, true, Qt::NoModifier, 1, 0, true},
                 {true, false, Qt::NoModifier, 0, 0, true},
                 {false, false, Qt::ShiftModifier, 0, 0, true}};
    for (const Case& c : cases) {
      Side side(c.hasCancel, c.enabled);
      side.show();
      QTest::keyClick(&side, Qt::Key_Escape, c.modifiers);
      const QString what =
          QStringLiteral("%1 %2 %3").arg(c.hasCancel).arg(c.enabled).arg(c.modifiers);
      QVERIFY2(side.clicks == c.clicks && side.closes == c.closes, qPrintable(what));
      QVERIFY2(side.isVisible() == c.visible, qPrintable(what));
    }
  }
};

QTEST_MAIN(DialogsTest)
#include "dialogs_test.moc"
