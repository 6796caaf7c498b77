// The map of a run: one item per point at its place, doubtful points in red
// on the screen and in the pictures, a click showing the error lines and the
// record; the exports read back; the field sketch on pages and in a PDF; the
// window's keys, save dialogs, information pane, size and captions.
#include <QCheckBox>
#include <QComboBox>
#include <QFileDialog>
#include <QImage>
#include <QLabel>
#include <QLineEdit>
#include <QMenuBar>
#include <QPainter>
#include <QPrintPreviewDialog>
#include <QProcess>
#include <QPushButton>
#include <QScreen>
#include <QScrollBar>
#include <QSplitter>
#include <QStandardPaths>
#include <QStatusBar>
#include <QSvgRenderer>
#include <QTextBlock>
#include <QTextBrowser>
#include <QToolBar>
#include <QToolButton>
#include <QToolTip>
#include <QtTest>

#include "core/tcvn3.h"
#include "support.h"
#include "ui/map_window.h"
#include "ui/sketch_pdf.h"

using namespace kavu;
using namespace kavu::ui;
using namespace kavu::ui::test;

namespace {

// A station on A oriented to B and checked on C, a peg and three detail
// points; the report names the detail point 2 and the peg.
Survey HandMade() {
  Survey s;
  s.control = {{"A", 1000, 2000, {}}, {"B", 1100, 2000, {}}, {"C", 1000, 2100, {}}};
  StationResult st{s.control[0], s.control[1], 0, 100, s.control[2], {}, 2};
  s.stations = {st};
  const std::string peg = "CP" + Utf8ToTcvn3("đ");
  const struct {
    std::string record;
    PointKind kind;
    double x, y;
  } points[] = {{"1 0 1 900000 1 10", PointKind::Detail, 1010, 2010},
                {"2 0 1 900000 1", PointKind::Detail, 1020, 1990},
                {"P 0 1 900000 1 " + peg, PointKind::Peg, 990, 2030},
                {"3 0 1 900000 1", PointKind::Detail, 1040, 2050}};
  for (const auto& p : points) {
    ComputedPoint& point = s.AddPoint(p.record, p.kind, p.x, p.y);
    point.line = static_cast<std::uint32_t>(s.points.size() + 3);
    point.words = p.kind == PointKind::Detail && p.record.size() > 16;  // the code "10"
  }
  s.AddReport("Diem 2            nhap sai phan phut", "2", 5);
  s.AddReport("Diem " + peg + "          nhap sai phan giay", peg, 6);
  return s;
}

// The hand-made survey with a second station set up on the peg, oriented to
// A: the run lists the peg among the known points it used.
Survey PegAsStation() {
  Survey s = HandMade();
  const ComputedPoint& peg = s.points[2];
  const SurveyPoint on{std::string(s.Name(peg)), peg.x, peg.y, {}};
  s.control.push_back(on);
  s.stations.push_back({on, s.control[0], 0, 10, std::nullopt, {}, 9});
  return s;
}

QColor PixelAt(const QImage& image, QPointF at) { return image.pixelColor(at.toPoint()); }
bool Red(const QColor& c) { return c.red() > 180 && c.green() < 80 && c.blue() < 80; }

// A station's section of the field sketch with rows detail rows.
QStringList Section(const QString& station, int rows) {
  const QString rule = QString(77, QLatin1Char('='));
  QStringList lines = {
      "",
      "Lược đồ số:01                SO DO CHI TIET",
      "",
      "Điểm trạm đo: " + station.leftJustified(12) + "    Khu đo: Xã Tân Phú",
      "1. Máy đo: TOPCOM 226         Số máy: 23756",
      rule,
      "| Điểm |  Khoảng  |   Góc bằng   |   Góc đứng  |  Chiều cao  |    Ghi chú   |",
      "| mia  |  cách (m)|   o  ,  ,,   |   o  ,  ,,  |    gương    |              |",
      QString(77, QLatin1Char('-'))};
  for (int i = 1; i <= rows; ++i) {
    lines << "|" + QString::number(i).leftJustified(5) +
                 " |   12.345 |  120 17 16  |   88 20 19 | 1.50        |              |";
  }
  lines << rule;
  return lines;
}

QString Sketch(std::initializer_list<std::pair<const char*, int>> stations) {
  QStringList lines;
  for (const auto& [station, rows] : stations) lines << Section(QLatin1String(station), rows);
  return lines.join(QStringLiteral("\r\n")) + QStringLiteral("\r\n");
}

// The text of a PDF page by page, or nothing without pdftotext.
std::optional<QStringList> PdfPages(const QString& pdf) {
  const QString pdftotext = QStandardPaths::findExecutable(QStringLiteral("pdftotext"));
  if (pdftotext.isEmpty()) return std::nullopt;
  QProcess text;
  text.start(pdftotext, {QStringLiteral("-layout"), pdf, QStringLiteral("-")});
  if (!text.waitForFinished(20000)) return QStringList();
  QStringList pages = QString::fromUtf8(text.readAllStandardOutput()).split(QLatin1Char('\f'));
  if (!pages.isEmpty() && pages.back().trimmed().isEmpty()) pages.removeLast();
  return pages;
}

// The map window on a survey, shown.
struct Shown {
  QTemporaryDir dir;
  MapWindow map;
  bool exposed = false;
  explicit Shown(Survey survey, const QByteArray& book = {}, const QString& sketch = {}) {
    const QString bookPath = dir.filePath(QStringLiteral("job1.asc"));
    WriteAll(bookPath, book);
    std::string sketchPath;
    if (!sketch.isEmpty()) {
      sketchPath = dir.filePath(QStringLiteral("job1.sdo")).toStdString();
      WriteAll(QString::fromStdString(sketchPath),
               QByteArray::fromStdString(Utf8ToTcvn3(sketch.toStdString())));
    }
    map.setSurvey(std::move(survey), bookPath.toStdString(), sketchPath);
    map.resize(640, 560);
    map.show();
    exposed = QTest::qWaitForWindowExposed(&map);
  }
  QString path(const char* name) const { return dir.filePath(QLatin1String(name)); }
  QAction* action(const char* name) { return Child<QAction>(map, name); }
};

// Runs check on the modal dialog that the next step opens; a dialog that
// does not close by itself is closed after a while, and fails the test.
struct OnDialog {
  bool seen = false, stuck = false;
  explicit OnDialog(std::function<void(QWidget&)> check) {
    QTimer::singleShot(0, [this, check] {
      QWidget* dialog = QApplication::activeModalWidget();
      if (dialog == nullptr) return;
      seen = true;
      check(*dialog);
    });
    QTimer::singleShot(5000, [this] {
      if (auto* dialog = qobject_cast<QDialog*>(QApplication::activeModalWidget())) {
        stuck = true;
        dialog->reject();
      }
    });
  }
};

}  // namespace

