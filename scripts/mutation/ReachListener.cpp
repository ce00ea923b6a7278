// Writes down which blocks of the library each test runs. scripts/mutate links it into the test
// programs together with a library compiled with -fsanitize-coverage=inline-8bit-counters,pc-table.
//
// The file that VORN_REACH names gets the addresses of all blocks, one line "pc ADDRESS" each in
// the order of their numbers, and for each test a line "test NAME MICROSECONDS NUMBER...".

#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <ctime>
#include <fstream>
#include <span>
#include <vector>

#include "gtest/gtest.h"

namespace {

/// One entry of the compiler's table: the address of a block and what it is.
struct Block {
  std::uintptr_t address;
  std::uintptr_t flags;
};

std::vector<std::span<std::uint8_t>>& Counters() {
  static std::vector<std::span<std::uint8_t>> counters;
  return counters;
}

std::vector<std::span<Block const>>& Blocks() {
  static std::vector<std::span<Block const>> blocks;
  return blocks;
}

class ReachListener : public testing::EmptyTestEventListener {
 public:
  explicit ReachListener(char const* path) : out_(path) {}

  void OnTestProgramStart(testing::UnitTest const&) override {
    out_ << std::hex;
    for (std::span<Block const> const table : Blocks())
      for (Block const& block : table) out_ << "pc " << block.address << '\n';
    out_ << std::dec;
  }

  void OnTestStart(testing::TestInfo const&) override {
    for (std::span<std::uint8_t> const part : Counters()) std::ranges::fill(part, 0);
    start_ = std::clock();
  }

  void OnTestEnd(testing::TestInfo const& test) override {
    // Of the processor: other work on the machine must not make a test look slow.
    double const seconds = static_cast<double>(std::clock() - start_) / CLOCKS_PER_SEC;
    out_ << "test " << test.test_suite_name() << '.' << test.name() << ' '
         << static_cast<std::int64_t>(1e6 * seconds);
    std::size_t number = 0;
    for (std::span<std::uint8_t> const part : Counters())
      for (std::uint8_t const count : part) {
        if (count != 0) out_ << ' ' << number;
        ++number;
      }
    out_ << '\n';
  }

 private:
  std::ofstream out_;
  std::clock_t start_ = 0;
};

[[maybe_unused]] bool const kIsListening = [] {
  char const* const path = std::getenv("VORN_REACH");
  if (path != nullptr)
    testing::UnitTest::GetInstance()->listeners().Append(new ReachListener(path));
  return true;
}();

}  // namespace

// What the compiler calls when the program starts.
extern "C" {
void __sanitizer_cov_8bit_counters_init(std::uint8_t* first, std::uint8_t* last);
void __sanitizer_cov_pcs_init(Block const* first, Block const* last);

void __sanitizer_cov_8bit_counters_init(std::uint8_t* first, std::uint8_t* last) {
  for (std::span<std::uint8_t> const part : Counters())
    if (part.data() == first) return;
  Counters().emplace_back(first, last);
}

void __sanitizer_cov_pcs_init(Block const* first, Block const* last) {
  for (std::span<Block const> const table : Blocks())
    if (table.data() == first) return;
  Blocks().emplace_back(first, last);
}
}
