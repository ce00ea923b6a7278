// Runs a harness over files and folders of inputs: the way the tests try the corpus, without the
// run time of the fuzzer.
#include <cstdint>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <vector>

#include "Require.h"

namespace {

namespace fs = std::filesystem;

std::size_t count = 0;

void Replay(fs::path const& file) {
  std::ifstream in(file, std::ios::binary);
  std::vector<char> const bytes{std::istreambuf_iterator<char>(in), {}};
  std::vector<std::uint8_t> const data(bytes.begin(), bytes.end());
  LLVMFuzzerTestOneInput(data.data(), data.size());
  ++count;
}

}  // namespace

int main(int argc, char** argv) {
  for (int i = 1; i < argc; ++i) {
    if (!fs::is_directory(argv[i])) {
      Replay(argv[i]);
      continue;
    }
    for (fs::directory_entry const& entry : fs::directory_iterator(argv[i])) Replay(entry.path());
  }
  std::printf("%zu inputs\n", count);
  return count > 0 ? 0 : 1;
}
