// Repeatable random numbers.

/** Numbers in [0, 1) that follow from the seed (xorshift). */
export function randomFrom(seed) {
  let state = seed >>> 0 || 1;
  return () => {
    state ^= state << 13;
    state ^= state >>> 17;
    state ^= state << 5;
    state >>>= 0;
    return state / 2 ** 32;
  };
}