class MapTest : public QObject {
  Q_OBJECT

  QTemporaryDir store_;

 private slots:
  void init() { UseScratchSettings(store_); }

  void oneItemPerPointAtItsPlaceWithTheRightHighlight() {
    const MapModel model = BuildMap(HandMade());
    QStringList items;  // kind name x y red
    for (const MapItem& i : model.items) {
      items << QStringLiteral("%1 %2 %3 %4 %5")
                   .arg(static_cast<int>(i.kind))
                   .arg(i.name)
                   .arg(i.x)
                   .arg(i.y)
                   .arg(i.flagged);
    }
    QCOMPARE(items, QStringList({"0 A 1000 2000 0", "0 B 1100 2000 0", "0 C 1000 2100 0",
                                 "1 A 1000 2000 0", "3 1 1010 2010 0", "3 2 1020 1990 1",
                                 "2 CPđ 990 2030 1", "3 3 1040 2050 0"}));
    QCOMPARE(model.sights.size(), 2u);  // orientation and check sight

    // North up, east right, one scale: B is above A, C right of A, as far.
    const MapView view = FitView(model, QSize(400, 400));
    const QPointF a = view.toDevice(1000, 2000), b = view.toDevice(1100, 2000),
                  c = view.toDevice(1000, 2100);
    QCOMPARE(b.x(), a.x());
    QVERIFY(b.y() < a.y());
    QCOMPARE(c.y(), a.y());
    QCOMPARE(c.x() - a.x(), a.y() - b.y());

    // The painting: red where the report points, black elsewhere.
    QImage image(view.size, QImage::Format_RGB32);
    QPainter painter(&image);
    PaintMap(painter, model, view);
    painter.end();
    QVERIFY(Red(PixelAt(image, view.toDevice(1020, 1990))));
    const QColor plain = PixelAt(image, view.toDevice(1040, 2050));
    QVERIFY(plain.lightness() < 60 && !Red(plain));
  }

