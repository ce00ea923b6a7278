#pragma once

#include <string>

#include "vorn/io/Pieces.h"

/// What the writers of all versions of DXF have in common.
namespace Vorn::IO::Dxf {

inline constexpr char const* kContourLayer = "CONTOUR";
inline constexpr char const* kHoleLayer = "CONTOUR_HOLES";
inline constexpr char const* kLineLayer = "CONTOUR_LINES";
inline constexpr char const* kArcLayer = "CONTOUR_ARCS";

/// Colours by their numbers.
inline constexpr int kRed = 1;
inline constexpr int kBlue = 5;
inline constexpr int kBlackOrWhite = 7;

/// The text of a file, group by group.
class Writer {
 public:
  /// A group: the code and the value, a line for each.
  void Group(int code, std::string const& value);
  /// A group with a number that reads back to the same bits, without an exponent.
  void Number(int code, double value);

  /// x and y under `code` and `code` + 10.
  void Flat(int code, XY const& point);

  /// The same and a z of 0.
  void At(int code, XY const& point);

  /// Centre and radius of the arc.
  void Circle(Piece const& arc);

  /// Where the arc begins and ends, in degrees counter-clockwise.
  void Angles(Piece const& arc);

  /// A section up to End().
  void Begin(std::string const& section);
  /// Ends the section begun last.
  void End();

  /// Begins an entity of R12 on a layer.
  void Entity(std::string const& type, std::string const& layer);

  /// All groups so far.
  std::string const& Text() const { return text_; }

 private:
  std::string text_;
};

/// Whether the piece can be an ARC: two equal angles would be read as a full circle.
bool IsWrittenAsArc(Piece const& piece);

}  // namespace Vorn::IO::Dxf
