// G-code: from the words of a tool path to the pieces of a contour.
#include <algorithm>
#include <array>
#include <cmath>
#include <optional>
#include <vector>

#include "io/base/Numbers.h"
#include "io/formats/GCode.h"
#include "io/formats/Text.h"
#include "io/pieces/Shapes.h"

namespace Vorn::IO {

namespace {

constexpr double kMillimetresPerInch = 25.4;

/// How far the radii at the ends of an arc may differ: files with two decimals still pass.
constexpr double kLargestRadiusError = 0.01;
constexpr double kLargestRelativeRadiusError = 1e-3;

struct Word {
  char letter = ' ';
  double value = 0.0;
  std::string_view text;
};

/// One block: the words of a line, by letter. Only G and M may be repeated.
struct Block {
  std::vector<Word> codes;
  std::array<std::optional<double>, 26> values;

  std::optional<double> const& operator[](char letter) const {
    return values[static_cast<std::size_t>(letter - 'A')];
  }
  std::optional<double>& operator[](char letter) {
    return values[static_cast<std::size_t>(letter - 'A')];
  }
};

/// Takes a line apart.
class Scanner {
 public:
  Scanner(std::string_view line, std::size_t number, std::string const& path)
      : line_(line), number_(number), path_(path) {}

  Block Read() {
    Block block;
    for (SkipComments(); at_ < line_.size(); SkipComments()) Sort(NextWord(), &block);
    return block;
  }

 private:
  [[noreturn]] void Refuse(std::string_view text, std::string const& complaint) const {
    RefuseLine(path_, number_, Quoted(text) + " " + complaint);
  }

  void SkipBlanks() { at_ = std::min(line_.find_first_not_of(" \t", at_), line_.size()); }

  void SkipComments() {
    for (SkipBlanks(); at_ < line_.size(); SkipBlanks()) {
      if (line_[at_] == ';' || (line_[at_] == '%' && Trimmed(line_) == "%")) {
        at_ = line_.size();
      } else if (line_[at_] == '(') {
        std::size_t const end = line_.find(')', at_);
        if (end == std::string_view::npos) Refuse(line_.substr(at_), "is a comment without end");
        at_ = end + 1;
      } else {
        return;
      }
    }
  }

  Word NextWord() {
    std::size_t const begin = at_;
    char const letter = LowerCase(line_.substr(at_, 1)).front();
    if (letter < 'a' || letter > 'z') Refuse(line_.substr(begin), "is no word of G-code");
    ++at_;
    SkipBlanks();
    std::size_t const digits = at_;
    at_ = std::min(line_.find_first_not_of("+-.0123456789", at_), line_.size());
    std::string_view const text = line_.substr(begin, at_ - begin);
    std::optional<double> const value = ParseNumber(line_.substr(digits, at_ - digits));
    if (!value) Refuse(text.size() > 1 ? text : line_.substr(begin), "is no word of G-code");
    if (!IsUsable(*value)) Refuse(text, "is too large");
    return {static_cast<char>(letter - 'a' + 'A'), *value, text};
  }

  void Sort(Word const& word, Block* block) const {
    constexpr std::string_view kKnown = "FGIJMNOPRSTXYZ";
    if (kKnown.find(word.letter) == std::string_view::npos) Refuse(word.text, "is not supported");
    if (word.letter == 'G' || word.letter == 'M') {
      block->codes.push_back(word);
      return;
    }
    std::optional<double>& value = (*block)[word.letter];
    if (value) Refuse(word.text, "is the second such word in its line");
    value = word.value;
  }

  std::string_view line_;
  std::size_t number_;
  std::string path_;
  std::size_t at_ = 0;
};

/// What a machine would remember, and the pieces it has cut.
class Machine {
 public:
  explicit Machine(std::string const& path) : path_(path) {}

  void Run(Block const& block, std::size_t line) {
    line_ = line;
    isDwell_ = false;
    for (Word const& word : block.codes) word.letter == 'G' ? TakeG(word) : TakeM(word);
    bool const moves = block['X'] || block['Y'] || block['Z'];
    bool const turns = block['I'] || block['J'] || block['R'];
    if (isDwell_) return;
    if (block['P']) Refuse("a P word belongs to G4 only");
    if (moves || turns) Move(block);
  }

  ContourFile Result() const {
    ContourFile contour;
    contour.pieces = pieces_;
    contour.isClosed = ReturnsToStart(pieces_);
    contour.units = units_;
    return contour;
  }

 private:
  [[noreturn]] void Refuse(std::string const& message) const { RefuseLine(path_, line_, message); }

  void TakeM(Word const& word) const {
    constexpr double kKnown[] = {0, 1, 2, 3, 4, 5, 6, 7, 8, 9, 30, 48, 49};
    if (std::find(std::begin(kKnown), std::end(kKnown), word.value) == std::end(kKnown)) {
      Refuse(Quoted(word.text) + " is not supported");
    }
  }

