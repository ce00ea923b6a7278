// Packs a column of whole numbers in the plainest way, for the tests.

/** Bytes of seven bits, the lowest first, each but the last with its top bit set. */
function appendUnsigned(bytes, number) {
  let rest = BigInt(number);
  for (; rest >= 128n; rest /= 128n) bytes.push(Number(rest % 128n) + 128);
  bytes.push(Number(rest));
}

export function packedBytes(differences) {
  const bytes = [];
  for (let i = 0; i < differences.length; ++i) {
    const number = BigInt(differences[i]);
    appendUnsigned(bytes, number < 0n ? -2n * number - 1n : 2n * number);
    if (number !== 0n) continue;
    let run = 0;
    while (i + 1 < differences.length && differences[i + 1] === 0) {
      ++i;
      ++run;
    }
    appendUnsigned(bytes, run);
  }
  return Buffer.from(bytes).toString('base64');
}

/** A packed column of these multiples of 10^-decimals. */
export function packed(multiples, {decimals = 0, order = 0} = {}) {
  let differences = [...multiples];
  for (let pass = 0; pass < order; ++pass) {
    differences = differences.map((value, i) => (i === 0 ? value : value - differences[i - 1]));
  }
  return {decimals, order, count: multiples.length, bytes: packedBytes(differences)};
}
