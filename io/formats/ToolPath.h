#pragma once

#include <cstddef>
#include <string>

#include "io/formats/GCode.h"
#include "io/pieces/Shapes.h"

namespace Vorn::IO {

/// Writes a tool path from rounded numbers only: what it remembers is what the machine knows.
class ToolPath {
 public:
  /// An empty path; the contour serves the messages and the digits.
  ToolPath(ContourFile const& contour, GCodeOptions const& options);

  /// Adds a line as it stands.
  void Line(std::string const& line) { text_ += line + "\n"; }

  /// A rapid move to the point, over the part where the options name a height; nothing when the
  /// tool stands there.
  void MoveTo(XY const& point);

  /// Cuts along the piece from where the tool stands. `number` is for messages, from 1.
  void Cut(Piece const& piece, std::size_t number);

  /// Leaves the part where the options name a height.
  void Retract();

  /// Whether anything was cut so far.
  bool HasCut() const { return hasCut_; }
  /// What was written so far.
  std::string const& Text() const { return text_; }

 private:
  /// Says that the contour cannot be written.
  [[noreturn]] void Refuse(std::string const& message) const;
  /// A number with the digits of the path.
  std::string Written(double value) const;
  /// The number as it is written.
  double Rounded(double value) const;
  /// The point as it is written.
  XY Rounded(XY const& point) const;
  /// Two words of one letter and one coordinate each.
  std::string Words(char first, char second, XY const& values) const;
  /// The words for the end of a move.
  std::string EndWords(XY const& to) const;
  /// The words for the way to the centre.
  std::string CenterWords(XY const& to, XY const& way) const;
  /// The word for a feed; empty where it is the one that holds already.
  std::string FeedWord(double feed);
  /// The same for the feed of cuts.
  std::string CutFeedWord();
  /// Brings the tool down where it is up.
  void Plunge();
  /// The way from the tool to the centre in the digits written: the one with the best radii at both
  /// ends.
  XY WayToCenter(Piece const& arc, XY const& to) const;
  /// The radius at the end of an arc, as a controller reckons it from rounded words.
  double RadiusAt(XY const& to, XY const& way) const;
  /// Cuts an arc; false when it is better written as a line.
  bool CutArc(Piece const& arc, XY const& to, std::size_t number);

  std::string path_;
  GCodeOptions options_;
  int decimals_;
  double step_;                ///< of the last digit
  double largestRadiusError_;  ///< in the units of the contour
  std::string text_;
  double feedSaid_ = 0.0;  ///< the last F word; 0: none yet
  XY at_;
  bool isPlaced_ = false;
  bool isDown_ = false;
  bool hasCut_ = false;
};

}  // namespace Vorn::IO
