// G-code: from the words of a tool path to the pieces of a contour.
#include <algorithm>
#include <cmath>
#include <iterator>
#include <optional>
#include <utility>
#include <vector>

#include "io/base/Words.h"
#include "io/formats/GCode.h"
#include "io/formats/GCodeBlocks.h"
#include "io/formats/GCodePlane.h"
#include "io/formats/LengthUnits.h"
#include "io/formats/Text.h"
#include "io/pieces/Shapes.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

/// How far the radii at the ends of an arc may differ: files with two decimals still pass.
constexpr double kLargestRadiusError = 0.01;
constexpr double kLargestRelativeRadiusError = 1e-3;

/// What a machine would remember, and the pieces it has cut.
class Machine {
 public:
  Machine(std::string path, ArcUse arcs) : path_(std::move(path)), arcs_(arcs) {}

  void Run(GCodeBlock const& block, std::size_t line) {
    line_ = line;
    isDwell_ = false;
    isElsewhere_ = false;
    takesP_ = false;
    for (GCodeWord const& word : block.codes) word.letter == 'G' ? TakeG(word) : TakeM(word);
    if (isDwell_) return;
    if (isElsewhere_) return Forget(block);
    if (block['P'] && !takesP_) Refuse("a P word belongs to G4 and G64 only");
    if (Moves(block)) Move(block);
  }

  bool HasEnded() const { return hasEnded_; }

  ContourFile Result() const {
    ContourFile contour;
    contour.pieces = pieces_;
    contour.isClosed = ReturnsToStart(pieces_);
    contour.units = units_;
    return contour;
  }

 private:
  [[noreturn]] void Refuse(std::string const& message) const { RefuseLine(path_, line_, message); }

  static bool Moves(GCodeBlock const& block) {
    constexpr std::string_view kWords = "XYZIJKR";
    return std::any_of(kWords.begin(), kWords.end(),
                       [&](char letter) { return block[letter].has_value(); });
  }

  void TakeM(GCodeWord const& word) {
    constexpr double kKnown[] = {0, 1, 2, 3, 4, 5, 6, 7, 8, 9, 30, 48, 49};
    if (std::find(std::begin(kKnown), std::end(kKnown), word.value) == std::end(kKnown)) {
      Refuse(Quoted(word.text) + " is not supported");
    }
    hasEnded_ = hasEnded_ || word.value == 2 || word.value == 30;
  }

  /// G words are told by ten times their number, since some have a digit after the point.
  void TakeG(GCodeWord const& word) {
    int const code = static_cast<int>(std::lround(std::clamp(word.value * 10.0, -1.0, 1e4)));
    bool const isTaken = TakeMotion(code) || TakeForBlock(code) || TakeUntilChanged(code);
    if (!isTaken && !IsPassedOver(code)) Refuse(Quoted(word.text) + " is not supported");
  }

  /// G0 to G3: how the tool moves.
  bool TakeMotion(int code) {
    bool const isMotion = code == 0 || code == 10 || code == 20 || code == 30;
    if (isMotion) motion_ = code / 10;
    return isMotion;
  }

  /// What the other words of this block mean: a pause, coordinates of the machine, a tolerance.
  bool TakeForBlock(int code) {
    isDwell_ = isDwell_ || code == 40;
    isElsewhere_ = isElsewhere_ || code == 280 || code == 300 || code == 530;
    takesP_ = takesP_ || code == 640;
    return code == 40 || code == 280 || code == 300 || code == 530 || code == 640;
  }

  /// What holds from here on.
  bool TakeUntilChanged(int code) {
    switch (code) {
      case 170:
        TakePlane(kPlaneXY);
        return true;
      case 180:
        TakePlane(kPlaneXZ);
        return true;
      case 200:
        TakeUnits("inch");
        return true;
      case 210:
        TakeUnits("mm");
        return true;
      case 900:
        isIncremental_ = false;
        return true;
      case 910:
        isIncremental_ = true;
        PlaceAtOrigin();
        return true;
      case 901:
      case 911:
        isCenterAbsolute_ = code == 901;
        return true;
      default:
        return false;
    }
  }

  /// Codes, ten times each, that leave the path as it is.
  static bool IsPassedOver(int code) {
    constexpr int kKnown[] = {400, 430, 490,                       // compensation off, tool length
                              540, 550, 560, 570, 580, 590,        // coordinates of the work
                              610, 800,                            // exact path, no cycle
                              930, 940, 950, 960, 970, 980, 990};  // feed, speed, return
    return std::find(std::begin(kKnown), std::end(kKnown), code) != std::end(kKnown);
  }

  void TakePlane(MachinePlane const& plane) {
    if (!pieces_.empty() && plane.second != plane_.second) {
      Refuse("the plane changes within the contour");
    }
    plane_ = plane;
  }

  void TakeUnits(char const* units) {
    if (!pieces_.empty() && units_ != units) Refuse("the units change within the contour");
    units_ = units;
  }

  /// Only a difference is known of where an incremental path begins.
  void PlaceAtOrigin() {
    for (std::size_t const axis : {plane_.first, plane_.second}) {
      if (!at_[axis]) at_[axis] = 0.0;
    }
  }

  /// A move in the coordinates of the machine: where the tool is then, those of the work do not
  /// tell.
  void Forget(GCodeBlock const& block) {
    for (std::size_t axis = 0; axis < at_.size(); ++axis) {
      if (block[kAxes[axis]]) at_[axis].reset();
    }
  }