  void wheelZoomKeepsThePointUnderTheCursorAndAClickShowsTheRecord() {
    QTemporaryDir dir;
    const QString book = dir.filePath(QStringLiteral("job.asc"));
    WriteAll(book, "TR A 1 2\r\nTR B 3 4\r\nTR A 1.5\r\nDKD B\r\n2 0751234 10 900000 1.5\r\n");
    MapWindow map;
    map.setSurvey(HandMade(), book.toStdString(), "");
    map.resize(640, 560);
    map.show();
    QVERIFY(QTest::qWaitForWindowExposed(&map));
    MapCanvas& canvas = map.canvas();

    const QPointF at = canvas.view().toDevice(1020, 1990);
    const QPointF ground = canvas.view().toGround(at + QPointF(30, 20));
    const double scale = canvas.view().scale;
    QWheelEvent wheel(at + QPointF(30, 20), canvas.mapToGlobal(at + QPointF(30, 20)), {}, {0, 240},
                      Qt::NoButton, Qt::NoModifier, Qt::NoScrollPhase, false);
    QCoreApplication::sendEvent(&canvas, &wheel);
    QVERIFY(canvas.view().scale > scale);
    const QPointF still = canvas.view().toGround(at + QPointF(30, 20));
    QVERIFY(std::abs(still.x() - ground.x()) < 1e-6 && std::abs(still.y() - ground.y()) < 1e-6);

    QTest::mouseClick(&canvas, Qt::LeftButton, {}, canvas.view().toDevice(1020, 1990).toPoint());
    QVERIFY(map.details().contains(QStringLiteral("nhap sai phan phut")));
    QVERIFY(map.details().contains(QStringLiteral("2 0751234 10 900000 1.5")));
  }

  // The view as PNG, the whole survey as PNG and SVG, red where the report
  // points; a folder that is not there is refused.
  void exportsReadBack() {
    QTemporaryDir dir;
    MapWindow map;
    map.setSurvey(HandMade(), {}, {});
    map.resize(500, 400);
    map.show();
    QVERIFY(QTest::qWaitForWindowExposed(&map));
    const QString png = dir.filePath(QStringLiteral("view.png"));
    const QString whole = dir.filePath(QStringLiteral("whole.png"));
    const QString svg = dir.filePath(QStringLiteral("whole.svg"));
    QVERIFY(map.savePicture(png, false) && map.savePicture(whole, true) &&
            map.savePicture(svg, true));
    QCOMPARE(QImage(png).size(), map.canvas().size());
    const MapView view = FitView(map.canvas().model(), kWholeSurveySize);
    QVERIFY(Red(PixelAt(QImage(whole), view.toDevice(1020, 1990))));
    QCOMPARE(QSvgRenderer(svg).viewBoxF(), QRectF(QPointF(0, 0), QSizeF(kWholeSurveySize)));
    QVERIFY(QString::fromUtf8(ReadAll(svg)).contains(QStringLiteral("CPđ")));
    QVERIFY(!map.savePicture(dir.filePath(QStringLiteral("no/such/folder/x.png")), true));
  }

