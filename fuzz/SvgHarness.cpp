// SVG of shapes, paths and transforms: groups and chords change nothing where none are needed, what
// was read and written is read back in its place; and the same text with words lost or replaced.
#include <algorithm>
#include <array>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <optional>
#include <string>

#include "Input.h"
#include "Require.h"
#include "Texts.h"
#include "support/Bits.h"
#include "vorn/io/Formats.h"

namespace Vorn::Fuzz {
namespace {

using Testing::SameBits;

constexpr double kChords = 0.01;

/// Makes the elements of a drawing.
class Drawing {
 public:
  explicit Drawing(Input* input) : input_(*input) {}

  std::string Elements(int levels) {
    std::string text;
    for (int count = input_.Integer(1, 3); count > 0; --count) text += Element(levels);
    return text;
  }

 private:
  std::string Element(int levels) {
    switch (input_.Byte() % 9) {
      case 0:
        return levels > 0 ? Group(levels - 1) : "";
      case 1:
        return Shape("line", {"x1", "y1", "x2", "y2"});
      case 2:
        return Shape("rect", {"x", "y", "width", "height", "rx"});
      case 3:
        return Shape("circle", {"cx", "cy", "r"});
      case 4:
        return Shape("ellipse", {"cx", "cy", "rx", "ry"});
      case 5:
        return Polygon();
      default:
        return PathElement();
    }
  }

  // One call that takes bytes in each statement: compilers order those of one expression freely.
  std::string Group(int levels) {
    std::string text = "<g" + Attributes() + ">";
    text += Elements(levels);
    return text + "</g>";
  }

  std::string Polygon() {
    std::string text = "<polygon" + Attributes();
    int const count = input_.Integer(2, 5);
    text += " points=\"" + Numbers(2 * count) + "\"/>";
    return text;
  }

  std::string PathElement() {
    std::string text = "<path" + Attributes();
    text += " d=\"" + Path() + "\"/>";
    return text;
  }

  std::string Attributes() {
    constexpr std::array kStyles = {"", " style=\"display: none\"", " display=\"none\"",
                                    " class=\"a&amp;b\""};
    std::uint8_t const style = input_.Byte() % 16U;
    std::string text = kStyles[style < kStyles.size() ? style : 0U];
    if (input_.Byte() % 4U == 1U) text += " transform=\"" + Transform() + "\"";
    return text;
  }

  std::string Transform() {
    struct Function {
      char const* name;
      int count;
    };
    constexpr std::array kFunctions = {Function{"matrix", 6}, Function{"translate", 2},
                                       Function{"scale", 1},  Function{"rotate", 3},
                                       Function{"skewX", 1},  Function{"skewY", 1}};
    Function const& chosen = kFunctions[input_.Byte() % kFunctions.size()];
    return std::string(chosen.name) + "(" + Numbers(chosen.count) + ")";
  }

  std::string Shape(char const* name, std::initializer_list<char const*> attributes) {
    std::string text = std::string("<") + name + Attributes();
    for (char const* attribute : attributes) {
      if (input_.Byte() % 8U == 7U) continue;
      text += std::string(" ") + attribute + "=\"" + NumberText() + "\"";
    }
    return text + "/>";
  }

  std::string Path() {
    struct Command {
      char letter;
      int count;
    };
    constexpr std::array kCommands = {Command{'L', 2}, Command{'H', 1}, Command{'V', 1},
                                      Command{'C', 6}, Command{'S', 4}, Command{'Q', 4},
                                      Command{'T', 2}, Command{'A', 0}, Command{'Z', 0},
                                      Command{'M', 2}, Command{'A', 0}, Command{'L', 4}};
    std::string text = "M " + Numbers(2);
    for (int count = input_.Integer(1, 6); count > 0; --count) {
      Command const& command = kCommands[input_.Byte() % kCommands.size()];
      text += static_cast<char>(input_.Flip() ? command.letter - 'A' + 'a' : command.letter);
      text += command.letter == 'A' ? Arc() : Numbers(command.count);
    }
    return text;
  }

