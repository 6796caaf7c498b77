// The survey as a map: what is drawn where, and the drawing itself, the same
// on the screen, in a PNG and in an SVG. X (north) points up, Y (east) to the
// right, at the same scale both ways.
#pragma once

#include <QColor>
#include <QPointF>
#include <QSize>
#include <QString>
#include <cstddef>
#include <optional>
#include <vector>

#include "core/survey.h"

class QPainter;

namespace kavu::ui {

enum class MapKind { Control, Station, Peg, Detail };

// One drawn point; x north and y east in metres.
struct MapItem {
  MapKind kind = MapKind::Detail;
  QString name;  // shown beside the point
  QString code;  // a detail point's code, shown after its name
  double x = 0, y = 0;
  bool flagged = false;   // named by an error-report line: drawn in red
  std::size_t index = 0;  // into Survey::control, stations or points
  std::size_t line = 0;   // field-book line of its record, 0 when none
};

// A station's sight to its orientation point or to its check point.
struct MapSight {
  double x1 = 0, y1 = 0, x2 = 0, y2 = 0;
  bool check = false;
};

struct MapModel {
  std::vector<MapItem> items;  // control points, stations, pegs, detail points
  std::vector<MapSight> sights;
  // The extent of every item, metres.
  double minX = 0, maxX = 0, minY = 0, maxY = 0;
};

MapModel BuildMap(const Survey& survey);

// The part of the plane a picture shows: the ground point at its centre and
// the pixels per metre.
struct MapView {
  double north = 0, east = 0;
  double scale = 1;
  QSize size{800, 600};

  QPointF toDevice(double x, double y) const;
  // The ground point (x north, y east) under a device point.
  QPointF toGround(QPointF device) const;
};

// Detail names and codes are drawn from this many pixels a metre on.
inline constexpr double kLabelScale = 2.0;
// The whole survey as a picture of its own.
inline constexpr QSize kWholeSurveySize{1600, 1200};

// The whole survey within size, with a margin.
MapView FitView(const MapModel& model, QSize size);
// Zoomed by factor, the ground point under device staying where it is.
MapView ZoomAt(const MapView& view, QPointF device, double factor);

void PaintMap(QPainter& painter, const MapModel& model, const MapView& view);

// The colour an item is drawn in: red when flagged, else by its kind.
QColor ColourOf(const MapItem& item);
// What a point is, for the legend, the tooltips and the information pane.
QString KindName(MapKind kind);
// Which of the items at one place stands for it: a control point, a peg, a
// detail point, then a station.
int KindRank(MapKind kind);

// The item nearest to a device point within radius pixels.
std::optional<std::size_t> ItemAt(const MapModel& model, const MapView& view, QPointF device,
                                  double radius = 8);

// Written whole or not at all; false when the file could not be written.
bool SaveMapPng(const MapModel& model, const MapView& view, const QString& path);
bool SaveMapSvg(const MapModel& model, const MapView& view, const QString& path);

// A TCVN3 text for the screen.
QString FromTcvn3(std::string_view text);

}  // namespace kavu::ui
