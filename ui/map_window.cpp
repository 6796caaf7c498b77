#include "ui/map_window.h"

#include <QAction>
#include <QFileDialog>
#include <QFileInfo>
#include <QLabel>
#include <QMouseEvent>
#include <QPainter>
#include <QPrintPreviewDialog>
#include <QPrinter>
#include <QSplitter>
#include <QStatusBar>
#include <QTextBrowser>
#include <QToolBar>
#include <QWheelEvent>
#include <cmath>
#include <set>

#include "core/lines.h"
#include "core/messages.h"
#include "ui/ask.h"
#include "ui/sketch_pdf.h"
#include "ui/texts.h"

namespace kavu::ui {
namespace {

// A drag shorter than this is a click.
constexpr int kClickSlack = 4;

}  // namespace

MapCanvas::MapCanvas(QWidget* parent) : QWidget(parent) {
  setObjectName(QStringLiteral("bando"));
  setMouseTracking(true);
  setMinimumSize(320, 240);
  setCursor(Qt::CrossCursor);
}

void MapCanvas::setModel(MapModel model) {
  model_ = std::move(model);
  fit();
}

void MapCanvas::fit() {
  view_ = FitView(model_, size());
  fitted_ = true;
  update();
}

void MapCanvas::zoomAt(QPointF device, double factor) {
  view_ = ZoomAt(view_, device, factor);
  fitted_ = false;
  update();
}

void MapCanvas::paintEvent(QPaintEvent*) {
  QPainter painter(this);
  PaintMap(painter, model_, view_);
}

void MapCanvas::resizeEvent(QResizeEvent*) {
  if (fitted_) {
    fit();
  } else {
    view_.size = size();
  }
}

void MapCanvas::wheelEvent(QWheelEvent* event) {
  zoomAt(event->position(), std::pow(1.0015, event->angleDelta().y()));
  event->accept();
}

void MapCanvas::mousePressEvent(QMouseEvent* event) {
  if (event->button() != Qt::LeftButton) return;
  pressed_ = last_ = event->position().toPoint();
  dragged_ = false;
}

void MapCanvas::mouseMoveEvent(QMouseEvent* event) {
  const QPoint at = event->position().toPoint();
  emit cursorMoved(view_.toGround(at));
  if (!pressed_ || !(event->buttons() & Qt::LeftButton)) return;
  if (!dragged_ && (at - *pressed_).manhattanLength() < kClickSlack) return;
  dragged_ = true;
  const QPoint step = at - *last_;
  view_.north += step.y() / view_.scale;
  view_.east -= step.x() / view_.scale;
  last_ = at;
  fitted_ = false;
  update();
}

void MapCanvas::mouseReleaseEvent(QMouseEvent* event) {
  if (event->button() != Qt::LeftButton || !pressed_) return;
  if (!dragged_) {
    if (const auto item = ItemAt(model_, view_, event->position())) emit itemClicked(*item);
  }
  pressed_.reset();
}

MapWindow::MapWindow(QWidget* parent) : QMainWindow(parent) {
  setObjectName(QStringLiteral("bandoWindow"));
  canvas_ = new MapCanvas;
  details_ = new QTextBrowser;
  details_->setObjectName(QStringLiteral("chitiet"));
  details_->setPlainText(Q(kHint));
  auto* split = new QSplitter(Qt::Vertical);
  split->addWidget(canvas_);
  split->addWidget(details_);
  split->setStretchFactor(0, 4);
  split->setStretchFactor(1, 1);
  setCentralWidget(split);

  cursor_ = new QLabel;
  cursor_->setObjectName(QStringLiteral("toado"));
  cursor_->setMinimumWidth(
      cursor_->fontMetrics().horizontalAdvance(QStringLiteral("X= -2345678.00   Y= -567890.00")));
  statusBar()->addPermanentWidget(cursor_);

  QToolBar* tools = addToolBar(Q(kMapTitle));
  tools->setMovable(false);
  auto action = [&](const char* name, std::string_view caption, auto slot) {
    QAction* a = tools->addAction(Q(caption));
    a->setObjectName(QLatin1String(name));
    connect(a, &QAction::triggered, this, slot);
    return a;
  };
  action("fit", kFit, [this] { canvas_->fit(); });
  action("saveView", kSaveView, [this] { askPicture(false); });
  action("saveWhole", kSaveWhole, [this] { askPicture(true); });
  saveSketch_ = action("saveSketch", kSaveSketch, [this] { askSketch(); });
  printSketch_ = action("printSketch", kPrintSketch, [this] { printSketch(); });

  chooseSave_ = [this](const QString& caption, const QString& filters) {
    return QFileDialog::getSaveFileName(this, caption, QFileInfo(Q(fieldBook_)).path(), filters);
  };
  connect(canvas_, &MapCanvas::cursorMoved, this, [this](QPointF ground) {
    cursor_->setText(
        QStringLiteral("X= %1   Y= %2").arg(ground.x(), 0, 'f', 2).arg(ground.y(), 0, 'f', 2));
  });
  connect(canvas_, &MapCanvas::itemClicked, this, &MapWindow::pick);
  resize(900, 700);
}

void MapWindow::setSurvey(Survey survey, std::string fieldBook, std::string sketch) {
  survey_ = std::move(survey);
  fieldBook_ = std::move(fieldBook);
  sketch_ = std::move(sketch);
  bookLines_.reset();
  setWindowTitle(Q(kMapTitle) + QFileInfo(Q(fieldBook_)).fileName());
  saveSketch_->setEnabled(!sketch_.empty());
  printSketch_->setEnabled(!sketch_.empty());
  details_->setPlainText(Q(kHint));
  canvas_->setModel(BuildMap(survey_));
}

std::string MapWindow::nameOf(const MapItem& item) const {
  switch (item.kind) {
    case MapKind::Control:
      return survey_.control[item.index].name;
    case MapKind::Station:
      return survey_.stations[item.index].station.name;
    case MapKind::Peg:
    case MapKind::Detail:
      break;
  }
  return std::string(survey_.Name(survey_.points[item.index]));
}

std::string MapWindow::bookLine(std::size_t line) {
  if (!bookLines_) bookLines_ = ReadLines(fieldBook_).value_or(std::vector<std::string>{});
  return line >= 1 && line <= bookLines_->size() ? (*bookLines_)[line - 1] : std::string();
}

QString MapWindow::describe(std::size_t index) {
  const MapItem& item = canvas_->model().items.at(index);
  QStringList text;
  text << item.name + QStringLiteral("  (") + Q(kPointKinds[static_cast<int>(item.kind)]) +
              QStringLiteral(")  X= ") + QString::number(item.x, 'f', 3) + QStringLiteral("  Y= ") +
              QString::number(item.y, 'f', 3);
  const std::string name = nameOf(item);
  bool heading = false;
  for (const ReportEntry& entry : survey_.report) {
    if (survey_.Point(entry) != name) continue;
    if (!heading) text << Q(kReportLines);
    heading = true;
    text << QStringLiteral("  ") + FromTcvn3(survey_.TextOf(entry));
  }
  // The records of the point: a peg that later served as a station has two.
  std::set<std::size_t> lines;
  for (const MapItem& other : canvas_->model().items) {
    if (other.line > 0 && other.name == item.name) lines.insert(other.line);
  }
  for (std::size_t line : lines) {
    text << Q(kRecordAt) + QString::number(line) + QLatin1Char(':');
    text << QStringLiteral("  ") + FromTcvn3(bookLine(line));
  }
  return text.join(QLatin1Char('\n'));
}

void MapWindow::pick(std::size_t item) { details_->setPlainText(describe(item)); }

QString MapWindow::details() const { return details_->toPlainText(); }

bool MapWindow::savePicture(const QString& path, bool whole) const {
  const MapView view = whole ? FitView(canvas_->model(), kWholeSurveySize) : canvas_->view();
  return path.endsWith(QStringLiteral(".svg"), Qt::CaseInsensitive)
             ? SaveMapSvg(canvas_->model(), view, path)
             : SaveMapPng(canvas_->model(), view, path);
}

bool MapWindow::saveSketch(const QString& path) const {
  return SaveSketchPdf(ReadSketch(sketch_), path);
}

void MapWindow::cannotWrite(const QString& path) {
  statusBar()->showMessage(Q(msg::kCannotWrite) + path, 10000);
}

void MapWindow::askPicture(bool whole) {
  const QString path = chooseSave_(Q(whole ? kSaveWhole : kSaveView), Q(kPictureFilter));
  if (!path.isEmpty() && !savePicture(path, whole)) cannotWrite(path);
}

void MapWindow::askSketch() {
  const QString path = chooseSave_(Q(kSaveSketch), Q(kPdfFilter));
  if (!path.isEmpty() && !saveSketch(path)) cannotWrite(path);
}

void MapWindow::printSketch() {
  QPrinter printer;
  QPrintPreviewDialog preview(&printer, this);
  preview.setWindowTitle(Q(kPrintSketch));
  const QString sketch = ReadSketch(sketch_);
  connect(&preview, &QPrintPreviewDialog::paintRequested, this,
          [&sketch](QPrinter* device) { PaintSketch(*device, sketch); });
  preview.exec();
}

}  // namespace kavu::ui
