// All pairs of pieces but for those that are apart: what the plain loops over all pairs ask, with
// fewer questions.

#pragma once

#include <cstddef>
#include <utility>
#include <vector>

#include "geometry/contours/near/BoxTree.h"
#include "geometry/contours/near/PieceExtents.h"

namespace Vorn::Contours {

/// Calls test(i, k) for pairs i < k of pieces until it answers true, and returns whether it did.
/// All pairs are tested but for those that have no common point and, if neighbours are left out,
/// some or all pairs (i, i + 1).
template <typename Test>
bool AnyPair(std::vector<Piece> const& pieces, Neighbours neighbours, Test const& test) {
  PieceExtents finder({&pieces});
  Extents extents = finder.Take(0);
  for (std::size_t const odd : extents.irregular) {
    for (std::size_t i = 0; i < odd; ++i) {
      if (test(i, odd)) return true;
    }
    for (std::size_t k = odd + 1; k < pieces.size(); ++k) {
      if (test(odd, k)) return true;
    }
  }
  BoxTree tree(std::move(extents.all), finder.SlantedMargin());
  return tree.AnyPair(test, neighbours);
}

/// The same for all pairs of one of the first and one of the second pieces.
template <typename Test>
bool AnyPair(std::vector<Piece> const& first, std::vector<Piece> const& second, Test const& test) {
  PieceExtents finder({&first, &second});
  Extents firstExtents = finder.Take(0);
  Extents secondExtents = finder.Take(1);
  for (std::size_t const odd : firstExtents.irregular) {
    for (std::size_t k = 0; k < second.size(); ++k) {
      if (test(odd, k)) return true;
    }
  }
  for (std::size_t const odd : secondExtents.irregular) {
    for (std::size_t i = 0; i < first.size(); ++i) {
      if (test(i, odd)) return true;
    }
  }
  BoxTree tree(std::move(firstExtents.all), finder.SlantedMargin());
  BoxTree otherTree(std::move(secondExtents.all), finder.SlantedMargin());
  return tree.AnyPair(otherTree, test);
}

}  // namespace Vorn::Contours
