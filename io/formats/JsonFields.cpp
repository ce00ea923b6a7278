#include "io/formats/JsonFields.h"

#include <algorithm>
#include <optional>

#include "io/base/Words.h"
#include "io/formats/JsonPlace.h"
#include "io/formats/Text.h"
#include "io/pieces/Shapes.h"
#include "vorn/io/Messages.h"

namespace Vorn::IO {

namespace {

using nlohmann::json;

/// The documents read here are five levels deep, nested geometries some more.
constexpr std::size_t kDeepest = 64;

/// Where brackets are nested deeper than that; nothing in good documents.
std::optional<std::size_t> FindTooDeep(std::string_view text) {
  std::size_t depth = 0;
  bool isInString = false;
  for (std::size_t i = 0; i < text.size(); ++i) {
    char const c = text[i];
    if (c == '"') isInString = !isInString;
    if (isInString && c == '\\') ++i;
    if (isInString) continue;
    if (c == '[' || c == '{') ++depth;
    if ((c == ']' || c == '}') && depth > 0) --depth;
    if (depth > kDeepest) return i;
  }
  return {};
}

std::string ComplaintAt(std::string_view text, std::size_t offset) {
  if (offset >= Trimmed(text).size()) return "is not JSON to the end: the text stops early";
  std::size_t const lineEnd = text.find('\n', offset);
  return "is not JSON from here on: " + Quoted(text.substr(offset, lineEnd - offset));
}

/// The beginning of the value as JSON, a little longer than a message quotes.
std::string BeginningOf(json const& value) {
  constexpr std::size_t kEnough = 64;
  if (!value.is_structured()) return value.dump(-1, ' ', false, json::error_handler_t::replace);
  std::string text(1, value.is_array() ? '[' : '{');
  for (auto const& item : value.items()) {
    if (text.size() > kEnough) return text;
    if (text.size() > 1) text += ',';
    if (value.is_object()) text += '"' + item.key() + "\":";
    text += BeginningOf(item.value());
  }
  return text + (value.is_array() ? ']' : '}');
}

}  // namespace

nlohmann::json ParsedJson(std::string_view text, std::string const& path) {
  if (std::optional<std::size_t> const deep = FindTooDeep(text)) {
    throw Failure(FailureKind::File, PlaceIn(text, *deep, path),
                  "is nested deeper than " + std::to_string(kDeepest) + " brackets");
  }
  try {
    return json::parse(text);
  } catch (json::parse_error const& error) {
    std::size_t const offset = std::min(error.byte > 0 ? error.byte - 1 : 0, text.size());
    throw Failure(FailureKind::File, PlaceIn(text, offset, path), ComplaintAt(text, offset));
  } catch (json::exception const&) {
    RefuseFile(path, "a number is too large for a double");
  }
}

void JsonField::Refuse(std::string const& message, Remedy help) const {
  throw Failure(FailureKind::File,
                PlaceIn(source_.text, OffsetInJson(source_.text, name_), source_.file),
                name_.empty() ? message : name_ + ": " + message, help);
}

bool JsonField::Has(char const* key) const {
  return value_.is_object() && value_.contains(key) && !value_.at(key).is_null();
}

JsonField JsonField::operator[](char const* key) const {
  if (!value_.is_object()) Refuse("is not an object but " + Text());
  std::string const name = name_.empty() ? key : name_ + "." + key;
  if (!value_.contains(key)) JsonField(value_, name, source_).Refuse("is missing");
  return {value_.at(key), name, source_};
}

std::size_t JsonField::Count() const {
  if (!value_.is_array()) Refuse("is not an array but " + Text());
  return value_.size();
}

JsonField JsonField::Item(std::size_t index) const {
  return {value_.at(index), name_ + "[" + std::to_string(index) + "]", source_};
}

double JsonField::Number() const {
  if (!value_.is_number()) Refuse("is not a number but " + Text());
  double const number = value_.get<double>();
  if (!IsUsable(number)) Refuse(Text() + " is too large");
  return number;
}

double JsonField::NumberOr(char const* key, double otherwise) const {
  return Has(key) ? (*this)[key].Number() : otherwise;
}

std::string JsonField::Word() const {
  if (!value_.is_string()) Refuse("is not a text but " + Text());
  return value_.get<std::string>();
}

bool JsonField::Truth() const {
  if (!value_.is_boolean()) Refuse("is neither true nor false but " + Text());
  return value_.get<bool>();
}

std::string JsonField::Text() const { return Quoted(BeginningOf(value_)); }

}  // namespace Vorn::IO
