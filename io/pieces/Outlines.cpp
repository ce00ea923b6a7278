#include "vorn/io/Outlines.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <deque>
#include <map>
#include <optional>
#include <utility>

#include "io/pieces/Shapes.h"

namespace Vorn::IO {

namespace {

/// One end of one piece.
struct End {
  std::size_t piece = 0;
  bool isStart = true;
};

/// Finds the ends near a place. Cells are as wide as the tolerance, so that only the cell of the
/// place and its neighbours need a look.
class EndIndex {
 public:
  EndIndex(std::vector<Piece> const& pieces, double tolerance)
      : pieces_(pieces), tolerance_(tolerance), isUsed_(pieces.size(), false) {
    for (std::size_t i = 0; i < pieces.size(); ++i) {
      ends_.emplace(CellOf(pieces[i].start), End{i, true});
      ends_.emplace(CellOf(pieces[i].end), End{i, false});
    }
  }

  bool IsUsed(std::size_t piece) const { return isUsed_[piece]; }
  void Use(std::size_t piece) { isUsed_[piece] = true; }

  /// The end of an unused piece at the place: the first such piece of the file, its start before
  /// its end if `wantsStart`.
  std::optional<End> Find(XY const& place, bool wantsStart) const {
    std::optional<End> best;
    Cell const middle = CellOf(place);
    for (std::int64_t i = -1; i <= 1; ++i) {
      for (std::int64_t k = -1; k <= 1; ++k) {
        auto const [begin, end] = ends_.equal_range({middle.first + i, middle.second + k});
        for (auto at = begin; at != end; ++at) Consider(at->second, place, wantsStart, &best);
      }
    }
    return best;
  }

 private:
  using Cell = std::pair<std::int64_t, std::int64_t>;

  Cell CellOf(XY const& place) const {
    return {static_cast<std::int64_t>(std::floor(place.x / tolerance_)),
            static_cast<std::int64_t>(std::floor(place.y / tolerance_))};
  }

  void Consider(End const& end, XY const& place, bool wantsStart, std::optional<End>* best) const {
    Piece const& piece = pieces_[end.piece];
    XY const& at = end.isStart ? piece.start : piece.end;
    if (isUsed_[end.piece] || !(Distance(at, place) <= tolerance_)) return;
    auto const rank = [&](End const& e) { return std::pair(e.isStart != wantsStart, e.piece); };
    if (!*best || rank(end) < rank(**best)) *best = end;
  }

  std::vector<Piece> const& pieces_;
  double tolerance_;
  std::vector<bool> isUsed_;
  std::multimap<Cell, End> ends_;
};

/// Grows a chain at both ends, from its first piece on.
std::deque<Piece> ChainFrom(std::size_t first, std::vector<Piece> const& pieces, double tolerance,
                            EndIndex* ends) {
  ends->Use(first);
  std::deque<Piece> chain = {pieces[first]};
  auto const isClosed = [&] {
    return Distance(chain.back().end, chain.front().start) <= tolerance;
  };
  while (!isClosed()) {
    std::optional<End> const next = ends->Find(chain.back().end, true);
    if (!next) break;
    ends->Use(next->piece);
    chain.push_back(next->isStart ? pieces[next->piece] : Reversed(pieces[next->piece]));
  }
  while (!isClosed()) {
    std::optional<End> const before = ends->Find(chain.front().start, false);
    if (!before) break;
    ends->Use(before->piece);
    chain.push_front(before->isStart ? Reversed(pieces[before->piece]) : pieces[before->piece]);
  }
  return chain;
}

/// Whether a ray from the place to the right crosses the stretch from a to b.
bool IsCrossed(XY const& a, XY const& b, XY const& place) {
  if ((a.y > place.y) == (b.y > place.y)) return false;
  return a.x + (place.y - a.y) / (b.y - a.y) * (b.x - a.x) > place.x;
}

bool Encloses(ContourFile const& outline, XY const& place) {
  constexpr int kPartsOfArc = 64;
  bool isInside = false;
  for (Piece const& piece : outline.pieces) {
    int const parts = piece.IsArc() ? kPartsOfArc : 1;
    XY from = piece.start;
    for (int i = 1; i <= parts; ++i) {
      XY const to = i == parts ? piece.end : PointOnArc(piece, piece.sweep * i / parts);
      if (IsCrossed(from, to, place)) isInside = !isInside;
      from = to;
    }
  }
  return isInside;
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
  Extent const extent = ExtentOf(pieces);
  double const size = std::max(extent.high.x - extent.low.x, extent.high.y - extent.low.y);
  return std::max(kPartOfSize * size, JointTolerance(pieces));
}

std::vector<ContourFile> OutlinesOf(ContourFile const& contour) {
  double const tolerance = ChainTolerance(contour.pieces);
  if (!(tolerance > 0.0)) return {contour};
  EndIndex ends(contour.pieces, tolerance);
  std::vector<ContourFile> outlines;
  for (std::size_t i = 0; i < contour.pieces.size(); ++i) {
    if (ends.IsUsed(i)) continue;
    std::deque<Piece> const chain = ChainFrom(i, contour.pieces, tolerance, &ends);
    ContourFile outline = contour;
    outline.pieces.assign(chain.begin(), chain.end());
    outline.isClosed =
        chain.size() > 1 && Distance(chain.back().end, chain.front().start) <= tolerance;
    outlines.push_back(std::move(outline));
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
  std::vector<std::size_t> depths(outlines.size());
  for (std::size_t i = 0; i < outlines.size(); ++i) {
    if (!outlines[i].isClosed) continue;
    for (std::size_t k = 0; k < outlines.size(); ++k) {
      bool const isAround =
          k != i && outlines[k].isClosed && Encloses(outlines[k], outlines[i].pieces.front().start);
      if (isAround) ++depths[i];
    }
  }
  return depths;
}

}  // namespace Vorn::IO
