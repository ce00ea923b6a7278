// Writes the example contours: exact geometry sampled at even steps, moved by a little noise.
//
// The noise comes from a fixed seed through a mapping of our own, because the distributions of the
// standard library differ between implementations, and the numbers are cut to five decimals, far
// above the last-bit differences of sin and cos. So the files are the same everywhere.

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <fstream>
#include <functional>
#include <iostream>
#include <iterator>
#include <numbers>
#include <random>
#include <string>
#include <vector>

namespace {

using std::numbers::pi;

struct Vec {
  double x = 0.0;
  double y = 0.0;
};

Vec operator+(Vec a, Vec b) { return {a.x + b.x, a.y + b.y}; }
Vec operator-(Vec a, Vec b) { return {a.x - b.x, a.y - b.y}; }
Vec operator*(double k, Vec a) { return {k * a.x, k * a.y}; }
double Dot(Vec a, Vec b) { return a.x * b.x + a.y * b.y; }
double Cross(Vec a, Vec b) { return a.x * b.y - a.y * b.x; }
double Length(Vec a) { return std::sqrt(Dot(a, a)); }
Vec Unit(Vec a) { return (1.0 / Length(a)) * a; }

/// The point at `angle` clockwise from the upward axis, where the gear tooth stands.
Vec FromTop(double radius, double angle) {
  return {radius * std::sin(angle), radius * std::cos(angle)};
}

/// One stretch of a path: its length and the point at a distance from its start.
struct Stretch {
  double length = 0.0;
  std::function<Vec(double)> at;
};

Stretch Line(Vec from, Vec to) {
  Vec const direction = Unit(to - from);
  return {Length(to - from), [=](double s) { return from + s * direction; }};
}

/// Part of a circle from angle `begin` over the signed `sweep`, angles as of atan2.
Stretch ArcOf(Vec center, double radius, double begin, double sweep) {
  double const turn = sweep < 0.0 ? -1.0 : 1.0;
  return {radius * std::fabs(sweep), [=](double s) {
            double const angle = begin + turn * s / radius;
            return center + Vec{radius * std::cos(angle), radius * std::sin(angle)};
          }};
}

/// The same stretch run the other way and mirrored in the upward axis.
Stretch Mirrored(Stretch const& original) {
  return {original.length, [original](double s) {
            Vec const p = original.at(original.length - s);
            return Vec{-p.x, p.y};
          }};
}

/// Points every `step` along the stretches joined together, the start included.
std::vector<Vec> Sample(std::vector<Stretch> const& path, double step) {
  double total = 0.0;
  for (Stretch const& stretch : path) total += stretch.length;
  std::vector<Vec> points;
  std::size_t current = 0;
  double passed = 0.0;
  for (std::size_t i = 0; static_cast<double>(i) * step <= total; ++i) {
    double const s = static_cast<double>(i) * step;
    while (current + 1 < path.size() && s > passed + path[current].length) {
      passed += path[current].length;
      ++current;
    }
    points.push_back(path[current].at(s - passed));
  }
  return points;
}

/// Seeded noise with a bell shape and hard limits: the mean of three even variables.
class Noise {
 public:
  explicit Noise(std::uint64_t seed) : engine_(seed) {}

  void Move(std::vector<Vec>* points, double limit) {
    // A disc of radius `limit` holds every shift when each coordinate keeps within limit/sqrt(2).
    double const perAxis = limit / std::numbers::sqrt2;
    for (Vec& point : *points) {
      point.x += perAxis * Bell();
      point.y += perAxis * Bell();
    }
  }

 private:
  double Even() { return static_cast<double>(engine_() >> 11) * 0x1p-52 - 1.0; }

  double Bell() {
    double const first = Even();
    double const second = Even();
    double const third = Even();
    return (first + second + third) / 3.0;
  }

