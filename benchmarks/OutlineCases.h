#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "benchmarks/Outlines.h"
#include "benchmarks/Scale.h"

namespace Vorn::Benchmarks {

/// A kind of outline that does not cross itself.
struct OutlineCase {
  char const* name;
  std::vector<GeometryUtils::Elem> (*make)(std::int64_t count, bool hasArcs);
  bool hasArcs;
};

constexpr OutlineCase kOutlineCases[] = {
    {"ring", MakeRing, false},       {"teeth", MakeTeeth, false},
    {"needles", MakeNeedles, false}, {"ring_arcs", MakeRing, true},
    {"teeth_arcs", MakeTeeth, true}, {"needles_arcs", MakeNeedles, true},
};

/// The name of a benchmark: function, outline and number of pieces.
inline std::string NameOf(char const* function, OutlineCase const& outline, std::int64_t size) {
  return std::string(function) + '/' + outline.name + '/' + std::to_string(size);
}

/// The corners of an outline of segments, without the closing one.
inline std::vector<GeometryUtils::Point> VerticesOf(OutlineCase const& outline,
                                                    std::int64_t count) {
  std::vector<GeometryUtils::Point> vertices;
  for (auto const& elem : outline.make(count, false)) vertices.push_back(elem.end);
  vertices.pop_back();
  return vertices;
}

/// How long a series of sizes may take.
inline double SecondsForOutlines(Scale scale) { return scale == Scale::Quick ? 0.5 : 10.0; }

}  // namespace Vorn::Benchmarks
