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
  void TakePiece(Piece const& piece);

  /// The text element beside the piece; nothing when there is no room.
  std::string Add(Piece const& piece, std::string const& text);

 private:
  bool IsFree(Rect const& rect) const;
  /// Whether another piece runs between the anchor and a label this far away.
  bool IsCutOff(Anchor const& anchor, double side, double distance) const;

  View const& view_;
  double band_;
  std::vector<Rect> pieces_;
  std::vector<Rect> taken_;
};

/// "3: R 12.5" for an arc, "4: 20.1" for a line: the number and the size.
std::string LabelOf(Piece const& piece, std::size_t number);

}  // namespace Vorn::IO::Svg
