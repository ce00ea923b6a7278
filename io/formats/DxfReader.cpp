// DXF: from the entities of a drawing to the pieces of a contour.
#include <algorithm>
#include <cmath>
#include <numbers>
#include <set>

#include "io/formats/Dxf.h"
#include "io/formats/DxfCurves.h"
#include "io/formats/DxfEntities.h"
#include "io/formats/Text.h"
#include "io/pieces/Shapes.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

using Dxf::Entity;
using Dxf::Group;

constexpr double kRadians = std::numbers::pi / 180.0;

/// Ends of entities are one point when they are as near as this, as a part of the whole drawing;
/// files with six digits pass.
constexpr double kSamePoint = 1e-6;

constexpr int kIsClosed = 1;
constexpr int kIs3d = 8;
constexpr int kIsMesh = 16 + 64;
constexpr int kIsSplineFrame = 16;

/// The pieces of one entity.
struct Stretch {
  std::vector<Piece> pieces;
  bool hasSense = true;

  XY const& Start() const { return pieces.front().start; }
  XY const& End() const { return pieces.back().end; }
};

struct Vertex {
  XY at;
  double bulge = 0.0;
};

bool IsPassedOver(Entity const& entity) {
  static std::set<std::string_view> const kAnnotations = {"ATTDEF", "DIMENSION", "LEADER",  "MTEXT",
                                                          "POINT",  "TEXT",      "VIEWPORT"};
  constexpr int kInPaperSpace = 67;
  return kAnnotations.count(entity.Type()) > 0 || entity.FlagsOr(kInPaperSpace, 0) == 1;
}

/// Whether its places are told in the plane of the entity, not in that of the drawing.
bool IsInOwnPlane(Entity const& entity) {
  return entity.Type() != "LINE" && entity.Type() != "ELLIPSE" && entity.Type() != "SPLINE";
}

/// Whether the entity is drawn on the back of the plane, where x runs the other way.
bool IsMirrored(Entity const& entity) {
  double const z = entity.NumberOr(230, 1.0);
  bool const isFlat = entity.NumberOr(210, 0.0) == 0.0 && entity.NumberOr(220, 0.0) == 0.0;
  if (!isFlat || z == 0.0) entity.Refuse("is not in the plane of x and y");
  return z < 0.0;
}

Stretch LineOf(Entity const& entity) {
  XY const start = {entity.Number(10), entity.Number(20)};
  XY const end = {entity.Number(11), entity.Number(21)};
  if (entity.NumberOr(30, 0.0) != entity.NumberOr(31, 0.0)) entity.Refuse("is not flat in z");
  return {{MakeLine(start, end)}};
}

double RadiusOf(Entity const& entity) {
  double const radius = entity.Number(40);
  if (!(radius > 0.0)) entity.Refuse("radius " + FormatExact(radius) + " is not above 0");
  return radius;
}

XY OnCircle(XY const& center, double radius, double degrees) {
  // The ends of the axes are exact.
  double const turned = std::remainder(degrees, 360.0);
  if (turned == 0.0) return {center.x + radius, center.y};
  if (turned == 90.0) return {center.x, center.y + radius};
  if (turned == -90.0) return {center.x, center.y - radius};
  if (std::fabs(turned) == 180.0) return {center.x - radius, center.y};
  return {center.x + radius * std::cos(turned * kRadians),
          center.y + radius * std::sin(turned * kRadians)};
}

Stretch ArcOf(Entity const& entity) {
  XY const center = {entity.Number(10), entity.Number(20)};
  double const radius = RadiusOf(entity);
  XY const start = OnCircle(center, radius, entity.Number(50));
  XY const end = OnCircle(center, radius, entity.Number(51));
  if (AreEqual(start, end)) return {MakeCircle(start, center, radius, true), false};
  return {{MakeArc(start, end, center, radius, true)}, false};
}

Stretch CircleOf(Entity const& entity) {
  XY const center = {entity.Number(10), entity.Number(20)};
  double const radius = RadiusOf(entity);
  return {MakeCircle(OnCircle(center, radius, 0.0), center, radius, true), false};
}

