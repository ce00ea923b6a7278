#include "vorn/io/Strategy.h"

namespace Vorn::IO {

std::string NameOf(Strategy strategy) {
  switch (strategy) {
    case Strategy::Mixed:
      return "mixed";
    case Strategy::Cells:
      return "cells";
    case Strategy::Arc:
      return "arc";
    case Strategy::Fewest:
      return "fewest";
  }
  return "unknown";
}

bool IsDeviationRelative(Strategy strategy) { return strategy != Strategy::Arc; }

bool NeedsSpacing(Strategy strategy) {
  return strategy == Strategy::Mixed || strategy == Strategy::Cells;
}

}  // namespace Vorn::IO
