#pragma once

#include <array>
#include <cstdint>

#include "geometry/fewest/Columns.h"
#include "geometry/fewest/Inverse.h"

/// Polytopes in the space of the four coefficients, kept as a list of corners with their neighbours
/// and cut by one half space after another (the double description of Motzkin and others 1953, for
/// simple polytopes).
namespace Vorn::Fewest {

class Polytope {
 public:
  static constexpr int kMostCorners = 400;
  static constexpr int kMostPlanes = 512;

  /// Begins with the parallelepiped |row_j| <= limit_j. What was there before is forgotten.
  void Begin(InvertedRows const& inverted, std::array<double, 4> const& limits);

  /// Where Form(c, c) is largest: at a corner or inside an edge, since the form has one negative
  /// direction only and so no largest value inside a face of two dimensions.
  struct Peak {
    Circle circle;
    double form = -1.0;
  };
  /// Form -1 when the polytope is empty or the form is nowhere above that.
  Peak FindPeak() const;

  /// Cuts off row > limit. Answers false when there is no room for the new corners or the new
  /// plane; the polytope is then as before.
  bool Cut(Row const& row, double limit);

  /// Whether nothing is left.
  bool IsEmpty() const { return count_ == 0; }
  /// Number of corners.
  int CornerCount() const { return count_; }

 private:
  struct Corner {
    Circle at;
    /// The four half spaces whose boundaries meet here, and the corner reached by leaving each.
    std::array<std::int16_t, 4> planes;
    std::array<std::int16_t, 4> neighbours;
  };

  /// The boundary of a half space: row = limit.
  struct Plane {
    Row row;
    double limit = 0.0;
  };

  /// Notes the boundary row = limit; there must be room.
  void AddPlane(Row const& row, double limit);
  /// Places a corner where its four planes meet, rounded on its own planes and not on the way
  /// between its neighbours; leaves it where they depend on each other.
  void Sharpen(Corner* corner) const;
  /// Adds a corner on every edge from a kept corner to one that is cut off, and counts them; -1,
  /// and nothing changed, when there is no room.
  void AddCornersOnEdges(std::array<double, kMostCorners> const& excess, int* added);
  /// Adds the corner at a share of the edge that leads from a corner off one of its planes.
  void AddCorner(int from, int plane, double share);
  /// Takes the new corners out again; links of kept corners to them go back to the corners cut off.
  void RemoveAdded(int firstNew);
  /// Links the new corners with each other.
  void LinkNewCorners(int firstNew);
  /// Links two new corners if they share, besides the new plane, two of the three others.
  void LinkIfNeighbours(int i, int k);
  /// Takes out the old corners of positive excess and renumbers the links.
  void RemoveCut(std::array<double, kMostCorners> const& excess, int oldCount);

  std::array<Corner, kMostCorners> corners_;
  std::array<Plane, kMostPlanes> planes_;
  int count_ = 0;
  int planeCount_ = 0;
};

}  // namespace Vorn::Fewest
