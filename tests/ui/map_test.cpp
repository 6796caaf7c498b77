// The map of a run: one item per point at its place, doubtful points in red
// on the screen and in the pictures, a click showing the error lines and the
// record; the exports read back; the field sketch on pages and in a PDF.
#include <QCheckBox>
#include <QImage>
#include <QPainter>
#include <QProcess>
#include <QPushButton>
#include <QStandardPaths>
#include <QSvgRenderer>
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

QColor PixelAt(const QImage& image, QPointF at) { return image.pixelColor(at.toPoint()); }
bool Red(const QColor& c) { return c.red() > 180 && c.green() < 80 && c.blue() < 80; }

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
    const QString pdftotext = QStandardPaths::findExecutable(QStringLiteral("pdftotext"));
    if (pdftotext.isEmpty()) QSKIP("pdftotext (poppler-utils) is not installed");
    QProcess text;
    text.start(pdftotext, {QStringLiteral("-layout"), pdf, QStringLiteral("-")});
    QVERIFY(text.waitForFinished(20000));
    const QString shown = QString::fromUtf8(text.readAllStandardOutput());
    for (const char* words : {"Điểm trạm đo: DC01", "Định hướng 1: DC02", "N đường"}) {
      QVERIFY2(shown.contains(QString::fromUtf8(words)), words);
    }
  }
};

QTEST_MAIN(MapTest)
#include "map_test.moc"
