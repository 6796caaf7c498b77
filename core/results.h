// Recording a computed detail point for the products.
#pragma once

#include "core/state.h"

namespace kavu {

// The descriptive-words test on field 5 (trims it in MangTruong).
bool DescriptiveWords(RunState& st);

void GhiMangToaDoChiTiet(RunState& st);
void GhiMangSoLieuToaDo(RunState& st);
void GhiMangSoLieuVaoSoDo(RunState& st);

}  // namespace kavu
