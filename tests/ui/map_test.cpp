// The map of a run: one item per point at its place, doubtful points in red
// on the screen and in the pictures, a click showing the error lines and the
// record; the exports read back; the field sketch on pages and in a PDF; the
// window's keys, save dialogs, information pane, size and captions.
#include <QProcess>
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

bool Red(const QColor& c) { return c.red() > 180 && c.green() < 80 && c.blue() < 80; }
const QString kPng = QStringLiteral("Hình PNG (*.png)"), kSvg = QStringLiteral("Hình SVG (*.svg)"),
              kPdf = QStringLiteral("File PDF (*.pdf)");

// A field sketch: each station's section with its header lines, the column
// heads and rows detail rows.
QString Sketch(std::initializer_list<std::pair<const char*, int>> stations) {
  QStringList lines;
  for (const auto& [station, rows] : stations) {
    lines << ""
          << "Lược đồ số:01                SO DO CHI TIET"
          << "Điểm trạm đo: " + QString::fromLatin1(station).leftJustified(12) + "    Khu đo: Xã A"
          << QString(77, '=') << "| Điểm |  Khoảng  |   Góc bằng   |"
          << "| mia  |  cách (m)|" << QString(77, '-');
    for (int i = 1; i <= rows; ++i)
      lines << "|" + QString::number(i).leftJustified(5) + " |  1.5 |";
    lines << QString(77, '=');
  }
  return lines.join(QStringLiteral("\r\n")) + QStringLiteral("\r\n");
}

// The text of a PDF page by page, or nothing without pdftotext.
std::optional<QStringList> PdfPages(const QString& pdf) {
  const QString pdftotext = QStandardPaths::findExecutable(QStringLiteral("pdftotext"));
  if (pdftotext.isEmpty()) return std::nullopt;
  QProcess text;
  text.start(pdftotext, {QStringLiteral("-layout"), pdf, QStringLiteral("-")});
  text.waitForFinished(20000);
  QStringList pages = QString::fromUtf8(text.readAllStandardOutput()).split(QLatin1Char('\f'));
  if (pages.back().trimmed().isEmpty()) pages.removeLast();
  return pages;
}

// The map window shown on a survey, its field book and sketch in a folder.
struct Shown {
  QTemporaryDir dir;
  MapWindow map;
  bool exposed = false;
  explicit Shown(Survey survey, const QByteArray& book = {}, const QString& sketch = {}) {
    WriteAll(path("job1.asc"), book);
    if (!sketch.isEmpty()) WriteAll(path("job1.sdo"), Utf8ToTcvn3(sketch.toStdString()).c_str());
    map.setSurvey(std::move(survey), path("job1.asc").toStdString(),
                  sketch.isEmpty() ? "" : path("job1.sdo").toStdString());
    map.resize(640, 560);
    map.show();
    exposed = QTest::qWaitForWindowExposed(&map);
  }
  QString path(const char* name) const { return dir.filePath(QLatin1String(name)); }
  QAction* action(const char* name) { return Child<QAction>(map, name); }
  MapCanvas& canvas() { return map.canvas(); }
  // A click on the point at north x, east y.
  void click(double x, double y) {
    QTest::mouseClick(&canvas(), Qt::LeftButton, {}, canvas().view().toDevice(x, y).toPoint());
  }
};

}  // namespace

class MapTest : public QObject {
  Q_OBJECT

  QTemporaryDir store_;

 private slots:
  void init() { UseScratchSettings(store_); }

