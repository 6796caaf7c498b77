// The field sketch on paper: the pages of the .sdo file, A4, in a monospaced
// font that has every Vietnamese letter, for a PDF file and for a printer.
#pragma once

#include <QString>
#include <QStringList>
#include <string>
#include <vector>

class QPagedPaintDevice;

namespace kavu::ui {

// The font of the sketch pages (Debian package fonts-noto-mono), named so that
// every system takes the same one: DejaVu Sans Mono lacks half of the
// Vietnamese letters with two marks (ả, ề, ố...).
inline constexpr const char* kSketchFont = "Noto Mono";

// The sketch text laid on pages of at most linesPerPage lines: each station
// starts a page; a station longer than a page goes on under a line naming the
// station followed by "(tiếp)" and the form's column heads repeated.
std::vector<QStringList> SketchPages(const QString& sketch, int linesPerPage);

// The .sdo file (TCVN3) as text; empty when it cannot be read.
QString ReadSketch(const std::string& utf8Path);

// The pages painted on a PDF writer or a printer, A4 portrait, each with its
// number and the count at its foot ("Trang 2/5"); false when the device could
// not be painted on.
bool PaintSketch(QPagedPaintDevice& device, const QString& sketch);

// Written whole or not at all; false when the file could not be written.
bool SaveSketchPdf(const QString& sketch, const QString& path);

}  // namespace kavu::ui