  // The README's example computed from the main window with the map ticked:
  // the map opens by itself; its picture goes to the build folder; the sketch
  // PDF shows the form's words and the points in Unicode.
  void theExampleOnTheMapAndItsSketchAsPdf() {
    Desk desk;
    QVERIFY(QFile::copy(QStringLiteral(KAVU_EXAMPLES "/job1.asc"), desk.path("job1.asc")));
    QVERIFY(desk.w.chooseFile(desk.path("job1.asc")));
    Child<QCheckBox>(desk.w, "fsdo")->setCheckState(Qt::Checked);
    Child<QCheckBox>(desk.w, "ckBando")->setChecked(true);
    QVERIFY(!Child<QPushButton>(desk.w, "bando")->isEnabled());
    desk.w.tinh_Click();
    MapWindow& map = desk.w.mapWindow();
    QVERIFY(map.isVisible());
    const MapModel& model = map.canvas().model();
    auto count = [&](MapKind kind) {
      return std::count_if(model.items.begin(), model.items.end(),
                           [kind](const MapItem& i) { return i.kind == kind; });
    };
    QCOMPARE(count(MapKind::Station), 4);
    QCOMPARE(count(MapKind::Detail), 100);
    QCOMPARE(count(MapKind::Peg), 2);
    QCOMPARE(model.sights.size(), 8u);  // every station has a check record
    // The picture: zoomed in on the first station far enough to read the
    // names, the peg CP1 clicked, the cursor on it.
    map.resize(1000, 760);
    QVERIFY(QTest::qWaitForWindowExposed(&map));
    MapCanvas& canvas = map.canvas();
    const auto cp1 = std::find_if(model.items.begin(), model.items.end(), [](const MapItem& i) {
      return i.kind == MapKind::Peg && i.name == QStringLiteral("CP1");
    });
    QVERIFY(cp1 != model.items.end());
    canvas.zoomAt(canvas.view().toDevice(cp1->x, cp1->y), 2.5);
    const QPoint at = canvas.view().toDevice(cp1->x, cp1->y).toPoint();
    QTest::mouseClick(&canvas, Qt::LeftButton, {}, at);
    QVERIFY(map.details().contains(QStringLiteral("CP1")));
    QTest::mouseMove(&canvas, at);
    QVERIFY(map.grab().save(QStringLiteral(KAVU_PICTURES "/kavu-map-job1.png")));

    const QString pdf = desk.path("job1.pdf");
    QVERIFY(map.saveSketch(pdf));
    QVERIFY(ReadAll(pdf).startsWith("%PDF"));
    const auto pages = PdfPages(pdf);
    if (!pages) QSKIP("pdftotext (poppler-utils) is not installed");
    const QString shown = pages->join(QLatin1Char('\f'));
    for (const char* words :
         {"Điểm trạm đo: DC01", "Định hướng 1: DC02", "N đường", "Trang 1/4", "Trang 4/4"}) {
      QVERIFY2(shown.contains(QString::fromUtf8(words)), words);
    }
  }

  // A peg is a peg wherever the map names what a point is, also once a
  // station stood on it; the point itself wins a click over its station.
  void aPegIsNamedAPegEverywhere() {
    const QString peg = QStringLiteral("CPđ");
    Shown shown(PegAsStation());
    MapWindow& map = shown.map;
    const MapModel& model = map.canvas().model();
    QStringList kinds;
    std::size_t pegItem = 0;
    for (std::size_t i = 0; i < model.items.size(); ++i) {
      if (model.items[i].name != peg) continue;
      kinds << KindName(model.items[i].kind);
      if (model.items[i].kind == MapKind::Peg) pegItem = i;
    }
    QCOMPARE(kinds, QStringList({"Trạm máy", "Cọc phụ"}));

    const auto pegAt = [&](MapCanvas& canvas) {
      return canvas.view().toDevice(model.items[pegItem].x, model.items[pegItem].y).toPoint();
    };
    QCOMPARE(ItemAt(model, map.canvas().view(), pegAt(map.canvas())),
             std::optional<std::size_t>(pegItem));
    QTest::mouseClick(&map.canvas(), Qt::LeftButton, {}, pegAt(map.canvas()));
    const QString details = map.details();
    QVERIFY2(details.startsWith(peg + QStringLiteral("  (Cọc phụ, Trạm máy)")),
             qPrintable(details));
    QVERIFY(details.contains(QStringLiteral("nhap sai phan giay")));
    // A control point with its station is both.
    QVERIFY(map.describe(0).startsWith(QStringLiteral("A  (Điểm khống chế, Trạm máy)")));

    QHelpEvent help(QEvent::ToolTip, pegAt(map.canvas()),
                    map.canvas().mapToGlobal(pegAt(map.canvas())));
    QCoreApplication::sendEvent(&map.canvas(), &help);
    QCOMPARE(QToolTip::text(), peg + QStringLiteral(" (Cọc phụ), có báo lỗi"));
    QToolTip::hideText();
    const QString legend = Child<QLabel>(map, "chuthich")->text();
    for (const char* kind : {"Điểm khống chế", "Trạm máy", "Cọc phụ", "Điểm chi tiết"}) {
      QVERIFY2(legend.contains(QString::fromUtf8(kind)), kind);
    }
    // On the picture it is a square, not a control point's triangle.
    const QString svg = shown.path("peg.svg");
    QVERIFY(SaveMapSvg(model, map.canvas().view(), svg));
    const QString drawn = QString::fromUtf8(ReadAll(svg));
    const QPointF at = map.canvas().view().toDevice(model.items[pegItem].x, model.items[pegItem].y);
    const QString square = QStringLiteral("<rect x=\"%1\" y=\"%2\" width=\"7\" height=\"7\"")
                               .arg(at.x() - 3.5)
                               .arg(at.y() - 3.5);
    QVERIFY2(drawn.contains(square), qPrintable(square));
    QVERIFY(!drawn.contains(QStringLiteral("d=\"M%1,%2 ").arg(at.x()).arg(at.y() - 7)));
  }

