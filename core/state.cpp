#include "core/state.h"

#include <algorithm>
#include <functional>
#include <iterator>
#include <optional>

#include "core/messages.h"
#include "core/text.h"

namespace kavu {

void ReportError(RunState& st, std::string_view line, std::string_view point) {
  ++st.err;
  st.survey.AddReport(line, point, st.line);
}

namespace {

// Where text stands within whole, if it does.
std::optional<std::uint64_t> Within(std::string_view whole, std::string_view text) {
  const std::less_equal<const char*> notAfter;
  if (notAfter(whole.data(), text.data()) &&
      notAfter(text.data() + text.size(), whole.data() + whole.size())) {
    return static_cast<std::uint64_t>(text.data() - whole.data());
  }
  return std::nullopt;
}

}  // namespace

std::uint64_t Place(RunState& st, std::string_view text) {
  if (const auto at = Within(st.dong, text)) {
    if (!st.dongKept) {
      st.dongAt = st.survey.KeepRecord(st.dong);
      st.dongKept = true;
    }
    return st.dongAt + *at;
  }
  if (const auto at = Within(st.survey.book, text)) return *at;
  if (const auto at = Within(st.survey.made, text)) return st.survey.book.size() + *at;
  return st.survey.Keep(text);
}

void ReportPoint(RunState& st, std::string_view name, std::string_view message) {
  ++st.err;
  // Right-trimmed, the name in its 12 columns stands as it was; a name with
  // spaces in front is named trimmed, so its line is kept as it stands.
  const std::string_view shown = name.substr(0, name.find_last_not_of(' ') + 1);
  const auto* const found =
      std::find(std::begin(msg::kPointMessages), std::end(msg::kPointMessages), message);
  if (shown.empty() || shown.front() == ' ' || found == std::end(msg::kPointMessages)) {
    std::string text;
    AppendPointLine(text, name, message);
    st.survey.AddReport(text, name, st.line);
    return;
  }
  ReportEntry entry;
  entry.at = Place(st, shown);
  entry.size = static_cast<std::uint32_t>(shown.size());
  entry.line = static_cast<std::uint32_t>(st.line);
  entry.message = static_cast<std::uint8_t>(found - std::begin(msg::kPointMessages) + 1);
  st.survey.report.push_back(entry);
}

}  // namespace kavu