  // One item per point at its place, north up and east right at one scale;
  // the wheel zooms around the cursor; the pictures red where the report
  // points, black elsewhere, and a folder that is not there refused.
  void theDrawingAndItsPictures() {
    Shown shown(HandMade());
    const MapModel& model = shown.canvas().model();
    QStringList items;  // kind name x y red
    for (const MapItem& i : model.items) {
      items << QStringList{QString::number(static_cast<int>(i.kind)), i.name, QString::number(i.x),
                           QString::number(i.y), QString::number(i.flagged)}
                   .join(QLatin1Char(' '));
    }
    QCOMPARE(items, QStringList({"0 A 1000 2000 0", "0 B 1100 2000 0", "0 C 1000 2100 0",
                                 "1 A 1000 2000 0", "3 1 1010 2010 0", "3 2 1020 1990 1",
                                 "2 CPđ 990 2030 1", "3 3 1040 2050 0"}));
    QCOMPARE(model.sights.size(), 2u);  // orientation and check sight
    const MapView whole = FitView(model, kWholeSurveySize);
    const QPointF a = whole.toDevice(1000, 2000), b = whole.toDevice(1100, 2000),
                  c = whole.toDevice(1000, 2100);
    QVERIFY(b.x() == a.x() && b.y() < a.y() && c.y() == a.y());
    QCOMPARE(c.x() - a.x(), a.y() - b.y());

    MapCanvas& canvas = shown.canvas();
    const QPointF at = canvas.view().toDevice(1020, 1990) + QPointF(30, 20);
    const QPointF ground = canvas.view().toGround(at);
    const double scale = canvas.view().scale;
    QWheelEvent wheel(at, canvas.mapToGlobal(at), {}, {0, 240}, Qt::NoButton, Qt::NoModifier,
                      Qt::NoScrollPhase, false);
    QCoreApplication::sendEvent(&canvas, &wheel);
    const QPointF still = canvas.view().toGround(at);
    QVERIFY(canvas.view().scale > scale && std::abs(still.x() - ground.x()) < 1e-6 &&
            std::abs(still.y() - ground.y()) < 1e-6);

    const QString png = shown.path("view.png"), all = shown.path("all.png"),
                  svg = shown.path("all.svg");
    QVERIFY(shown.map.savePicture(png, false) && shown.map.savePicture(all, true) &&
            shown.map.savePicture(svg, true));
    QCOMPARE(QImage(png).size(), canvas.size());
    QVERIFY(Red(QImage(all).pixelColor(whole.toDevice(1020, 1990).toPoint())));
    const QColor plain = QImage(all).pixelColor(whole.toDevice(1040, 2050).toPoint());
    QVERIFY(plain.lightness() < 60 && !Red(plain));
    QCOMPARE(QSvgRenderer(svg).viewBoxF(), QRectF(QPointF(0, 0), QSizeF(kWholeSurveySize)));
    QVERIFY(QString::fromUtf8(ReadAll(svg)).contains(QStringLiteral("CPđ")));
    QVERIFY(!shown.map.savePicture(shown.path("no/such/folder/x.png"), true));
  }

  // The README's example computed from the main window with the map ticked:
  // the map opens by itself; its picture goes to the build folder; the sketch
  // PDF shows the form's words and the points in Unicode.
  void theExampleOnTheMapAndItsSketchAsPdf() {
    Desk desk;
    QVERIFY(desk.example());
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
    for (const char* words : {"Điểm trạm đo: DC01", "Định hướng 1: DC02", "N đường"})
      QVERIFY2(shown.contains(QString::fromUtf8(words)), words);
  }