  // Detail numbers start again at each station: a click shows the point's
  // own record and report lines, not those of its namesakes elsewhere.
  void namesakesElsewhereAreOtherPoints() {
    Survey s = HandMade();
    ComputedPoint& again = s.AddPoint("2 0 1 900000 1", PointKind::Detail, 1060, 2060);
    again.line = 12;
    s.AddReport("Diem 2            nhap sai phan do", "2", 12);
    Shown shown(std::move(s),
                "l1\r\nl2\r\nl3\r\nl4\r\nfirst 2\r\nl6\r\nl7\r\nl8\r\nl9\r\nl10\r\n"
                "l11\r\nsecond 2\r\n");
    const QString first = shown.map.describe(5), second = shown.map.describe(8);
    QVERIFY(first.contains(QStringLiteral("phan phut")) &&
            !first.contains(QStringLiteral("phan do")));
    QVERIFY(first.contains(QStringLiteral("first 2")) &&
            !first.contains(QStringLiteral("second 2")));
    QVERIFY(second.contains(QStringLiteral("phan do")) &&
            !second.contains(QStringLiteral("phan phut")));
    QVERIFY(second.contains(QStringLiteral("second 2")) &&
            !second.contains(QStringLiteral("first 2")));
  }

  void theJobsNameAndTheExtension() {
    const QString png = QStringLiteral("Hình PNG (*.png)"),
                  svg = QStringLiteral("Hình SVG (*.svg)"),
                  pdf = QStringLiteral("File PDF (*.pdf)");
    const struct {
      QString book, extension, proposed;
    } proposals[] = {{"/d/khu A/job1.asc", "png", "/d/khu A/job1.png"},
                     {"/d/xa.tan.phu.asc", "pdf", "/d/xa.pdf"},
                     {"/d/job1", "svg", "/d/job1.svg"},
                     {"/d/.asc", "png", "/d/.asc.png"},
                     {"", "png", ""}};
    for (const auto& p : proposals) QCOMPARE(ProposedPath(p.book, p.extension), p.proposed);
    const QStringList pictures{png, svg};
    const struct {
      QString typed, filter, saved;
    } typed[] = {{"/d/ban do", png, "/d/ban do.png"}, {"/d/ban do", svg, "/d/ban do.svg"},
                 {"/d/ban.svg", png, "/d/ban.svg"},   {"/d/ban.PNG", svg, "/d/ban.PNG"},
                 {"/d/ban.v2", png, "/d/ban.v2.png"}, {"/d/ban.", svg, "/d/ban.svg"}};
    for (const auto& t : typed) QCOMPARE(WithExtension(t.typed, t.filter, pictures), t.saved);
    QCOMPARE(WithExtension(QStringLiteral("/d/so"), pdf, {pdf}), QStringLiteral("/d/so.pdf"));
  }

  // Each save action proposes the job's name with the extension of the kind
  // chosen last, and adds the chosen kind's extension to a bare name.
  void saveActionsProposeTheJobAndAddTheExtension() {
    Shown shown(HandMade(), {}, Sketch({{"A", 3}}));
    const QString png = QStringLiteral("Hình PNG (*.png)"),
                  svg = QStringLiteral("Hình SVG (*.svg)"),
                  pdf = QStringLiteral("File PDF (*.pdf)");
    const struct {
      const char* action;
      QString proposedName, proposedFilter;  // what the dialog is asked
      const char* typed;
      QString chosen;
      const char* saved;
      QByteArray starts;
    } steps[] = {{"saveWhole", "job1.png", png, "ca khu", svg, "ca khu.svg", "<?xml"},
                 {"saveView", "job1.svg", svg, "xem", png, "xem.png", "\x89PNG"},
                 {"saveView", "job1.png", png, "xem2.svg", png, "xem2.svg", "<?xml"},
                 {"saveSketch", "job1.pdf", pdf, "so do", pdf, "so do.pdf", "%PDF"}};
    for (const auto& step : steps) {
      SaveRequest asked;
      shown.map.setSaveChooser([&](QWidget*, const SaveRequest& request) {
        asked = request;
        return SaveChoice{shown.path(step.typed), step.chosen};
      });
      shown.action(step.action)->trigger();
      QCOMPARE(asked.proposed, shown.path(qPrintable(step.proposedName)));
      QCOMPARE(asked.filter, step.proposedFilter);
      QVERIFY2(!asked.caption.contains(QLatin1Char('&')), qPrintable(asked.caption));
      QVERIFY2(ReadAll(shown.path(step.saved)).startsWith(step.starts), step.saved);
    }
  }

