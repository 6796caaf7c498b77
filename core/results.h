// What a detail record holds for the products.
#pragma once

#include <string>

#include "core/state.h"

namespace kavu {

// The descriptive-words test on field 5 of the current record: a code that is
// no number, or one of at most two characters.
bool DescriptiveWords(const RunState& st);

// A prism height as the record listings write it.
std::string PrismText(double ccg);

}  // namespace kavu