  MachinePlace Target(GCodeBlock const& block) const {
    MachinePlace target = at_;
    for (std::size_t axis = 0; axis < at_.size(); ++axis) {
      std::optional<double> const& word = block[kAxes[axis]];
      if (word) target[axis] = isIncremental_ ? at_[axis].value_or(0.0) + *word : *word;
    }
    return target;
  }

  void Move(GCodeBlock const& block) {
    if (!motion_) Refuse("a move before any of G0 to G3");
    MachinePlace const target = Target(block);
    if (*motion_ >= 1 && at_[plane_.first] && at_[plane_.second]) {
      bool const movesAcross = at_[plane_.across] && target[plane_.across] != at_[plane_.across];
      Cut(block, {*target[plane_.first], *target[plane_.second]}, movesAcross);
    } else if (*motion_ >= 2) {
      Refuse("an arc before the place of the tool is known");
    }
    at_ = target;
  }

  void Cut(GCodeBlock const& block, XY const& to, bool movesAcross) {
    XY const from = {*at_[plane_.first], *at_[plane_.second]};
    bool const isArc = *motion_ >= 2;
    if (!isArc && AreEqual(from, to)) return;
    if (movesAcross) {
      Refuse(std::string("a cut that leaves the plane: ") + LowerCase({&kAxes[plane_.across], 1}) +
             " changes with " + LowerCase({&kAxes[plane_.first], 1}) + " and " +
             LowerCase({&kAxes[plane_.second], 1}));
    }
    if (isArc) return CutArc(block, from, to);
    if (block['I'] || block['J'] || block['K'] || block['R']) {
      Refuse("I, J, K and R belong to G2 and G3 only");
    }
    pieces_.push_back(MakeLine(from, to));
  }

  double LargestError(double radius) const {
    double const unit = units_ == "inch" ? kMillimetresPerInch : 1.0;
    return kLargestRadiusError / unit + kLargestRelativeRadiusError * radius;
  }

  void CutArc(GCodeBlock const& block, XY const& from, XY const& to) {
    bool const hasOffset = block[plane_.firstOffset] || block[plane_.secondOffset];
    std::string const second(1, plane_.secondOffset);
    if (hasOffset && block['R']) Refuse("an arc has both R and I or " + second);
    if (!hasOffset && !block['R']) Refuse("an arc has neither R nor I and " + second);
    bool const isCounterClockwise = (*motion_ == 3) != plane_.isMirrored;
    XY const center = hasOffset ? CenterByOffset(block, from)
                                : CenterByRadius(*block['R'], from, to, isCounterClockwise);
    double const atStart = Distance(from, center);
    double const atEnd = Distance(to, center);
    if (!(atStart > 0.0)) Refuse("an arc has no radius");
    if (!(std::fabs(atStart - atEnd) <= LargestError(atStart))) {
      Refuse("the radius of an arc is " + FormatShort(atStart) + " at its start and " +
             FormatShort(atEnd) + " at its end");
    }
    if (AreEqual(from, to)) {
      for (Piece const& half : MakeCircle(from, center, atStart, isCounterClockwise)) AddArc(half);
    } else {
      AddArc(MakeArc(from, to, center, (atStart + atEnd) / 2.0, isCounterClockwise));
    }
  }

  void AddArc(Piece const& arc) {
    if (arcs_ == ArcUse::Refuse) RefuseArc(arc, {path_, line_});
    pieces_.push_back(arc);
  }

  XY CenterByOffset(GCodeBlock const& block, XY const& from) const {
    std::optional<double> const& first = block[plane_.firstOffset];
    std::optional<double> const& second = block[plane_.secondOffset];
    if (!isCenterAbsolute_) return {from.x + first.value_or(0.0), from.y + second.value_or(0.0)};
    if (!first || !second) {
      Refuse(std::string("an absolute centre (G90.1) needs both I and ") + plane_.secondOffset);
    }
    return {*first, *second};
  }

  /// A negative radius asks for the longer of the two arcs.
  XY CenterByRadius(double radius, XY const& from, XY const& to, bool isCounterClockwise) const {
    double const size = std::fabs(radius);
    double const chord = Distance(from, to);
    if (AreEqual(from, to)) Refuse("an arc by R ends where it starts");
    if (chord / 2.0 - size > LargestError(size)) {
      Refuse("an arc by R with the radius " + FormatShort(size) + " cannot span " +
             FormatShort(chord));
    }
    double const height = std::sqrt(std::max(0.0, (size - chord / 2.0) * (size + chord / 2.0)));
    bool const isLeft = isCounterClockwise == (radius > 0.0);
    double const part = (isLeft ? height : -height) / chord;
    return {(from.x + to.x) / 2.0 - part * (to.y - from.y),
            (from.y + to.y) / 2.0 + part * (to.x - from.x)};
  }

  std::string path_;
  ArcUse arcs_;
  std::size_t line_ = 0;
  std::vector<Piece> pieces_;
  std::string units_;
  std::optional<int> motion_;
  MachinePlane plane_ = kPlaneXY;
  MachinePlace at_;
  bool isDwell_ = false;      ///< the words of this block say how long to wait
  bool isElsewhere_ = false;  ///< the words of this block are coordinates of the machine
  bool takesP_ = false;
  bool hasEnded_ = false;
  bool isIncremental_ = false;
  bool isCenterAbsolute_ = false;
};

}  // namespace

ContourFile ParseGCode(std::string_view text, std::string const& path, ArcUse arcs) {
  Machine machine(path, arcs);
  Lines lines(text);
  std::string_view line;
  while (lines.Next(&line)) {
    machine.Run(ReadGCodeBlock(line, lines.Number(), path), lines.Number());
    if (machine.HasEnded()) break;
  }
  return machine.Result();
}

}  // namespace Vorn::IO
