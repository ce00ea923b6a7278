// Columns of many numbers, which the data of the page may hold packed.

/** The bytes that base64 stands for. */
function bytesOf(base64) {
  const characters = atob(base64);
  const bytes = new Uint8Array(characters.length);
  for (let i = 0; i < bytes.length; ++i) bytes[i] = characters.charCodeAt(i);
  return bytes;
}

/** Reads whole numbers of seven bits a byte, the lowest first; more than 32 bits happen. */
class ByteReader {
  constructor(bytes) {
    this.bytes = bytes;
    this.at = 0;
  }

  next() {
    let number = 0, weight = 1;
    for (;;) {
      const byte = this.bytes[this.at++];
      number += (byte & 0x7f) * weight;
      if (!(byte & 0x80)) return number;
      weight *= 128;
    }
  }
}

/** The differences as they were packed: signs are in the lowest bit, and 0 stands for a run. */
function differencesOf(column) {
  const reader = new ByteReader(bytesOf(column.bytes));
  const numbers = new Float64Array(column.count);
  for (let i = 0; i < numbers.length; ++i) {
    const number = reader.next();
    if (number === 0) i += reader.next();
    else numbers[i] = number % 2 ? -(number + 1) / 2 : number / 2;
  }
  return numbers;
}

/**
 * The numbers of a packed column: differences are summed up `order` times and divided by
 * 10^decimals. Anything else, such as an array of numbers, is given back as it is.
 */
export function unpacked(column) {
  if (typeof column?.bytes !== 'string') return column;
  const numbers = differencesOf(column);
  for (let pass = 0; pass < column.order; ++pass) {
    for (let i = 1; i < numbers.length; ++i) numbers[i] += numbers[i - 1];
  }
  // Exact, which the operator for powers need not be.
  const power = Number(`1e${Math.abs(column.decimals)}`);
  for (let i = 0; i < numbers.length; ++i) {
    numbers[i] = column.decimals >= 0 ? numbers[i] / power : numbers[i] * power;
  }
  return numbers;
}
