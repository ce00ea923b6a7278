#pragma once

#include <string>
#include <vector>

#include "io/drawing/Layout.h"

namespace Vorn::IO::Svg {

/// The point half way along the piece and the unit normal that points away from an arc's centre.
struct Anchor {
  Pixel at;
  Pixel normal;
};

/// Finds room for the labels of the pieces, on the outer side of a piece if it is free.
class Labels {
 public:
  /// Keeps off the contour by `band` pixels and some more.
  Labels(View const& view, double band) : view_(view), band_(band) {}

  /// Something is drawn here.
  void Take(Pixel const& at);
  /// The same for all of a circle, in pixels.
  void TakeRing(Pixel const& at, double radius);
  /// The same along a piece, which labels of others are not cut off by either.
  void TakePiece(Piece const& piece);

  /// The text element beside the piece; nothing when there is no room.
  std::string AddBeside(Piece const& piece, std::string const& text);

  /// The same, or farther away with a thin line to the middle of the piece.
  std::string AddAnywhere(Piece const& piece, std::string const& text);

 private:
  /// The text element in its place, which is taken from now on.
  std::string Write(Piece const& piece, Rect const& rect, std::string const& text);
  /// The label in the nearest free place around with a line to the anchor; nothing when there is
  /// none.
  std::string AddWithLeader(Piece const& piece, Anchor const& anchor, std::string const& text);
  /// Whether the place is inside the frame and nothing is drawn there.
  bool IsFree(Rect const& rect) const;
  /// Whether no piece and no label lies on the way of the line.
  bool IsLeaderFree(Pixel const& from, Pixel const& to) const;
  /// Whether another piece runs between the anchor and a label this far away.
  bool IsCutOff(Anchor const& anchor, double side, double distance) const;

  View const& view_;
  double band_;
  std::vector<Rect> pieces_;
  std::vector<Rect> taken_;
  std::vector<Rect> labels_;
};

/// "3: R 12.5" for an arc, "4: 20.1" for a line: the number and the size.
std::string LabelOf(Piece const& piece, std::size_t number);

}  // namespace Vorn::IO::Svg