  void TakeG(Word const& word) {
    switch (static_cast<int>(std::lround(std::clamp(word.value * 10.0, -1.0, 1e4)))) {
      case 0:
      case 10:
      case 20:
      case 30:
        motion_ = static_cast<int>(word.value);
        break;
      case 40:
        isDwell_ = true;
        break;
      case 200:
        TakeUnits("inch");
        break;
      case 210:
        TakeUnits("mm");
        break;
      case 900:
        isIncremental_ = false;
        break;
      case 910:
        isIncremental_ = true;
        PlaceAtOrigin();
        break;
      case 901:
        isCenterAbsolute_ = true;
        break;
      case 911:
        isCenterAbsolute_ = false;
        break;
      case 170:  // the plane of x and y
      case 400:  // no cutter compensation
      case 490:  // no tool length compensation
      case 540:  // the six coordinate systems of the work
      case 550:
      case 560:
      case 570:
      case 580:
      case 590:
      case 610:  // ways to follow the path
      case 640:
      case 800:  // no cycle
      case 940:  // feed in units a minute
        break;
      default:
        Refuse(Quoted(word.text) + " is not supported");
    }
  }

  void TakeUnits(char const* units) {
    if (!pieces_.empty() && units_ != units) Refuse("the units change within the contour");
    units_ = units;
  }

  /// Only a difference is known of where an incremental path begins.
  void PlaceAtOrigin() {
    if (!x_) x_ = 0.0;
    if (!y_) y_ = 0.0;
  }

  std::optional<double> Target(std::optional<double> const& from,
                               std::optional<double> const& word) const {
    if (!word) return from;
    return isIncremental_ ? from.value_or(0.0) + *word : *word;
  }

  void Move(Block const& block) {
    if (!motion_) Refuse("a move before any of G0 to G3");
    std::optional<double> const x = Target(x_, block['X']);
    std::optional<double> const y = Target(y_, block['Y']);
    std::optional<double> const z = Target(z_, block['Z']);
    if (*motion_ >= 1 && x_ && y_) {
      Cut(block, {*x, *y}, z_ && z != z_);
    } else if (*motion_ >= 2) {
      Refuse("an arc before the place of the tool is known");
    }
    x_ = x;
    y_ = y;
    z_ = z;
  }

  void Cut(Block const& block, XY const& to, bool movesInZ) {
    XY const from = {*x_, *y_};
    bool const isArc = *motion_ >= 2;
    if (!isArc && AreEqual(from, to)) return;
    if (movesInZ) Refuse("a cut that leaves the plane: z changes with x and y");
    if (isArc) {
      CutArc(block, from, to);
    } else {
      if (block['I'] || block['J'] || block['R']) Refuse("I, J and R belong to G2 and G3 only");
      pieces_.push_back(MakeLine(from, to));
    }
  }

  double LargestError(double radius) const {
    double const unit = units_ == "inch" ? kMillimetresPerInch : 1.0;
    return kLargestRadiusError / unit + kLargestRelativeRadiusError * radius;
  }

  void CutArc(Block const& block, XY const& from, XY const& to) {
    bool const hasOffset = block['I'] || block['J'];
    if (hasOffset && block['R']) Refuse("an arc has both R and I or J");
    if (!hasOffset && !block['R']) Refuse("an arc has neither R nor I and J");
    bool const isCounterClockwise = *motion_ == 3;
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
      for (Piece const& half : MakeCircle(from, center, atStart, isCounterClockwise)) {
        pieces_.push_back(half);
      }
    } else {
      pieces_.push_back(MakeArc(from, to, center, (atStart + atEnd) / 2.0, isCounterClockwise));
    }
  }

  XY CenterByOffset(Block const& block, XY const& from) const {
    if (!isCenterAbsolute_) {
      return {from.x + block['I'].value_or(0.0), from.y + block['J'].value_or(0.0)};
    }
    if (!block['I'] || !block['J']) Refuse("an absolute centre (G90.1) needs both I and J");
    return {*block['I'], *block['J']};
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
  std::size_t line_ = 0;
  std::vector<Piece> pieces_;
  std::string units_;
  std::optional<int> motion_;
  std::optional<double> x_;
  std::optional<double> y_;
  std::optional<double> z_;
  bool isDwell_ = false;
  bool isIncremental_ = false;
  bool isCenterAbsolute_ = false;
};

}  // namespace

ContourFile ParseGCode(std::string_view text, std::string const& path) {
  Machine machine(path);
  Lines lines(text);
  std::string_view line;
  while (lines.Next(&line)) {
    machine.Run(Scanner(line, lines.Number(), path).Read(), lines.Number());
  }
  return machine.Result();
}

}  // namespace Vorn::IO
