// Choices among points by their distance or direction from a centre that is known up to an error,
// and whether they would be the same for every centre within that error.

#pragma once

#include <algorithm>
#include <cmath>
#include <limits>

#include "geometry/cells/fast/CellSequence.h"
#include "geometry/elementary/Angles.h"
#include "geometry/elementary/Points.h"
#include "geometry/fitting/runs/Runs.h"
#include "math/NumericConstants.h"

namespace Vorn::Fitting {

/// The first of the candidates with the least value, and how far behind the next one is.
template <typename Candidate>
struct Choice {
  /// Takes one more candidate into account.
  void Offer(double value, Candidate const& candidate) {
    bool const isBetter = count == 0 || value < least;
    if (count > 0) runnerUp = std::min(runnerUp, isBetter ? least : value);
    if (isBetter) {
      least = value;
      best = candidate;
    }
    ++count;
  }

  /// By how much the next candidate's value is above the least; infinite for a single candidate.
  double Lead() const { return runnerUp - least; }

  Candidate best{};
  double least = 0.0;
  double runnerUp = std::numeric_limits<double>::infinity();
  int count = 0;
};

/// The angle between two directions, from 0 to pi.
inline double AngleBetween(double direction, double other) {
  double const difference = std::fabs(direction - other);
  return difference > Numeric::kTruncatedPi ? Numeric::kTruncatedTwoPi - difference : difference;
}

/// A centre that is known up to an error, and by how much what is measured from it may change.
class UncertainCentre {
 public:
  /// For a centre that is off by no more than its error.
  explicit UncertainCentre(Cells::RoughCentre const& centre)
      : at_(centre.at), error_(centre.error) {}

  /// Where it is thought to be.
  Point const& At() const { return at_; }

  /// Whether the centre is the true one: then every choice is the true one.
  bool IsExact() const { return error_ == 0.0; }

  /// The squared distance of a point from where it is thought to be.
  double SquaredDistanceTo(Point const& p) const { return Elementary::SquaredDistance(p, at_); }

  /// The polar angle of a point as seen from there.
  double DirectionTo(Point const& p) const { return Elementary::AngleAbout(at_, p); }

  /// By how much two squared distances up to the largest one may change against each other with a
  /// centre within the error, their rounding included; several times over. A distance d changes by
  /// the error e at most, its square by e * (2 * d + e), and two squares by twice that.
  double SquaredDistanceSlack(double largest2) const {
    double const distance = std::sqrt(largest2);
    return kSafety * (error_ + kRounding * distance) * (distance + error_);
  }

  /// The same for the directions of two points no nearer than this one: seen from a point at the
  /// distance d, a centre that moves by e turns the direction by e / d, to first order.
  double DirectionSlack(Point const& p) const {
    return kSafety * (error_ / std::sqrt(SquaredDistanceTo(p)) + kRounding);
  }

  /// Whether the directions of two points differ by more than they may change.
  bool AreClearlyApart(Point const& p, Point const& q) const {
    return AngleBetween(DirectionTo(p), DirectionTo(q)) > DirectionSlack(p) + DirectionSlack(q);
  }

 private:
  /// More than all roundings of a distance or of a direction together, relative to it: each is made
  /// of fewer than ten operations, and 2^-48 is 32 roundings of 2^-53.
  static constexpr double kRounding = 0x1p-48;
  /// Above the factors of the first-order bounds (4 for squared distances, 2 for directions), with
  /// room for the terms of higher order.
  static constexpr double kSafety = 16.0;

  Point at_;
  double error_;
};

}  // namespace Vorn::Fitting