  // Qt's dialog itself: the proposed name follows the kind chosen, a bare
  // name typed gets its extension before the dialog returns it.
  void theSaveDialogKeepsTheExtensionInStep() {
    QTemporaryDir dir;
    const QStringList filters =
        QString::fromUtf8(kPictureFilter.data()).split(QStringLiteral(";;"));
    QString proposed, switched;
    OnDialog dialog([&](QWidget& window) {
      auto* name = window.findChild<QLineEdit*>(QStringLiteral("fileNameEdit"));
      auto* kinds = window.findChild<QComboBox*>(QStringLiteral("fileTypeCombo"));
      if (name == nullptr || kinds == nullptr) return;
      proposed = name->text();
      kinds->setCurrentIndex(1);
      emit kinds->activated(1);
      switched = name->text();
      name->setText(QStringLiteral("ban do"));
      qobject_cast<QDialog*>(&window)->accept();
    });
    const SaveChoice choice = ChooseSavePath(
        nullptr,
        {QStringLiteral("Lưu"), dir.filePath(QStringLiteral("job1.png")), filters, filters[0]});
    QVERIFY(dialog.seen && !dialog.stuck);
    QCOMPARE(proposed, QStringLiteral("job1.png"));
    QCOMPARE(switched, QStringLiteral("job1.svg"));
    QCOMPARE(choice.path, dir.filePath(QStringLiteral("ban do.svg")));
    QCOMPARE(choice.filter, filters[1]);
  }

  // +, - and 0 zoom from the keyboard and from the tool bar, the arrows
  // move the view a step towards their side.
  void keysAndButtonsZoomAndPan() {
    Shown shown(HandMade());
    MapCanvas& canvas = shown.map.canvas();
    const MapView fitted = canvas.view();
    const struct {
      Qt::Key key;
      double scale;        // times the fitted scale
      double north, east;  // the middle's move, in steps of an eighth of the drawing
    } keys[] = {{Qt::Key_Plus, 1.25, 0, 0}, {Qt::Key_Minus, 1, 0, 0}, {Qt::Key_Minus, 0.8, 0, 0},
                {Qt::Key_0, 1, 0, 0},       {Qt::Key_Right, 1, 0, 1}, {Qt::Key_Up, 1, 1, 1},
                {Qt::Key_Left, 1, 1, 0},    {Qt::Key_Down, 1, 0, 0},  {Qt::Key_Equal, 1.25, 0, 0}};
    for (const auto& k : keys) {
      QTest::keyClick(&canvas, k.key);
      const MapView& v = canvas.view();
      QVERIFY2(std::abs(v.scale / fitted.scale - k.scale) < 1e-9,
               qPrintable(QString::number(k.key)));
      QVERIFY(std::abs((v.north - fitted.north) * fitted.scale - k.north * canvas.height() / 8.0) <
              1e-6);
      QVERIFY(std::abs((v.east - fitted.east) * fitted.scale - k.east * canvas.width() / 8.0) <
              1e-6);
    }
    auto* tools = Child<QToolBar>(shown.map, "congcu");
    const double before = canvas.view().scale;
    qobject_cast<QToolButton*>(tools->widgetForAction(shown.action("zoomIn")))->click();
    QCOMPARE(canvas.view().scale, before * 1.25);
    qobject_cast<QToolButton*>(tools->widgetForAction(shown.action("zoomOut")))->click();
    qobject_cast<QToolButton*>(tools->widgetForAction(shown.action("zoomOut")))->click();
    QCOMPARE(canvas.view().scale, before / 1.25);
    qobject_cast<QToolButton*>(tools->widgetForAction(shown.action("fit")))->click();
    QCOMPARE(canvas.view().scale, fitted.scale);
  }

