#include "ui/map_window.h"

#include <QAction>
#include <QApplication>
#include <QFileDialog>
#include <QFileInfo>
#include <QFontDatabase>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QMenuBar>
#include <QMouseEvent>
#include <QPainter>
#include <QPrintPreviewDialog>
#include <QPrinter>
#include <QRegularExpression>
#include <QScreen>
#include <QScrollBar>
#include <QShowEvent>
#include <QSplitter>
#include <QStatusBar>
#include <QTextBrowser>
#include <QToolBar>
#include <QToolTip>
#include <QWheelEvent>
#include <algorithm>
#include <cmath>
#include <set>

#include "core/lines.h"
#include "core/messages.h"
#include "ui/ask.h"
#include "ui/dialog.h"
#include "ui/sketch_pdf.h"
#include "ui/texts.h"

namespace kavu::ui {
namespace {

// A drag shorter than this is a click.
constexpr int kClickSlack = 4;
// One press of + or -, and the part of the drawing an arrow key moves it by.
constexpr double kZoomStep = 1.25;
constexpr double kPanStep = 0.125;
// The window as it first opens, when the screen has room for it.
constexpr QSize kDefaultSize{1000, 760};
// Room left on the screen for the window's frame and title bar.
constexpr QSize kFrameAllowance{16, 48};
// The lines the information pane shows when the window opens.
constexpr int kPaneLines = 7;
// Two items less than this apart, metres, are one point.
constexpr double kSamePlace = 0.0005;

// A caption without its access key.
QString Plain(std::string_view text) { return Q(text).remove(QLatin1Char('&')); }

// What an action does, and its keys.
void SetTip(QAction& action, std::string_view tip) {
  const QString keys = action.shortcut().toString(QKeySequence::NativeText);
  action.setToolTip(keys.isEmpty() ? Q(tip)
                                   : Q(tip) + QStringLiteral(" (") + keys + QLatin1Char(')'));
}

// The extensions of every filter, lower case.
QStringList Extensions(const QStringList& filters) {
  QStringList extensions;
  for (const QString& filter : filters) extensions << FilterExtension(filter).toLower();
  return extensions;
}

// Qt's own save dialog, whose proposed name follows the kind chosen. A name
// typed without an extension gets the chosen kind's before the dialog checks
// it, so that it asks before replacing the file that is written.
class SaveDialog : public QFileDialog {
 public:
  SaveDialog(QWidget* parent, const SaveRequest& request)
      : QFileDialog(parent, request.caption), filters_(request.filters) {
    SetUpFileDialog(*this, request.filters);
    setAcceptMode(QFileDialog::AcceptSave);
    setFileMode(QFileDialog::AnyFile);
    setLabelText(QFileDialog::Accept, Q(kSave));
    if (!request.filter.isEmpty()) selectNameFilter(request.filter);
    if (!request.proposed.isEmpty()) {
      const QFileInfo proposed(request.proposed);
      setDirectory(proposed.path());
      selectFile(proposed.fileName());
    }
  }

  void accept() override {
    // A folder's name typed opens the folder.
    QLineEdit* edit = nameEdit();
    if (edit != nullptr && !edit->text().trimmed().isEmpty() &&
        !QFileInfo(directory().filePath(edit->text())).isDir()) {
      edit->setText(WithExtension(edit->text(), selectedNameFilter(), filters_));
    }
    QFileDialog::accept();
  }

 private:
  QLineEdit* nameEdit() const { return findChild<QLineEdit*>(QStringLiteral("fileNameEdit")); }

