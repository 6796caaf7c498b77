#include "products/pegs.h"

namespace kavu {

void WritePegFileHead(RunState&) {}

void incocphu(RunState&) {}

}  // namespace kavu