  std::mt19937_64 engine_;
};

struct Corner {
  Vec at;
  double fillet = 0.0;
};

/// A polyline whose inner corners are rounded by fillets tangent to both sides (0: left sharp).
std::vector<Stretch> RoundedPolyline(std::vector<Corner> const& corners) {
  std::vector<Stretch> path;
  Vec from = corners.front().at;
  for (std::size_t i = 1; i + 1 < corners.size(); ++i) {
    Vec const corner = corners[i].at;
    double const radius = corners[i].fillet;
    Vec const in = Unit(corner - corners[i - 1].at);
    Vec const out = Unit(corners[i + 1].at - corner);
    double const turn = std::atan2(Cross(in, out), Dot(in, out));
    double const side = turn < 0.0 ? -1.0 : 1.0;
    double const cut = radius * std::tan(0.5 * std::fabs(turn));
    Vec const tangentIn = corner - cut * in;
    path.push_back(Line(from, tangentIn));
    if (radius > 0.0) {
      Vec const center = tangentIn + (side * radius) * Vec{-in.y, in.x};
      Vec const arm = tangentIn - center;
      path.push_back(ArcOf(center, radius, std::atan2(arm.y, arm.x), turn));
    }
    from = corner + cut * out;
  }
  path.push_back(Line(from, corners.back().at));
  return path;
}

std::vector<Vec> MachinedProfile() {
  std::vector<Corner> const corners = {
      {{0.0, 0.0}},         {{0.0, 14.0}, 2.0},   {{28.0, 14.0}, 4.0},  {{28.0, 26.0}, 3.0},
      {{52.0, 26.0}, 5.0},  {{60.0, 18.0}, 5.0},  {{84.0, 18.0}, 6.0},  {{92.0, 38.0}, 8.0},
      {{112.0, 38.0}, 4.0}, {{112.0, 22.0}, 6.0}, {{140.0, 22.0}, 2.5}, {{140.0, 4.0}},
  };
  return Sample(RoundedPolyline(corners), 0.5);
}

/// Travel of the follower, 0 to 1, over a cycloidal rise: no jump in speed or acceleration.
double Cycloidal(double part) { return part - std::sin(2.0 * pi * part) / (2.0 * pi); }

double CamRadius(double degrees) {
  constexpr double kBase = 25.0;
  constexpr double kLift = 9.0;
  constexpr double kRiseFrom = 60.0;
  constexpr double kRise = 100.0;
  constexpr double kTopDwell = 40.0;
  constexpr double kReturn = 110.0;
  double const sinceRise = degrees - kRiseFrom;
  if (sinceRise < 0.0) return kBase;
  if (sinceRise < kRise) return kBase + kLift * Cycloidal(sinceRise / kRise);
  double const sinceReturn = sinceRise - kRise - kTopDwell;
  if (sinceReturn < 0.0) return kBase + kLift;
  if (sinceReturn < kReturn) return kBase + kLift * (1.0 - Cycloidal(sinceReturn / kReturn));
  return kBase;
}

std::vector<Vec> Cam() {
  std::vector<Vec> points;
  for (int i = 0; i < 480; ++i) {
    double const degrees = 0.75 * i;
    double const angle = degrees * pi / 180.0;
    points.push_back(CamRadius(degrees) * Vec{std::cos(angle), std::sin(angle)});
  }
  return points;
}

/// Half a tooth of a full-depth gear, from the middle of its tip to the middle of the gap.
std::vector<Stretch> HalfTooth() {
  constexpr double kModule = 8.0;
  constexpr double kTeeth = 20.0;
  constexpr double kPressureAngle = 20.0 * pi / 180.0;
  constexpr double kFillet = 2.5;
  double const pitchRadius = 0.5 * kModule * kTeeth;
  double const baseRadius = pitchRadius * std::cos(kPressureAngle);
  double const tipRadius = pitchRadius + kModule;
  double const rootRadius = pitchRadius - 1.25 * kModule;

  // Half the angle of the tooth on the base circle, where the involute begins.
  double const baseAngle = pi / (2.0 * kTeeth) + std::tan(kPressureAngle) - kPressureAngle;
  double const tipRoll = std::sqrt(tipRadius * tipRadius / (baseRadius * baseRadius) - 1.0);
  double const tipAngle = baseAngle - (tipRoll - std::atan(tipRoll));
  double const involuteLength = 0.5 * baseRadius * tipRoll * tipRoll;
  auto involute = [=](double s) {
    // The length of an involute from its start is half the base radius times the roll squared.
    double const roll = std::sqrt(std::fmax(0.0, 2.0 * (involuteLength - s) / baseRadius));
    return FromTop(baseRadius * std::sqrt(1.0 + roll * roll), baseAngle - (roll - std::atan(roll)));
  };

  double const filletArm = rootRadius + kFillet;
  double const filletAngle = baseAngle + std::asin(kFillet / filletArm);
  Vec const filletCenter = FromTop(filletArm, filletAngle);
  double const radialEnd = std::sqrt(filletArm * filletArm - kFillet * kFillet);
  Vec const filletFrom = FromTop(radialEnd, baseAngle) - filletCenter;
  Vec const filletTo = FromTop(rootRadius, filletAngle) - filletCenter;
  double const filletSweep = std::atan2(Cross(filletFrom, filletTo), Dot(filletFrom, filletTo));

  return {
      ArcOf({}, tipRadius, 0.5 * pi, -tipAngle),
      {involuteLength, involute},
      Line(FromTop(baseRadius, baseAngle), FromTop(radialEnd, baseAngle)),
      ArcOf(filletCenter, kFillet, std::atan2(filletFrom.y, filletFrom.x), filletSweep),
      ArcOf({}, rootRadius, 0.5 * pi - filletAngle, filletAngle - pi / kTeeth),
  };
}

std::vector<Vec> GearTooth() {
  std::vector<Stretch> const half = HalfTooth();
  std::vector<Stretch> path;
  std::transform(half.rbegin(), half.rend(), std::back_inserter(path), Mirrored);
  path.insert(path.end(), half.begin(), half.end());
  return Sample(path, 0.12);
}

/// A bent strip: a line, a bend, a line and around a sharp corner another line; `size` is its whole
/// length.
std::vector<Vec> BentStrip(double size, double step) {
  double const bend = 0.15 * size;
  double const quarter = 0.5 * pi * bend;
  double const side = (size - quarter) / 3.0;
  Vec const bendStart = {side, 0.0};
  Vec const corner = {side + bend, bend + side};
  return Sample(
      {Line({0.0, 0.0}, bendStart), ArcOf(bendStart + Vec{0.0, bend}, bend, -0.5 * pi, 0.5 * pi),
       Line({side + bend, bend}, corner), Line(corner, corner + Vec{-0.8 * side, 0.6 * side})},
      step);
}

/// Points so dense that the noise makes them step backwards.
std::vector<Vec> DenseScan() { return BentStrip(16.0, 0.004); }

/// Too large to ship: see main.
std::vector<Vec> LargeScan() { return BentStrip(100.0, 0.001); }

struct Example {
  char const* file;
  char const* title;
  char const* tolerance;
  double noise;
  std::uint64_t seed;
  std::vector<Vec> (*points)();
};

bool Write(std::string const& directory, Example const& example) {
  std::vector<Vec> points = example.points();
  Noise(example.seed).Move(&points, example.noise);
  std::string const path = directory + "/" + example.file;
  std::ofstream file(path, std::ios::binary);
  file << "# " << example.title << "\n# units mm\n# tolerance " << example.tolerance << "\nx,y\n";
  for (Vec const& point : points) {
    char line[64];
    std::snprintf(line, sizeof line, "%.5f,%.5f\n", point.x, point.y);
    file << line;
  }
  file.close();
  if (!file) {
    std::cerr << "generate_examples: cannot write " << path << '\n';
    return false;
  }
  std::cout << path << ": " << points.size() << " points\n";
  return true;
}

}  // namespace

