#include "geometry/fewest/OnePiece.h"

#include "geometry/fewest/PieceSearch.h"

namespace Vorn::Fewest {

namespace {

Chain ChainOf(Path const& path, PlacedCircle const& circle, double ratio) {
  Chain chain;
  chain.pieces.push_back({0, path.Count(), AlongPath(path, circle), ratio});
  return chain;
}

}  // namespace

PlacedCircle AlongPath(Path const& path, PlacedCircle const& circle) {
  return AdvanceAlong(path, circle, 0, path.Count(), 1) < 0.0 ? Scaled(circle, -1.0) : circle;
}

std::vector<Chain> MakeOnePiece(Path const& path, PlacedCircle const& covering) {
  constexpr double kWholeShare = 1.0;
  PieceSearch search(path, kWholeShare);
  search.MoveTo(0, path.Count());
  std::vector<Chain> chains;
  PlacedCircle const along = AlongPath(path, covering);
  PieceFit const best = search.FindBest(path.start, path.finish, {along, 1.0, false});
  if (best.isFound) chains.push_back(ChainOf(path, best.circle, best.ratio));
  chains.push_back(ChainOf(path, along, 1.0));
  return chains;
}

}  // namespace Vorn::Fewest
