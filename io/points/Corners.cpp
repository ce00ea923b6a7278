#include "vorn/io/Corners.h"

#include <algorithm>
#include <cmath>
#include <numbers>

#include "vorn/io/Spacing.h"

namespace Vorn::IO {

namespace {

/// The turn between two chords of 25 times the noise has a standard deviation of sqrt(6) / 25
/// radians, 5.6 degrees: kLeastCorner is more than five of them away.
constexpr double kReachPerNoise = 25.0;

std::vector<double> PlacesAlong(std::vector<WPoint> const& points) {
  std::vector<double> places(points.size());
  for (std::size_t i = 1; i < points.size(); ++i) {
    places[i] = places[i - 1] + Distance(points[i - 1], points[i]);
  }
  return places;
}

Corner CornerAt(std::vector<WPoint> const& points, std::size_t before, std::size_t at,
                std::size_t after) {
  constexpr double kHalfTurn = 180.0;  // in degrees
  double const inX = points[at].x - points[before].x;
  double const inY = points[at].y - points[before].y;
  double const outX = points[after].x - points[at].x;
  double const outY = points[after].y - points[at].y;
  double const turn = std::atan2(inX * outY - inY * outX, inX * outX + inY * outY);
  return {at, std::fabs(turn) * kHalfTurn / std::numbers::pi, turn > 0.0};
}

/// Every point with a turn of a corner, however near to the next such point.
std::vector<Corner> SharpTurns(std::vector<WPoint> const& points, std::vector<double> const& places,
                               double reach) {
  std::vector<Corner> turns;
  auto const isFar = [&](std::size_t from, std::size_t to) {
    double const distance = places[to] - places[from];
    return distance >= reach && distance > 0.0;
  };
  std::size_t before = 0;
  std::size_t after = 0;
  for (std::size_t at = 0; at < points.size(); ++at) {
    while (before + 1 < at && isFar(before + 1, at)) ++before;
    while (after < points.size() && !isFar(at, after)) ++after;
    if (after == points.size()) break;
    if (!isFar(before, at)) continue;
    // Of points in one place the first stands for all.
    if (places[at] == places[at - 1]) continue;
    Corner const turn = CornerAt(points, before, at, after);
    if (turn.degrees >= kLeastCorner) turns.push_back(turn);
  }
  return turns;
}

/// Of turns that follow each other within the reach the sharpest.
std::vector<Corner> Merged(std::vector<Corner> const& turns, std::vector<double> const& places,
                           double reach) {
  std::vector<Corner> corners;
  for (std::size_t i = 0; i < turns.size(); ++i) {
    bool const isNew = i == 0 || places[turns[i].point] - places[turns[i - 1].point] > reach;
    if (isNew) {
      corners.push_back(turns[i]);
    } else if (turns[i].degrees > corners.back().degrees) {
      corners.back() = turns[i];
    }
  }
  return corners;
}

/// The turns of the middle one of three rounds, from one on that is not within the reach of the one
/// before: what belongs together must not be torn apart where the round begins.
std::vector<Corner> TurnsOfOneRound(std::vector<Corner> const& turns,
                                    std::vector<double> const& places, double reach,
                                    std::size_t round) {
  std::vector<Corner> chosen;
  for (Corner const& turn : turns) {
    if (turn.point >= round && turn.point < 2 * round) chosen.push_back(turn);
  }
  auto const apart =
      std::adjacent_find(chosen.begin(), chosen.end(), [&](Corner const& turn, Corner const& next) {
        return places[next.point] - places[turn.point] > reach;
      });
  if (apart == chosen.end()) return chosen;
  for (auto turn = chosen.begin(); turn <= apart; ++turn) turn->point += round;
  std::rotate(chosen.begin(), apart + 1, chosen.end());
  return chosen;
}

std::vector<Corner> CornersOfRound(std::vector<WPoint> points, double reach) {
  bool const repeatsFirst =
      points.front().x == points.back().x && points.front().y == points.back().y;
  if (repeatsFirst) points.pop_back();
  std::size_t const round = points.size();
  points.reserve(3 * round);
  for (std::size_t i = 0; i < 2 * round; ++i) points.push_back(points[i]);
  std::vector<double> const places = PlacesAlong(points);
  if (round == 0 || !(places[round] > 2.0 * reach)) return {};
  std::vector<Corner> corners = Merged(
      TurnsOfOneRound(SharpTurns(points, places, reach), places, reach, round), places, reach);
  for (Corner& corner : corners) corner.point %= round;
  std::sort(corners.begin(), corners.end(),
            [](Corner const& a, Corner const& b) { return a.point < b.point; });
  return corners;
}

}  // namespace

std::vector<Corner> FindCorners(std::vector<WPoint> const& points, double reach, bool isClosed) {
  if (points.empty()) return {};
  if (isClosed) return CornersOfRound(points, reach);
  std::vector<double> const places = PlacesAlong(points);
  return Merged(SharpTurns(points, places, reach), places, reach);
}

double ReachForNoise(double noise) { return kReachPerNoise * noise; }

}  // namespace Vorn::IO
