#pragma once

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdlib>
#include <map>
#include <numbers>
#include <optional>
#include <sstream>
#include <string>
#include <vector>

/// What a machine does with a program of G-code, by the rules that controllers have in common. It
/// shares nothing with the reader under test.
namespace Vorn::Testing {

/// One cut of the tool, in the order X, Y, Z and in millimetres or whatever the units are.
struct ToolMove {
  std::array<double, 3> from{};
  std::array<double, 3> to{};
  bool isRapid = false;
  bool isArc = false;
  double centerA = 0.0;  ///< in the plane, as is centerB
  double centerB = 0.0;
  bool turnsFromAToB = false;  ///< from the first axis of the plane towards the second
};

/// Runs a program line by line and stops at the first fault, as a controller does.
class ToolController {
 public:
  std::string fault;            ///< of the first line that cannot be run; empty: none
  std::vector<ToolMove> moves;  ///< until then
  bool hasEnded = false;        ///< by M2 or M30
  std::size_t axisA = 0;        ///< first axis of the contour in the plane
  std::size_t axisB = 1;        ///< second axis

  void Run(std::string const& program) {
    std::istringstream lines(program);
    int number = 0;
    for (std::string line; !hasEnded && fault.empty() && std::getline(lines, line);) {
      ++number;
      RunLine(line);
      if (!fault.empty()) fault = "line " + std::to_string(number) + ": " + fault;
    }
    if (fault.empty() && !hasEnded) fault = "the program has no end";
  }

 private:
  using Words = std::map<char, double>;

  void RunLine(std::string line) {
    while (line.find('(') != std::string::npos) {
      std::size_t const begin = line.find('(');
      line.erase(begin, line.find(')', begin) - begin + 1);
    }
    std::istringstream words(line);
    Words values;
    for (std::string word; words >> word;) {
      char* end = nullptr;
      double const value = std::strtod(word.c_str() + 1, &end);
      if (*end != '\0' || end == word.c_str() + 1) return Stop("bad word " + word);
      Take(word[0], value, &values);
      if (!fault.empty()) return;
    }
    if (values.count('F') > 0) feed_ = values['F'];
    Move(values);
  }

  void Stop(std::string const& why) { fault = why; }

  void Take(char letter, double value, Words* values) {
    if (letter == 'G') return TakeG(value);
    if (letter == 'M') {
      hasEnded = hasEnded || value == 2.0 || value == 30.0;
    } else if (!values->emplace(letter, value).second) {
      Stop(std::string("two words ") + letter);
    }
  }

  void TakeG(double code) {
    if (code == 0.0 || code == 1.0 || code == 2.0 || code == 3.0) {
      motion_ = static_cast<int>(code);
    } else if (code == 17.0) {
      axisB = 1;
      isMirrored_ = false;
    } else if (code == 18.0) {
      axisB = 2;
      isMirrored_ = true;  // Z turns into X counter-clockwise
    } else if (code == 20.0) {
      isInch_ = true;
    } else if (code == 90.0 || code == 91.1) {
      modes_ += code == 90.0 ? "a" : "c";
    } else if (code != 21.0) {
      Stop("unknown code");
    }
  }

  void Move(Words& values) {
    std::array<double, 3> to = at_;
    constexpr std::string_view kAxes = "XYZ";
    bool isMove = false;
    for (std::size_t axis = 0; axis < 3; ++axis) {
      if (values.count(kAxes[axis]) == 0) continue;
      to[axis] = values[kAxes[axis]];
      isMove = true;
    }
    if (!isMove) return;
    if (motion_ < 0) return Stop("no motion mode");
    if (modes_.find('a') == std::string::npos) return Stop("the distance mode is not said");
    if (motion_ > 0 && !(feed_ > 0.0)) return Stop("cannot cut with no feed");
    ToolMove move;
    move.from = at_;
    move.to = to;
    move.isRapid = motion_ == 0;
    if (motion_ >= 2) MakeArc(values, &move);
    if (!fault.empty()) return;
    moves.push_back(move);
    at_ = to;
  }

  void MakeArc(Words& values, ToolMove* move) {
    move->isArc = true;
    move->turnsFromAToB = (motion_ == 3) != isMirrored_;
    char const second = axisB == 1 ? 'J' : 'K';
    double const a = move->from[axisA];
    double const b = move->from[axisB];
    double const endA = move->to[axisA];
    double const endB = move->to[axisB];
    if (values.count('R') > 0) {
      double const chord = std::hypot(endA - a, endB - b);
      double const radius = std::fabs(values['R']);
      if (chord == 0.0) return Stop("an arc by R that ends where it starts");
      if (chord > 2.0 * radius * (1.0 + 1e-9)) return Stop("R too small for its ends");
      double const height = std::sqrt(std::max(0.0, radius * radius - chord * chord / 4.0));
      double const side = (move->turnsFromAToB == (values['R'] > 0.0) ? height : -height) / chord;
      move->centerA = (a + endA) / 2.0 - side * (endB - b);
      move->centerB = (b + endB) / 2.0 + side * (endA - a);
      return;
    }
    if (values.count('I') + values.count(second) == 0) return Stop("an arc without centre");
    if (modes_.find('c') == std::string::npos) return Stop("the arc mode is not said");
    move->centerA = a + values['I'];
    move->centerB = b + values[second];
    double const atStart = std::hypot(values['I'], values[second]);
    double const atEnd = std::hypot(endA - move->centerA, endB - move->centerB);
    double const error = std::fabs(atStart - atEnd);
    double const unit = isInch_ ? 25.4 : 1.0;
    if (error * unit > 0.005 && error > 0.0005 * atStart) {
      Stop("the radii at the ends of an arc differ by " + std::to_string(error));
    }
  }

  std::array<double, 3> at_{};
  int motion_ = -1;
  double feed_ = 0.0;
  bool isInch_ = false;
  bool isMirrored_ = false;
  std::string modes_;
};

/// How far (a, b) is from what the tool has cut, in the plane of the program.
inline double DistanceToCuts(ToolController const& controller, double a, double b) {
  double least = HUGE_VAL;
  for (ToolMove const& move : controller.moves) {
    double const fromA = move.from[controller.axisA];
    double const fromB = move.from[controller.axisB];
    double const toA = move.to[controller.axisA];
    double const toB = move.to[controller.axisB];
    if (move.isRapid) continue;
    least = std::min({least, std::hypot(a - fromA, b - fromB), std::hypot(a - toA, b - toB)});
    if (move.isArc) {
      auto const angle = [&](double x, double y) {
        return std::atan2(y - move.centerB, x - move.centerA);
      };
      double const sense = move.turnsFromAToB ? 1.0 : -1.0;
      auto const turned = [&](double x, double y) {
        double const turn = sense * (angle(x, y) - angle(fromA, fromB));
        return turn < 0.0 ? turn + 2.0 * std::numbers::pi : turn;
      };
      if (turned(a, b) > turned(toA, toB)) continue;
      double const radius = std::hypot(fromA - move.centerA, fromB - move.centerB);
      least = std::min(least, std::fabs(std::hypot(a - move.centerA, b - move.centerB) - radius));
    } else {
      double const alongA = toA - fromA;
      double const alongB = toB - fromB;
      double const length2 = alongA * alongA + alongB * alongB;
      double const part = ((a - fromA) * alongA + (b - fromB) * alongB) / length2;
      if (!(part > 0.0 && part < 1.0)) continue;
      least = std::min(least, std::hypot(a - fromA - part * alongA, b - fromB - part * alongB));
    }
  }
  return least;
}

}  // namespace Vorn::Testing