  // A click shows the point's own record and report lines, not those of a
  // namesake at another station (detail numbers start again at each), the
  // record whole on one line of a fixed-width font in a pane grown to show
  // every line and resized with its splitter. A peg is a peg wherever the map
  // names what a point is, also once a station stood on it; the point itself
  // wins a click over its station.
  void aClickDescribesThePoint() {
    Survey s = HandMade();
    for (int i = 0; i < 6; ++i) s.AddReport("Diem 2            loi " + std::to_string(i), "2", 5);
    s.AddPoint("2 0 1 900000 1", PointKind::Detail, 1060, 2060).line = 8;
    s.AddReport("Diem 2            nhap sai phan do", "2", 8);
    const SurveyPoint on{std::string(s.Name(s.points[2])), s.points[2].x, s.points[2].y, {}};
    s.control.push_back(on);
    s.stations.push_back({on, s.control[0], 0, 10, std::nullopt, {}, 9});
    const QByteArray record = "2 0751234 10 900000 1.5 " + QByteArray(90, 'x');
    Shown shown(std::move(s), "1\r\n2\r\n3\r\n4\r\n" + record + "\r\n6\r\n7\r\nsecond 2\r\n");
    const auto describe = [&](double x, double y) {
      const MapView& view = shown.canvas().view();
      return shown.map.describe(ItemAt(shown.canvas().model(), view, view.toDevice(x, y)).value());
    };
    const QString first = describe(1020, 1990), second = describe(1060, 2060);
    QVERIFY(first.contains("phan phut") && first.contains(record) && !first.contains("phan do") &&
            !first.contains("second 2"));
    QVERIFY(second.contains("phan do") && second.contains("second 2") &&
            !second.contains("phan phut"));
    auto* pane = Child<QTextBrowser>(shown.map, "chitiet");
    QVERIFY(QFontInfo(pane->font()).fixedPitch());
    shown.click(1020, 1990);
    QCOMPARE(shown.map.details(), first);
    // The point, the report heading and its 7 lines, the record heading and line.
    QCOMPARE(pane->document()->blockCount(), 11);
    for (QTextBlock b = pane->document()->begin(); b.isValid(); b = b.next()) {
      QCOMPARE(b.layout()->lineCount(), 1);
    }
    QCOMPARE(pane->verticalScrollBar()->maximum(), 0);
    auto* split = Child<QSplitter>(shown.map, "chia");
    QVERIFY(!split->isCollapsible(0) && !split->isCollapsible(1));
    split->setSizes({split->sizes()[0] + split->sizes()[1] - 200, 200});
    QCOMPARE(pane->height(), 200);

    const QString peg = QStringLiteral("CPđ");
    MapCanvas& canvas = shown.canvas();
    const MapModel& model = canvas.model();
    QStringList kinds;
    std::size_t item = 0;
    for (std::size_t i = 0; i < model.items.size(); ++i) {
      if (model.items[i].name != peg) continue;
      kinds << KindName(model.items[i].kind);
      if (model.items[i].kind == MapKind::Peg) item = i;
    }
    QCOMPARE(kinds, QStringList({"Trạm máy", "Cọc phụ"}));
    shown.click(model.items[item].x, model.items[item].y);
    QVERIFY(shown.map.details().startsWith(peg + QStringLiteral("  (Cọc phụ, Trạm máy)")));
    QVERIFY(shown.map.describe(0).startsWith(QStringLiteral("A  (Điểm khống chế, Trạm máy)")));
    const QPointF at = canvas.view().toDevice(model.items[item].x, model.items[item].y);
    QHelpEvent help(QEvent::ToolTip, at.toPoint(), canvas.mapToGlobal(at.toPoint()));
    QCoreApplication::sendEvent(&canvas, &help);
    QCOMPARE(QToolTip::text(), peg + QStringLiteral(" (Cọc phụ), có báo lỗi"));
    QToolTip::hideText();
    const QString legend = Child<QLabel>(shown.map, "chuthich")->text();
    for (std::string_view kind : kPointKinds) QVERIFY(legend.contains(Q(kind)));
    // Drawn as a square, not as a control point's triangle.
    QVERIFY(SaveMapSvg(model, canvas.view(), shown.path("peg.svg")));
    QVERIFY(QString::fromUtf8(ReadAll(shown.path("peg.svg")))
                .contains(QStringLiteral("<rect x=\"%1\" y=\"%2\" width=\"7\" height=\"7\"")
                              .arg(at.x() - 3.5)
                              .arg(at.y() - 3.5)));
  }

  void theJobsNameWithTheRightExtension() {
    const QString proposals[][3] = {{"/d/khu A/job1.asc", "png", "/d/khu A/job1.png"},
                                    {"/d/xa.tan.phu.asc", "pdf", "/d/xa.pdf"},
                                    {"/d/job1", "svg", "/d/job1.svg"},
                                    {"/d/.asc", "png", "/d/.asc.png"},
                                    {"", "png", ""}};
    for (const auto& p : proposals) QCOMPARE(ProposedPath(p[0], p[1]), p[2]);
    const QString typed[][3] = {
        {"/d/ban do", kPng, "/d/ban do.png"}, {"/d/ban do", kSvg, "/d/ban do.svg"},
        {"/d/ban.svg", kPng, "/d/ban.svg"},   {"/d/ban.PNG", kSvg, "/d/ban.PNG"},
        {"/d/ban.v2", kPng, "/d/ban.v2.png"}, {"/d/ban.", kSvg, "/d/ban.svg"}};
    for (const auto& t : typed) QCOMPARE(WithExtension(t[0], t[1], {kPng, kSvg}), t[2]);
  }

