#include "ui/sketch_pdf.h"

#include <QFont>
#include <QFontMetricsF>
#include <QMarginsF>
#include <QPageLayout>
#include <QPageSize>
#include <QPagedPaintDevice>
#include <QPainter>
#include <QPdfWriter>
#include <QRegularExpression>
#include <QSaveFile>
#include <QStringView>
#include <algorithm>

#include "core/lines.h"
#include "core/tcvn3.h"
#include "ui/texts.h"

namespace kavu::ui {
namespace {

QString Text(std::string_view text) {
  return QString::fromUtf8(text.data(), static_cast<qsizetype>(text.size()));
}

// The largest size of the sketch's letters; smaller when a line is too wide.
constexpr double kPointSize = 10;
constexpr double kMarginMm = 15;
// The lines of a page kept for its number: an empty one and the number.
constexpr int kFootLines = 2;

// The column heads of a section: the rule above them, their two lines and the
// rule below them; empty when the section has none.
QStringList ColumnHeads(const QStringList& section) {
  for (qsizetype i = 1; i + 2 < section.size(); ++i) {
    if (section[i].startsWith(QLatin1Char('|')) && section[i - 1].startsWith(QLatin1Char('='))) {
      return section.mid(i - 1, 4);
    }
  }
  return {};
}

// The station a section is about, as its header names it; empty when none.
QString StationName(const QStringList& section) {
  const QString label = Text(kSketchStation);
  for (const QString& line : section) {
    if (!line.startsWith(label)) continue;
    QString name = line.mid(label.size());
    const qsizetype area = name.indexOf(Text(kSketchArea));
    if (area >= 0) name.truncate(area);
    return name.trimmed();
  }
  return {};
}

}  // namespace

std::vector<QStringList> SketchPages(const QString& sketch, int linesPerPage) {
  QStringList lines = sketch.split(QRegularExpression(QStringLiteral("\r\n|\r|\n")));
  while (!lines.isEmpty() && lines.back().isEmpty()) lines.removeLast();

  std::vector<QStringList> sections;
  const QString sectionStart = Text(kSketchSection);
  for (const QString& line : lines) {
    if (sections.empty() || line.startsWith(sectionStart)) sections.emplace_back();
    sections.back().append(line);
  }

  std::vector<QStringList> pages;
  for (QStringList& section : sections) {
    // The empty lines between the sections belong to no page.
    while (!section.isEmpty() && section.front().isEmpty()) section.removeFirst();
    while (!section.isEmpty() && section.back().isEmpty()) section.removeLast();
    if (section.isEmpty()) continue;
    // A page that goes on with a station names it and repeats the heads.
    QStringList goesOn = ColumnHeads(section);
    const QString station = StationName(section);
    goesOn.prepend(Text(kSketchStation) + QLatin1Char(' ') + station + Text(kContinued));
    const int room = std::max(linesPerPage, static_cast<int>(goesOn.size()) + 1);
    qsizetype next = 0;
    pages.emplace_back();
    while (next < section.size()) {
      if (pages.back().size() >= room) {
        pages.emplace_back(goesOn);
      }
      pages.back().append(section[next++]);
    }
  }
  return pages;
}

QString ReadSketch(const std::string& utf8Path) {
  const auto bytes = ReadFileBytes(utf8Path);
  return bytes ? QString::fromStdString(Tcvn3ToUtf8(*bytes)) : QString();
}

bool PaintSketch(QPagedPaintDevice& device, const QString& sketch) {
  device.setPageLayout(QPageLayout(QPageSize(QPageSize::A4), QPageLayout::Portrait,
                                   QMarginsF(kMarginMm, kMarginMm, kMarginMm, kMarginMm),
                                   QPageLayout::Millimeter));
  QPainter painter;
  if (!painter.begin(&device)) return false;
  QFont font(QString::fromLatin1(kSketchFont));
  font.setStyleHint(QFont::Monospace);
  font.setPointSizeF(kPointSize);

  // Every line fits the page's width.
  qsizetype widest = 1;
  for (QStringView line : QStringView(sketch).split(QLatin1Char('\n'))) {
    widest = std::max(widest, line.trimmed().size());
  }
  const double width =
      QFontMetricsF(font, &device).horizontalAdvance(QString(widest, QLatin1Char('M')));
  if (width > device.width()) font.setPointSizeF(kPointSize * device.width() / width);
  painter.setFont(font);
  const QFontMetricsF metrics(font, &device);
  const double step = metrics.lineSpacing();
  const int lines = static_cast<int>(device.height() / step);
  const int perPage = std::max(1, lines - kFootLines);

  const std::vector<QStringList> pages = SketchPages(sketch, perPage);
  const QString count = QString::number(pages.size());
  for (std::size_t i = 0; i < pages.size(); ++i) {
    if (i > 0 && !device.newPage()) return false;
    double y = metrics.ascent();
    for (const QString& line : pages[i]) {
      painter.drawText(QPointF(0, y), line);
      y += step;
    }
    // The number at the page's foot, in the middle.
    const QRectF foot(0, std::max(lines - 1, 0) * step, device.width(), step);
    painter.drawText(foot, Qt::AlignHCenter | Qt::AlignTop,
                     Text(kPageNumber).arg(QString::number(i + 1), count));
  }
  return painter.end();
}

bool SaveSketchPdf(const QString& sketch, const QString& path) {
  QSaveFile file(path);
  if (!file.open(QIODevice::WriteOnly)) return false;
  {
    QPdfWriter pdf(&file);
    pdf.setTitle(QStringLiteral("SO DO CHI TIET"));
    pdf.setCreator(QStringLiteral("kavu"));
    pdf.setResolution(300);
    if (!PaintSketch(pdf, sketch)) return false;
  }
  return file.commit();
}

}  // namespace kavu::ui
