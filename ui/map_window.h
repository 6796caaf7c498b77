// The map window: the run drawn in the plane, its doubtful points in red, a
// click on a point showing its error-report lines and field-book record; the
// map saved as a picture, the field sketch saved as PDF or printed.
#pragma once

#include <QMainWindow>
#include <QPoint>
#include <QRect>
#include <QStringList>
#include <QWidget>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "core/survey.h"
#include "ui/map_model.h"

class QAction;
class QLabel;
class QSplitter;
class QTextBrowser;

namespace kavu::ui {

// The main window's map button and its check box.
inline constexpr std::string_view kMapButton = "Bản đồ";
inline constexpr std::string_view kOpenMapAfterRun = "Mở bản đồ sau khi tính";

// The drawing: wheel zoom around the cursor, drag or the arrow keys to pan,
// click to pick; a point's name and kind under the cursor as its tooltip.
class MapCanvas : public QWidget {
  Q_OBJECT
 public:
  explicit MapCanvas(QWidget* parent = nullptr);
  void setModel(MapModel model);
  const MapModel& model() const { return model_; }
  const MapView& view() const { return view_; }
  // The whole survey in the window.
  void fit();
  void zoomAt(QPointF device, double factor);
  // Zoomed around the middle of the drawing.
  void zoom(double factor);
  // The view moved by pixels on the screen: positive x shows more of the
  // east, positive y more of the south.
  void pan(QPointF pixels);

 signals:
  void cursorMoved(QPointF ground);  // x north, y east
  void itemClicked(std::size_t item);

 protected:
  bool event(QEvent* event) override;
  void paintEvent(QPaintEvent* event) override;
  void resizeEvent(QResizeEvent* event) override;
  void wheelEvent(QWheelEvent* event) override;
  void keyPressEvent(QKeyEvent* event) override;
  void mousePressEvent(QMouseEvent* event) override;
  void mouseMoveEvent(QMouseEvent* event) override;
  void mouseReleaseEvent(QMouseEvent* event) override;

 private:
  MapModel model_;
  MapView view_;
  bool fitted_ = false;  // follows the window's size until zoomed or panned
  std::optional<QPoint> pressed_, last_;
  bool dragged_ = false;
};

// What a save dialog is asked for.
struct SaveRequest {
  QString caption;
  QString proposed;  // the path proposed, with the extension of `filter`
  QStringList filters;
  QString filter;  // the one chosen when the dialog opens
};

// What the user chose; an empty path when cancelled.
struct SaveChoice {
  QString path;
  QString filter;
};

// The extension of a filter such as "Hình PNG (*.png)", without its dot.
QString FilterExtension(const QString& filter);
// The job's name: the field book's path up to the first "." of its file name,
// in its folder, followed by "." and extension; empty without a field book.
QString ProposedPath(const QString& fieldBook, const QString& extension);
// The path with the extension of filter added, unless it already ends with
// the extension of one of filters.
QString WithExtension(const QString& path, const QString& filter, const QStringList& filters);
// Qt's own save dialog with the program's labels, proposing request.proposed
// and keeping its extension in step with the filter chosen.
SaveChoice ChooseSavePath(QWidget* parent, const SaveRequest& request);

// Where a window goes on a screen: the frame wanted, made smaller to fit the
// screen's available area (never below minimum) and moved into it.
QRect PlaceWithin(const QRect& frame, QSize minimum, const QRect& available);

class MapWindow : public QMainWindow {
  Q_OBJECT
 public:
  using SaveChooser = std::function<SaveChoice(QWidget*, const SaveRequest&)>;

  explicit MapWindow(QWidget* parent = nullptr);

  // The run to show: its survey, the field book its records come from and its
  // field sketch (empty when the run wrote none). Paths are UTF-8.
  void setSurvey(Survey survey, std::string fieldBook, std::string sketch);
  MapCanvas& canvas() { return *canvas_; }
  // What a click on an item shows: the point, its error-report lines and its
  // field-book record.
  QString describe(std::size_t item);
  QString details() const;

  // The map as PNG or SVG (by the path's suffix): the window's view or the
  // whole survey.
  bool savePicture(const QString& path, bool whole) const;
  bool saveSketch(const QString& path) const;
  void printSketch();
  // Asks for the path to save to; Qt's dialog unless a test stands in.
  void setSaveChooser(SaveChooser chooser) { chooseSave_ = std::move(chooser); }

 protected:
  void showEvent(QShowEvent* event) override;

 private:
  void pick(std::size_t item);
  void askPicture(bool whole);
  void askSketch();
  // Asks for a path; the filter chosen in `filter`, empty when cancelled.
  QString askPath(std::string_view caption, const QStringList& filters, QString& filter);
  void cannotWrite(const QString& path);
  void showDetails(const QString& text);
  void placeOnScreen();
  std::string nameOf(const MapItem& item) const;
  std::string bookLine(std::size_t line);

  Survey survey_;
  std::string fieldBook_, sketch_;
  std::optional<std::vector<std::string>> bookLines_;
  MapCanvas* canvas_ = nullptr;
  QSplitter* split_ = nullptr;
  QTextBrowser* details_ = nullptr;
  QLabel* cursor_ = nullptr;
  QAction* saveSketch_ = nullptr;
  QAction* printSketch_ = nullptr;
  QString pictureFilter_;  // the picture kind chosen last
  bool placed_ = false;
  SaveChooser chooseSave_ = ChooseSavePath;
};

}  // namespace kavu::ui
