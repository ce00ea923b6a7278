#pragma once

#include <string>
#include <vector>

namespace Vorn::IO {

/// A word that a template writes in braces, and what stands in its place.
struct NamedField {
  std::string name;
  std::string value;
};

/// The template with every {name} replaced; braces around anything else but a word stay.
/// @throws Failure (FailureKind::BadArgument) naming the fields there are for a word that is none.
std::string FilledIn(std::string const& text, std::vector<NamedField> const& fields);

/// The date of today where the program runs: "2024-05-31".
std::string Today();

}  // namespace Vorn::IO
