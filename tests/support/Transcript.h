#pragma once

#include <cinttypes>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <string>
#include <vector>

#include "support/Bits.h"
#include "vorn/GeometryUtils.h"

/// Everything one call leaves behind, as text: two implementations agree bit for bit exactly when
/// their transcripts are equal, and where they are not, the test framework shows the first line
/// that differs.
namespace Vorn::Testing {

/// Notes every percentage that is reported.
class ProgressRecorder : public ExecutionState {
 public:
  void SetProgress(std::int32_t percent) override { percents.push_back(percent); }

  std::vector<std::int32_t> percents;
};

class Transcript {
 public:
  std::string const& Text() const { return text_; }

  void Add(char const* name, bool value) { AddLine(name, value ? "true" : "false"); }
  void Add(char const* name, std::int32_t value) { AddLine(name, std::to_string(value)); }
  void Add(char const* name, ErrorCode value) { Add(name, static_cast<std::int32_t>(value)); }
  void Add(char const* name, double value) { AddLine(name, Format(value)); }
  void Add(char const* name, GeometryUtils::Point const& value) {
    AddLine(name, Format(value.x) + ' ' + Format(value.y));
  }

  void Add(char const* name, std::vector<std::int32_t> const& values) {
    std::string line;
    for (std::int32_t value : values) line += std::to_string(value) + ' ';
    AddLine(name, line);
  }

  void Add(char const* name, std::vector<GeometryUtils::IndexedPoint> const& values) {
    AddLine(name, std::to_string(values.size()));
    for (auto const& value : values) {
      AddLine(" sample", Format(value.pt.x) + ' ' + Format(value.pt.y) + ' ' + Format(value.w) +
                             ' ' + std::to_string(value.index));
    }
  }

  /// Cells grow to thousands of triangles: the first few in full, the rest as a digest.
  void Add(char const* name, std::vector<GeometryUtils::Triangle> const& cell) {
    AddLine(name, std::to_string(cell.size()));
    std::uint64_t digest = kDigestStart;
    std::size_t shown = 0;
    for (auto const& triangle : cell) {
      std::string line;
      for (auto const& pt : triangle.pts) line += Format(pt.x) + ' ' + Format(pt.y) + ' ';
      for (char c : line) digest = (digest ^ static_cast<unsigned char>(c)) * kDigestFactor;
      if (shown++ < kShownTriangles) AddLine(" triangle", line);
    }
    char text[32];
    std::snprintf(text, sizeof text, "%016" PRIx64, digest);
    AddLine(" digest", text);
  }

  /// The fields that a segment leaves unset are left out.
  void Add(char const* name, std::vector<GeometryUtils::Elem> const& contour) {
    AddLine(name, std::to_string(contour.size()));
    for (auto const& elem : contour) {
      Add(" type", static_cast<std::int32_t>(elem.type));
      Add(" end", elem.end);
      if (elem.type == GeometryUtils::ElemType::Segment) continue;
      Add(" center", elem.center);
      Add(" radius", elem.radius);
      Add(" direction", elem.direction);
      Add(" startAngle", elem.startAngle);
      Add(" endAngle", elem.endAngle);
    }
  }

  void Add(char const* name, std::vector<WPoint2> const& curve) {
    AddLine(name, std::to_string(curve.size()));
    for (auto const& s : curve) {
      AddLine(" sample",
              Format(s.dx) + ' ' + Format(s.dy) + ' ' + Format(s.dev) + ' ' + Format(s.weight));
    }
  }

 private:
  static constexpr std::uint64_t kDigestStart = 0xcbf29ce484222325U;
  static constexpr std::uint64_t kDigestFactor = 0x100000001b3U;
  static constexpr std::size_t kShownTriangles = 8;

  /// Hexadecimal, so nothing is rounded and -0.0 shows; all not-a-numbers read alike.
  static std::string Format(double value) {
    if (std::isnan(value)) return "nan";
    char text[40];
    std::snprintf(text, sizeof text, "%a", value);
    return text;
  }

  void AddLine(char const* name, std::string const& value) {
    text_ += name;
    text_ += ": ";
    text_ += value;
    text_ += '\n';
  }

  std::string text_;
};

}  // namespace Vorn::Testing