  // The pane shows a long record on one line of a fixed-width font, grows to
  // show every line, and is resized with its splitter.
  void theInformationPaneShowsEveryLineWhole() {
    Survey s = HandMade();
    for (int i = 0; i < 6; ++i)
      s.AddReport("Diem 2            loi so " + std::to_string(i), "2", 5);
    const QByteArray record = "2 0751234 10 900000 1.5 " + QByteArray(90, 'x') + " END";
    Shown shown(std::move(s), "l1\r\nl2\r\nl3\r\nl4\r\n" + record + "\r\n");
    auto* pane = Child<QTextBrowser>(shown.map, "chitiet");
    auto* split = Child<QSplitter>(shown.map, "chia");
    QVERIFY(QFontInfo(pane->font()).fixedPitch());
    QTest::mouseClick(&shown.map.canvas(), Qt::LeftButton, {},
                      shown.map.canvas().view().toDevice(1020, 1990).toPoint());
    QApplication::processEvents();
    QVERIFY(shown.map.details().contains(QString::fromLatin1(record)));
    // The point, the report heading and its 7 lines, the record heading and line.
    QCOMPARE(pane->document()->blockCount(), 11);
    for (QTextBlock b = pane->document()->begin(); b.isValid(); b = b.next()) {
      QCOMPARE(b.layout()->lineCount(), 1);
    }
    QCOMPARE(pane->verticalScrollBar()->maximum(), 0);
    QVERIFY(!split->isCollapsible(0) && !split->isCollapsible(1));
    const int total = split->sizes().value(0) + split->sizes().value(1);
    split->setSizes({total - 200, 200});
    QCOMPARE(split->sizes().value(1), 200);
  }

  void theWindowFitsTheScreen() {
    const QRect screen(0, 0, 1280, 1000);
    const struct {
      QRect frame;
      QSize minimum;
      QRect placed;
    } cases[] = {{{100, 100, 1016, 808}, {400, 400}, {100, 100, 1016, 808}},
                 {{500, 400, 1016, 808}, {400, 400}, {264, 192, 1016, 808}},
                 {{0, 0, 1400, 1100}, {400, 400}, {0, 0, 1280, 1000}},
                 {{-50, -20, 800, 600}, {400, 400}, {0, 0, 800, 600}},
                 {{0, 0, 600, 300}, {400, 1200}, {0, 0, 600, 1200}}};
    for (const auto& c : cases) QCOMPARE(PlaceWithin(c.frame, c.minimum, screen), c.placed);

    MapWindow map;
    map.setSurvey(HandMade(), {}, {});
    // Its default and smallest sizes with a title bar and frame on a
    // 1280x1000 screen.
    const QSize frame(16, 48);
    QVERIFY(map.size().width() + frame.width() <= 1280 &&
            map.size().height() + frame.height() <= 1000);
    const QSize smallest = map.minimumSizeHint().expandedTo(map.minimumSize());
    QVERIFY(smallest.width() + frame.width() <= 1280 && smallest.height() + frame.height() <= 1000);
    map.move(5000, 5000);
    map.show();
    QVERIFY(QTest::qWaitForWindowExposed(&map));
    const QRect available = map.screen()->availableGeometry();
    QVERIFY(available.contains(map.frameGeometry()));
    QVERIFY(
        available.contains(map.statusBar()->mapToGlobal(map.statusBar()->rect().bottomRight())));
  }

  // Esc closes the print preview, and then the map.
  void escapeClosesTheWindows() {
    Shown shown(HandMade(), {}, Sketch({{"A", 3}}));
    OnDialog preview([](QWidget& window) { QTest::keyClick(&window, Qt::Key_Escape); });
    shown.action("printSketch")->trigger();
    QVERIFY(preview.seen && !preview.stuck);
    QVERIFY(shown.map.isVisible());
    shown.map.activateWindow();
    QVERIFY(QTest::qWaitForWindowActive(&shown.map));
    QTest::keyClick(&shown.map.canvas(), Qt::Key_Escape);
    QVERIFY(!shown.map.isVisible());
  }

