#pragma once

#include "geometry/fewest/Programme.h"

/// Linear programmes for tests of the kernel.
namespace Vorn::Testing {

/// The programme of all rows, without conditions. The columns have to outlive it.
inline Fewest::Programme ProgrammeOf(Fewest::Columns const& columns) {
  Fewest::Programme programme;
  programme.columns = &columns;
  programme.last = columns.Size();
  return programme;
}

}  // namespace Vorn::Testing
