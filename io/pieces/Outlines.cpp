#include "vorn/io/Outlines.h"

#include <algorithm>
#include <cmath>

#include "io/pieces/Chains.h"
#include "io/pieces/Nesting.h"
#include "io/pieces/Shapes.h"

namespace Vorn::IO {

namespace {

ContourFile OutlineOf(LinkChain const& chain, ContourFile const& contour) {
  ContourFile outline = {contour.path,      {}, false, contour.units, contour.leftOut,
                         contour.hadHeights};
  for (Link const& link : chain.links) {
    Piece const& piece = contour.pieces[link.index];
    outline.pieces.push_back(link.isReversed ? Reversed(piece) : piece);
  }
  outline.isClosed = chain.links.size() > 1 && chain.isClosed;
  return outline;
}

ContourFile Joined(std::vector<ContourFile> const& outlines) {
  ContourFile contour = outlines.front();
  for (std::size_t i = 1; i < outlines.size(); ++i) {
    contour.pieces.insert(contour.pieces.end(), outlines[i].pieces.begin(),
                          outlines[i].pieces.end());
  }
  contour.isClosed = outlines.size() == 1 && outlines.front().isClosed;
  return contour;
}

}  // namespace

double ChainTolerance(std::vector<Piece> const& pieces) {
  constexpr double kPartOfSize = 1e-6;
  if (pieces.empty()) return 0.0;
  Extent const extent = ExtentOf(pieces);
  double const size = std::max(extent.high.x - extent.low.x, extent.high.y - extent.low.y);
  return std::max(kPartOfSize * size, JointTolerance(pieces));
}

std::vector<ContourFile> OutlinesOf(ContourFile const& contour) {
  double const tolerance = ChainTolerance(contour.pieces);
  if (!(tolerance > 0.0) || !std::isfinite(tolerance)) return {contour};
  std::vector<Ends> ends;
  ends.reserve(contour.pieces.size());
  for (Piece const& piece : contour.pieces) ends.push_back({piece.start, piece.end});
  std::vector<ContourFile> outlines;
  for (LinkChain const& chain : ChainsOf(ends, tolerance)) {
    outlines.push_back(OutlineOf(chain, contour));
  }
  bool const areClosed = std::all_of(outlines.begin(), outlines.end(),
                                     [](ContourFile const& outline) { return outline.isClosed; });
  if (contour.isClosed && !areClosed) return {contour};
  return outlines;
}

ContourFile Chained(ContourFile const& contour) {
  std::vector<ContourFile> const outlines = OutlinesOf(contour);
  std::size_t const runs = ConnectedRuns(contour.pieces, ChainTolerance(contour.pieces)).size();
  return outlines.size() < runs ? Joined(outlines) : contour;
}

std::vector<std::size_t> DepthsOf(std::vector<ContourFile> const& outlines) {
  std::vector<std::size_t> depths;
  for (std::vector<std::size_t> const& around : ContainersOf(outlines)) {
    depths.push_back(around.size());
  }
  return depths;
}

}  // namespace Vorn::IO