  QStringList filters_;
};

// The symbol of each kind, as the map draws it.
QString Symbol(MapKind kind) {
  switch (kind) {
    case MapKind::Control:
      return QStringLiteral("\u25B3");
    case MapKind::Station:
      return QStringLiteral("\u25CB");
    case MapKind::Peg:
      return QStringLiteral("\u25A1");
    case MapKind::Detail:
      break;
  }
  return QStringLiteral("\u2022");
}

// The legend: each kind's symbol in its colour and its name, then the red of
// a point named in the error report.
QString Legend() {
  QStringList entries;
  auto entry = [&entries](const MapItem& item, const QString& symbol, const QString& name) {
    entries << QStringLiteral("<span style=\"color:%1\">%2</span>&nbsp;%3")
                   .arg(ColourOf(item).name(), symbol, name.toHtmlEscaped());
  };
  for (MapKind kind : {MapKind::Control, MapKind::Station, MapKind::Peg, MapKind::Detail}) {
    MapItem item;
    item.kind = kind;
    entry(item, Symbol(kind), KindName(kind));
  }
  MapItem flagged;
  flagged.flagged = true;
  entry(flagged, QStringLiteral("\u25CF"), Q(kFlaggedKind));
  return entries.join(QStringLiteral("&nbsp;&nbsp; "));
}

bool SamePlace(const MapItem& a, const MapItem& b) {
  return std::abs(a.x - b.x) < kSamePlace && std::abs(a.y - b.y) < kSamePlace;
}

}  // namespace

QString FilterExtension(const QString& filter) {
  static const QRegularExpression pattern(QStringLiteral("\\*\\.([^ ;)]+)"));
  const QRegularExpressionMatch match = pattern.match(filter);
  return match.hasMatch() ? match.captured(1) : QString();
}

QString ProposedPath(const QString& fieldBook, const QString& extension) {
  if (fieldBook.isEmpty()) return {};
  const QFileInfo book(fieldBook);
  const QString name = book.fileName();
  const qsizetype dot = name.indexOf(QLatin1Char('.'));
  // A name that starts with its "." is kept whole.
  const QString job = dot > 0 ? name.left(dot) : name;
  return book.path() + QLatin1Char('/') + job + QLatin1Char('.') + extension;
}

QString WithExtension(const QString& path, const QString& filter, const QStringList& filters) {
  const QString extension = FilterExtension(filter);
  const QString suffix = QFileInfo(path).suffix().toLower();
  if (extension.isEmpty() || path.isEmpty() || Extensions(filters).contains(suffix)) return path;
  return path.endsWith(QLatin1Char('.')) ? path + extension : path + QLatin1Char('.') + extension;
}

SaveChoice ChooseSavePath(QWidget* parent, const SaveRequest& request) {
  SaveDialog dialog(parent, request);
  if (dialog.exec() != QDialog::Accepted || dialog.selectedFiles().isEmpty()) return {};
  return {dialog.selectedFiles().first(), dialog.selectedNameFilter()};
}

QRect PlaceWithin(const QRect& frame, QSize minimum, const QRect& available) {
  QRect placed(frame.topLeft(), frame.size().boundedTo(available.size()).expandedTo(minimum));
  // Into the area from the right and the bottom, then from the left and the
  // top: a window larger than the screen keeps its title bar on it.
  placed.moveRight(std::min(placed.right(), available.right()));
  placed.moveBottom(std::min(placed.bottom(), available.bottom()));
  placed.moveLeft(std::max(placed.left(), available.left()));
  placed.moveTop(std::max(placed.top(), available.top()));
  return placed;
}

MapCanvas::MapCanvas(QWidget* parent) : QWidget(parent) {
  setObjectName(QStringLiteral("bando"));
  setMouseTracking(true);
  setMinimumSize(320, 240);
  setCursor(Qt::CrossCursor);
  setFocusPolicy(Qt::StrongFocus);
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

void MapCanvas::zoom(double factor) { zoomAt(QRectF(rect()).center(), factor); }

void MapCanvas::pan(QPointF pixels) {
  view_.north -= pixels.y() / view_.scale;
  view_.east += pixels.x() / view_.scale;
  fitted_ = false;
  update();
}

bool MapCanvas::event(QEvent* event) {
  if (event->type() != QEvent::ToolTip) return QWidget::event(event);
  // The point under the cursor, else what the mouse and the keys do here.
  const auto* help = static_cast<QHelpEvent*>(event);
  const std::optional<std::size_t> item = ItemAt(model_, view_, help->pos());
  QString tip = Q(kCanvasTip);
  if (item) {
    const MapItem& point = model_.items[*item];
    tip = point.name + QStringLiteral(" (") + KindName(point.kind) + QLatin1Char(')');
    if (point.flagged) tip += QStringLiteral(", ") + Q(kFlaggedKind).toLower();
  }
  QToolTip::showText(help->globalPos(), tip, this);
  return true;
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

void MapCanvas::keyPressEvent(QKeyEvent* event) {
  const QPointF step(width() * kPanStep, height() * kPanStep);
  switch (event->key()) {
    case Qt::Key_Left:
      pan({-step.x(), 0});
      break;
    case Qt::Key_Right:
      pan({step.x(), 0});
      break;
    case Qt::Key_Up:
      pan({0, -step.y()});
      break;
    case Qt::Key_Down:
      pan({0, step.y()});
      break;
    default:
      QWidget::keyPressEvent(event);
      return;
  }
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
  // Records and report lines line up as in the files, one screen line each.
  QFont fixed(QString::fromLatin1(kSketchFont));
  fixed.setStyleHint(QFont::Monospace);
  fixed.setPointSizeF(QFontDatabase::systemFont(QFontDatabase::FixedFont).pointSizeF());
  details_->setFont(fixed);
  details_->setLineWrapMode(QTextEdit::NoWrap);
  details_->setMinimumHeight(details_->fontMetrics().lineSpacing() * 3);
  details_->setPlainText(Q(kHint));
  split_ = new QSplitter(Qt::Vertical);
  split_->setObjectName(QStringLiteral("chia"));
  split_->addWidget(canvas_);
  split_->addWidget(details_);
  split_->setStretchFactor(0, 4);
  split_->setStretchFactor(1, 1);
  split_->setCollapsible(0, false);
  split_->setCollapsible(1, false);
  setCentralWidget(split_);

  auto* legend = new QLabel(Legend());
  legend->setObjectName(QStringLiteral("chuthich"));
  statusBar()->addWidget(legend);
  cursor_ = new QLabel;
  cursor_->setObjectName(QStringLiteral("toado"));
  cursor_->setMinimumWidth(
      cursor_->fontMetrics().horizontalAdvance(QStringLiteral("X= -2345678.00   Y= -567890.00")));
  statusBar()->addPermanentWidget(cursor_);

  // Every action in a menu, where its access key and keys show, and the
  // everyday ones on the tool bar too.
  QMenu* file = menuBar()->addMenu(Q(kFileMenu));
  QMenu* view = menuBar()->addMenu(Q(kViewMenu));
  QToolBar* tools = addToolBar(Q(kMapButton));
  tools->setObjectName(QStringLiteral("congcu"));
  tools->setMovable(false);
  auto action = [&](QMenu* menu, const char* name, std::string_view caption, std::string_view tip,
                    QList<QKeySequence> keys, auto slot) {
    auto* a = new QAction(Q(caption), this);
    a->setObjectName(QLatin1String(name));
    a->setShortcuts(keys);
    a->setStatusTip(Q(tip));
    SetTip(*a, tip);
    connect(a, &QAction::triggered, this, slot);
    menu->addAction(a);
    addAction(a);  // its keys work wherever the focus is in the window
    return a;
  };
  QAction* zoomIn = action(view, "zoomIn", kZoomIn, kZoomInTip,
                           {Qt::Key_Plus, Qt::Key_Equal, QKeySequence::ZoomIn},
                           [this] { canvas_->zoom(kZoomStep); });
  QAction* zoomOut =
      action(view, "zoomOut", kZoomOut, kZoomOutTip, {Qt::Key_Minus, QKeySequence::ZoomOut},
             [this] { canvas_->zoom(1 / kZoomStep); });
  QAction* fit = action(view, "fit", kFit, kFitTip, {Qt::Key_0}, [this] { canvas_->fit(); });
  QAction* saveView =
      action(file, "saveView", kSaveView, kSaveViewTip, {}, [this] { askPicture(false); });
  QAction* saveWhole =
      action(file, "saveWhole", kSaveWhole, kSaveWholeTip, {}, [this] { askPicture(true); });
  saveSketch_ =
      action(file, "saveSketch", kSaveSketch, kSaveSketchTip, {}, [this] { askSketch(); });
  printSketch_ = action(file, "printSketch", kPrintSketch, kPrintSketchTip, {QKeySequence::Print},
                        [this] { printSketch(); });
  file->addSeparator();
  action(file, "closeMap", kCloseMap, kCloseMapTip, {Qt::Key_Escape}, [this] { close(); });
  tools->addActions({zoomIn, zoomOut, fit});
  tools->addSeparator();
  tools->addActions({saveView, saveWhole, saveSketch_, printSketch_});

  connect(canvas_, &MapCanvas::cursorMoved, this, [this](QPointF ground) {
    cursor_->setText(
        QStringLiteral("X= %1   Y= %2").arg(ground.x(), 0, 'f', 2).arg(ground.y(), 0, 'f', 2));
  });
  connect(canvas_, &MapCanvas::itemClicked, this, &MapWindow::pick);
  pictureFilter_ = Q(kPictureFilter).section(QStringLiteral(";;"), 0, 0);
  resize(kDefaultSize);
}

void MapWindow::setSurvey(Survey survey, std::string fieldBook, std::string sketch) {
  survey_ = std::move(survey);
  fieldBook_ = std::move(fieldBook);
  sketch_ = std::move(sketch);
  bookLines_.reset();
  setWindowTitle(Q(kMapTitle) + QFileInfo(Q(fieldBook_)).fileName());
  // Without a sketch its buttons say why they cannot be pressed.
  const bool sketched = !sketch_.empty();
  saveSketch_->setEnabled(sketched);
  printSketch_->setEnabled(sketched);
  SetTip(*saveSketch_, sketched ? kSaveSketchTip : kNoSketchTip);
  SetTip(*printSketch_, sketched ? kPrintSketchTip : kNoSketchTip);
  details_->setPlainText(Q(kHint));
  canvas_->setModel(BuildMap(survey_));
}

void MapWindow::showEvent(QShowEvent* event) {
  QMainWindow::showEvent(event);
  if (event->spontaneous()) return;
  const bool first = !placed_;
  placeOnScreen();
  if (first) {
    // Room for what a point usually shows: its line, a report line or two and
    // its records; the drawing takes the rest.
    const QList<int> sizes = split_->sizes();
    const int total = sizes.value(0) + sizes.value(1);
    const int pane =
        details_->fontMetrics().lineSpacing() * kPaneLines + 2 * details_->frameWidth();
    if (total > 2 * pane) split_->setSizes({total - pane, pane});
  }
  canvas_->setFocus();
}

void MapWindow::placeOnScreen() {
  // The screen the user works on: that of the window in front, else its own.
  const QWidget* front = QApplication::activeWindow();
  QScreen* screen = front != nullptr && front != this ? front->screen() : this->screen();
  if (screen == nullptr) return;
  const QRect available = screen->availableGeometry();
  const QRect frame = frameGeometry();
  // Before the first showing the frame is not known yet: room is left for it.
  const QSize margins = frame.size() != size() ? frame.size() - size() : kFrameAllowance;
  if (!placed_) {
    resize(size().boundedTo(available.size() - margins));
    QRect centred(QPoint(), size() + margins);
    centred.moveCenter(available.center());
    move(centred.topLeft());
    placed_ = true;
  }
  const QRect within =
      PlaceWithin(QRect(frameGeometry().topLeft(), size() + margins),
                  minimumSizeHint().expandedTo(minimumSize()) + margins, available);
  resize(within.size() - margins);
  move(within.topLeft());
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
  const std::vector<MapItem>& items = canvas_->model().items;
  const MapItem& item = items.at(index);
  // The point is every item of its name at its place: a control point or a
  // peg and the station set up on it. Points of one name elsewhere (numbers
  // that start again at each station) are other points.
  std::vector<const MapItem*> here;
  bool elsewhere = false;
  for (const MapItem& other : items) {
    if (other.name != item.name) continue;
    if (SamePlace(other, item)) {
      here.push_back(&other);
    } else {
      elsewhere = true;
    }
  }
  std::stable_sort(here.begin(), here.end(), [](const MapItem* a, const MapItem* b) {
    return KindRank(a->kind) < KindRank(b->kind);
  });
  QStringList kinds;
  std::set<std::size_t> lines;  // a peg that later served as a station has two
  for (const MapItem* part : here) {
    if (!kinds.contains(KindName(part->kind))) kinds << KindName(part->kind);
    if (part->line > 0) lines.insert(part->line);
  }

  QStringList text;
  text << item.name + QStringLiteral("  (") + kinds.join(QStringLiteral(", ")) +
              QStringLiteral(")  X= ") + QString::number(item.x, 'f', 3) + QStringLiteral("  Y= ") +
              QString::number(item.y, 'f', 3);
  const std::string name = nameOf(item);
  bool heading = false;
  for (const ReportEntry& entry : survey_.report) {
    if (survey_.Point(entry) != name) continue;
    if (elsewhere && entry.line != 0 && !lines.contains(entry.line)) continue;
    if (!heading) text << Q(kReportLines);
    heading = true;
    text << QStringLiteral("  ") + FromTcvn3(survey_.TextOf(entry));
  }
  for (std::size_t line : lines) {
    text << Q(kRecordAt) + QString::number(line) + QLatin1Char(':');
    text << QStringLiteral("  ") + FromTcvn3(bookLine(line));
  }
  return text.join(QLatin1Char('\n'));
}

void MapWindow::pick(std::size_t item) { showDetails(describe(item)); }

void MapWindow::showDetails(const QString& text) {
  details_->setPlainText(text);
  // The pane grows to show every line, up to half the window's height; the
  // drawing keeps the rest.
  QTextDocument& document = *details_->document();
  const int frame = 2 * details_->frameWidth();
  const bool wide = document.idealWidth() > details_->viewport()->width();
  const int wanted = static_cast<int>(std::ceil(document.size().height())) + frame +
                     (wide ? details_->horizontalScrollBar()->sizeHint().height() : 0);
  const QList<int> sizes = split_->sizes();
  const int total = sizes.value(0) + sizes.value(1);
  const int pane = std::min(wanted, total / 2);
  if (total > 0 && sizes.value(1) < pane) split_->setSizes({total - pane, pane});
}

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

QString MapWindow::askPath(std::string_view caption, const QStringList& filters, QString& filter) {
  const SaveRequest request{Plain(caption), ProposedPath(Q(fieldBook_), FilterExtension(filter)),
                            filters, filter};
  const SaveChoice choice = chooseSave_(this, request);
  if (choice.path.isEmpty()) return {};
  if (filters.contains(choice.filter)) filter = choice.filter;
  return WithExtension(choice.path, filter, filters);
}

void MapWindow::askPicture(bool whole) {
  const QString path = askPath(whole ? kSaveWhole : kSaveView,
                               Q(kPictureFilter).split(QStringLiteral(";;")), pictureFilter_);
  if (!path.isEmpty() && !savePicture(path, whole)) cannotWrite(path);
}

void MapWindow::askSketch() {
  QString filter = Q(kPdfFilter);
  const QString path = askPath(kSaveSketch, {filter}, filter);
  if (!path.isEmpty() && !saveSketch(path)) cannotWrite(path);
}

void MapWindow::printSketch() {
  QPrinter printer;
  // The print job, and a print to a file, are named after the job.
  printer.setDocName(QFileInfo(ProposedPath(Q(fieldBook_), QStringLiteral("pdf"))).completeBaseName());
  QPrintPreviewDialog preview(&printer, this);
  preview.setObjectName(QStringLiteral("inSodo"));
  preview.setWindowTitle(Plain(kPrintSketch));
  const QString sketch = ReadSketch(sketch_);
  connect(&preview, &QPrintPreviewDialog::paintRequested, this,
          [&sketch](QPrinter* device) { PaintSketch(*device, sketch); });
  preview.exec();
}

}  // namespace kavu::ui
