// The kinds of input the program reads, in one table: the window's kind
// list, the batch command's --kind, the dispatch, the help, the manual page
// and the fuzz target all read it. A new format is one reader and one row.
#pragma once

#include <optional>
#include <span>
#include <string_view>

#include "import/converters.h"

namespace kavu {

struct Format {
  std::string_view name;       // short name for --kind ("sdr")
  std::string_view listText;   // the window's kind list (UTF-8)
  std::string_view extension;  // upper case, without the dot; empty: any other file
  std::string_view pattern;    // the file lists' pattern ("*.sdr")
  std::string_view about;      // what the file is, in a few words (help texts)
  // The reader that turns the file into a field book, given its index; none
  // for the kinds whose field book NAME.asc must already exist.
  Conversion (*convert)(std::string_view content, int kind) = nullptr;
};

// Every format, by its index in the kind list. The first is the field book
// itself, the last any other file.
std::span<const Format> Formats();
// The format of an index; none outside the table.
const Format* FormatAt(int index);
// The index of a format named by its short name or by its index ("sdr", "1").
std::optional<int> FormatIndexOf(std::string_view nameOrIndex);
// The highest index of the kind list.
int LastFormatIndex();

// Index in the kind list of an upper-case extension ("SDR" -> 1); the last
// (any other file) for an extension of no format.
int KindOfExtension(std::string_view upperExtension);
// The file pattern of a kind ("*.sdr"); "*.*" outside the table.
std::string_view PatternOfKind(int kind);

}  // namespace kavu
