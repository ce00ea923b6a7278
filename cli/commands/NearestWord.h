#pragma once

#include <optional>
#include <string>
#include <vector>

#include "cli/base/Library.h"

namespace Vorn::Cli {

/// The word that the text was probably meant to be: the one that the fewest letters must be added
/// to, taken from, replaced in or exchanged with their neighbours. Nothing when that is more than a
/// third of the letters of the word and more than one.
std::optional<std::string> NearestWord(std::string const& text,
                                       std::vector<std::string> const& words);

}  // namespace Vorn::Cli
