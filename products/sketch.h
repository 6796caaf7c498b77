// The field sketch (.sdo): the observations laid out per station as the
// ruled form filed with the survey.
#pragma once

#include <array>
#include <string>

#include "core/lines.h"
#include "core/survey.h"

namespace kavu {

// A section for each computed station: the header texts (the seven of the
// header form at their widths), the station's coordinates and orientation,
// a row for each detail point, the closing row with the orientation.
void WriteSketch(TextOut& out, const Survey& survey, const std::array<std::string, 7>& header);

}  // namespace kavu
