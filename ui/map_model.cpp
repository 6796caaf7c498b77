#include "ui/map_model.h"

#include <QFont>
#include <QImage>
#include <QPainter>
#include <QPainterPath>
#include <QPolygonF>
#include <QSaveFile>
#include <QSvgGenerator>
#include <algorithm>
#include <cmath>
#include <set>
#include <string>

#include "core/tcvn3.h"
#include "core/text.h"
#include "ui/texts.h"

namespace kavu::ui {
namespace {

const QColor kFlagged(220, 0, 0);
const QColor kControl(0, 60, 200);
const QColor kStation(0, 120, 40);
const QColor kPeg(150, 0, 150);
const QColor kSight(150, 150, 150);

QFont LabelFont(int pixels, bool bold = false) {
  QFont font(QStringLiteral("DejaVu Sans"));
  font.setPixelSize(pixels);
  font.setBold(bold);
  return font;
}

// The largest 1, 2 or 5 times a power of ten not above limit.
double RoundLength(double limit) {
  const double power = std::pow(10.0, std::floor(std::log10(limit)));
  for (double step : {5.0, 2.0, 1.0}) {
    if (step * power <= limit) return step * power;
  }
  return power;
}

QString MetresText(double metres) {
  return metres >= 1000 ? QString::number(metres / 1000) + QStringLiteral(" km")
                        : QString::number(metres) + QStringLiteral(" m");
}

void PaintScaleBar(QPainter& painter, const MapView& view) {
  const double metres = RoundLength(120 / view.scale);
  const double length = metres * view.scale;
  const QPointF left(16, view.size.height() - 18.0);
  const QPointF right = left + QPointF(length, 0);
  painter.setPen(QPen(Qt::black, 2));
  painter.drawLine(left, right);
  painter.drawLine(left, left - QPointF(0, 6));
  painter.drawLine(right, right - QPointF(0, 6));
  painter.setFont(LabelFont(12));
  painter.drawText(left + QPointF(0, -9), MetresText(metres));
}

void PaintNorthArrow(QPainter& painter, const MapView& view) {
  const double x = view.size.width() - 28.0;
  QPolygonF arrow;
  arrow << QPointF(x, 18) << QPointF(x + 8, 48) << QPointF(x, 42) << QPointF(x - 8, 48);
  painter.setPen(QPen(Qt::black, 1));
  painter.setBrush(Qt::black);
  painter.drawPolygon(arrow);
  painter.setFont(LabelFont(13, true));
  painter.drawText(QRectF(x - 10, 48, 20, 18), Qt::AlignCenter, QStringLiteral("N"));
}

void PaintLabel(QPainter& painter, QPointF at, const QString& text, const QColor& colour) {
  painter.setPen(colour);
  painter.drawText(at + QPointF(6, -5), text);
}

}  // namespace

QColor ColourOf(const MapItem& item) {
  if (item.flagged) return kFlagged;
  switch (item.kind) {
    case MapKind::Control:
      return kControl;
    case MapKind::Station:
      return kStation;
    case MapKind::Peg:
      return kPeg;
    case MapKind::Detail:
      break;
  }
  return Qt::black;
}

QString FromTcvn3(std::string_view text) { return QString::fromStdString(Tcvn3ToUtf8(text)); }

MapModel BuildMap(const Survey& survey) {
  std::set<std::string, std::less<>> named;
  for (const ReportEntry& entry : survey.report) {
    if (entry.size > 0) named.emplace(survey.Point(entry));
  }
  // A peg set out in this run that a later station occupies or sights is a
  // known point of the run, but it stays a peg on the map; a known point that
  // the run read keeps its name first, whatever peg shares it.
  std::set<std::string_view, std::less<>> read, pegs;
  for (std::size_t i = 0; i < survey.knownRead && i < survey.known.size(); ++i) {
    read.insert(TrimView(survey.known[i][0]));
  }
  for (const ComputedPoint& p : survey.points) {
    if (p.kind() == PointKind::Peg) pegs.insert(survey.Name(p));
  }
  MapModel model;
  auto add = [&](MapKind kind, std::string_view name, double x, double y, std::size_t index,
                 std::size_t line) {
    MapItem item{kind, FromTcvn3(name), {}, x, y, named.contains(name), index, line};
    model.items.push_back(std::move(item));
  };
  for (std::size_t i = 0; i < survey.control.size(); ++i) {
    const SurveyPoint& p = survey.control[i];
    if (pegs.contains(p.name) && !read.contains(p.name)) continue;
    add(MapKind::Control, p.name, p.x, p.y, i, 0);
  }
  for (std::size_t i = 0; i < survey.stations.size(); ++i) {
    const StationResult& s = survey.stations[i];
    add(MapKind::Station, s.station.name, s.station.x, s.station.y, i, s.line);
    model.sights.push_back({s.station.x, s.station.y, s.orientation.x, s.orientation.y, false});
    if (s.check) model.sights.push_back({s.station.x, s.station.y, s.check->x, s.check->y, true});
  }
  for (std::size_t i = 0; i < survey.points.size(); ++i) {
    const ComputedPoint& p = survey.points[i];
    add(p.kind() == PointKind::Peg ? MapKind::Peg : MapKind::Detail, survey.Name(p), p.x, p.y, i,
        p.line);
    model.items.back().code = FromTcvn3(survey.Code(p));
  }
  bool first = true;
  for (const MapItem& item : model.items) {
    model.minX = first ? item.x : std::min(model.minX, item.x);
    model.maxX = first ? item.x : std::max(model.maxX, item.x);
    model.minY = first ? item.y : std::min(model.minY, item.y);
    model.maxY = first ? item.y : std::max(model.maxY, item.y);
    first = false;
  }
  return model;
}

QPointF MapView::toDevice(double x, double y) const {
  return {(y - east) * scale + size.width() / 2.0, size.height() / 2.0 - (x - north) * scale};
}

QPointF MapView::toGround(QPointF device) const {
  return {north - (device.y() - size.height() / 2.0) / scale,
          east + (device.x() - size.width() / 2.0) / scale};
}

MapView FitView(const MapModel& model, QSize size) {
  constexpr double kMargin = 48;
  MapView view;
  view.size = size;
  view.north = (model.minX + model.maxX) / 2;
  view.east = (model.minY + model.maxY) / 2;
  // A lone point is shown with 20 m around it.
  const double north = std::max(model.maxX - model.minX, 20.0);
  const double east = std::max(model.maxY - model.minY, 20.0);
  view.scale = std::min(std::max(size.width() - 2 * kMargin, 10.0) / east,
                        std::max(size.height() - 2 * kMargin, 10.0) / north);
  return view;
}

MapView ZoomAt(const MapView& view, QPointF device, double factor) {
  const QPointF ground = view.toGround(device);
  MapView zoomed = view;
  zoomed.scale = std::clamp(view.scale * factor, 1e-4, 1e4);
  // Keep the ground point under the device point.
  zoomed.north = ground.x() + (device.y() - view.size.height() / 2.0) / zoomed.scale;
  zoomed.east = ground.y() - (device.x() - view.size.width() / 2.0) / zoomed.scale;
  return zoomed;
}

void PaintMap(QPainter& painter, const MapModel& model, const MapView& view) {
  painter.save();
  painter.setRenderHint(QPainter::Antialiasing);
  painter.fillRect(QRectF(QPointF(0, 0), QSizeF(view.size)), Qt::white);
  const QRectF visible = QRectF(QPointF(0, 0), QSizeF(view.size)).adjusted(-60, -30, 60, 30);

  for (const MapSight& sight : model.sights) {
    painter.setPen(QPen(kSight, 1, sight.check ? Qt::DashLine : Qt::SolidLine));
    painter.drawLine(view.toDevice(sight.x1, sight.y1), view.toDevice(sight.x2, sight.y2));
  }

  const bool labels = view.scale >= kLabelScale;
  // One name a point: a control point's, else its station's, which is shown
  // at every scale.
  std::set<QString> controlNames, stationNames;
  for (const MapItem& item : model.items) {
    if (item.kind == MapKind::Control) controlNames.insert(item.name);
    if (item.kind == MapKind::Station) stationNames.insert(item.name);
  }
  // Detail points first, so that the control points stay on top.
  QList<QPointF> dots;
  for (const MapItem& item : model.items) {
    const QPointF at = view.toDevice(item.x, item.y);
    if (item.kind == MapKind::Detail && !item.flagged && visible.contains(at)) dots.append(at);
  }
  painter.setPen(QPen(Qt::black, 4, Qt::SolidLine, Qt::RoundCap));
  painter.drawPoints(dots.data(), static_cast<int>(dots.size()));

  painter.setFont(LabelFont(11));
  for (int pass = 0; pass < 2; ++pass) {
    for (const MapItem& item : model.items) {
      const bool known = item.kind == MapKind::Control || item.kind == MapKind::Station;
      if (known != (pass == 1)) continue;
      const QPointF at = view.toDevice(item.x, item.y);
      if (!visible.contains(at)) continue;
      const QColor colour = ColourOf(item);
      painter.setBrush(Qt::NoBrush);
      switch (item.kind) {
        case MapKind::Detail:
          if (item.flagged) {
            painter.setPen(QPen(colour, 7, Qt::SolidLine, Qt::RoundCap));
            painter.drawPoint(at);
          }
          if (labels || item.flagged) {
            PaintLabel(painter, at,
                       item.code.isEmpty() ? item.name : item.name + QLatin1Char(' ') + item.code,
                       colour);
          }
          break;
        case MapKind::Peg:
          painter.setPen(QPen(colour, 1.5));
          painter.drawRect(QRectF(at - QPointF(3.5, 3.5), QSizeF(7, 7)));
          if ((labels || item.flagged) && !controlNames.contains(item.name) &&
              !stationNames.contains(item.name)) {
            PaintLabel(painter, at, item.name, colour);
          }
          break;
        case MapKind::Control: {
          QPolygonF triangle;
          triangle << at + QPointF(0, -7) << at + QPointF(6.5, 4.5) << at + QPointF(-6.5, 4.5);
          painter.setPen(QPen(colour, 2));
          painter.drawPolygon(triangle);
          painter.setFont(LabelFont(12, true));
          PaintLabel(painter, at, item.name, colour);
          painter.setFont(LabelFont(11));
          break;
        }
        case MapKind::Station:
          painter.setPen(QPen(colour, 2));
          painter.drawEllipse(at, 9.5, 9.5);
          if (!controlNames.contains(item.name)) PaintLabel(painter, at, item.name, colour);
          break;
      }
    }
  }
  PaintScaleBar(painter, view);
  PaintNorthArrow(painter, view);
  painter.restore();
}

int KindRank(MapKind kind) {
  switch (kind) {
    case MapKind::Control:
      return 0;
    case MapKind::Peg:
      return 1;
    case MapKind::Detail:
      return 2;
    case MapKind::Station:
      break;
  }
  return 3;
}

QString KindName(MapKind kind) {
  const std::string_view name = kPointKinds[static_cast<std::size_t>(kind)];
  return QString::fromUtf8(name.data(), static_cast<qsizetype>(name.size()));
}

std::optional<std::size_t> ItemAt(const MapModel& model, const MapView& view, QPointF device,
                                  double radius) {
  // Points closer than this on the screen are at one place.
  constexpr double kSamePlace = 0.25;  // pixels, squared
  std::optional<std::size_t> nearest;
  double best = radius * radius;
  for (std::size_t i = 0; i < model.items.size(); ++i) {
    const MapItem& item = model.items[i];
    const QPointF d = view.toDevice(item.x, item.y) - device;
    const double distance = d.x() * d.x() + d.y() * d.y();
    // At one place the point itself wins over the station set up on it: a
    // control point or a peg over its station.
    const bool tie = nearest && std::abs(distance - best) < kSamePlace;
    if (tie ? KindRank(item.kind) < KindRank(model.items[*nearest].kind) : distance < best) {
      best = std::min(best, distance);
      nearest = i;
    }
  }
  return nearest;
}

bool SaveMapPng(const MapModel& model, const MapView& view, const QString& path) {
  QImage image(view.size, QImage::Format_RGB32);
  {
    QPainter painter(&image);
    PaintMap(painter, model, view);
  }
  QSaveFile file(path);
  return file.open(QIODevice::WriteOnly) && image.save(&file, "PNG") && file.commit();
}

bool SaveMapSvg(const MapModel& model, const MapView& view, const QString& path) {
  QSaveFile file(path);
  if (!file.open(QIODevice::WriteOnly)) return false;
  QSvgGenerator svg;
  svg.setOutputDevice(&file);
  svg.setSize(view.size);
  svg.setViewBox(QRect(QPoint(0, 0), view.size));
  svg.setResolution(96);  // a pixel as a browser counts it
  svg.setTitle(QStringLiteral("kavu"));
  QPainter painter;
  if (!painter.begin(&svg)) return false;
  PaintMap(painter, model, view);
  return painter.end() && file.commit();
}

}  // namespace kavu::ui