Stretch PolylineOf(Entity const& entity, std::vector<Vertex> vertices, bool isClosed) {
  if (vertices.size() < 2) entity.Refuse("has fewer than two vertices");
  Stretch stretch;
  // A closed polyline may repeat its first vertex at its end.
  if (isClosed && !AreEqual(vertices.front().at, vertices.back().at)) {
    vertices.push_back(vertices.front());
  }
  for (std::size_t i = 1; i < vertices.size(); ++i) {
    Vertex const& from = vertices[i - 1];
    stretch.pieces.push_back(MakeBulge(from.at, vertices[i].at, from.bulge));
  }
  return stretch;
}

Stretch LightPolylineOf(Entity const& entity) {
  std::vector<Vertex> vertices;
  for (Group const& group : entity.Groups()) {
    if (group.code == 10) vertices.push_back({{entity.NumberOf(group), 0.0}});
    if (vertices.empty()) continue;
    if (group.code == 20) vertices.back().at.y = entity.NumberOf(group);
    if (group.code == 42) vertices.back().bulge = entity.NumberOf(group);
  }
  auto const count = static_cast<double>(vertices.size());
  double const stated = entity.NumberOr(90, count);
  if (stated != count) {
    entity.Refuse("has " + FormatExact(count) + " vertices and says " + FormatExact(stated));
  }
  return PolylineOf(entity, vertices, (entity.FlagsOr(70, 0) & kIsClosed) != 0);
}

void Mirror(Stretch* stretch) {
  for (Piece& piece : stretch->pieces) {
    auto const mirrored = [](XY const& point) { return XY{-point.x, point.y}; };
    XY const start = mirrored(piece.start);
    XY const end = mirrored(piece.end);
    double const sweep = piece.sweep;
    piece = piece.IsArc()
                ? MakeArc(start, end, mirrored(piece.center), piece.radius, !piece.counterClockwise)
                : MakeLine(start, end);
    piece.sweep = sweep;
  }
}

/// Goes through the entities of a drawing.
class Reader {
 public:
  Reader(Dxf::Drawing const& drawing, ReadOptions const& options)
      : entities_(drawing.entities), flattening_{options.flattening}, arcs_(options.arcs) {}

  std::vector<Stretch> Read() {
    std::vector<Stretch> stretches;
    while (next_ < entities_.size()) {
      Entity const& entity = entities_[next_++];
      if (IsPassedOver(entity)) {
        if (entity.Type() == "POLYLINE") Vertices();
        continue;
      }
      stretches.push_back(StretchOf(entity));
      if (IsInOwnPlane(entity) && IsMirrored(entity)) Mirror(&stretches.back());
      RequireSameHeight(entity);
      if (arcs_ == ArcUse::Refuse) RefuseArcs(entity, stretches.back());
    }
    return stretches;
  }

 private:
  static void RefuseArcs(Entity const& entity, Stretch const& stretch) {
    for (Piece const& piece : stretch.pieces) {
      if (piece.IsArc()) entity.Refuse(DescribeArc(piece), Remedy::FlattenCurves);
    }
  }

  Stretch StretchOf(Entity const& entity) {
    if (entity.Type() == "LINE") return LineOf(entity);
    if (entity.Type() == "ARC") return ArcOf(entity);
    if (entity.Type() == "CIRCLE") return CircleOf(entity);
    if (entity.Type() == "LWPOLYLINE") return LightPolylineOf(entity);
    if (entity.Type() == "POLYLINE") return HeavyPolylineOf(entity);
    if (entity.Type() == "ELLIPSE") return {Dxf::EllipsePieces(entity, &flattening_)};
    if (entity.Type() == "SPLINE") return {Dxf::SplinePieces(entity, &flattening_)};
    entity.Refuse("is none of LINE, ARC, CIRCLE, LWPOLYLINE, POLYLINE, ELLIPSE and SPLINE");
  }