  // Each save action proposes the job's name with the extension of the kind
  // chosen last, and adds the chosen kind's extension to a bare name.
  void saveActionsProposeTheJobAndAddTheExtension() {
    Shown shown(HandMade(), {}, Sketch({{"A", 3}}));
    const struct {
      const char *action, *proposed;
      QString filter;  // proposed
      const char* typed;
      QString chosen;
      const char* saved;
      QByteArray starts;
    } steps[] = {{"saveWhole", "job1.png", kPng, "ca khu", kSvg, "ca khu.svg", "<?xml"},
                 {"saveView", "job1.svg", kSvg, "xem", kPng, "xem.png", "\x89PNG"},
                 {"saveView", "job1.png", kPng, "xem2.svg", kPng, "xem2.svg", "<?xml"},
                 {"saveSketch", "job1.pdf", kPdf, "so do", kPdf, "so do.pdf", "%PDF"}};
    for (const auto& step : steps) {
      SaveRequest asked;
      shown.map.setSaveChooser([&](QWidget*, const SaveRequest& request) {
        asked = request;
        return SaveChoice{shown.path(step.typed), step.chosen};
      });
      shown.action(step.action)->trigger();
      QCOMPARE(asked.proposed, shown.path(step.proposed));
      QCOMPARE(asked.filter, step.filter);
      QVERIFY(!asked.caption.contains(QLatin1Char('&')));
      QVERIFY2(ReadAll(shown.path(step.saved)).startsWith(step.starts), step.saved);
    }
  }

  // +, - and 0 zoom from the keyboard and from the tool bar, the arrows
  // move the view an eighth of the drawing towards their side.
  void keysAndButtonsZoomAndPan() {
    Shown shown(HandMade());
    shown.map.activateWindow();  // the keys go to the window in front
    QVERIFY(shown.exposed && QTest::qWaitForWindowActive(&shown.map));
    MapCanvas& canvas = shown.canvas();
    const MapView fitted = canvas.view();
    const struct {
      Qt::Key key;
      double scale, north, east;  // times the fitted scale; eighths of the drawing
    } keys[] = {{Qt::Key_Plus, 1.25, 0, 0}, {Qt::Key_Minus, 1, 0, 0}, {Qt::Key_Minus, 0.8, 0, 0},
                {Qt::Key_0, 1, 0, 0},       {Qt::Key_Right, 1, 0, 1}, {Qt::Key_Up, 1, 1, 1},
                {Qt::Key_Left, 1, 1, 0},    {Qt::Key_Down, 1, 0, 0},  {Qt::Key_Equal, 1.25, 0, 0}};
    for (const auto& k : keys) {
      QTest::keyClick(&canvas, k.key);
      const MapView& v = canvas.view();
      QVERIFY(std::abs(v.scale / fitted.scale - k.scale) < 1e-9);
      QVERIFY(std::abs((v.north - fitted.north) * fitted.scale - k.north * canvas.height() / 8) <
              1e-6);
      QVERIFY(std::abs((v.east - fitted.east) * fitted.scale - k.east * canvas.width() / 8) < 1e-6);
    }
    auto* tools = Child<QToolBar>(shown.map, "congcu");
    const auto press = [&](const char* action) {
      qobject_cast<QToolButton*>(tools->widgetForAction(shown.action(action)))->click();
      return canvas.view().scale / fitted.scale;
    };
    QCOMPARE(press("fit"), 1.0);
    QCOMPARE(press("zoomIn"), 1.25);
    QCOMPARE(press("zoomOut"), 1.0);
  }

  // Esc closes the print preview, and then the map.
  void escapeClosesTheWindows() {
    Shown shown(HandMade(), {}, Sketch({{"A", 3}}));
    bool closed = false;
    const auto preview = WhenShown([&](QDialog& d) {
      QTest::keyClick(&d, Qt::Key_Escape);
      closed = !d.isVisible();
    });
    shown.action("printSketch")->trigger();
    QVERIFY(*preview && closed && shown.map.isVisible());
    shown.map.activateWindow();
    QVERIFY(QTest::qWaitForWindowActive(&shown.map));
    QTest::keyClick(&shown.canvas(), Qt::Key_Escape);
    QVERIFY(!shown.map.isVisible());
  }

  void theWindowFitsTheScreen() {
    const QRect cases[][2] = {{{100, 100, 1016, 808}, {100, 100, 1016, 808}},
                              {{500, 400, 1016, 808}, {264, 192, 1016, 808}},
                              {{0, 0, 1400, 1100}, {0, 0, 1280, 1000}},
                              {{-50, -20, 300, 200}, {0, 0, 400, 400}}};
    for (const auto& c : cases) {
      QCOMPARE(PlaceWithin(c[0], {400, 400}, {0, 0, 1280, 1000}), c[1]);
    }
    // The default and smallest sizes with room for a frame on 1280x1000.
    MapWindow map;
    const QSize smallest = map.minimumSizeHint().expandedTo(map.minimumSize());
    for (QSize size : {map.size(), smallest}) {
      QVERIFY(size.width() + 16 <= 1280 && size.height() + 48 <= 1000);
    }
    map.move(5000, 5000);
    map.show();
    QVERIFY(QTest::qWaitForWindowExposed(&map));
    const QRect available = map.screen()->availableGeometry();
    QVERIFY(available.contains(map.frameGeometry()));
    QVERIFY(
        available.contains(map.statusBar()->mapToGlobal(map.statusBar()->rect().bottomRight())));
  }