  std::string Arc() {
    std::string const radius = NumberText();
    std::string const other = input_.Byte() % 4U == 0U ? NumberText() : radius;
    std::string const turn = NumberText();
    std::uint8_t const flags = input_.Byte();
    return radius + " " + other + " " + turn + ((flags & 1U) != 0U ? " 0" : " 1") +
           ((flags & 2U) != 0U ? " 0 " : ",1,") + Numbers(2);
  }

  std::string Numbers(int count) {
    std::string text;
    for (int i = 0; i < count; ++i) text += (i > 0 ? " " : "") + NumberText();
    return text;
  }

  std::string NumberText() {
    constexpr std::array kOdd = {"1e-12", ".5", "-.25e1", "1e4", "0", "-0", "1e-300", "3E2"};
    std::uint8_t const odd = input_.Byte();
    if (odd < kOdd.size()) return kOdd[odd];
    char text[40];
    std::snprintf(text, sizeof text, "%.17g", input_.OnGrid());
    return text;
  }

  Input& input_;
};

std::string Page(std::string const& elements) {
  return R"(<svg xmlns="http://www.w3.org/2000/svg" width="100mm" height="100mm" )"
         R"(viewBox="0 0 100 100">)" +
         elements + "</svg>";
}

std::optional<IO::ContourFile> Read(std::string const& text, std::optional<double> chords) {
  try {
    IO::ContourFile contour = IO::ParseContour(text, "f", {IO::Format::Svg, chords});
    RequireSound(contour);
    return contour;
  } catch (IO::Failure const& failure) {
    RequirePlace(failure);
    return {};
  }
}

void RequireSame(IO::ContourFile const& a, IO::ContourFile const& b, char const* claim) {
  Require(a.pieces.size() == b.pieces.size(), claim);
  for (std::size_t i = 0; i < a.pieces.size(); ++i) {
    Require(a.pieces[i].kind == b.pieces[i].kind &&
                SameBits(a.pieces[i].start, b.pieces[i].start) &&
                SameBits(a.pieces[i].end, b.pieces[i].end),
            claim);
  }
}

double LargestOf(IO::Extent const& box) {
  return std::max(
      {std::fabs(box.low.x), std::fabs(box.low.y), std::fabs(box.high.x), std::fabs(box.high.y)});
}

/// Where the contour lies comes back, up to rounding: arcs are written by their ends and a radius.
void TryRoundTrip(IO::ContourFile const& contour) {
  IO::WriteOptions options;
  options.svgPlain = true;
  std::optional<IO::ContourFile> const again =
      Read(IO::ToText(contour, IO::Format::Svg, options), {});
  Require(again.has_value(), "what was written is read");
  IO::Extent const a = IO::ExtentOf(contour.pieces);
  IO::Extent const b = IO::ExtentOf(again->pieces);
  double const room = 1e-6 * LargestOf(a);
  Require(IO::Distance(a.low, b.low) <= room && IO::Distance(a.high, b.high) <= room,
          "what was written lies where it was");
}

void TryGood(std::string const& elements) {
  std::optional<IO::ContourFile> const plain = Read(Page(elements), {});
  std::optional<IO::ContourFile> const grouped = Read(Page("<g>" + elements + "</g>"), {});
  Require(plain.has_value() == grouped.has_value(), "a group around all refuses nothing");
  if (plain) {
    std::optional<IO::ContourFile> const flattened = Read(Page(elements), kChords);
    Require(flattened.has_value(), "chords are no reason to refuse");
    RequireSame(*plain, *grouped, "a group around all changes nothing");
    RequireSame(*plain, *flattened, "chords change nothing where there are no curves");
    TryRoundTrip(*plain);
  } else if (std::optional<IO::ContourFile> const flattened = Read(Page(elements), kChords)) {
    TryRoundTrip(*flattened);
  }
}

}  // namespace
}  // namespace Vorn::Fuzz

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size) {
  namespace Fuzz = Vorn::Fuzz;
  constexpr int kLevels = 3;
  Fuzz::Input input(data, size);
  std::string const elements = Fuzz::Drawing(&input).Elements(kLevels);
  Fuzz::TryGood(elements);
  Fuzz::Read(Fuzz::Mangle(Fuzz::Page(elements), &input), Fuzz::kChords);
  return 0;
}
