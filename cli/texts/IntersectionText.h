#pragma once

#include <string>
#include <vector>

#include "cli/base/Library.h"
#include "vorn/io/Intersections.h"

namespace Vorn::Cli {

/// For people. Without `b` the intersections are those of `a` with itself.
std::string ToText(std::vector<Intersection> const& found, ContourFile const& a,
                   ContourFile const* b);

}  // namespace Vorn::Cli
