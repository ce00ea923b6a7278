#include "io/formats/GCode.h"

#include <algorithm>
#include <cmath>

#include "io/formats/LengthUnits.h"
#include "io/formats/NamedFields.h"
#include "io/formats/ToolPath.h"
#include "io/pieces/Shapes.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

using End = GCodeOptions::End;
using Plane = GCodeOptions::Plane;

constexpr int kDecimalsOfMillimetres = 4;
constexpr int kDecimalsOfInches = 5;

/// The last digit is at most a tolerance divided by ten so many times.
constexpr double kDigitsBelowTolerance = 2.0;

/// The R of an arc near half a circle says little about where the centre is; at this sweep an error
/// of R moves the centre by not more than twice as much.
constexpr double kWidestRadiusArc = 2.0943951023931953;  // 120 degrees

void WriteUnits(ContourFile const& contour, ToolPath* tool) {
  if (IsInch(contour.units)) {
    tool->Line("G20");
  } else if (IsMillimetre(contour.units)) {
    tool->Line("G21");
  } else if (contour.units.empty()) {
    tool->Line("(units not known: neither G20 nor G21)");
  } else {
    throw Failure(FailureKind::BadArgument, {contour.path},
                  "G-code is in mm or inch, and the contour is in " + Quoted(contour.units),
                  Remedy::ChooseUnits);
  }
}

void Halve(Piece const& arc, double widest, std::vector<Piece>* parts) {
  if (!arc.IsArc() || arc.sweep <= widest) {
    parts->push_back(arc);
    return;
  }
  for (Piece const& half : Halves(arc)) Halve(half, widest, parts);
}

void CutPieces(ContourFile const& contour, GCodeOptions const& options, ToolPath* tool) {
  double const tolerance = JointTolerance(contour.pieces);
  double const widest = options.useRadiusWords ? kWidestRadiusArc : kWidestArc;
  for (std::size_t i = 0; i < contour.pieces.size(); ++i) {
    Piece const& piece = contour.pieces[i];
    bool const isJoined = i > 0 && Distance(contour.pieces[i - 1].end, piece.start) <= tolerance;
    if (!isJoined) tool->MoveTo(piece.start);
    std::vector<Piece> parts;
    Halve(piece, widest, &parts);
    for (Piece const& part : parts) tool->Cut(part, i + 1);
  }
}

/// The name of a file as it may stand in a comment: a parenthesis of its own would end the comment,
/// and a controller would obey what follows.
std::string InComment(std::string text) {
  std::replace(text.begin(), text.end(), '(', '[');
  std::replace(text.begin(), text.end(), ')', ']');
  return text;
}

std::vector<NamedField> FieldsOf(ContourFile const& contour, GCodeOptions const& options) {
  double length = 0.0;
  for (Piece const& piece : contour.pieces) length += piece.length;
  auto const number = [](std::optional<double> const& value) {
    return value ? FormatShort(*value) : std::string();
  };
  return {{"name", InComment(contour.path)},
          {"units", contour.units},
          {"tolerance", number(options.tolerance)},
          {"feed", number(options.feed)},
          {"pieces", std::to_string(contour.pieces.size())},
          {"length", FormatShort(length)},
          {"date", Today()}};
}

void WriteText(std::string const& text, ToolPath* tool) {
  if (text.empty()) return;
  tool->Line(text.back() == '\n' ? text.substr(0, text.size() - 1) : text);
}

}  // namespace

int GCodeDecimals(std::string const& units, std::optional<double> tolerance) {
  int const usual = IsInch(units) ? kDecimalsOfInches : kDecimalsOfMillimetres;
  if (!tolerance || !(*tolerance >= 0.0)) return usual;
  double const needed = std::ceil(kDigitsBelowTolerance - std::log10(*tolerance));
  return static_cast<int>(std::clamp<double>(needed, usual, kMostGCodeDecimals));
}

std::string ToGCode(ContourFile const& contour, GCodeOptions const& options) {
  if (options.plane == Plane::G18 && options.safeHeight) {
    throw Failure(FailureKind::BadArgument, {contour.path},
                  "heights are for the plane of X and Y, not for X and Z");
  }
  if (options.decimals && (*options.decimals < 0 || *options.decimals > kMostGCodeDecimals)) {
    throw Failure(FailureKind::BadArgument, {contour.path},
                  "G-code has from 0 to " + std::to_string(kMostGCodeDecimals) + " decimals, not " +
                      std::to_string(*options.decimals));
  }
  std::vector<NamedField> const fields = FieldsOf(contour, options);
  ToolPath tool(contour, options);
  WriteText(FilledIn(options.header, fields), &tool);
  WriteUnits(contour, &tool);
  tool.Line(options.plane == Plane::G18 ? "G18 G90 G91.1" : "G17 G90 G91.1");
  CutPieces(contour, options, &tool);
  if (!tool.HasCut()) {
    throw Failure(FailureKind::BadArgument, {contour.path},
                  "is smaller than the last digit of the G-code");
  }
  tool.Retract();
  WriteText(FilledIn(options.footer, fields), &tool);
  if (options.end != End::None) tool.Line(options.end == End::M30 ? "M30" : "M2");
  return tool.Text();
}

}  // namespace Vorn::IO
