#include "products/sketch.h"

namespace kavu {

void insodo(RunState&) {}

}  // namespace kavu
