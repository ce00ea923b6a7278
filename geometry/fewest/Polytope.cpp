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

void Polytope::Begin(InvertedRows const& inverted, std::array<double, 4> const& limits) {
  planeCount_ = 0;
  for (std::size_t j = 0; j < 4; ++j) {
    AddPlane(Negated(inverted.rows[j]), limits[j]);
    AddPlane(inverted.rows[j], limits[j]);
  }
  for (int mask = 0; mask < 16; ++mask) {
    Corner& corner = corners_[At(mask)];
    std::array<double, 4> values;
    for (int j = 0; j < 4; ++j) {
      bool const isPlus = (mask >> j & 1) != 0;
      values[At(j)] = isPlus ? limits[At(j)] : -limits[At(j)];
      corner.planes[At(j)] = static_cast<std::int16_t>(2 * j + (isPlus ? 1 : 0));
      corner.neighbours[At(j)] = static_cast<std::int16_t>(mask ^ (1 << j));
    }
    corner.at = Solve(inverted, values);
  }
  count_ = 16;
}

void Polytope::AddPlane(Row const& row, double limit) { planes_[At(planeCount_++)] = {row, limit}; }

/// Places a corner where its four planes meet. Between its neighbours it is known only to the
/// rounding of the larger of them, which is a million units where the box bounds the polytope: rows
/// of 1 / w would then be missed by 1e6 / w units in the last place, far more than the slack of a
/// proof. On its own planes it misses each row by a few units in the last place of the row's terms
/// at the corner, which is what the slack of the programmes allows for.
void Polytope::Sharpen(Corner* corner) const {
  InvertedRows inverted;
  std::array<double, 4> limits;
  for (std::size_t k = 0; k < 4; ++k) {
    Plane const& plane = planes_[At(corner->planes[k])];
    inverted.rows[k] = plane.row;
    limits[k] = plane.limit;
  }
  if (InvertRows(inverted.rows, &inverted.inverse)) corner->at = Solve(inverted, limits);
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
  if (planeCount_ == kMostPlanes) return false;
  AddPlane(row, limit);
  int const oldCount = count_;
  int added = 0;
  AddCornersOnEdges(excess, &added);
  if (added < 0) {
    --planeCount_;
    return false;
  }
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

void Polytope::AddCorner(int from, int plane, double share) {
  Corner& old = corners_[At(from)];
  Corner& fresh = corners_[At(count_)];
  std::int16_t const n = old.neighbours[At(plane)];
  fresh.at = Between(old.at, corners_[At(n)].at, share);
  int kept = 0;
  for (int k = 0; k < 4; ++k) {
    if (k != plane) fresh.planes[At(kept++)] = old.planes[At(k)];
  }
  fresh.planes[3] = static_cast<std::int16_t>(planeCount_ - 1);
  Sharpen(&fresh);
  // Leaving the new plane leads back to the kept corner; the others are linked later. Until then
  // two of them remember the edge for RemoveAdded().
  fresh.neighbours = {static_cast<std::int16_t>(plane), n, kNone, static_cast<std::int16_t>(from)};
  old.neighbours[At(plane)] = static_cast<std::int16_t>(count_);
  ++count_;
}

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
