#include "core/text.h"

namespace kavu {

std::string_view TrimView(std::string_view text) {
  const std::size_t first = text.find_first_not_of(' ');
  if (first == std::string_view::npos) return {};
  const std::size_t last = text.find_last_not_of(' ');
  return text.substr(first, last - first + 1);
}

std::string Trim(std::string_view text) { return std::string(TrimView(text)); }

std::string Upper(std::string_view text) {
  std::string out(text);
  for (char& c : out) {
    if (c >= 'a' && c <= 'z') c = static_cast<char>(c - 'a' + 'A');
  }
  return out;
}

std::string FixedWidth(std::string_view text, std::size_t width) {
  std::string out;
  AppendFixed(out, text, width);
  return out;
}

std::string NumberWidth(std::string_view text, std::size_t width) {
  std::string out(text);
  PadBehind(out, 0, width);
  return out;
}

void PadBehind(std::string& out, std::size_t from, std::size_t width) {
  const std::size_t size = out.size() - from;
  if (size < width) out.append(width - size, ' ');
}

void PadInFront(std::string& out, std::size_t from, std::size_t width) {
  const std::size_t size = out.size() - from;
  if (size < width) out.insert(from, width - size, ' ');
}

void AppendFixed(std::string& out, std::string_view text, std::size_t width) {
  const std::size_t from = out.size();
  out.append(text.substr(0, width));
  PadBehind(out, from, width);
}

namespace {

// The decision is taken on the untrimmed length, the padding on the trimmed
// text: ' ab ' in 5 gives '   ab'.
std::string Align(std::string_view text, int width, bool right) {
  if (width < 0 || text.size() >= static_cast<std::size_t>(width)) return std::string(text);
  const std::string_view core = TrimView(text);
  const std::string pad(static_cast<std::size_t>(width) - core.size(), ' ');
  return right ? pad + std::string(core) : std::string(core) + pad;
}

}  // namespace

std::string RString(std::string_view text, int width) { return Align(text, width, true); }

std::string LString(std::string_view text, int width) { return Align(text, width, false); }

std::string NumberColumn(std::string_view text, int width) {
  std::string out = RString(TrimView(text), width);
  if (out.empty() || out.front() != ' ') out.insert(0, 1, ' ');
  return out;
}

int KTraCCG(std::string_view text) {
  for (const char c : TrimView(text)) {
    if (!((c >= '0' && c <= '9') || c == '.')) return 1;
  }
  return 0;
}

namespace {

// Tabs turned into spaces and runs of spaces reduced to one, in place.
void Normalise(std::string& line) {
  std::size_t size = 0;
  for (char c : line) {
    if (c == '\t') c = ' ';
    if (c == ' ' && size > 0 && line[size - 1] == ' ') continue;
    line[size++] = c;
  }
  line.resize(size);
}

template <typename Add>
void EachField(std::string_view text, Add add) {
  if (text.empty()) return;
  std::size_t start = 0;
  for (std::size_t i = 0; i < text.size(); ++i) {
    if (text[i] == ' ') {
      add(text.substr(start, i - start));
      start = i + 1;
    }
  }
  add(text.substr(start));
}

}  // namespace

void SplitFields(std::string& line, std::vector<std::string_view>& fields) {
  fields.clear();
  // Most lines are already normal: split in the pass that finds it out.
  const std::string_view text = line;
  std::size_t start = 0;
  for (std::size_t i = 0; i < text.size(); ++i) {
    const char c = text[i];
    if (c == '\t' || (c == ' ' && i > 0 && text[i - 1] == ' ')) {
      Normalise(line);
      fields.clear();
      EachField(line, [&](std::string_view field) { fields.push_back(field); });
      return;
    }
    if (c == ' ') {
      fields.push_back(text.substr(start, i - start));
      start = i + 1;
    }
  }
  if (!text.empty()) fields.push_back(text.substr(start));
}

std::vector<std::string> SplitFields(std::string& line) {
  Normalise(line);
  std::vector<std::string> fields;
  EachField(line, [&](std::string_view field) { fields.emplace_back(field); });
  return fields;
}

std::string_view RecordField(std::string_view record, std::size_t k) {
  std::size_t start = 0;
  for (; k > 0; --k) {
    const std::size_t space = record.find(' ', start);
    if (space == std::string_view::npos) return {};
    start = space + 1;
  }
  if (start > record.size()) return {};
  return record.substr(start, record.find(' ', start) - start);
}

}  // namespace kavu
