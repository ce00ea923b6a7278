#include "io/base/Fields.h"

#include <algorithm>
#include <string>

#include "io/base/Words.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

constexpr std::string_view kBlanks = " \t";
constexpr char kQuote = '"';

/// Where the search for the separator behind a field begins: behind its closing quote, if the
/// field is in quotes.
std::size_t StartOfSearch(std::string_view text) {
  std::size_t const first = text.find_first_not_of(kBlanks);
  if (first == std::string_view::npos || text[first] != kQuote) return 0;
  std::size_t const closing = text.find(kQuote, first + 1);
  return closing == std::string_view::npos ? 0 : closing + 1;
}

std::string WithoutQuotedText(std::string_view line) {
  // A single one is no quotation but, say, the sign for inches.
  if (std::count(line.begin(), line.end(), kQuote) % 2 != 0) return std::string(line);
  std::string bare;
  bool isQuoted = false;
  for (char const c : line) {
    if (c == kQuote) isQuoted = !isQuoted;
    bare += isQuoted ? kQuote : c;
  }
  return bare;
}

bool AnyHolds(std::vector<std::string_view> const& fields, std::string_view characters) {
  return std::any_of(fields.begin(), fields.end(), [&](std::string_view field) {
    return field.find_first_of(characters) != std::string_view::npos;
  });
}

/// Whether a line with commas and blanks makes sense as numbers between blanks only.
bool AreDecimalsBetweenBlanks(std::string_view line) {
  std::vector<std::string_view> fields;
  SplitFields(line, ',', &fields);
  if (!AnyHolds(fields, kBlanks)) return false;
  SplitFields(line, ' ', &fields);
  return std::all_of(fields.begin(), fields.end(), [](std::string_view field) {
    return ParseNumber(field, DecimalMark::Comma).has_value();
  });
}

bool AreTabsWithinFields(std::string_view line) {
  std::vector<std::string_view> fields;
  SplitFields(line, ',', &fields);
  return AnyHolds(fields, "\t");
}

void SplitAtBlanks(std::string_view line, std::vector<std::string_view>* fields) {
  while (!(line = Trimmed(line)).empty()) {
    std::size_t end = StartOfSearch(line);
    while (end < line.size() && line[end] != ' ' && line[end] != '\t') ++end;
    fields->push_back(line.substr(0, end));
    line.remove_prefix(end);
  }
}

}  // namespace

char FindSeparator(std::string_view line) {
  std::string const bare = WithoutQuotedText(line);
  auto const has = [&](char c) { return bare.find(c) != std::string::npos; };
  if (has(';')) return ';';
  if (!has(',')) return has('\t') ? '\t' : ' ';
  if (has('\t')) return AreTabsWithinFields(bare) ? '\t' : ',';
  return AreDecimalsBetweenBlanks(bare) ? ' ' : ',';
}

void SplitFields(std::string_view line, char separator, std::vector<std::string_view>* fields) {
  fields->clear();
  if (separator == ' ') return SplitAtBlanks(line, fields);
  for (std::size_t end = 0; end != std::string_view::npos;) {
    end = line.find(separator, StartOfSearch(line));
    fields->push_back(Trimmed(line.substr(0, end)));
    if (end != std::string_view::npos) line.remove_prefix(end + 1);
  }
}

std::string_view Unquoted(std::string_view field) {
  bool const isQuoted = field.size() >= 2 && field.front() == kQuote && field.back() == kQuote;
  return isQuoted ? Trimmed(field.substr(1, field.size() - 2)) : field;
}

}  // namespace Vorn::IO