  // Every action says what it does and its keys; the menus show access keys,
  // one letter each within a menu.
  void tooltipsAndAccessKeys() {
    Shown shown(HandMade());
    const QList<QAction*> actions = shown.map.findChildren<QAction*>(Qt::FindDirectChildrenOnly);
    QVERIFY(actions.size() >= 8);
    for (QAction* a : actions) {
      if (a->objectName().isEmpty()) continue;  // the menus' own
      QVERIFY2(a->toolTip().size() > a->iconText().size() + 4, qPrintable(a->objectName()));
      if (!a->shortcut().isEmpty()) {
        QVERIFY2(a->toolTip().contains(a->shortcut().toString(QKeySequence::NativeText)),
                 qPrintable(a->toolTip()));
      }
    }
    for (QToolButton* button : Child<QToolBar>(shown.map, "congcu")->findChildren<QToolButton*>()) {
      if (button->defaultAction() == nullptr) continue;
      QVERIFY2(!button->toolTip().isEmpty(), qPrintable(button->text()));
      QVERIFY2(!button->text().contains(QLatin1Char('&')), qPrintable(button->text()));
    }
    QList<QList<QAction*>> menus = {shown.map.menuBar()->actions()};
    for (QAction* menu : shown.map.menuBar()->actions()) menus << menu->menu()->actions();
    for (const QList<QAction*>& entries : menus) {
      QSet<QChar> keys;
      for (QAction* entry : entries) {
        if (entry->isSeparator()) continue;
        const qsizetype amp = entry->text().indexOf(QLatin1Char('&'));
        QVERIFY2(amp >= 0 && amp + 1 < entry->text().size(), qPrintable(entry->text()));
        const QChar key = entry->text()[amp + 1].toLower();
        QVERIFY2(!keys.contains(key), qPrintable(entry->text()));
        keys.insert(key);
      }
    }
    QCOMPARE(shown.action("closeMap")->shortcut(), QKeySequence(Qt::Key_Escape));
    // Without a sketch its actions say why they are greyed.
    QVERIFY(!shown.action("saveSketch")->isEnabled());
    QVERIFY(shown.action("saveSketch")->toolTip().contains(QStringLiteral("Tạo File sổ đo")));
  }

  // A station longer than a page goes on under its name and "(tiếp)" with the
  // column heads again; the next station starts a page.
  void longStationsGoOnUnderTheirName() {
    const QString sketch = Sketch({{"DC01", 20}, {"CP1", 2}});
    const struct {
      int perPage;
      QList<int> sizes;  // lines per page
    } layouts[] = {{40, {29, 11}}, {12, {12, 12, 12, 8, 11}}, {25, {25, 9, 11}}};
    for (const auto& l : layouts) {
      const std::vector<QStringList> pages = SketchPages(sketch, l.perPage);
      QList<int> sizes;
      for (const QStringList& page : pages) sizes << static_cast<int>(page.size());
      QCOMPARE(sizes, l.sizes);
      for (std::size_t i = 1; i < pages.size(); ++i) {
        const bool goesOn = !pages[i].front().startsWith(QStringLiteral("Lược đồ"));
        if (!goesOn) continue;
        QCOMPARE(pages[i].front(), QStringLiteral("Điểm trạm đo: DC01 (tiếp)"));
        QCOMPARE(pages[i].mid(1, 4), Section("DC01", 0).mid(5, 4));
      }
    }
  }

  // The PDF: every page numbered of the count at its foot, the pages that go
  // on with a station under its name and "(tiếp)".
  void theSketchPdfNumbersItsPages() {
    QTemporaryDir dir;
    const QString pdf = dir.filePath(QStringLiteral("so do.pdf"));
    QVERIFY(SaveSketchPdf(Sketch({{"DC01", 150}, {"CP1", 5}}), pdf));
    const auto pages = PdfPages(pdf);
    if (!pages) QSKIP("pdftotext (poppler-utils) is not installed");
    QVERIFY(pages->size() >= 4);
    const QString count = QString::number(pages->size());
    for (qsizetype i = 0; i < pages->size(); ++i) {
      const QString& page = (*pages)[i];
      const QString number = QStringLiteral("Trang %1/%2").arg(i + 1).arg(count);
      QVERIFY2(page.trimmed().endsWith(number), qPrintable(number));
      const bool first = i == 0 || i + 1 == pages->size();  // DC01's first, CP1's
      QCOMPARE(page.contains(QStringLiteral("DC01 (tiếp)")), !first);
      QCOMPARE(page.contains(QStringLiteral("CP1")), i + 1 == pages->size());
    }
    QVERIFY(pages->back().contains(QStringLiteral("Điểm trạm đo: CP1")));
  }
};

QTEST_MAIN(MapTest)
#include "map_test.moc"
