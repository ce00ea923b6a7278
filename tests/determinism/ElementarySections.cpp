#include <array>
#include <cstdint>

#include "determinism/Digest.h"
#include "determinism/Inputs.h"
#include "determinism/Sections.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Testing {

namespace {

using Point = GeometryUtils::Point;

constexpr int kRounds = 4000;

/// Both ends of two points in the order in which the outputs were named.
template <typename Call>
void AddTwoPoints(Call const& call, Digest* digest) {
  Point first{-1.0, -1.0};
  Point second{-1.0, -1.0};
  auto const answer = call(&first, &second);
  digest->Add(answer, first, second);
}

}  // namespace

std::uint64_t DigestAngles() {
  return DigestRounds(101, kRounds, [](Inputs* inputs, Digest* digest) {
    auto const [a, b, c, d, e, f, g] = inputs->Numbers<7>();
    bool const flag = inputs->Random().Flip();
    GeometryUtils::Arc const arc{{a, b}, {c, d}, e, flag ? 1.0 : -1.0, f, g};
    digest->Add(GeometryUtils::GetNaturalAngle(a, b), GeometryUtils::NaturalAngleToAzimuthRad(c),
                GeometryUtils::NaturalAngleToTangentialAzimuthRad(d, flag),
                GeometryUtils::SubtrAng(f, g), GeometryUtils::GetArcLength(arc),
                GeometryUtils::GetArcAngleRad(arc));
  });
}

std::uint64_t DigestDistances() {
  return DigestRounds(102, kRounds, [](Inputs* inputs, Digest* digest) {
    auto const [a, b, c, x, y] = inputs->Numbers<5>();
    auto const coords = inputs->Numbers<6>();
    WPoint const p = inputs->Measured();
    WPoint const q = inputs->Measured();
    double deviation = -1.0;
    double signedDeviation = -1.0;
    double fromCoords = -1.0;
    std::array<double, 3> line{};
    std::array<double, 3> normal{};
    std::array<double, 4> box{};
    digest->Add(GeometryUtils::GetDeviation(a, b, c, x, y, &deviation),
                GeometryUtils::GetSignedDeviation(a, b, c, x, y, &signedDeviation),
                GeometryUtils::GetDeviation(coords.data(), &fromCoords),
                GeometryUtils::IsPointValidToFit(p, q),
                GeometryUtils::GetDist2({p.x, p.y}, {q.x, q.y}),
                GeometryUtils::GetLineParameters(a, b, x, y, &line[0], &line[1], &line[2]));
    GeometryUtils::GetNormal(a, b, c, {x, y}, &normal[0], &normal[1], &normal[2]);
    GeometryUtils::GetXyminXymax(a, b, x, y, box.data());
    digest->Add(deviation, signedDeviation, fromCoords);
    for (double const value : line) digest->Add(value);
    for (double const value : normal) digest->Add(value);
    for (double const value : box) digest->Add(value);
  });
}

std::uint64_t DigestCircles() {
  return DigestRounds(103, kRounds, [](Inputs* inputs, Digest* digest) {
    auto const [a, b, c] = inputs->Points<3>();
    auto const [wa, wb, wc] = inputs->Numbers<3>();
    Point centre;
    Point otherCentre;
    double radius = -1.0;
    double otherRadius = -1.0;
    bool ccw = false;
    digest->Add(
        GeometryUtils::GetCircle(a.x, a.y, b.x, b.y, c.x, c.y, &centre.x, &centre.y, &radius),
        GeometryUtils::GetCircle(a, b, c, &otherCentre, &otherRadius),
        GeometryUtils::IsCcw(a, b, c, &ccw));
    digest->Add(centre, radius, otherCentre, otherRadius, ccw);

    WPoint circle;
    std::array<Point, 3> moved{a, b, c};
    digest->Add(GeometryUtils::GetCircle({a.x, a.y, 0.01 * wa}, {b.x, b.y, 0.01 * wb},
                                         {c.x, c.y, 0.01 * wc}, &circle, &moved[0], &moved[1],
                                         &moved[2], &ccw));
    digest->Add(circle, moved[0], moved[1], moved[2], ccw);
  });
}

std::uint64_t DigestLineIntersections() {
  return DigestRounds(104, kRounds, [](Inputs* inputs, Digest* digest) {
    auto const [p, q, r, s] = inputs->Points<4>();
    auto const [a, b, c, d, e, f] = inputs->Numbers<6>();
    Point meeting;
    Point crossing;
    Point onSegment;
    Point foot;
    digest->Add(GeometryUtils::GetLineSegmentsIntersection(p.x, p.y, q.x, q.y, r.x, r.y, s.x, s.y,
                                                           &meeting.x, &meeting.y),
                GeometryUtils::GetLinesIntersection(a, b, c, d, e, f, &crossing.x, &crossing.y),
                GeometryUtils::GetLineAndSegmentIntersection(a, b, c, p.x, p.y, q.x, q.y,
                                                             &onSegment.x, &onSegment.y),
                GeometryUtils::AreLineSegmentsIntersect(p.x, p.y, q.x, q.y, r.x, r.y, s.x, s.y),
                GeometryUtils::GetNearestPointOnLine(a, b, c, p, &foot));
    digest->Add(meeting, crossing, onSegment, foot);
  });
}

std::uint64_t DigestArcIntersections() {
  return DigestRounds(105, kRounds, [](Inputs* inputs, Digest* digest) {
    using Utils = GeometryUtils;
    auto const points = inputs->Points<4>();
    auto const line = inputs->Numbers<3>();
    auto const radii = inputs->Numbers<2>();
    auto const angles = inputs->Numbers<4>();
    auto const senses = inputs->Numbers<2>();
    Point const& p = points[0];
    Point const& q = points[1];
    Point const& c1 = points[2];
    Point const& c2 = points[3];
    AddTwoPoints(
        [&](Point* first, Point* second) {
          return Utils::GetLineSegmentAndCircleIntersection(p.x, p.y, q.x, q.y, c1.x, c1.y,
                                                            radii[0], &first->x, &first->y,
                                                            &second->x, &second->y);
        },
        digest);
    AddTwoPoints(
        [&](Point* first, Point* second) {
          return Utils::GetLineAndCircleIntersection(line[0], line[1], line[2], c1.x, c1.y,
                                                     radii[0], &first->x, &first->y, &second->x,
                                                     &second->y);
        },
        digest);
    AddTwoPoints(
        [&](Point* first, Point* second) {
          return Utils::GetLineSegmentAndCircleArcIntersection(
              p.x, p.y, q.x, q.y, c1.x, c1.y, radii[0], senses[0], angles[0], angles[1], &first->x,
              &first->y, &second->x, &second->y);
        },
        digest);
    AddTwoPoints(
        [&](Point* first, Point* second) {
          return Utils::GetCircleArcAndCircleArcIntersection(
              c1.x, c1.y, radii[0], senses[0], angles[0], angles[1], c2.x, c2.y, radii[1],
              senses[1], angles[2], angles[3], &first->x, &first->y, &second->x, &second->y);
        },
        digest);
    Point nearest;
    digest->Add(Utils::GetNearestPointOnCircle(c1, radii[0], p, &nearest), nearest);
  });
}

}  // namespace Vorn::Testing
