#include "import/converters.h"

namespace kavu {

// Not converted yet: an empty field book.
std::string ConvertObs(std::string_view, int) { return {}; }

}  // namespace kavu
