// The batch command's pictures of a run: the map as PNG and SVG, the field
// sketch as PDF. Built only with Qt; without it the options are refused.
#pragma once

#include <string>
#include <vector>

#include "core/state.h"

namespace kavu {

struct PictureFiles {
  std::string png, svg, pdf;  // UTF-8 paths; empty when not asked for
};

// Draws the completed run in st (its field sketch from daufile + ".sdo").
// Returns the files that could not be written.
std::vector<std::string> WritePictures(const RunState& st, const PictureFiles& files);

}  // namespace kavu
