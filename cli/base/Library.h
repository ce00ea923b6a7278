#pragma once

namespace Vorn::IO {}

/// The program is written in the terms of the library that reads, measures and draws contours.
namespace Vorn::Cli {

using namespace IO;

}  // namespace Vorn::Cli
