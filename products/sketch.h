// The field sketch (.sdo): the observations laid out per station as the
// ruled form filed with the survey.
#pragma once

#include <array>
#include <string>

#include "core/lines.h"
#include "core/survey.h"

namespace kavu {

// The header texts in the order of the header form: survey area, sketch
// number, instrument, instrument number, surveyor, recorder, survey date.
// Each stands in a column of the printed form; a text that a label follows on
// its line keeps one character less than its column, so that a space always
// parts it from the label ("Người ghi:"). The characters of each text that the
// sketch prints; a longer text is cut.
inline constexpr std::array<std::size_t, 7> kSketchHeaderColumns = {39, 6, 19, 20, 17, 18, 10};
inline constexpr std::array<std::size_t, 7> kSketchHeaderWidths = {39, 6, 18, 20, 16, 17, 10};

// A section for each computed station: the header texts (the seven of the
// header form, cut to their widths, in their columns), the station's coordinates and orientation,
// a row for each detail point, the closing row with the orientation.
void WriteSketch(TextOut& out, const Survey& survey, const std::array<std::string, 7>& header);

}  // namespace kavu
