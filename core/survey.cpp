#include "core/survey.h"

#include <array>
#include <cstring>

#include "core/messages.h"
#include "core/numbers.h"
#include "core/text.h"

namespace kavu {

namespace {
}  // namespace

// A million points and their report lines fit in little memory.
static_assert(sizeof(ComputedPoint) <= 40);
static_assert(sizeof(ReportEntry) <= 16);

std::string_view Survey::Record(const ComputedPoint& point) const {
  const std::string_view rest = Text(point.record, std::string_view::npos);
  std::size_t end = 0;
  while (end < rest.size() && rest[end] != '\r' && rest[end] != '\n') ++end;
  return rest.substr(0, end);
}

std::uint64_t Survey::KeepRecord(std::string_view record) {
  const std::uint64_t at = Keep(record);
  made.push_back('\n');
  return at;
}

std::string_view Survey::Text(std::uint64_t at, std::size_t size) const {
  if (at < book.size()) return std::string_view(book).substr(at, size);
  return std::string_view(made).substr(at - book.size(), size);
}

std::uint64_t Survey::Keep(std::string_view text) {
  const std::uint64_t at = book.size() + made.size();
  made.append(text);
  return at;
}

Survey::PointTexts Survey::Texts(const ComputedPoint& point) const {
  // The record's first fields, in one pass up to its line end.
  std::array<std::string_view, 7> f;
  RecordFields(Text(point.record, std::string_view::npos), f);
  const bool peg = point.kind() == PointKind::Peg;
  return {(peg ? f[5] : f[0]).substr(0, kNameWidth), point.words ? f[5] : std::string_view(),
          point.words || peg ? f[6] : std::string_view(), f[4]};
}

double Survey::Prism(const ComputedPoint& point) const { return Val(Texts(point).prism); }

void Survey::AppendText(std::string& out, const ReportEntry& entry) const {
  const std::string_view name = Point(entry);
  if (entry.message == 0) {
    std::uint32_t size = 0;
    std::memcpy(&size, Text(entry.at - sizeof size, sizeof size).data(), sizeof size);
    out.append(Text(entry.at + entry.size, size));
    return;
  }
  AppendPointLine(out, name, msg::kPointMessages[entry.message - 1]);
}

void AppendPointLine(std::string& out, std::string_view name, std::string_view message) {
  out.append(msg::kPoint);
  out.append(name);
  if (name.size() < kNameWidth) out.append(kNameWidth - name.size(), ' ');
  out.append(message);
}

std::string Survey::TextOf(const ReportEntry& entry) const {
  std::string text;
  AppendText(text, entry);
  return text;
}

ComputedPoint& Survey::AddPoint(std::string_view record, PointKind kind, double x, double y) {
  ComputedPoint point;
  point.record = KeepRecord(record);
  point.SetKind(kind);
  point.x = x;
  point.y = y;
  points.push_back(point);
  return points.back();
}

void Survey::AddReport(std::string_view text, std::string_view point, std::size_t line,
                       bool counted) {
  ReportEntry entry;
  const std::string_view name = TrimView(point);
  const auto size = static_cast<std::uint32_t>(text.size());
  char sizeBytes[sizeof size];
  std::memcpy(sizeBytes, &size, sizeof size);
  Keep(std::string_view(sizeBytes, sizeof size));
  entry.at = Keep(name);
  Keep(text);
  entry.size = static_cast<std::uint32_t>(name.size());
  entry.line = static_cast<std::uint32_t>(line);
  entry.counted = counted ? 1 : 0;
  report.push_back(entry);
}

}  // namespace kavu