int main(int argc, char** argv) {
  bool const isLarge = argc == 3 && std::string(argv[2]) == "--large";
  if (argc != 2 && !isLarge) {
    std::cerr << "usage: generate_examples DIRECTORY [--large]\n"
                 "With --large it writes the scan of 100,000 points that is not shipped.\n";
    return 2;
  }
  if (isLarge) {
    return Write(argv[1], {"large_scan.csv", "bent strip, a point every micrometre", "0.01", 0.005,
                           20240615, LargeScan})
               ? 0
               : 1;
  }
  Example const examples[] = {
      {"machined_profile.csv", "half section of a turned part: lines joined by fillets", "0.02",
       0.006, 20240611, MachinedProfile},
      {"cam.csv", "plate cam, closed: base circle, cycloidal rise, dwell, cycloidal return", "0.02",
       0.006, 20240612, Cam},
      {"gear_tooth.csv", "gear tooth: module 8, 20 teeth, pressure angle 20 degrees", "0.008",
       0.0024, 20240613, GearTooth},
      {"dense_scan.csv", "bent strip, scanned far denser than the tolerance", "0.01", 0.005,
       20240614, DenseScan},
  };
  bool ok = true;
  for (Example const& example : examples) ok = Write(argv[1], example) && ok;
  return ok ? 0 : 1;
}
