#include "io/drawing/SvgPieces.h"

#include <numbers>

#include "io/drawing/Decimation.h"
#include "io/drawing/Labels.h"
#include "io/drawing/Style.h"
#include "io/drawing/SvgElements.h"
#include "io/drawing/SvgPaths.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO::Svg {

namespace {

/// More pieces are drawn as one path of each kind.
constexpr std::size_t kMostSinglePieces = 2000;

std::string PieceTitle(Drawing const& drawing, std::size_t i) {
  Piece const& piece = drawing.pieces[i];
  std::string title = std::to_string(i + 1) + ": ";
  if (piece.IsArc()) {
    title += "arc, radius " + FormatShort(piece.radius) + ", " +
             FormatShort(piece.sweep * 180.0 / std::numbers::pi) + " degrees";
  } else {
    title += "line, length " + FormatShort(piece.length);
  }
  return title;
}

std::string StrokeOf(Piece const& piece) {
  return "stroke=\"" + ColorOf(piece) + "\"" + (piece.IsArc() ? " " + kArcDashes : "");
}

std::string SinglePieces(Scene const& scene) {
  std::string svg;
  for (std::size_t i = 0; i < scene.drawing.pieces.size(); ++i) {
    Piece const& piece = scene.drawing.pieces[i];
    svg += "<path " + StrokeOf(piece) + " d=\"" + PathData({piece}, scene.view) + "\"><title>" +
           Escaped(PieceTitle(scene.drawing, i)) + "</title></path>\n";
  }
  return svg;
}

std::string MergedPieces(Scene const& scene) {
  std::vector<Piece> lines;
  std::vector<Piece> arcs;
  for (Piece const& piece : scene.drawing.pieces) (piece.IsArc() ? arcs : lines).push_back(piece);
  std::string svg;
  for (std::vector<Piece> const& pieces : {lines, arcs}) {
    if (!pieces.empty()) {
      svg += PathElement(PathData(pieces, scene.view), StrokeOf(pieces.front()));
    }
  }
  return svg;
}

}  // namespace

std::string Pieces(Scene const& scene) {
  bool const areFew = scene.drawing.pieces.size() <= kMostSinglePieces;
  return "<g class=\"pieces\" fill=\"none\" stroke-width=\"" + Px(kContourWidth) +
         "\" stroke-linejoin=\"round\">\n" + (areFew ? SinglePieces(scene) : MergedPieces(scene)) +
         "</g>\n";
}

std::string Joints(Scene const& scene) {
  std::vector<Piece> const& pieces = scene.drawing.pieces;
  double const radius = pieces.size() > 60 ? 2.2 : 3.4;
  std::vector<Pixel> joints;
  for (std::size_t i = 1; i < pieces.size(); ++i) {
    joints.push_back(scene.view(pieces[i].start.x, pieces[i].start.y));
  }
  std::string svg =
      "<g class=\"joints\" fill=\"white\" stroke=\"" + kTextColor + "\" stroke-width=\"1\">\n";
  for (std::size_t const i : OnePerCell(joints, 1.0)) svg += CircleElement(joints[i], radius, "");
  return svg + "</g>\n";
}

std::string PieceLabels(Scene const& scene) {
  bool const areSized = scene.drawing.pieces.size() <= kMostSizedLabels;
  double const band = scene.IsBandVisible()
                          ? scene.magnify * scene.drawing.LargestTolerance() * scene.view.Scale()
                          : 0.0;
  Labels labels(scene.view, band);
  for (std::size_t const i : OnePerCell(scene.magnified, 2.0)) labels.Take(scene.magnified[i]);
  for (Piece const& piece : scene.drawing.pieces) labels.TakePiece(piece);
  if (scene.IsMeasured()) labels.TakeRing(scene.magnified[scene.drawing.Worst()], kWorstRadius);
  std::string svg = "<g font-size=\"11\" text-anchor=\"middle\" class=\"halo\">\n";
  for (std::size_t i = 0; i < scene.drawing.pieces.size(); ++i) {
    Piece const& piece = scene.drawing.pieces[i];
    svg += areSized ? labels.AddAnywhere(piece, LabelOf(piece, i + 1))
                    : labels.AddBeside(piece, std::to_string(i + 1));
  }
  return svg + "</g>\n";
}

}  // namespace Vorn::IO::Svg
