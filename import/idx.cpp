#include "import/converters.h"

namespace kavu {

// Not converted yet: an empty field book.
std::string ConvertIdx(std::string_view) { return {}; }

}  // namespace kavu
