// Recording a computed detail point for the products.
#pragma once

#include "core/state.h"

namespace kavu {

// The descriptive-words test on field 5 (trims it in MangTruong).
bool DescriptiveWords(RunState& st);

// The code and note of the current detail record, as the coordinate text
// file shows them.
std::pair<std::string, std::string> CodeAndNote(RunState& st);

// A prism height as the record listings write it.
std::string PrismText(double ccg);

void GhiMangSoLieuVaoSoDo(RunState& st);

}  // namespace kavu
