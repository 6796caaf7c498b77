#include "cli/pictures.h"

#include <QGuiApplication>
#include <QString>
#include <cstdio>
#include <optional>

#include "core/lines.h"
#include "core/messages.h"
#include "ui/map_model.h"
#include "ui/sketch_pdf.h"
#include "ui/survey_of.h"

namespace kavu {

std::vector<std::string> WritePictures(const RunState& st, const PictureFiles& files) {
  // Qt paints through an application object; a batch command needs no
  // display, so it paints off screen unless told otherwise.
  int argc = 1;
  char name[] = "kavu-cli";
  char* argv[] = {name, nullptr};
  std::optional<QGuiApplication> app;
  // Qt's notes about the desktop session (no runtime folder, no display) say
  // nothing about the pictures; its errors still go to stderr.
  const QtMessageHandler previous =
      qInstallMessageHandler([](QtMsgType type, const QMessageLogContext&, const QString& text) {
        if (type == QtCriticalMsg || type == QtFatalMsg) {
          std::fputs((text.toStdString() + "\n").c_str(), stderr);
        }
      });
  if (QCoreApplication::instance() == nullptr) {
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM")) qputenv("QT_QPA_PLATFORM", "offscreen");
    app.emplace(argc, argv);
  }

  std::vector<std::string> failed;
  const auto path = [](const std::string& utf8) { return QString::fromStdString(utf8); };
  // A picture never replaces a file the run reads.
  const auto overInput = [&](const std::string& picture) {
    for (const std::string& input : st.inputs) {
      if (!WouldReplace(picture, input)) continue;
      failed.push_back(picture + std::string(msg::kProductIsInput));
      return true;
    }
    return false;
  };
  if (!files.png.empty() || !files.svg.empty()) {
    const ui::MapModel model = ui::BuildMap(SurveyOf(st));
    const ui::MapView view = ui::FitView(model, ui::kWholeSurveySize);
    if (!files.png.empty() && !overInput(files.png) &&
        !ui::SaveMapPng(model, view, path(files.png))) {
      failed.push_back(files.png);
    }
    if (!files.svg.empty() && !overInput(files.svg) &&
        !ui::SaveMapSvg(model, view, path(files.svg))) {
      failed.push_back(files.svg);
    }
  }
  if (!files.pdf.empty() && !overInput(files.pdf) &&
      !ui::SaveSketchPdf(ui::ReadSketch(st.daufile + ".sdo"), path(files.pdf))) {
    failed.push_back(files.pdf);
  }
  qInstallMessageHandler(previous);
  return failed;
}

}  // namespace kavu
