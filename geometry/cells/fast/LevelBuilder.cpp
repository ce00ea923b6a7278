#include "geometry/cells/fast/LevelBuilder.h"

#include <cstdint>

namespace Vorn::Cells {

LevelBuilder::LevelBuilder(std::vector<std::size_t> const& counts, CellLevel* level)
    : counts_(counts), level_(*level), table_(counts.size()) {
  level_.clear();
  level_.words.ends.reserve(counts.size());
}

void LevelBuilder::Keep(BoxedTriangle const& boxed, std::size_t copies) {
  auto const letter = static_cast<Letter>(level_.triangles.size());
  level_.triangles.push_back(boxed);
  Append(letter, copies);
}

void LevelBuilder::EndWord() {
  level_.words.ends.push_back(static_cast<std::uint32_t>(level_.words.letters.size()));
}

void LevelBuilder::Append(Letter letter, std::size_t copies) {
  bool const isNew = letter == level_.counts.size();
  if (isNew) level_.counts.push_back(0);
  for (std::size_t copy = 0; copy < copies; ++copy) level_.words.letters.push_back(letter);
  std::size_t const occurrences = copies * counts_[level_.words.ends.size()];
  level_.counts[letter] += occurrences;
  level_.size += occurrences;
}

Letter LevelBuilder::LetterOf(Triangle const& triangle) {
  // Copies follow each other.
  if (!level_.words.letters.empty()) {
    Letter const previous = level_.words.letters.back();
    if (AreIdentical(level_.triangles[previous].triangle, triangle)) return previous;
  }
  return table_.FindOrAdd(triangle, &level_.triangles);
}

}  // namespace Vorn::Cells
