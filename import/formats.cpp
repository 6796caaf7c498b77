#include "import/formats.h"

#include <array>
#include <charconv>

namespace kavu {
namespace {

Conversion Set(std::string_view content, int) { return ConvertSet(content); }
Conversion Idx(std::string_view content, int) { return ConvertIdx(content); }
Conversion Tcm(std::string_view content, int) { return ConvertTcm(content); }

// The spaces of the list texts line the patterns up in the list's font.
constexpr std::array<Format, 10> kFormats{{
    {"asc", "Số liệu sổ đo                    [*.asc]", "ASC", "*.asc", "field book", nullptr},
    {"sdr", "Số liệu FieldBook SDR     [*.sdr]", "SDR", "*.sdr", "SDR field book", ConvertSdr},
    {"obs", "Số liệu FieldBook Sokki   [*.obs]", "OBS", "*.obs", "Sokkia field book", ConvertObs},
    {"set", "Số liệu máy SET               [*.set]", "SET", "*.set", "SET file", Set},
    {"raw", "Số liệu máy Geodimet      [*.raw]", "RAW", "*.raw", "RAW (NAME.asc must exist)",
     nullptr},
    {"idx", "Số liệu máy Topcom         [*.idx]", "IDX", "*.idx", "Topcom keyword file", Idx},
    {"tcm", "Số liệu máy Topcom 226  [*.tcm]", "TCM", "*.tcm", "Topcom 226 column file", Tcm},
    {"gre", "Số liệu máy LEICA Wid     [*.gre]", "GRE", "*.gre", "GRE (SDR records)", ConvertSdr},
    {"dn7", "Số liệu máy NIKON           [*.dn7]", "DN7", "*.dn7", "DN7 (NAME.asc must exist)",
     nullptr},
    {"other", "Số liệu khác                      [*.*]", "", "*.*",
     "any other file (NAME.asc must exist)", nullptr},
}};

}  // namespace

std::span<const Format> Formats() { return kFormats; }

int LastFormatIndex() { return static_cast<int>(kFormats.size()) - 1; }

const Format* FormatAt(int index) {
  if (index < 0 || index > LastFormatIndex()) return nullptr;
  return &kFormats[static_cast<std::size_t>(index)];
}

std::optional<int> FormatIndexOf(std::string_view nameOrIndex) {
  for (std::size_t k = 0; k < kFormats.size(); ++k) {
    if (kFormats[k].name == nameOrIndex) return static_cast<int>(k);
  }
  int index = -1;
  const char* end = nameOrIndex.data() + nameOrIndex.size();
  const auto [at, ec] = std::from_chars(nameOrIndex.data(), end, index);
  if (ec != std::errc{} || at != end || nameOrIndex.empty() || FormatAt(index) == nullptr) {
    return std::nullopt;
  }
  return index;
}

int KindOfExtension(std::string_view upperExtension) {
  for (std::size_t k = 0; k + 1 < kFormats.size(); ++k) {
    if (kFormats[k].extension == upperExtension) return static_cast<int>(k);
  }
  return LastFormatIndex();
}

std::string_view PatternOfKind(int kind) {
  const Format* format = FormatAt(kind);
  return format != nullptr ? format->pattern : "*.*";
}

}  // namespace kavu
