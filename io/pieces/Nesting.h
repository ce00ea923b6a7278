#pragma once

#include <cstddef>
#include <vector>

#include "vorn/io/ContourFile.h"

namespace Vorn::IO {

/// For each outline the closed ones that it lies in, in their order; nothing for open ones.
/// Outlines must not cross.
std::vector<std::vector<std::size_t>> ContainersOf(std::vector<ContourFile> const& outlines);

/// A closed outline with those that are cut out of it.
struct Face {
  std::size_t outer = 0;
  std::vector<std::size_t> holes;
};

/// The closed outlines as faces: those that lie in an even number of others have holes, which lie
/// in one more and in them.
std::vector<Face> FacesOf(std::vector<ContourFile> const& outlines);

}  // namespace Vorn::IO
