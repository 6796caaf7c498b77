// Every instrument converter and the field-book splitter must end on any
// bytes, without reading outside their input.
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

#include "core/lines.h"
#include "core/numbers.h"
#include "core/text.h"
#include "import/converters.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::string_view bytes(reinterpret_cast<const char*>(data), size);
  for (int kind : {1, 7, 8}) (void)kavu::ConvertSdr(bytes, kind);
  (void)kavu::ConvertObs(bytes, 2);
  (void)kavu::ConvertSet(bytes);
  (void)kavu::ConvertIdx(bytes);
  (void)kavu::ConvertTcm(bytes);
  for (std::string line : kavu::SplitLines(bytes)) {
    line = kavu::Trim(line);
    for (const std::string& field : kavu::SplitFields(line)) {
      (void)kavu::Mask(kavu::Val(field), "#######.000");
    }
  }
  return 0;
}
