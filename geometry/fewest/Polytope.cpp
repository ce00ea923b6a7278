#include "geometry/fewest/Polytope.h"

#include <cmath>

namespace Vorn::Fewest {

namespace {

constexpr std::int16_t kNone = -1;

std::size_t At(int i) { return static_cast<std::size_t>(i); }

Circle Difference(Circle const& c, Circle const& o) {
  return {c.a - o.a, c.bx - o.bx, c.by - o.by, c.d - o.d};
}

}  // namespace

Polytope::Polytope(std::array<Circle, 4> const& inverse, std::array<double, 4> const& limits) {
  for (int mask = 0; mask < 16; ++mask) {
    Corner& corner = corners_[At(mask)];
    corner.at = {};
    for (int j = 0; j < 4; ++j) {
      bool const isPlus = (mask >> j & 1) != 0;
      Circle const& column = inverse[At(j)];
      double const factor = isPlus ? limits[At(j)] : -limits[At(j)];
      corner.at = {corner.at.a + factor * column.a, corner.at.bx + factor * column.bx,
                   corner.at.by + factor * column.by, corner.at.d + factor * column.d};
      corner.planes[At(j)] = static_cast<std::int16_t>(2 * j + (isPlus ? 1 : 0));
      corner.neighbours[At(j)] = static_cast<std::int16_t>(mask ^ (1 << j));
    }
  }
  count_ = 16;
}

Polytope::Peak Polytope::FindPeak() const {
  Peak peak;
  for (int i = 0; i < count_; ++i) {
    Corner const& corner = corners_[At(i)];
    double const form = Form(corner.at, corner.at);
    if (form > peak.form) peak = {corner.at, form};
    for (std::int16_t n : corner.neighbours) {
      if (n <= i) continue;  // Each edge once; n is kNone only where rounding broke a link.
      Circle const along = Difference(corners_[At(n)].at, corner.at);
      double const curvature = Form(along, along);
      double const slope = Form(corner.at, along);
      if (!(curvature < 0.0) || !(slope > 0.0) || !(slope < -curvature)) continue;
      Circle const inside = Between(corner.at, corners_[At(n)].at, -slope / curvature);
      double const formInside = Form(inside, inside);
      if (formInside > peak.form) peak = {inside, formInside};
    }
  }
  return peak;
}

bool Polytope::Cut(Row const& row, double limit) {
  std::array<double, kMostCorners> excess;
  bool isCut = false;
  for (int i = 0; i < count_; ++i) {
    excess[At(i)] = Apply(row, corners_[At(i)].at) - limit;
    isCut = isCut || excess[At(i)] > 0.0;
  }
  if (!isCut) return true;
  int const oldCount = count_;
  int added = 0;
  AddCornersOnEdges(excess, &added);
  if (added < 0) return false;
  ++planeCount_;
  LinkNewCorners(oldCount);
  RemoveCut(excess, oldCount);
  return true;
}

void Polytope::AddCornersOnEdges(std::array<double, kMostCorners> const& excess, int* added) {
  int const oldCount = count_;
  for (int i = 0; i < oldCount; ++i) {
    if (excess[At(i)] > 0.0) continue;
    for (int j = 0; j < 4; ++j) {
      std::int16_t const n = corners_[At(i)].neighbours[At(j)];
      if (n < 0 || n >= oldCount || !(excess[At(n)] > 0.0)) continue;
      if (count_ == kMostCorners) {
        RemoveAdded(oldCount);
        *added = -1;
        return;
      }
      AddCorner(i, j, excess[At(i)] / (excess[At(i)] - excess[At(n)]));
      ++*added;
    }
  }
}

/// Adds the corner at a share of the edge that leads from a corner off one of its planes.
void Polytope::AddCorner(int from, int plane, double share) {
  Corner& old = corners_[At(from)];
  Corner& fresh = corners_[At(count_)];
  std::int16_t const n = old.neighbours[At(plane)];
  fresh.at = Between(old.at, corners_[At(n)].at, share);
  int kept = 0;
  for (int k = 0; k < 4; ++k) {
    if (k != plane) fresh.planes[At(kept++)] = old.planes[At(k)];
  }
  fresh.planes[3] = planeCount_;
  // Leaving the new plane leads back to the kept corner; the others are linked later. Until then
  // two of them remember the edge for RemoveAdded().
  fresh.neighbours = {static_cast<std::int16_t>(plane), n, kNone, static_cast<std::int16_t>(from)};
  old.neighbours[At(plane)] = static_cast<std::int16_t>(count_);
  ++count_;
}

/// The links of kept corners to the new ones go back to the corners cut off.
void Polytope::RemoveAdded(int firstNew) {
  for (int k = firstNew; k < count_; ++k) {
    Corner const& made = corners_[At(k)];
    corners_[At(made.neighbours[3])].neighbours[At(made.neighbours[0])] = made.neighbours[1];
  }
  count_ = firstNew;
}

void Polytope::LinkNewCorners(int firstNew) {
  for (int i = firstNew; i < count_; ++i) {
    Corner& corner = corners_[At(i)];
    corner.neighbours[0] = corner.neighbours[1] = corner.neighbours[2] = kNone;
  }
  for (int i = firstNew; i < count_; ++i) {
    for (int k = i + 1; k < count_; ++k) LinkIfNeighbours(i, k);
  }
}

/// Neighbours share the new plane and two of the three others.
void Polytope::LinkIfNeighbours(int i, int k) {
  Corner& one = corners_[At(i)];
  Corner& other = corners_[At(k)];
  int oneLeaves = -1;
  int shared = 0;
  bool isOtherShared[3] = {false, false, false};
  for (int p = 0; p < 3; ++p) {
    bool isFound = false;
    for (int q = 0; q < 3; ++q) {
      if (one.planes[At(p)] == other.planes[At(q)]) isFound = isOtherShared[q] = true;
    }
    if (isFound) {
      ++shared;
    } else {
      oneLeaves = p;
    }
  }
  if (shared != 2) return;
  int const otherLeaves = !isOtherShared[0] ? 0 : !isOtherShared[1] ? 1 : 2;
  one.neighbours[At(oneLeaves)] = static_cast<std::int16_t>(k);
  other.neighbours[At(otherLeaves)] = static_cast<std::int16_t>(i);
}

void Polytope::RemoveCut(std::array<double, kMostCorners> const& excess, int oldCount) {
  std::array<std::int16_t, kMostCorners> place;
  std::int16_t kept = 0;
  for (int i = 0; i < count_; ++i) {
    bool const isCut = i < oldCount && excess[At(i)] > 0.0;
    place[At(i)] = isCut ? kNone : kept;
    if (!isCut) corners_[At(kept++)] = corners_[At(i)];
  }
  count_ = kept;
  for (int i = 0; i < count_; ++i) {
    for (std::int16_t& n : corners_[At(i)].neighbours) n = n < 0 ? kNone : place[At(n)];
  }
}

}  // namespace Vorn::Fewest
