// Every reader of the table of formats and the field-book splitter must end on any
// bytes, without reading outside their input.
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

#include "core/lines.h"
#include "core/numbers.h"
#include "core/text.h"
#include "import/formats.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::string_view bytes(reinterpret_cast<const char*>(data), size);
  int kind = 0;
  for (const kavu::Format& format : kavu::Formats()) {
    if (format.convert != nullptr) (void)format.convert(bytes, kind);
    ++kind;
  }
  for (std::string line : kavu::SplitLines(bytes)) {
    line = kavu::Trim(line);
    for (const std::string& field : kavu::SplitFields(line)) {
      (void)kavu::Mask(kavu::Val(field), "#######.000");
    }
  }
  return 0;
}
