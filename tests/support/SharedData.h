#pragma once

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <fstream>
#include <limits>
#include <optional>
#include <sstream>
#include <stdexcept>
#include <string>
#include <vector>

#include "vorn/GeometryUtils.h"

/// Measured contours that are kept outside the repository. The environment variable VORN_DATA_DIR
/// names their folder; tests that need them are skipped where it is not set.
namespace Vorn::Testing {

inline std::optional<std::string> SharedDataFolder() {
  char const* folder = std::getenv("VORN_DATA_DIR");
  if (folder == nullptr || *folder == '\0') return std::nullopt;
  return std::string(folder);
}

/// The rows of a CSV file without its header, as text cells. Throws when the file cannot be read.
inline std::vector<std::vector<std::string>> ReadCsvRows(std::string const& path) {
  std::ifstream file(path);
  if (!file) throw std::runtime_error("cannot open " + path);
  std::vector<std::vector<std::string>> rows;
  std::string line;
  std::getline(file, line);
  while (std::getline(file, line)) {
    if (!line.empty() && line.back() == '\r') line.pop_back();
    std::vector<std::string> cells;
    std::stringstream stream(line);
    for (std::string cell; std::getline(stream, cell, ',');) cells.push_back(cell);
    if (!cells.empty()) rows.push_back(cells);
  }
  return rows;
}

/// Points of a file with the header `x,y`, tolerance still 0.
inline std::vector<WPoint> ReadPoints(std::string const& path) {
  std::vector<WPoint> points;
  for (auto const& row : ReadCsvRows(path)) {
    if (row.size() < 2) throw std::runtime_error("short row in " + path);
    points.push_back({std::stod(row[0]), std::stod(row[1]), 0.0});
  }
  return points;
}

inline void SetTolerance(std::vector<WPoint>* points, double tolerance) {
  for (WPoint& p : *points) p.w = tolerance;
}

/// Each point gets 0.3 times the distance to its nearer neighbour, but no more than the cap.
inline void SetTolerancePerPoint(std::vector<WPoint>* points, double cap) {
  for (std::size_t i = 0; i < points->size(); ++i) {
    double nearer = std::numeric_limits<double>::infinity();
    auto const compare = [&](std::size_t j) {
      nearer = std::min(
          nearer, std::hypot((*points)[i].x - (*points)[j].x, (*points)[i].y - (*points)[j].y));
    };
    if (i > 0) compare(i - 1);
    if (i + 1 < points->size()) compare(i + 1);
    (*points)[i].w = std::min(cap, 0.3 * nearer);
  }
}

}  // namespace Vorn::Testing
