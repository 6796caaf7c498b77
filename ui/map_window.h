// The map window: the run drawn in the plane, its doubtful points in red, a
// click on a point showing its error-report lines and field-book record; the
// map saved as a picture, the field sketch saved as PDF or printed.
#pragma once

#include <QMainWindow>
#include <QPoint>
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
class QTextBrowser;

namespace kavu::ui {

// The main window's map button and its check box.
inline constexpr std::string_view kMapButton = "Bản đồ";
inline constexpr std::string_view kOpenMapAfterRun = "Mở bản đồ sau khi tính";

// The drawing: wheel zoom around the cursor, drag to pan, click to pick.
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

 signals:
  void cursorMoved(QPointF ground);  // x north, y east
  void itemClicked(std::size_t item);

 protected:
  void paintEvent(QPaintEvent* event) override;
  void resizeEvent(QResizeEvent* event) override;
  void wheelEvent(QWheelEvent* event) override;
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

class MapWindow : public QMainWindow {
  Q_OBJECT
 public:
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
  // Asks for the path to save to (caption, filters); empty when cancelled.
  void setSaveChooser(std::function<QString(const QString&, const QString&)> chooser) {
    chooseSave_ = std::move(chooser);
  }

 private:
  void pick(std::size_t item);
  void askPicture(bool whole);
  void askSketch();
  void cannotWrite(const QString& path);
  std::string nameOf(const MapItem& item) const;
  std::string bookLine(std::size_t line);

  Survey survey_;
  std::string fieldBook_, sketch_;
  std::optional<std::vector<std::string>> bookLines_;
  MapCanvas* canvas_ = nullptr;
  QTextBrowser* details_ = nullptr;
  QLabel* cursor_ = nullptr;
  QAction* saveSketch_ = nullptr;
  QAction* printSketch_ = nullptr;
  std::function<QString(const QString&, const QString&)> chooseSave_;
};

}  // namespace kavu::ui
