#include <cmath>
#include <cstdint>
#include <vector>

#include "geometry/cells/fast/SequenceSum.h"
#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/RandomGeometry.h"

// The sum over a sequence of words must have the bits of a loop over the terms one by one.

namespace Vorn::Testing {
namespace {

using Cells::SequenceSum;
using Cells::Words;

struct Chain {
  std::vector<Words> levels;
  std::size_t letters = 0;

  std::vector<std::uint32_t> Expand() const {
    std::vector<std::uint32_t> sequence = {0};
    for (Words const& words : levels) {
      std::vector<std::uint32_t> next;
      for (std::uint32_t const letter : sequence) {
        for (std::uint32_t const replacement : words.Of(letter)) next.push_back(replacement);
      }
      sequence.swap(next);
    }
    return sequence;
  }
};

/// Words of one to four letters, many of them three times the same one, as narrowing makes them.
Chain RandomChain(RandomGeometry& random, int depth) {
  Chain chain;
  std::size_t letters = 1;
  for (int level = 0; level < depth; ++level) {
    std::size_t const nextLetters = static_cast<std::size_t>(random.Integer(2, 9));
    Words words;
    for (std::size_t letter = 0; letter < letters; ++letter) {
      auto const pick = [&] {
        return static_cast<std::uint32_t>(
            random.Integer(0, static_cast<std::int32_t>(nextLetters) - 1));
      };
      if (random.Integer(0, 3) != 0) {
        words.letters.insert(words.letters.end(), 3, pick());
      } else {
        for (int i = random.Integer(0, 4); i > 0; --i) words.letters.push_back(pick());
      }
      words.ends.push_back(static_cast<std::uint32_t>(words.letters.size()));
    }
    chain.levels.push_back(words);
    letters = nextLetters;
  }
  chain.letters = letters;
  return chain;
}

double PlainSum(Chain const& chain, std::vector<double> const& terms,
                std::vector<bool> const& isSkipped) {
  double sum = 0.0;
  for (std::uint32_t const letter : chain.Expand()) {
    if (!isSkipped[letter]) sum += terms[letter];
  }
  return sum;
}

double FastSum(Chain const& chain, std::vector<double> const& terms,
               std::vector<bool> const& isSkipped) {
  std::vector<Words const*> levels;
  for (Words const& words : chain.levels) levels.push_back(&words);
  return SequenceSum(levels).Sum(terms, isSkipped);
}

/// Compares on many random chains; returns the longest sequence met.
template <typename MakeTerm>
std::size_t CompareOnRandomChains(std::uint64_t seeds, MakeTerm const& makeTerm) {
  std::size_t longest = 0;
  for (std::uint64_t seed = 1; seed <= seeds; ++seed) {
    SCOPED_TRACE(seed);
    RandomGeometry random(seed);
    Chain const chain = RandomChain(random, random.Integer(1, 10));
    std::vector<double> terms;
    std::vector<bool> isSkipped;
    for (std::size_t letter = 0; letter < chain.letters; ++letter) {
      terms.push_back(makeTerm(random));
      isSkipped.push_back(random.Integer(0, 5) == 0);
    }
    EXPECT_SAME_BITS(FastSum(chain, terms, isSkipped), PlainSum(chain, terms, isSkipped));
    longest = std::max(longest, chain.Expand().size());
  }
  return longest;
}

TEST(SequenceSum, HasTheBitsOfAPlainLoopForPositiveTerms) {
  EXPECT_GT(CompareOnRandomChains(600, [](RandomGeometry& r) { return r.Uniform(0.0, 1.0); }),
            20000U);
}

TEST(SequenceSum, HasTheBitsOfAPlainLoopForTermsOfBothSigns) {
  CompareOnRandomChains(600, [](RandomGeometry& r) { return r.Uniform(-1.0, 1.0); });
}

TEST(SequenceSum, HasTheBitsOfAPlainLoopForTermsOfVeryDifferentSize) {
  CompareOnRandomChains(600, [](RandomGeometry& r) { return r.Wide(-40, 40); });
}

TEST(SequenceSum, HasTheBitsOfAPlainLoopWhereTermsLieBetweenTwoGridPoints) {
  // Few significant bits next to sums of many: every other addition is a tie.
  CompareOnRandomChains(600, [](RandomGeometry& r) {
    return std::ldexp(static_cast<double>(r.Integer(-9, 9)), r.Integer(-56, 2));
  });
}

TEST(SequenceSum, HasTheBitsOfAPlainLoopAtTheEndsOfTheRange) {
  CompareOnRandomChains(300, [](RandomGeometry& r) { return r.Wide(-1074, -1000); });
  CompareOnRandomChains(300, [](RandomGeometry& r) { return r.Wide(1000, 1023); });
  CompareOnRandomChains(300, [](RandomGeometry& r) { return r.AnyDouble(); });
}

TEST(SequenceSum, CancelsToZeroAsAPlainLoopDoes) {
  CompareOnRandomChains(
      600, [](RandomGeometry& r) { return static_cast<double>(r.Integer(-2, 2)) * 0.1; });
}

TEST(SequenceSum, StaysExactNextToTheBoundsOfABinade) {
  // A first term right below or above a power of two, then many small ones of either sign.
  for (double const first : {Down(1.0), 1.0, Up(1.0), Down(2.0), 2.0, Up(2.0), -1.0, Down(-1.0)}) {
    for (double const step : {0x1p-53, 0x1p-52, 0x1.8p-53, -0x1p-53, -0x1p-54, -0x1.8p-54}) {
      Chain chain;
      chain.levels.push_back({{2}, {0, 1}});
      chain.levels.push_back({{1, 4}, {0, 1, 1, 1}});
      for (int level = 0; level < 6; ++level) chain.levels.push_back({{1, 4}, {0, 1, 1, 1}});
      chain.letters = 2;
      std::vector<double> const terms = {first, step};
      EXPECT_SAME_BITS(FastSum(chain, terms, {false, false}),
                       PlainSum(chain, terms, {false, false}));
    }
  }
}

}  // namespace
}  // namespace Vorn::Testing