  // Every action says what it does and its keys; the menus show access keys,
  // one letter each within a menu; greyed sketch actions say why.
  void tooltipsAndAccessKeys() {
    Shown shown(HandMade());
    for (QAction* a : shown.map.findChildren<QAction*>(Qt::FindDirectChildrenOnly)) {
      const QString keys = a->shortcut().toString(QKeySequence::NativeText);
      QVERIFY2(a->toolTip().size() > a->iconText().size() + 4, qPrintable(a->objectName()));
      QVERIFY2(a->toolTip().contains(keys), qPrintable(a->toolTip()));
    }
    for (QToolButton* b : Child<QToolBar>(shown.map, "congcu")->findChildren<QToolButton*>()) {
      if (b->defaultAction() != nullptr) QVERIFY(!b->toolTip().isEmpty());
    }
    QList<QList<QAction*>> menus = {shown.map.menuBar()->actions()};
    for (QAction* menu : menus.front()) menus << menu->menu()->actions();
    for (const QList<QAction*>& entries : menus) {
      QSet<QChar> keys;
      for (QAction* entry : entries) {
        const qsizetype amp = entry->text().indexOf(QLatin1Char('&'));
        if (entry->isSeparator()) continue;
        QVERIFY2(amp >= 0 && !keys.contains(entry->text()[amp + 1].toLower()),
                 qPrintable(entry->text()));
        keys.insert(entry->text()[amp + 1].toLower());
      }
    }
    QCOMPARE(shown.action("closeMap")->shortcut(), QKeySequence(Qt::Key_Escape));
    QVERIFY(!shown.action("saveSketch")->isEnabled());
    QVERIFY(shown.action("saveSketch")->toolTip().contains(QStringLiteral("Tạo File sổ đo")));
  }

  // A station longer than a page goes on under its name and "(tiếp)" with
  // the column heads again; the next station starts a page; in the PDF every
  // page is numbered of the count at its foot.
  void longStationsGoOnUnderTheirNameOnNumberedPages() {
    const QString sketch = Sketch({{"DC01", 20}, {"CP1", 2}});  // 27 and 9 lines
    const struct {
      int perPage;
      QList<int> sizes;  // lines per page
    } layouts[] = {{40, {27, 9}}, {12, {12, 12, 12, 6, 9}}, {25, {25, 7, 9}}};
    const QString goesOn = QStringLiteral("Điểm trạm đo: DC01 (tiếp)");
    for (const auto& l : layouts) {
      const std::vector<QStringList> pages = SketchPages(sketch, l.perPage);
      QList<int> sizes;
      for (const QStringList& page : pages) sizes << static_cast<int>(page.size());
      QCOMPARE(sizes, l.sizes);
      for (std::size_t i = 1; i + 1 < pages.size(); ++i) {
        QCOMPARE(pages[i].mid(0, 5), QStringList({goesOn}) + pages[0].mid(2, 4));
      }
    }

    QTemporaryDir dir;
    QVERIFY(SaveSketchPdf(Sketch({{"DC01", 150}, {"CP1", 5}}), dir.filePath("so do.pdf")));
    const auto pages = PdfPages(dir.filePath("so do.pdf"));
    if (!pages) QSKIP("pdftotext (poppler-utils) is not installed");
    QVERIFY(pages->size() >= 4);
    for (qsizetype i = 0; i < pages->size(); ++i) {
      const QString& page = (*pages)[i];
      const bool last = i + 1 == pages->size();  // CP1's
      QVERIFY(page.trimmed().endsWith(QStringLiteral("Trang %1/%2").arg(i + 1).arg(pages->size())));
      QCOMPARE(page.contains(goesOn), i > 0 && !last);
      QCOMPARE(page.contains(QStringLiteral("Điểm trạm đo: CP1")), last);
    }
  }
};

QTEST_MAIN(MapTest)
#include "map_test.moc"
