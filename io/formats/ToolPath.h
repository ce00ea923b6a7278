#pragma once

#include <cstddef>
#include <string>

#include "io/formats/GCode.h"
#include "io/pieces/Shapes.h"

namespace Vorn::IO {

/// Writes a tool path from rounded numbers only: what it remembers is what the machine knows.
class ToolPath {
 public:
  ToolPath(ContourFile const& contour, GCodeOptions const& options);

  void Line(std::string const& line) { text_ += line + "\n"; }

  /// A rapid move to the point, over the part where the options name a height; nothing when the
  /// tool stands there.
  void MoveTo(XY const& point);

  /// Cuts along the piece from where the tool stands. `number` is for messages, from 1.
  void Cut(Piece const& piece, std::size_t number);

  /// Leaves the part where the options name a height.
  void Retract();

  bool HasCut() const { return hasCut_; }
  std::string const& Text() const { return text_; }

 private:
  [[noreturn]] void Refuse(std::string const& message) const;
  std::string Written(double value) const;
  double Rounded(double value) const;
  XY Rounded(XY const& point) const;
  std::string Words(char first, char second, XY const& values) const;
  std::string EndWords(XY const& to) const;
  std::string CenterWords(XY const& to, XY const& way) const;
  std::string FeedWord(double feed);
  std::string CutFeedWord();
  void Plunge();
  XY WayToCenter(Piece const& arc, XY const& to) const;
  double RadiusAt(XY const& to, XY const& way) const;
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