  Stretch HeavyPolylineOf(Entity const& entity) {
    int const flags = entity.FlagsOr(70, 0);
    if ((flags & kIsMesh) != 0) entity.Refuse("is a mesh");
    std::vector<Vertex> vertices;
    for (Entity const& vertex : Vertices()) {
      if ((vertex.FlagsOr(70, 0) & kIsSplineFrame) != 0) continue;
      vertices.push_back({{vertex.Number(10), vertex.Number(20)}, vertex.NumberOr(42, 0.0)});
      if ((flags & kIs3d) != 0) RequireSameHeight(vertex);
    }
    return PolylineOf(entity, vertices, (flags & kIsClosed) != 0);
  }

  /// The vertices that follow; the end of the sequence is passed.
  std::vector<Entity> Vertices() {
    std::vector<Entity> vertices;
    while (next_ < entities_.size() && entities_[next_].Type() == "VERTEX") {
      vertices.push_back(entities_[next_++]);
    }
    if (next_ == entities_.size() || entities_[next_].Type() != "SEQEND") {
      entities_[next_ - 1].Refuse("the sequence of vertices has no SEQEND");
    }
    ++next_;
    return vertices;
  }

  void RequireSameHeight(Entity const& entity) {
    if (entity.Type() == "POLYLINE" && (entity.FlagsOr(70, 0) & kIs3d) != 0) return;
    double const height = entity.NumberOr(entity.Type() == "LWPOLYLINE" ? 38 : 30, 0.0);
    if (hasHeight_ && height != height_) {
      entity.Refuse("z is " + FormatExact(height) + ", but " + FormatExact(height_) + " before");
    }
    hasHeight_ = true;
    height_ = height;
  }

  std::vector<Entity> const& entities_;
  Flattening flattening_;
  ArcUse arcs_;
  std::size_t next_ = 0;
  bool hasHeight_ = false;
  double height_ = 0.0;
};

void Reverse(Stretch* stretch) {
  std::reverse(stretch->pieces.begin(), stretch->pieces.end());
  for (Piece& piece : stretch->pieces) piece = Reversed(piece);
}

/// Whether the stretch fits the other way round, given how far off it is as it is and turned.
bool FitsReversed(Stretch const& stretch, double kept, double reversed, double samePoint) {
  if (stretch.hasSense) return reversed <= samePoint && kept > samePoint;
  return reversed + samePoint < kept;
}

/// Turns stretches round where that makes them follow each other.
void Align(std::vector<Stretch>* stretches, double samePoint) {
  for (std::size_t i = 0; i < stretches->size(); ++i) {
    Stretch& stretch = (*stretches)[i];
    double kept = 0.0;
    double reversed = 0.0;
    if (i > 0) {
      XY const& from = (*stretches)[i - 1].End();
      kept = Distance(from, stretch.Start());
      reversed = Distance(from, stretch.End());
    } else if (stretches->size() > 1) {
      // The first one must end where the second begins, whichever way that will run.
      Stretch const& next = (*stretches)[1];
      auto const toNext = [&](XY const& end) {
        return std::min(Distance(end, next.Start()), Distance(end, next.End()));
      };
      kept = toNext(stretch.End());
      reversed = toNext(stretch.Start());
    }
    if (FitsReversed(stretch, kept, reversed, samePoint)) Reverse(&stretch);
  }
}

std::vector<Piece> Joined(std::vector<Stretch> const& stretches) {
  std::vector<Piece> pieces;
  for (Stretch const& stretch : stretches) {
    pieces.insert(pieces.end(), stretch.pieces.begin(), stretch.pieces.end());
  }
  return pieces;
}

}  // namespace

ContourFile ParseDxf(std::string_view text, std::string const& path, ReadOptions const& options) {
  Dxf::Drawing const drawing = Dxf::ReadDrawing(text, path);
  std::vector<Stretch> stretches = Reader(drawing, options).Read();
  ContourFile contour;
  contour.units = drawing.units;
  if (stretches.empty()) return contour;
  Extent const extent = ExtentOf(Joined(stretches));
  Align(&stretches, kSamePoint * Distance(extent.low, extent.high));
  contour.pieces = Joined(stretches);
  contour.isClosed = ReturnsToStart(contour.pieces);
  return contour;
}

}  // namespace Vorn::IO
