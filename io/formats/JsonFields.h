#pragma once

#include <cstddef>
#include <nlohmann/json.hpp>
#include <string>
#include <string_view>
#include <utility>

#include "vorn/io/Failure.h"

/// What the readers of JSON documents have in common.
namespace Vorn::IO {

/// The document.
/// @throws Failure (FailureKind::File) with line and column where the text is no JSON or nested
///         deeper than any document that is read here.
nlohmann::json ParsedJson(std::string_view text, std::string const& path);

/// Where a document comes from, for messages.
struct JsonSource {
  std::string file;
  std::string_view text;
};

/// One value of the document, with the way to it for messages: `elements[2].end.x`.
class JsonField {
 public:
  /// The document and its source must outlive the field.
  JsonField(nlohmann::json const& value, std::string name, JsonSource const& source)
      : value_(value), name_(std::move(name)), source_(source) {}

  /// Ends the reading with a message about this value that names its line and column.
  [[noreturn]] void Refuse(std::string const& message, Remedy help = Remedy::None) const;

  /// Whether the value is an object that holds something other than null under the key.
  bool Has(char const* key) const;

  /// What an object holds under the key; refused where that is missing.
  JsonField operator[](char const* key) const;

  /// How many items an array has.
  std::size_t Count() const;

  /// An item of an array, below Count().
  JsonField Item(std::size_t index) const;

  /// A number that can be a coordinate.
  double Number() const;

  /// The number under the key of an object, if it is there.
  double NumberOr(char const* key, double otherwise) const;

  /// A text.
  std::string Word() const;

  /// true or false.
  bool Truth() const;

  /// The value as it may stand in a message.
  std::string Text() const;

 private:
  nlohmann::json const& value_;
  std::string name_;
  JsonSource const& source_;
};

}  // namespace Vorn::IO
